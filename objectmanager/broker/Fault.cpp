#include "objectmanager/broker/Fault.h"

#include <utility>

namespace om {

#define OM_NAME(name) #name,

const std::vector<std::string>& faultNames() {
    static const std::vector<std::string> names = {OM_FAULT_KINDS(OM_NAME)};
    return names;
}

#undef OM_NAME

std::optional<FaultKind> faultKind(std::string_view name) {
    const std::vector<std::string>& names = faultNames();
    for (std::size_t i = 0; i < names.size(); ++i) {
        if (names[i] == name) return static_cast<FaultKind>(i + 1); // None has no name
    }
    return std::nullopt;
}

CallWatch::CallWatch(const std::optional<Fault>& fault, CallObserver observer)
    : fault_(fault.value_or(Fault())), observer_(std::move(observer)) {
    if ((fault || observer_) && current_ == nullptr) current_ = this;
}

CallWatch::~CallWatch() {
    if (current_ == this) current_ = nullptr;
}

} // namespace om
