#pragma once

#include "objectmanager/mof/Checker.h"

#include <optional>
#include <string>
#include <vector>

namespace endpoint {

/// A file's text. Throws std::invalid_argument where it cannot be read, or is empty.
std::string contentOf(const std::string& file);

/// The classes of MOF files, or where there are no files those built in.
class SchemaFiles {
public:
    /// A class may refer to those before it, and to the standard's that are built in: these are left out where the
    /// files have one of them themselves. Throws std::invalid_argument with all that is wrong.
    explicit SchemaFiles(const std::vector<std::string>& files);

    const om::Schema& schema() const;

private:
    std::optional<mof::Checker> read;
};

} // namespace endpoint
