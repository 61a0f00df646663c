#include "objectmanager/cimxml/Typing.h"

#include "objectmanager/cimxml/Errors.h"
#include "objectmanager/model/Characters.h"
#include "objectmanager/model/DateTime.h"
#include "objectmanager/model/NumberText.h"
#include "objectmanager/model/TypeNames.h"

#include <utf8.h>

#include <charconv>

namespace cimxml {
namespace {

using om::elementType;
using om::isArray;

[[noreturn]] void mismatch(std::string_view text, CMPIType type) {
    constexpr std::size_t shown = 60;
    throw CimError(CMPI_RC_ERR_TYPE_MISMATCH, "'" + std::string(text.substr(0, shown)) + "' is no " + typeName(type));
}

[[noreturn]] void unusable(const std::string& what) {
    throw CimError(CMPI_RC_ERR_INVALID_PARAMETER, what);
}

om::Value booleanOf(std::string_view text) {
    if (om::sameName(text, "TRUE")) return {CMPI_boolean, true};
    if (om::sameName(text, "FALSE")) return {CMPI_boolean, false};
    mismatch(text, CMPI_boolean);
}

/// One UTF-16 unit, written as the character itself.
om::Value characterOf(const std::string& text) {
    const char* at = text.data();
    const char* const end = at + text.size();
    if (at == end || !utf8::is_valid(at, end)) mismatch(text, CMPI_char16);
    const std::uint32_t character = utf8::unchecked::next(at);
    if (at != end || character > 0xFFFF) mismatch(text, CMPI_char16);
    return {CMPI_char16, std::uint64_t{character}};
}

/// A number in hexadecimal, in decimal.
std::string decimal(std::string_view text) {
    const bool negative = !text.empty() && text.front() == '-';
    const std::string_view digits = text.substr(negative ? 1 : 0);
    if (digits.size() < 3 || digits[0] != '0' || om::lower(digits[1]) != 'x') return std::string(text);
    std::uint64_t number = 0;
    const auto [end, error] = std::from_chars(digits.data() + 2, digits.data() + digits.size(), number, 16);
    if (error != std::errc() || end != digits.data() + digits.size()) return std::string(text);
    return (negative ? "-" : "") + std::to_string(number);
}

/// The standard's words for what is no number, in ours.
std::string realText(std::string_view text) {
    if (om::sameName(text, "NaN")) return "NaN";
    if (om::sameName(text, "INF")) return "Infinity";
    if (om::sameName(text, "-INF")) return "-Infinity";
    // The words that we use elsewhere are no numbers here.
    return om::lower(text.empty() ? ' ' : text.back()) == 'y' ? "" : std::string(text);
}

om::Value numberOf(std::string_view text, CMPIType type) {
    const bool real = type == CMPI_real32 || type == CMPI_real64;
    om::Value value;
    if (om::readNumber(real ? realText(text) : decimal(text), type, value) != om::NumberError::None) {
        mismatch(text, type);
    }
    return value;
}

om::Value embeddedOf(const std::string& text, const Reading& reading) {
    try {
        return {CMPI_instance, std::make_shared<const om::Instance>(typedInstance(readEmbedded(text), reading))};
    } catch (const Refusal& refusal) {
        unusable(std::string("embedded instance: ") + refusal.what());
    }
}

om::Value scalarOf(const std::string& text, CMPIType type, const Reading& reading) {
    switch (type) {
    case CMPI_string:
        return {type, text};
    case CMPI_instance:
        return embeddedOf(text, reading);
    case CMPI_char16:
        return characterOf(text);
    case CMPI_boolean:
        return booleanOf(om::trimmed(text));
    case CMPI_dateTime:
        if (!om::isDateTime(om::trimmed(text))) mismatch(text, type);
        return {type, std::string(om::trimmed(text))};
    case CMPI_ref:
        mismatch(text, type);
    default:
        return numberOf(om::trimmed(text), type);
    }
}

const om::PropertyDeclaration* declaredKey(const om::ResolvedClass* known, const KeyElement& element) {
    if (known == nullptr) return nullptr;
    if (element.name.empty()) return known->keys.size() == 1 ? known->keys.front() : nullptr;
    return known->findProperty(element.name);
}

/// The type of a key that the schema does not know.
CMPIType statedType(const KeyElement& key) {
    if (key.value.kind == ValueElement::Kind::Reference) return CMPI_ref;
    if (const std::optional<CMPIType> type = typeNamed(key.type)) return *type;
    if (key.valueType == "boolean") return CMPI_boolean;
    if (key.valueType != "numeric") return CMPI_string;
    om::Value probe;
    return om::readNumber(om::trimmed(key.value.text), CMPI_sint64, probe) == om::NumberError::None ? CMPI_sint64
                                                                                                    : CMPI_uint64;
}

om::NamedValue typedKey(const KeyElement& element, const om::ResolvedClass* known, const Reading& reading) {
    const om::PropertyDeclaration* declared = declaredKey(known, element);
    const std::string name = !element.name.empty() ? element.name : declared != nullptr ? declared->name : "";
    if (name.empty()) unusable("a key without a name");
    CMPIType type = declared != nullptr ? declared->type : statedType(element);
    if (reading.trust == Trust::Message && typeNamed(element.type)) type = statedType(element);
    return {declared != nullptr ? declared->name : name, typedValue(element.value, type, reading)};
}

/// The type of a property: the schema's and the message's have to agree where a request is read.
CMPIType propertyType(const PropertyElement& element, const om::PropertyDeclaration* declared, Trust trust) {
    std::optional<CMPIType> stated = element.type.empty() ? CMPI_ref : typeNamed(element.type);
    if (!stated) unusable("property " + element.name + " has the type " + element.type);
    if (element.embedded && *stated == CMPI_string) stated = CMPI_instance;
    const auto type = static_cast<CMPIType>(*stated | (element.array ? CMPI_ARRAY : 0));
    if (declared == nullptr || trust == Trust::Message || declared->type == type) return type;
    throw CimError(CMPI_RC_ERR_TYPE_MISMATCH, "property " + declared->name + " is " + typeName(declared->type) +
                                                  (isArray(declared->type) ? "[]" : ""));
}

} // namespace

std::optional<CMPIType> typeNamed(std::string_view word) {
    if (word == "reference") return CMPI_ref;
    const std::optional<CMPIType> type = om::typeNamed(word);
    return type && (*type == CMPI_ref || isArray(*type)) ? std::nullopt : type;
}

std::string typeName(CMPIType type) {
    const CMPIType element = elementType(type);
    if (element == CMPI_ref) return "reference";
    return element == CMPI_instance ? "string" : om::typeName(element);
}

om::Value typedValue(const ValueElement& element, CMPIType type, const Reading& reading) {
    using Kind = ValueElement::Kind;
    switch (element.kind) {
    case Kind::None:
        return {type, {}};
    case Kind::Text:
        if (isArray(type)) mismatch(element.text, type);
        return scalarOf(element.text, type, reading);
    case Kind::Array:
    case Kind::References: {
        if (!isArray(type) || (element.kind == Kind::References) != (elementType(type) == CMPI_ref)) {
            mismatch("an array", type);
        }
        std::vector<om::Value> elements;
        for (const ValueElement& each : element.elements) {
            elements.push_back(typedValue(each, elementType(type), reading));
        }
        return {type, std::move(elements)};
    }
    case Kind::Reference:
    case Kind::InstanceName:
    case Kind::ClassName:
        if (type != CMPI_ref) mismatch("a reference", type);
        return {type, std::make_shared<const om::ObjectPath>(typedPath(*element.path, reading))};
    case Kind::Instance:
        if (type != CMPI_instance) mismatch("an instance", type);
        return {type, std::make_shared<const om::Instance>(typedInstance(*element.instance, reading))};
    default:
        mismatch("what is no value", type);
    }
}

om::ObjectPath typedPath(const PathElement& element, const Reading& reading) {
    const om::ResolvedClass* known = reading.schema.resolve(element.className);
    om::ObjectPath path;
    path.host = element.host;
    path.nameSpace = element.nameSpace.empty() ? reading.nameSpace : element.nameSpace;
    path.className = known != nullptr ? known->declaration->name : element.className;
    // A reference in a key lies where the path lies, unless it says otherwise.
    const Reading inner{reading.schema, path.nameSpace, reading.trust};
    for (const KeyElement& key : element.keys) {
        om::NamedValue typed = typedKey(key, known, inner);
        if (om::findValue(path.keys, typed.first) != nullptr) unusable("key " + typed.first + " is given twice");
        path.keys.push_back(std::move(typed));
    }
    return path;
}

om::Instance typedInstance(const InstanceElement& element, const Reading& reading) {
    const om::ResolvedClass* known = reading.schema.resolve(element.className);
    om::Instance instance;
    instance.path.nameSpace = reading.nameSpace;
    instance.path.className = known != nullptr ? known->declaration->name : element.className;
    for (const PropertyElement& property : element.properties) {
        const om::PropertyDeclaration* declared = known == nullptr ? nullptr : known->findProperty(property.name);
        const std::string& name = declared != nullptr ? declared->name : property.name;
        if (om::findValue(instance.properties, name) != nullptr) unusable("property " + name + " is given twice");
        const CMPIType type = propertyType(property, declared, reading.trust);
        instance.properties.emplace_back(name, typedValue(property.value, type, reading));
    }
    return instance;
}

} // namespace cimxml
