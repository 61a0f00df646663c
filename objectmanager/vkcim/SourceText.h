#pragma once

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

namespace vkcim {

/// A text together with where each of its bytes stood in what the user wrote, so that an error inside a nested or
/// escaped text is reported at its place in the whole.
class SourceText {
public:
    SourceText() = default;
    explicit SourceText(std::string_view text, std::size_t firstOffset = 0) {
        for (std::size_t i = 0; i < text.size(); ++i) append(text[i], firstOffset + i);
        end(firstOffset + text.size());
    }

    void append(char c, std::size_t offset) {
        bytes.push_back(c);
        offsets.push_back(offset);
    }
    /// Sets where the text ends in the whole.
    void end(std::size_t offset) { endOffset = offset; }

    std::string_view text() const { return bytes; }
    std::size_t size() const { return bytes.size(); }
    char operator[](std::size_t index) const { return bytes[index]; }
    /// The place of byte `index` in the whole; that of the end for any index past the last byte.
    std::size_t offsetOf(std::size_t index) const { return index < offsets.size() ? offsets[index] : endOffset; }
    SourceText from(std::size_t first) const {
        SourceText rest;
        for (std::size_t i = first; i < bytes.size(); ++i) rest.append(bytes[i], offsets[i]);
        rest.end(endOffset);
        return rest;
    }

private:
    std::string bytes;
    std::vector<std::size_t> offsets;
    std::size_t endOffset = 0;
};

} // namespace vkcim
