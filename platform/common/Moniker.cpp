#include "vk/Moniker.h"

#include <limits>

namespace VK {

Moniker::Moniker() = default;
Moniker::~Moniker() = default;
Moniker::Moniker(const Moniker&) = default;
Moniker& Moniker::operator=(const Moniker&) = default;

void Moniker::addKey(std::string name, const std::string& value) {
    keys.emplace_back(std::move(name), value);
}

unsigned int Moniker::getKeyCount() const {
    return static_cast<unsigned int>(keys.size());
}

bool Moniker::selectKey(unsigned int index) {
    const bool there = index < keys.size();
    // A caller that overlooked the false must not read a pair that it never selected.
    current = there ? index : std::numeric_limits<unsigned int>::max();
    return there;
}

bool Moniker::getName(std::string& name) const {
    if (current >= keys.size()) return false;
    name = keys[current].first;
    return true;
}

bool Moniker::getValue(std::string& value) const {
    if (current >= keys.size()) return false;
    value = keys[current].second;
    return true;
}

} // namespace VK
