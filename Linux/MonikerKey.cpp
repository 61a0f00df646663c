#include "Linux/MonikerKey.h"

#include "include/Exceptions.h"

namespace VK::BaseServerProvider {

std::string requiredKey(Moniker& moniker, const char* name) {
    for (unsigned int index = 0; index < moniker.getKeyCount(); ++index) {
        moniker.selectKey(index);
        std::string found;
        std::string value;
        // The cursor stands on a pair, which has a name and a value.
        if (moniker.getName(found) && found == name && moniker.getValue(value)) return value; // GCOVR_EXCL_BR_LINE
    }
    const std::string message = std::string("Could not find '") + name + "' Key in Moniker";
    throw FrameworkException(message.c_str());
}

void replaceMoniker(Moniker& moniker, const char* name, const std::string& value) {
    Moniker replacement;
    replacement.addKey(name, value);
    moniker = replacement;
}

} // namespace VK::BaseServerProvider
