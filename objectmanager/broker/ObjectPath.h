#pragma once

#include "objectmanager/broker/Object.h"

namespace om {

class PathObject final : public Object<PathObject, CMPIObjectPath> {
public:
    static const CMPIObjectPathFT table;

    PathObject(Broker& broker, ObjectPath value) : Object(broker), path(std::move(value)) {}

    ObjectPath path;

private:
    void clear() noexcept override;
};

} // namespace om
