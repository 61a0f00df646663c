#include "support/Provider.h"

#include <stdexcept>

namespace test {
namespace {

om::Request request(om::Operation operation, const om::ObjectPath& path) {
    om::Request made;
    made.operation = operation;
    made.path = path;
    return made;
}

om::Answer associated(om::Operation operation, const om::ObjectPath& source, std::optional<std::string> assocClass,
                      std::optional<std::string> resultClass) {
    om::Request made = request(operation, source);
    made.assocClass = std::move(assocClass);
    made.resultClass = std::move(resultClass);
    return provider().run(made);
}

template <class Result>
std::vector<Result> resultsOf(const om::Answer& answer) {
    std::vector<Result> found;
    for (const auto& result : answer.results) found.push_back(std::get<Result>(result));
    return found;
}

} // namespace

om::ObjectManager& provider() {
    static om::ObjectManager manager(VK_PROVIDER_LIBRARY, "BaseServerProvider", "root/cimv2");
    return manager;
}

om::ObjectPath path(const std::string& className, const std::vector<std::pair<std::string, std::string>>& keys) {
    om::ObjectPath made;
    made.nameSpace = "root/cimv2";
    made.className = className;
    for (const auto& [name, value] : keys) made.keys.push_back({name, {CMPI_string, value}});
    return made;
}

om::ObjectPath associationPath(const std::string& className,
                               const std::vector<std::pair<std::string, om::ObjectPath>>& references) {
    om::ObjectPath made = path(className);
    for (const auto& [name, reference] : references)
        made.keys.push_back({name, {CMPI_ref, std::make_shared<const om::ObjectPath>(reference)}});
    return made;
}

om::Answer names(const std::string& className) {
    return provider().run(request(om::Operation::EnumInstanceNames, path(className)));
}

om::Answer instances(const std::string& className) {
    return provider().run(request(om::Operation::EnumInstances, path(className)));
}

om::Answer get(const om::ObjectPath& asked) {
    return provider().run(request(om::Operation::GetInstance, asked));
}

om::Answer associatorNames(const om::ObjectPath& source, std::optional<std::string> assocClass,
                           std::optional<std::string> resultClass) {
    return associated(om::Operation::AssociatorNames, source, std::move(assocClass), std::move(resultClass));
}

om::Answer associators(const om::ObjectPath& source, std::optional<std::string> assocClass,
                       std::optional<std::string> resultClass) {
    return associated(om::Operation::Associators, source, std::move(assocClass), std::move(resultClass));
}

om::Answer modify(const om::ObjectPath& asked, std::vector<om::NamedValue> properties) {
    om::Request made = request(om::Operation::ModifyInstance, asked);
    made.values = std::move(properties);
    return provider().run(made);
}

om::Answer invoke(const om::ObjectPath& asked, const std::string& method, std::vector<om::NamedValue> in) {
    om::Request made = request(om::Operation::InvokeMethod, asked);
    made.method = method;
    made.values = std::move(in);
    return provider().run(made);
}

std::vector<om::ObjectPath> paths(const om::Answer& answer) {
    return resultsOf<om::ObjectPath>(answer);
}

std::vector<om::Instance> instancesOf(const om::Answer& answer) {
    return resultsOf<om::Instance>(answer);
}

const om::Value* find(const std::vector<om::NamedValue>& values, const std::string& name) {
    for (const auto& [found, value] : values)
        if (found == name) return &value;
    return nullptr;
}

std::string text(const om::Value& value) {
    return std::get<std::string>(value.data);
}

std::vector<std::string> namesOf(const std::vector<om::NamedValue>& values) {
    std::vector<std::string> found;
    for (const auto& value : values) found.push_back(value.first);
    return found;
}

std::string print(const om::ObjectPath& printed) {
    std::string line = printed.className;
    char separator = '.';
    for (const auto& [name, value] : printed.keys) {
        line += separator + name + "=";
        if (const auto* reference = std::get_if<std::shared_ptr<const om::ObjectPath>>(&value.data))
            line += "(" + print(**reference) + ")";
        else
            line += "\"" + text(value) + "\"";
        separator = ',';
    }
    return line;
}

} // namespace test
