#pragma once

#include "objectmanager/broker/Object.h"

#include <vector>

namespace om {

class ArgsObject final : public Object<ArgsObject, CMPIArgs> {
public:
    static const CMPIArgsFT table;

    explicit ArgsObject(Broker& broker, std::vector<NamedValue> list = {}) : Object(broker), values(std::move(list)) {}

    std::vector<NamedValue> values;

private:
    void clear() noexcept override;
};

} // namespace om
