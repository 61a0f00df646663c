#pragma once

#include "objectmanager/model/Schema.h"

#include <string>
#include <vector>

namespace mof {

/// Takes classes one after the other into a schema and notes everything that is wrong with them.
class Checker {
public:
    /// `trusted` are in the schema before all others.
    explicit Checker(const std::vector<om::ClassDeclaration>& trusted = {}) : known(trusted) {}

    /// Classes that were parsed, each behind those that it refers to. `ours` asks for a description and a version
    /// everywhere, and refuses what only the standard's files may do.
    void add(std::vector<om::ClassDeclaration> classes, bool ours = true);

    /// Values and defaults have the types of their declarations, where they fit; a key is one in each subclass, too.
    const om::Schema& schema() const { return known; }
    /// Each as FILE:LINE: TEXT.
    const std::vector<std::string>& complaints() const { return wrong; }

private:
    om::Schema known;
    std::vector<std::string> wrong;
};

} // namespace mof
