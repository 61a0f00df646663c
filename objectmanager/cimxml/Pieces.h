#pragma once

#include "objectmanager/cimxml/Writer.h"

#include <cstddef>
#include <functional>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

namespace cimxml {

/// Writes one element more; false where none is left.
using Elements = std::function<bool(Writer&)>;

/// Elements for the objects of a list: each is written when its turn comes, and gives its memory back then.
template <class Object, class Write>
Elements oneByOne(std::vector<Object> objects, Write write) {
    return [objects = std::move(objects), next = std::size_t{0}, write = std::move(write)](Writer& writer) mutable {
        if (next == objects.size()) return false;
        write(writer, objects[next]);
        objects[next++] = Object();
        return true;
    };
}

/// A text of which the elements are written piece by piece: of a large answer, never all is there at once.
class Pieces {
public:
    Pieces() = default;
    // Not explicit: what is small is a text.
    Pieces(std::string whole) : before(std::move(whole)) {}
    explicit Pieces(Elements list) : elements(std::move(list)) {}

    /// Puts something before and behind all that is still to be written.
    void enclose(std::string_view first, std::string_view last);

    /// Writes on until `writer` holds that much, or a little more; less at the end. Whether something is left.
    bool writeTo(Writer& writer, std::size_t enough);

    bool isEmpty() const { return before.empty() && !elements && behind.empty(); }

private:
    std::string before;
    Elements elements;
    std::string behind;
};

} // namespace cimxml
