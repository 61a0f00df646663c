#pragma once

#include "objectmanager/endpoint/NameSpace.h"

#include <string>
#include <vector>

namespace endpoint {

/// The namespace `interop`, where clients ask first which namespaces there are and who answers. `others` are the
/// namespaces beside it, `host` the name of this computer.
NameSpace interopNameSpace(std::vector<std::string> others, const std::string& host);

} // namespace endpoint
