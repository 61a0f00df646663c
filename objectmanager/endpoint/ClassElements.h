#pragma once

#include "objectmanager/cimxml/Writer.h"
#include "objectmanager/endpoint/Call.h"

namespace endpoint {

/// Which part of a class a client wants.
struct ClassSelection {
    bool localOnly = true;
    bool qualifiers = true;
    bool origins = false;
    std::optional<std::vector<std::string>> properties;

    /// What the parameters of a call say; the default of IncludeQualifiers differs between operations.
    static ClassSelection of(const Call& call, bool qualifiersByDefault);
};

/// Writes CLASS.
void writeClass(cimxml::Writer& writer, const om::Schema& schema, const om::ClassDeclaration& declared,
                const ClassSelection& selection);

} // namespace endpoint
