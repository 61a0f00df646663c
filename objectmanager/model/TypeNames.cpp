#include "objectmanager/model/TypeNames.h"

#include <fmt/format.h>

namespace om {
namespace {

struct TypeWord {
    const char* word;
    CMPIType type;
};

// The first fifteen are what a value may be written as; the rest occurs in answers alone.
constexpr TypeWord typeWords[] = {{"boolean", CMPI_boolean}, {"char16", CMPI_char16},     {"real32", CMPI_real32},
                                  {"real64", CMPI_real64},   {"uint8", CMPI_uint8},       {"uint16", CMPI_uint16},
                                  {"uint32", CMPI_uint32},   {"uint64", CMPI_uint64},     {"sint8", CMPI_sint8},
                                  {"sint16", CMPI_sint16},   {"sint32", CMPI_sint32},     {"sint64", CMPI_sint64},
                                  {"string", CMPI_string},   {"datetime", CMPI_dateTime}, {"ref", CMPI_ref},
                                  {"string", CMPI_chars},    {"instance", CMPI_instance}};
constexpr std::size_t writableTypes = 15;

struct StatusWord {
    int code;
    const char* name;
};

#define STATUS(name)                                                                                                   \
    { name, #name }
constexpr StatusWord statusWords[] = {STATUS(CMPI_RC_OK),
                                      STATUS(CMPI_RC_ERR_FAILED),
                                      STATUS(CMPI_RC_ERR_ACCESS_DENIED),
                                      STATUS(CMPI_RC_ERR_INVALID_NAMESPACE),
                                      STATUS(CMPI_RC_ERR_INVALID_PARAMETER),
                                      STATUS(CMPI_RC_ERR_INVALID_CLASS),
                                      STATUS(CMPI_RC_ERR_NOT_FOUND),
                                      STATUS(CMPI_RC_ERR_NOT_SUPPORTED),
                                      STATUS(CMPI_RC_ERR_CLASS_HAS_CHILDREN),
                                      STATUS(CMPI_RC_ERR_CLASS_HAS_INSTANCES),
                                      STATUS(CMPI_RC_ERR_INVALID_SUPERCLASS),
                                      STATUS(CMPI_RC_ERR_ALREADY_EXISTS),
                                      STATUS(CMPI_RC_ERR_NO_SUCH_PROPERTY),
                                      STATUS(CMPI_RC_ERR_TYPE_MISMATCH),
                                      STATUS(CMPI_RC_ERR_QUERY_LANGUAGE_NOT_SUPPORTED),
                                      STATUS(CMPI_RC_ERR_INVALID_QUERY),
                                      STATUS(CMPI_RC_ERR_METHOD_NOT_AVAILABLE),
                                      STATUS(CMPI_RC_ERR_METHOD_NOT_FOUND),
                                      STATUS(CMPI_RC_NO_MORE_ELEMENTS),
                                      STATUS(CMPI_RC_ERR_SERVER_LIMITS_EXCEEDED),
                                      STATUS(CMPI_RC_ERR_QUERY_FEATURE_NOT_SUPPORTED),
                                      STATUS(CMPI_RC_DO_NOT_UNLOAD),
                                      STATUS(CMPI_RC_NEVER_UNLOAD),
                                      STATUS(CMPI_RC_ERR_INVALID_HANDLE),
                                      STATUS(CMPI_RC_ERR_INVALID_DATA_TYPE),
                                      STATUS(CMPI_RC_ERR_NOT_IN_CODEPAGE),
                                      STATUS(CMPI_RC_ERROR_SYSTEM),
                                      STATUS(CMPI_RC_ERROR)};
#undef STATUS

} // namespace

std::optional<CMPIType> typeNamed(std::string_view word) {
    constexpr std::string_view brackets = "[]";
    CMPIType array = 0;
    if (word.size() > brackets.size() && word.substr(word.size() - brackets.size()) == brackets) {
        word.remove_suffix(brackets.size());
        array = CMPI_ARRAY;
    }
    for (std::size_t i = 0; i < writableTypes; ++i) {
        if (word == typeWords[i].word) return static_cast<CMPIType>(typeWords[i].type | array);
    }
    return std::nullopt;
}

std::string typeName(CMPIType type) {
    if (type == CMPI_null) return "null";
    for (const TypeWord& known : typeWords) {
        if (known.type == elementType(type)) return isArray(type) ? std::string(known.word) + "[]" : known.word;
    }
    return fmt::format("0x{:04x}", type);
}

const char* statusName(int code) {
    for (const StatusWord& known : statusWords) {
        if (known.code == code) return known.name;
    }
    return "UNKNOWN";
}

} // namespace om
