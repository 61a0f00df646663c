#pragma once

#include "objectmanager/model/Schema.h"

#include <string>
#include <vector>

namespace mof {

/// Notes what is wrong with a class that is in the schema: what a MOF compiler checks, and what we ask of our own
/// beyond that.
void checkClass(const om::Schema& schema, const om::ClassDeclaration& declared, bool ours,
                std::vector<std::string>& complaints);

/// A type as complaints and documents name it: `uint16[]`, `CIM_System ref`.
std::string typeText(CMPIType type, const std::string& referenceClass = {});

/// FILE:LINE
std::string shown(const om::Place& place);

} // namespace mof
