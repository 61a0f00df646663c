#pragma once

#include "objectmanager/cimxml/Writer.h"
#include "objectmanager/endpoint/Call.h"

#include <optional>
#include <string>
#include <vector>

namespace endpoint {

/// Which part of an instance a client wants. Providers may leave all of that to the object manager. It may outlive the
/// call.
class Selection {
public:
    /// What the parameters PropertyList and IncludeClassOrigin say. LocalOnly and IncludeQualifiers are ignored on
    /// purpose: both are deprecated for instances, and clients that leave LocalOnly out expect inherited properties.
    explicit Selection(const Call& call);

    /// Only properties that this class has, too.
    void limitTo(const om::ResolvedClass& known) { limit = &known; }
    const std::optional<std::vector<std::string>>& properties() const { return list; }

    /// The selected part: without properties that are not asked for, or that its class does not have.
    om::Instance of(om::Instance instance) const;
    /// Writes INSTANCE.
    void write(cimxml::Writer& writer, const om::Instance& instance) const;

private:
    bool wants(const om::ResolvedClass* known, const std::string& property) const;

    const om::Schema& schema;
    std::optional<std::vector<std::string>> list;
    bool origins;
    const om::ResolvedClass* limit = nullptr;
};

/// The class that declares a property or method first, seen from `className`; empty where none does.
std::string_view originOfProperty(const om::Schema& schema, std::string_view className, std::string_view property);
std::string_view originOfMethod(const om::Schema& schema, std::string_view className, std::string_view method);

} // namespace endpoint
