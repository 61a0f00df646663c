#pragma once

#include "support/Provider.h"

namespace test {

/// The two references of each association, printed `a -> b`, in the order of the keys.
inline std::vector<std::string> ends(const std::vector<om::ObjectPath>& associations) {
    std::vector<std::string> lines;
    for (const om::ObjectPath& association : associations) {
        std::string line;
        for (const auto& [name, value] : association.keys) {
            const auto& reference = *std::get<std::shared_ptr<const om::ObjectPath>>(value.data);
            line += (line.empty() ? "" : " -> ") + name + "=" + text(reference.keys.back().second);
        }
        lines.push_back(line);
    }
    return lines;
}

inline std::vector<om::ObjectPath> pathsOfInstances(const om::Answer& answer) {
    std::vector<om::ObjectPath> found;
    for (const om::Instance& instance : instancesOf(answer)) found.push_back(instance.path);
    return found;
}

} // namespace test
