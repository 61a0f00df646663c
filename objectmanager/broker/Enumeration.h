#pragma once

#include "objectmanager/broker/Object.h"

#include <vector>

namespace om {

class EnumerationObject final : public Object<EnumerationObject, CMPIEnumeration> {
public:
    static const CMPIEnumerationFT table;

    EnumerationObject(Broker& broker, CMPIType type, std::vector<Value> list)
        : Object(broker), elementType(type), elements(std::move(list)) {}

    CMPIType elementType;
    std::vector<Value> elements;
    std::size_t next = 0;

private:
    void clear() noexcept override;
};

} // namespace om
