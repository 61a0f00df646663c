#include "objectmanager/endpoint/Parameters.h"

#include "objectmanager/cimxml/Errors.h"
#include "objectmanager/cimxml/Typing.h"
#include "objectmanager/model/Names.h"

#include <algorithm>

namespace endpoint {
namespace {

using Kind = cimxml::ValueElement::Kind;

[[noreturn]] void invalid(std::string_view name, const char* what) {
    throw cimxml::CimError(CMPI_RC_ERR_INVALID_PARAMETER, "parameter " + std::string(name) + ' ' + what);
}

} // namespace

Parameters::Parameters(const std::vector<cimxml::ParameterElement>& given,
                       const std::vector<std::string_view>& allowed) {
    for (const cimxml::ParameterElement& parameter : given) {
        const auto same = [&](std::string_view name) { return om::sameName(name, parameter.name); };
        if (std::none_of(allowed.begin(), allowed.end(), same)) invalid(parameter.name, "is unknown");
        if (std::any_of(list.begin(), list.end(), [&](const auto* each) { return same(each->name); })) {
            invalid(parameter.name, "is given twice");
        }
        list.push_back(&parameter);
    }
}

const cimxml::ValueElement* Parameters::find(std::string_view name) const {
    for (const cimxml::ParameterElement* each : list) {
        if (om::sameName(each->name, name)) return each->value.kind == Kind::None ? nullptr : &each->value;
    }
    return nullptr;
}

bool Parameters::flag(std::string_view name, bool otherwise) const {
    const cimxml::ValueElement* value = find(name);
    if (value == nullptr) return otherwise;
    if (value->kind == Kind::Text) {
        const std::size_t first = value->text.find_first_not_of(" \t\r\n");
        const std::size_t last = value->text.find_last_not_of(" \t\r\n");
        const std::string word = first == std::string::npos ? "" : value->text.substr(first, last - first + 1);
        if (om::sameName(word, "TRUE")) return true;
        if (om::sameName(word, "FALSE")) return false;
    }
    invalid(name, "is neither true nor false");
}

std::optional<std::string> Parameters::className(std::string_view name) const {
    const cimxml::ValueElement* value = find(name);
    if (value == nullptr) return std::nullopt;
    if (value->kind != Kind::ClassName) invalid(name, "is no name of a class");
    return value->path->className;
}

std::optional<std::string> Parameters::text(std::string_view name) const {
    const cimxml::ValueElement* value = find(name);
    if (value == nullptr) return std::nullopt;
    if (value->kind != Kind::Text) invalid(name, "is no text");
    return value->text.empty() ? std::nullopt : std::optional<std::string>(value->text);
}

std::optional<std::uint32_t> Parameters::number(std::string_view name) const {
    const cimxml::ValueElement* value = find(name);
    if (value == nullptr) return std::nullopt;
    try {
        static const om::Schema none({});
        const om::Value number = cimxml::typedValue(*value, CMPI_uint32, {none, {}, cimxml::Trust::Schema});
        return static_cast<std::uint32_t>(std::get<std::uint64_t>(number.data));
    } catch (const cimxml::CimError&) {
        invalid(name, "is no number");
    }
}

std::optional<std::vector<std::string>> Parameters::names(std::string_view name) const {
    const cimxml::ValueElement* value = find(name);
    if (value == nullptr) return std::nullopt;
    if (value->kind != Kind::Array) invalid(name, "is no array");
    std::vector<std::string> found;
    for (const cimxml::ValueElement& element : value->elements) {
        if (element.kind != Kind::Text) invalid(name, "holds a null");
        found.push_back(element.text);
    }
    return found;
}

std::string Parameters::requiredClassName(std::string_view name) const {
    const std::optional<std::string> found = className(name);
    if (!found) invalid(name, "is missing");
    return *found;
}

std::string Parameters::requiredText(std::string_view name) const {
    const std::optional<std::string> found = text(name);
    if (!found) invalid(name, "is missing");
    return *found;
}

const cimxml::PathElement& Parameters::requiredInstanceName(std::string_view name) const {
    return *required(name, Kind::InstanceName).path;
}

const cimxml::PathElement& Parameters::requiredObjectName(std::string_view name) const {
    const cimxml::ValueElement* value = find(name);
    if (value == nullptr) invalid(name, "is missing");
    if (value->kind != Kind::InstanceName && value->kind != Kind::ClassName) invalid(name, "is no name of an object");
    return *value->path;
}

const cimxml::ValueElement& Parameters::required(std::string_view name, Kind kind) const {
    const cimxml::ValueElement* value = find(name);
    if (value == nullptr) invalid(name, "is missing");
    if (value->kind != kind) invalid(name, "holds something else");
    return *value;
}

} // namespace endpoint
