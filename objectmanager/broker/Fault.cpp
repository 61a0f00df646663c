#include "objectmanager/broker/Fault.h"

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

FaultWatch::FaultWatch(const std::optional<Fault>& fault) : fault_(fault.value_or(Fault())) {
    if (fault && current_ == nullptr) current_ = this;
}

FaultWatch::~FaultWatch() {
    if (current_ == this) current_ = nullptr;
}

} // namespace om
