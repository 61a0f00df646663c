#include "objectmanager/model/Names.h"

#include <algorithm>
#include <cstdint>

namespace om {

bool sameName(std::string_view a, std::string_view b) {
    // Most names differ in length, and most that are the same are spelt the same.
    return a.size() == b.size() &&
           (a == b || std::equal(a.begin(), a.end(), b.begin(), [](char x, char y) { return lower(x) == lower(y); }));
}

bool containsName(const std::vector<std::string>& names, std::string_view name) {
    return std::any_of(names.begin(), names.end(), [name](const std::string& each) { return sameName(each, name); });
}

std::size_t NameHash::operator()(std::string_view name) const {
    // As FNV-1a, but of eight characters at once: they go in with the bit set in which the cases of a letter differ.
    constexpr std::uint64_t caseBits = 0x2020202020202020U;
    std::uint64_t hash = 14695981039346656037U ^ name.size();
    for (std::string_view left = name; !left.empty();) {
        std::uint64_t characters = 0;
        const std::size_t taken = left.copy(reinterpret_cast<char*>(&characters), sizeof characters);
        hash = (hash ^ (characters | caseBits)) * 1099511628211U;
        hash ^= hash >> 32U;
        left.remove_prefix(taken);
    }
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
