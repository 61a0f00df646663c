#pragma once

#include "objectmanager/broker/Object.h"

namespace om {

class ArrayObject final : public Object<ArrayObject, CMPIArray> {
public:
    static const CMPIArrayFT table;
    /// More elements are refused; nobody needs them, and the memory would be the whole machine's.
    static constexpr CMPICount mostElements = 1U << 20U;

    /// An array of nulls.
    ArrayObject(Broker& broker, CMPICount size, CMPIType declaredType);
    ArrayObject(Broker& broker, CMPIType elementType, std::vector<Value> elements);

    CMPIType declaredType; ///< of the elements, as the maker said; CMPI_chars keeps its name
    std::vector<Value> elements;

private:
    void clear() noexcept override;
};

} // namespace om
