#pragma once

#include "objectmanager/cimxml/Request.h"

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace endpoint {

/// The parameters of an intrinsic operation by name, without regard to case. What a parameter holds is checked when it
/// is asked for; all errors are CimError with INVALID_PARAMETER.
class Parameters {
public:
    /// Throws where a parameter stands there twice, or is none of the operation's.
    Parameters(const std::vector<cimxml::ParameterElement>& given, const std::vector<std::string_view>& allowed);

    /// A boolean; the default where it is missing or null.
    bool flag(std::string_view name, bool otherwise) const;
    /// A name of a class, or a text; nothing where it is missing, null or empty.
    std::optional<std::string> className(std::string_view name) const;
    std::optional<std::string> text(std::string_view name) const;
    std::optional<std::uint32_t> number(std::string_view name) const;
    /// An array of names; an empty array is something else than none.
    std::optional<std::vector<std::string>> names(std::string_view name) const;

    /// These throw where the parameter is missing or null.
    std::string requiredClassName(std::string_view name) const;
    std::string requiredText(std::string_view name) const;
    const cimxml::PathElement& requiredInstanceName(std::string_view name) const;
    /// The name of an instance or a class.
    const cimxml::PathElement& requiredObjectName(std::string_view name) const;
    /// A parameter of that kind.
    const cimxml::ValueElement& required(std::string_view name, cimxml::ValueElement::Kind kind) const;

    /// The parameter as it stands there; null where it is missing or holds nothing.
    const cimxml::ValueElement* find(std::string_view name) const;

private:
    std::vector<const cimxml::ParameterElement*> list;
};

} // namespace endpoint
