#include "objectmanager/vkcim/ValueText.h"

#include "objectmanager/model/DateTime.h"
#include "objectmanager/model/Names.h"
#include "objectmanager/model/NumberText.h"
#include "objectmanager/model/TypeNames.h"
#include "objectmanager/vkcim/ParseError.h"
#include "objectmanager/vkcim/PathText.h"

#include <fmt/format.h>

namespace vkcim {
namespace {

bool isBoolean(std::string_view text) {
    return om::sameName(text, "true") || om::sameName(text, "false");
}

om::Value parseNumber(std::string_view text, CMPIType type, std::size_t offset) {
    om::Value value;
    switch (om::readNumber(text, type, value)) {
    case om::NumberError::None:
        return value;
    case om::NumberError::OutOfRange:
        throw ParseError(offset,
                         fmt::format("{} is out of range for {} ({})", text, om::typeName(type), om::rangeOf(type)));
    default:
        throw ParseError(offset, fmt::format("\"{}\" is no {}", text, om::typeName(type)));
    }
}

om::Value parseScalar(const SourceText& source, CMPIType type, const ValueContext& context) {
    const std::string_view text = source.text();
    const std::size_t offset = source.offsetOf(0);
    switch (type) {
    case CMPI_boolean:
        if (!isBoolean(text)) throw ParseError(offset, fmt::format("\"{}\" is neither true nor false", text));
        return {type, om::sameName(text, "true")};
    case CMPI_string:
        return {type, std::string(text)};
    case CMPI_dateTime:
        if (!om::isDateTime(text)) {
            throw ParseError(offset, fmt::format("\"{}\" is no datetime (yyyymmddhhmmss.mmmmmm+utc with the offset in "
                                                 "minutes, or ddddddddhhmmss.mmmmmm:000)",
                                                 text));
        }
        return {type, std::string(text)};
    case CMPI_ref:
        return {type, std::make_shared<const om::ObjectPath>(
                          parsePath(source, context.nameSpace, context.schema, context.remarks))};
    default:
        return parseNumber(text, type, offset);
    }
}

om::Value parseArray(const SourceText& source, CMPIType type, const ValueContext& context) {
    std::vector<om::Value> elements;
    if (source.size() == 0) return {type, elements};
    SourceText element;
    for (std::size_t i = 0; i < source.size(); ++i) {
        const std::size_t offset = source.offsetOf(i);
        if (source[i] == ',') {
            element.end(offset);
            elements.push_back(parseScalar(element, om::elementType(type), context));
            element = SourceText();
            continue;
        }
        if (source[i] == '\\') {
            ++i;
            if (i == source.size() || (source[i] != ',' && source[i] != '\\')) {
                throw ParseError(offset, "a '\\' in an array stands before ',' or '\\' alone");
            }
        }
        element.append(source[i], offset);
    }
    element.end(source.offsetOf(source.size()));
    elements.push_back(parseScalar(element, om::elementType(type), context));
    return {type, elements};
}

om::Value parseTyped(const SourceText& source, CMPIType type, const ValueContext& context) {
    return om::isArray(type) ? parseArray(source, type, context) : parseScalar(source, type, context);
}

CMPIType guessType(std::string_view text) {
    if (isBoolean(text)) return CMPI_boolean;
    if (om::looksLikeReal(text)) return CMPI_real64;
    if (!om::looksLikeInteger(text)) return CMPI_string;
    if (text.front() == '-') return CMPI_sint64;
    om::Value value;
    return om::readNumber(text, CMPI_uint32, value) == om::NumberError::None ? CMPI_uint32 : CMPI_uint64;
}

std::string joined(const std::vector<om::Value>& elements, const char* separator, bool escape,
                   const ValueContext& context) {
    std::string text;
    for (const om::Value& element : elements) {
        if (&element != &elements.front()) text += separator;
        for (const char c : plainText(element, context)) {
            if (escape && (c == ',' || c == '\\')) text += '\\';
            text += c;
        }
    }
    return text;
}

} // namespace

om::Value parseValue(std::string_view text, std::optional<CMPIType> declared, const ValueContext& context,
                     std::size_t offset) {
    if (text.empty()) return {CMPI_string, std::string()};
    const SourceText source(text, offset);
    const std::size_t colon = text.find(':');
    if (colon != std::string_view::npos) {
        const std::string_view word = text.substr(0, colon);
        if (const auto type = om::typeNamed(word)) return parseTyped(source.from(colon + 1), *type, context);
        if (word == "null") {
            const std::string_view name = text.substr(colon + 1);
            if (const auto type = om::typeNamed(name)) return {*type, std::monostate()};
            throw ParseError(offset + colon + 1, fmt::format("\"{}\" is no type", name));
        }
    }
    // A declared type that has no word (an embedded instance) cannot be written.
    const bool usable = declared && om::typeNamed(om::typeName(*declared));
    return parseTyped(source, usable ? *declared : guessType(text), context);
}

om::NamedValue parseAssignment(std::string_view text, const DeclaredType& declaredType, const ValueContext& context) {
    const std::size_t equals = text.find('=');
    if (equals == std::string_view::npos) throw ParseError(text.size(), "'=' is missing (NAME=VALUE)");
    if (equals == 0) throw ParseError(0, "the name before '=' is missing");
    std::string name(text.substr(0, equals));
    om::Value value = parseValue(text.substr(equals + 1), declaredType(name), context, equals + 1);
    return {std::move(name), std::move(value)};
}

std::string plainText(const om::Value& value, const ValueContext& context) {
    if (value.isNull()) return "null";
    if (const auto* flag = std::get_if<bool>(&value.data)) return *flag ? "true" : "false";
    if (const auto* text = std::get_if<std::string>(&value.data)) return *text;
    if (const auto* path = std::get_if<std::shared_ptr<const om::ObjectPath>>(&value.data)) {
        return *path ? qualifiedPathText(**path, context.nameSpace, context.schema) : "null";
    }
    if (const auto* instance = std::get_if<std::shared_ptr<const om::Instance>>(&value.data)) {
        return *instance ? qualifiedPathText((*instance)->path, context.nameSpace, context.schema) : "null";
    }
    if (const auto* elements = std::get_if<std::vector<om::Value>>(&value.data)) {
        return joined(*elements, ", ", false, context);
    }
    return om::numberText(value);
}

std::string valueText(const om::Value& value, const ValueContext& context) {
    if (value.isNull()) return "null:" + om::typeName(value.type);
    const auto* elements = std::get_if<std::vector<om::Value>>(&value.data);
    return om::typeName(value.type) + ':' +
           (elements ? joined(*elements, ",", true, context) : plainText(value, context));
}

} // namespace vkcim
