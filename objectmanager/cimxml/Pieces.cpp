#include "objectmanager/cimxml/Pieces.h"

namespace cimxml {

void Pieces::enclose(std::string_view first, std::string_view last) {
    before.insert(0, first);
    (elements ? behind : before).append(last);
}

bool Pieces::writeTo(Writer& writer, std::size_t enough) {
    writer.raw(std::exchange(before, {}));
    while (elements) {
        if (writer.text().size() >= enough) return true;
        if (!elements(writer)) elements = nullptr;
    }
    writer.raw(std::exchange(behind, {}));
    return false;
}

} // namespace cimxml
