#include "objectmanager/vkcim/HostNotes.h"

namespace vkcim {

std::vector<std::string> hostNotes(const std::string&) {
    return {};
}

} // namespace vkcim
