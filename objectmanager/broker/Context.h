#pragma once

#include "objectmanager/broker/Object.h"

#include <string>
#include <vector>

namespace om {

/// An entry of a context: a value, or a pointer with a length that only the one who put it there understands.
struct ContextEntry {
    std::string name;
    Value value; ///< of type CMPI_ptr without data for a pointer
    CMPIValuePtr pointer = {};
};

class ContextObject final : public Object<ContextObject, CMPIContext> {
public:
    static const CMPIContextFT table;

    ContextObject(Broker& broker, std::vector<ContextEntry> list) : Object(broker), entries(std::move(list)) {}

    std::vector<ContextEntry> entries;

private:
    void clear() noexcept override;
};

/// The entries that every call has: no flags, the namespace, the principal, and role and languages unknown.
std::vector<ContextEntry> usualEntries(const std::string& nameSpace, const std::string& principal = {});

} // namespace om
