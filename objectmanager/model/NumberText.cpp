#include "objectmanager/model/NumberText.h"

#include "objectmanager/model/Characters.h"

#include <fmt/format.h>

#include <charconv>
#include <cmath>
#include <limits>

namespace om {
namespace {

template <typename Number>
std::string shortest(Number number) {
    char buffer[64];
    const std::to_chars_result end = std::to_chars(buffer, buffer + sizeof buffer, number);
    return {buffer, end.ptr};
}

std::string realText(double number, CMPIType type) {
    if (std::isnan(number)) return "NaN";
    if (std::isinf(number)) return number < 0 ? "-Infinity" : "Infinity";
    return type == CMPI_real32 ? shortest(static_cast<float>(number)) : shortest(number);
}

template <typename Stored>
struct Limits {
    Stored lowest;
    Stored highest;
};

Limits<std::uint64_t> unsignedLimits(CMPIType type) {
    switch (type) {
    case CMPI_uint8:
        return {0, std::numeric_limits<std::uint8_t>::max()};
    case CMPI_char16:
    case CMPI_uint16:
        return {0, std::numeric_limits<std::uint16_t>::max()};
    case CMPI_uint32:
        return {0, std::numeric_limits<std::uint32_t>::max()};
    default:
        return {0, std::numeric_limits<std::uint64_t>::max()};
    }
}

template <typename Integer>
constexpr Limits<std::int64_t> limitsOf() {
    return {std::numeric_limits<Integer>::min(), std::numeric_limits<Integer>::max()};
}

Limits<std::int64_t> signedLimits(CMPIType type) {
    switch (type) {
    case CMPI_sint8:
        return limitsOf<std::int8_t>();
    case CMPI_sint16:
        return limitsOf<std::int16_t>();
    case CMPI_sint32:
        return limitsOf<std::int32_t>();
    default:
        return limitsOf<std::int64_t>();
    }
}

bool isSigned(CMPIType type) {
    return type == CMPI_sint8 || type == CMPI_sint16 || type == CMPI_sint32 || type == CMPI_sint64;
}

template <typename Stored>
NumberError readInteger(std::string_view text, Limits<Stored> limits, Value& value) {
    Stored number{};
    const std::from_chars_result read = std::from_chars(text.data(), text.data() + text.size(), number);
    if (read.ec != std::errc() || number < limits.lowest || number > limits.highest) return NumberError::OutOfRange;
    value.data = number;
    return NumberError::None;
}

template <typename Real>
NumberError readReal(std::string_view text, Value& value) {
    Real number{};
    if (text == "NaN") {
        number = std::numeric_limits<Real>::quiet_NaN();
    } else if (text == "Infinity" || text == "-Infinity") {
        number = text.front() == '-' ? -std::numeric_limits<Real>::infinity() : std::numeric_limits<Real>::infinity();
    } else if (!looksLikeInteger(text) && !looksLikeReal(text)) {
        return NumberError::NotANumber;
    } else if (std::from_chars(text.data(), text.data() + text.size(), number).ec != std::errc()) {
        return NumberError::OutOfRange;
    }
    value.data = static_cast<double>(number);
    return NumberError::None;
}

std::size_t countDigits(std::string_view text) {
    std::size_t count = 0;
    while (count < text.size() && isDigit(text[count])) ++count;
    return count;
}

} // namespace

std::string numberText(const Value& value) {
    if (const auto* number = std::get_if<std::uint64_t>(&value.data)) return std::to_string(*number);
    if (const auto* number = std::get_if<std::int64_t>(&value.data)) return std::to_string(*number);
    if (const auto* number = std::get_if<double>(&value.data)) return realText(*number, value.type);
    return {};
}

NumberError readNumber(std::string_view text, CMPIType type, Value& value) {
    value.type = type;
    if (type == CMPI_real32) return readReal<float>(text, value);
    if (type == CMPI_real64) return readReal<double>(text, value);
    if (!looksLikeInteger(text)) return NumberError::NotANumber;
    if (isSigned(type)) return readInteger(text, signedLimits(type), value);
    // "-0" is zero, every other negative number is out of range.
    if (text.front() == '-' && text.find_first_not_of("-0") == std::string_view::npos) text.remove_prefix(1);
    if (text.front() == '-') return NumberError::OutOfRange;
    return readInteger(text, unsignedLimits(type), value);
}

std::string rangeOf(CMPIType type) {
    if (type == CMPI_real32) return "magnitudes up to 3.4028235e+38";
    if (type == CMPI_real64) return "magnitudes up to 1.7976931348623157e+308";
    if (isSigned(type)) return fmt::format("{} to {}", signedLimits(type).lowest, signedLimits(type).highest);
    return fmt::format("{} to {}", unsignedLimits(type).lowest, unsignedLimits(type).highest);
}

bool looksLikeInteger(std::string_view text) {
    if (!text.empty() && text.front() == '-') text.remove_prefix(1);
    return !text.empty() && countDigits(text) == text.size();
}

bool looksLikeReal(std::string_view text) {
    if (!text.empty() && text.front() == '-') text.remove_prefix(1);
    const std::size_t whole = countDigits(text);
    text.remove_prefix(whole);
    const bool point = !text.empty() && text.front() == '.';
    std::size_t fraction = 0;
    if (point) {
        text.remove_prefix(1);
        fraction = countDigits(text);
        text.remove_prefix(fraction);
    }
    if (whole + fraction == 0) return false;
    if (text.empty()) return point;
    if (lower(text.front()) != 'e') return false;
    text.remove_prefix(1);
    if (!text.empty() && (text.front() == '+' || text.front() == '-')) text.remove_prefix(1);
    return !text.empty() && countDigits(text) == text.size();
}

} // namespace om
