#include "objectmanager/model/Names.h"

#include <algorithm>
#include <cstdint>

namespace om {

bool sameName(std::string_view a, std::string_view b) {
    return a.size() == b.size() &&
           std::equal(a.begin(), a.end(), b.begin(), [](char x, char y) { return lower(x) == lower(y); });
}

bool containsName(const std::vector<std::string>& names, std::string_view name) {
    return std::any_of(names.begin(), names.end(), [name](const std::string& each) { return sameName(each, name); });
}

std::size_t NameHash::operator()(std::string_view name) const {
    std::uint64_t hash = 14695981039346656037U; // FNV-1a
    for (const char c : name) hash = (hash ^ static_cast<unsigned char>(lower(c))) * 1099511628211U;
    return static_cast<std::size_t>(hash);
}

const Value* findValue(const std::vector<NamedValue>& list, std::string_view name) {
    for (const NamedValue& entry : list) {
        if (sameName(entry.first, name)) return &entry.second;
    }
    return nullptr;
}

void putValue(std::vector<NamedValue>& list, std::string_view name, Value value) {
    for (NamedValue& entry : list) {
        if (sameName(entry.first, name)) {
            entry.second = std::move(value);
            return;
        }
    }
    list.emplace_back(name, std::move(value));
}

} // namespace om
