#include "objectmanager/vkcim/Suggestion.h"

#include "objectmanager/model/Characters.h"

#include <algorithm>
#include <numeric>
#include <vector>

namespace vkcim {
namespace {

constexpr std::size_t longest = 256;

/// The letters to insert, delete or replace to come from one to the other.
std::size_t distance(std::string_view from, std::string_view to) {
    std::vector<std::size_t> row(to.size() + 1);
    std::iota(row.begin(), row.end(), std::size_t{0});
    for (std::size_t i = 0; i < from.size(); ++i) {
        std::size_t diagonal = row[0]++;
        for (std::size_t j = 0; j < to.size(); ++j) {
            const std::size_t replaced = diagonal + (om::lower(from[i]) == om::lower(to[j]) ? 0 : 1);
            diagonal = row[j + 1];
            row[j + 1] = std::min({replaced, row[j] + 1, diagonal + 1});
        }
    }
    return row.back();
}

std::string_view withoutPrefix(std::string_view name) {
    const std::size_t underscore = name.find('_');
    return underscore == std::string_view::npos ? name : name.substr(underscore + 1);
}

} // namespace

std::optional<std::string> nearestName(std::string_view name, const std::vector<std::string>& known) {
    if (name.size() > longest) return std::nullopt;
    std::optional<std::string> nearest;
    std::size_t best = name.size() / 4 + 2;
    for (const std::string& each : known) {
        const std::size_t away = distance(name, each);
        if (away >= best) continue;
        best = away;
        nearest = each;
    }
    return nearest;
}

std::optional<std::string> nearestClass(std::string_view className, const om::Schema& schema) {
    if (className.size() > longest || schema.find(className)) return std::nullopt;
    std::vector<std::string> names = schema.served();
    for (const om::ClassDeclaration& known : schema.classes()) names.push_back(known.name);
    // A common mistake is the name alone, without the schema's prefix.
    for (const std::string& known : names)
        if (om::sameName(className, withoutPrefix(known))) return known;
    return nearestName(className, names);
}

std::string didYouMean(const std::optional<std::string>& name) {
    return name ? "; did you mean " + *name + "?" : "";
}

} // namespace vkcim
