#pragma once

#include <ostream>
#include <streambuf>

namespace vkcim {

/// The standard output that the program was started with, kept for its answer alone. As long as this lives, what others
/// print on standard output (the provider's library, the commands that it starts) goes to standard error. Made before
/// the library is loaded. Fails as a stream where the output is closed or cannot be written.
class OwnOutput : public std::ostream {
public:
    OwnOutput();

private:
    /// Writes at once: what is printed comes in one piece, and its failure must be known before the program ends.
    class Buffer : public std::streambuf {
    public:
        explicit Buffer(int written) : descriptor(written) {}

    protected:
        int_type overflow(int_type character) override;
        std::streamsize xsputn(const char* text, std::streamsize size) override;

    private:
        const int descriptor;
    };

    Buffer buffer;
};

} // namespace vkcim
