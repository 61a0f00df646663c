#include "nvlog/NVMessageBuffer.h"

#include "logger/MessageText.h"
#include "logger/Pool.h"

#include <array>
#include <charconv>

namespace NVLog {

/// What a buffer collects into. It outlives the buffer and serves the next one, so that a log line allocates no memory
/// and makes no stream; the pool, and with it whatever is unused, goes when the library is unloaded.
struct NVMessageBuffer::Storage : MessageText {
    static Pool<Storage> pool;
    std::atomic<bool>* free = nullptr;
};

Pool<NVMessageBuffer::Storage> NVMessageBuffer::Storage::pool;

NVMessageBuffer::NVMessageBuffer() : storage(Storage::pool.take()) {
    if (storage == nullptr) storage = new Storage;
}

NVMessageBuffer::~NVMessageBuffer() {
    storage->reset();
    Storage::pool.give(storage);
}

NVMessageBuffer& NVMessageBuffer::operator<<(const char* text) {
    storage->append(text != nullptr ? text : "(null)");
    return *this;
}

NVMessageBuffer& NVMessageBuffer::operator<<(char* text) {
    return *this << static_cast<const char*>(text);
}

NVMessageBuffer& NVMessageBuffer::operator<<(unsigned int number) {
    std::array<char, 10> digits; // of 4294967295
    const auto end = std::to_chars(digits.data(), digits.data() + digits.size(), number).ptr;
    storage->append(std::string_view(digits.data(), static_cast<std::size_t>(end - digits.data())));
    return *this;
}

NVMessageBuffer::operator std::ostream&() {
    return storage->getStream();
}

const std::string& NVMessageBuffer::str(NVMessageBuffer& buffer) {
    return buffer.storage->handOut();
}

const std::string& NVMessageBuffer::str(std::ostream& stream) {
    if (auto* const ours = dynamic_cast<MessageText::Stream*>(&stream)) return ours->text.handOut();
    // Never destroyed, because threads may log while the process ends; an empty string owns nothing.
    alignas(std::string) static unsigned char place[sizeof(std::string)];
    static const std::string& none = *new (place) std::string;
    return none;
}

} // namespace NVLog
