#include "Linux/HostName.h"

#include <cstring>

#include <unistd.h>

namespace VK::BaseServerProvider {

HostName::HostName() {
    // On purpose the result is ignored. A name that does not fit stays cut; after any other failure the field is empty.
    static_cast<void>(gethostname(field, sizeof field));
}

std::string HostName::text() const {
    return std::string(field, strnlen(field, sizeof field));
}

} // namespace VK::BaseServerProvider
