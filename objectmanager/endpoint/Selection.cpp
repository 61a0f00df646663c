#include "objectmanager/endpoint/Selection.h"

#include <algorithm>

namespace endpoint {
namespace {

template <class Declarations>
bool declares(const Declarations& list, std::string_view name) {
    return std::any_of(list.begin(), list.end(), [&](const auto& each) { return om::sameName(each.name, name); });
}

template <class Member>
std::string_view origin(const om::Schema& schema, std::string_view className, std::string_view name, Member member) {
    std::string_view found;
    for (const om::ClassDeclaration* c : schema.line(className)) {
        if (declares(c->*member, name)) found = c->name;
    }
    return found;
}

} // namespace

std::string_view originOfProperty(const om::Schema& schema, std::string_view className, std::string_view property) {
    return origin(schema, className, property, &om::ClassDeclaration::properties);
}

std::string_view originOfMethod(const om::Schema& schema, std::string_view className, std::string_view method) {
    return origin(schema, className, method, &om::ClassDeclaration::methods);
}

Selection::Selection(const Call& given)
    : schema(given.schema()), list(given.parameters.names("PropertyList")),
      origins(given.parameters.flag("IncludeClassOrigin", false)) {
    given.parameters.flag("LocalOnly", false);
    given.parameters.flag("IncludeQualifiers", false);
}

bool Selection::wants(const om::ResolvedClass* known, const std::string& property) const {
    if (known != nullptr && known->findProperty(property) == nullptr) return false;
    if (limit != nullptr && limit->findProperty(property) == nullptr) return false;
    return !list || om::containsName(*list, property);
}

om::Instance Selection::of(om::Instance instance) const {
    const om::ResolvedClass* known = schema.resolve(instance.path.className);
    auto& properties = instance.properties;
    properties.erase(std::remove_if(properties.begin(), properties.end(),
                                    [&](const om::NamedValue& each) { return !wants(known, each.first); }),
                     properties.end());
    return instance;
}

void Selection::write(cimxml::Writer& writer, const om::Instance& instance) const {
    if (!origins) {
        writer.instance(instance);
        return;
    }
    const std::string& className = instance.path.className;
    writer.instance(instance, [&](const std::string& property) {
        const std::string_view found = originOfProperty(schema, className, property);
        return found.empty() ? std::string_view(className) : found;
    });
}

} // namespace endpoint
