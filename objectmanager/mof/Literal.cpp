#include "objectmanager/mof/Literal.h"

#include "objectmanager/model/DateTime.h"
#include "objectmanager/model/Names.h"
#include "objectmanager/model/NumberText.h"
#include "objectmanager/model/TypeNames.h"

#include <charconv>
#include <limits>

namespace mof {
namespace {

using om::NumberError;

bool isReal(CMPIType type) {
    return type == CMPI_real32 || type == CMPI_real64;
}

/// The decimal text of a hexadecimal number; any other as it is.
std::string decimal(std::string_view text) {
    const bool negative = text.front() == '-';
    const std::string_view digits = text.substr(negative ? 1 : 0);
    if (digits.size() < 3 || om::lower(digits[1]) != 'x') return std::string(text);
    std::uint64_t number = 0;
    const auto read = std::from_chars(digits.data() + 2, digits.data() + digits.size(), number, 16);
    if (read.ec != std::errc()) return "Infinity";
    return (negative ? "-" : "") + std::to_string(number);
}

std::optional<om::Value> typedElements(const om::Value& literal, CMPIType type) {
    const auto* elements = std::get_if<std::vector<om::Value>>(&literal.data);
    if (elements == nullptr) return std::nullopt;
    std::vector<om::Value> found;
    for (const om::Value& element : *elements) {
        const std::optional<om::Value> made = typed(element, om::elementType(type));
        if (!made) return std::nullopt;
        found.push_back(*made);
    }
    return om::Value{type, std::move(found)};
}

} // namespace

om::Value readLiteral(std::string_view text) {
    if (text.front() == '+') text.remove_prefix(1);
    const std::string number = decimal(text);
    om::Value value;
    for (const CMPIType type : std::initializer_list<CMPIType>{CMPI_uint64, CMPI_sint64, CMPI_real64}) {
        if (om::readNumber(number, type, value) == NumberError::None) return value;
    }
    return {CMPI_real64, std::numeric_limits<double>::infinity()};
}

std::optional<om::Value> typed(const om::Value& literal, CMPIType type) {
    if (om::isArray(type)) return typedElements(literal, type);
    if (const auto* text = std::get_if<std::string>(&literal.data)) {
        const bool fits = type == CMPI_string || (type == CMPI_dateTime && om::isDateTime(*text));
        return fits ? std::optional(om::Value{type, *text}) : std::nullopt;
    }
    if (std::holds_alternative<bool>(literal.data)) {
        return type == CMPI_boolean ? std::optional(literal) : std::nullopt;
    }
    const bool number = (type & (CMPI_INTEGER | CMPI_REAL)) != 0 || type == CMPI_char16;
    om::Value value;
    if (!number || (isReal(literal.type) && !isReal(type)) ||
        om::readNumber(om::numberText(literal), type, value) != NumberError::None) {
        return std::nullopt;
    }
    return value;
}

} // namespace mof
