#pragma once

#include <cmpidt.h>

#include <string_view>
#include <vector>

namespace om {

/// A qualifier of the standard: its type, what it may stand on, and how it is inherited.
struct QualifierType {
    std::string_view name;
    CMPIType type;
    std::string_view scopes; ///< a letter each: c class, a association, r reference, p property, m method, i parameter,
                             ///< n indication
    bool overridable;
    bool inherited;
    bool translatable;
    std::string_view otherwise; ///< the default's text; empty for none
};

/// All that may stand in a schema.
const std::vector<QualifierType>& qualifierTypes();
/// Without regard to case; null for an unknown one.
const QualifierType* findQualifierType(std::string_view name);

} // namespace om
