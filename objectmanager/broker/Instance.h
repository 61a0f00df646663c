#pragma once

#include "objectmanager/broker/Object.h"
#include "objectmanager/model/Schema.h"

#include <optional>
#include <string>
#include <vector>

namespace om {

class InstanceObject final : public Object<InstanceObject, CMPIInstance> {
public:
    static const CMPIInstanceFT table;

    InstanceObject(Broker& broker, Instance value);

    /// Sets a property as a provider may: with the schema's type, where the schema knows the property.
    void set(const char* name, const CMPIValue* value, CMPIType type);
    void setPath(ObjectPath path);
    void setFilter(const char** properties, const char** keys);

    const Instance& value() const { return instance; }
    /// The path, with those keys that it lacks and key properties give.
    ObjectPath completePath() const;
    /// The instance with its complete path.
    Instance complete() const;

private:
    void clear() noexcept override;

    Instance instance;
    const ResolvedClass* schemaClass; ///< null for a class that the schema lacks
    std::optional<std::vector<std::string>> filter;
};

} // namespace om
