#pragma once

#include "vk/Moniker.h"

#include <string>
#include <utility>
#include <vector>

namespace test {

inline VK::Moniker moniker(const std::vector<std::pair<std::string, std::string>>& keys) {
    VK::Moniker made;
    for (const auto& [name, value] : keys) made.addKey(name, value);
    return made;
}

/// `name=value` of every pair, separated by commas.
inline std::string print(VK::Moniker moniker) {
    std::string line;
    for (unsigned int index = 0; index < moniker.getKeyCount(); ++index) {
        std::string name;
        std::string value;
        moniker.selectKey(index);
        moniker.getName(name);
        moniker.getValue(value);
        line += (index == 0 ? "" : ",") + name + "=" + value;
    }
    return line;
}

/// The text of the Exception that `action` throws; "(nothing thrown)" when it throws none, and another kind passes.
template <class Exception, class Action>
std::string thrownText(Action action) {
    try {
        action();
    } catch (const Exception& exception) {
        return exception.what();
    }
    return "(nothing thrown)";
}

} // namespace test
