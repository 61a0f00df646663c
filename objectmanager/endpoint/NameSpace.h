#pragma once

#include "objectmanager/broker/ObjectManager.h"

#include <functional>
#include <string>
#include <vector>

namespace endpoint {

/// What answers an operation: a provider, called through the broker. Called from several threads at once.
using Ask = std::function<om::Answer(const om::Request&)>;

/// A namespace: its classes, and who is asked for their instances.
struct NameSpace {
    std::string name;
    std::vector<std::string> aliases; ///< other names that clients use
    const om::Schema* schema = nullptr;
    Ask ask;
};

/// Who sent a request, and what they may do.
struct Caller {
    std::string user;    ///< empty: nobody in particular
    std::string address; ///< for the log
    bool mayRead = false;
    bool mayChange = false;
};

} // namespace endpoint
