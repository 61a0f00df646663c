#pragma once

#include <iosfwd>
#include <string>

namespace NVLog {

/// Collects the text of one log line.
///
/// Text goes in with `<<`; `str` hands out what was collected and starts the buffer anew: the returned reference stays
/// valid until the next insertion or the buffer's end. A buffer belongs to one thread at a time. Running out of memory
/// is reported as std::bad_alloc.
class NVMessageBuffer {
public:
    NVMessageBuffer();
    ~NVMessageBuffer();
    NVMessageBuffer(const NVMessageBuffer&) = delete;
    NVMessageBuffer& operator=(const NVMessageBuffer&) = delete;

    /// Appends a text; a null pointer appends `(null)`.
    NVMessageBuffer& operator<<(const char* text);
    NVMessageBuffer& operator<<(char* text);
    /// Appends a number in decimal.
    NVMessageBuffer& operator<<(unsigned int number);

    /// A stream that appends to this buffer; made when first asked for, and valid as long as the buffer.
    operator std::ostream&();

    /// The text collected in `buffer` since it was made or last asked.
    static const std::string& str(NVMessageBuffer& buffer);
    /// The same for the stream that a buffer was converted to; an empty text for any other stream.
    static const std::string& str(std::ostream& stream);

private:
    struct Storage;
    Storage* storage;
};

} // namespace NVLog
