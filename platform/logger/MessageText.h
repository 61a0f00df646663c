#pragma once

#include <optional>
#include <ostream>
#include <streambuf>
#include <string>
#include <string_view>

namespace NVLog {

/// A text that is collected piece by piece, and a stream that appends to it.
class MessageText {
public:
    /// Appends what a stream prints.
    class Appender : public std::streambuf {
    public:
        explicit Appender(MessageText& where) : text(where) {}

    protected:
        int_type overflow(int_type c) override {
            if (traits_type::eq_int_type(c, traits_type::eof())) return traits_type::not_eof(c);
            const char byte = traits_type::to_char_type(c);
            text.append(std::string_view(&byte, 1));
            return c;
        }
        std::streamsize xsputn(const char* bytes, std::streamsize count) override {
            text.append(std::string_view(bytes, static_cast<std::size_t>(count)));
            return count;
        }

    private:
        MessageText& text;
    };

    /// A stream that knows its buffer.
    class Stream : public std::ostream {
    public:
        explicit Stream(MessageText& where) : std::ostream(nullptr), text(where), appender(where) { reset(); }

        /// Forgets what the last user did to the stream.
        void reset() {
            rdbuf(&appender);
            tie(nullptr);
            flags(std::ios_base::skipws | std::ios_base::dec);
            width(0);
            precision(6);
            fill(' ');
            // Not the process's global locale: a log line's numbers have no thousands separators.
            if (getloc() != std::locale::classic()) imbue(std::locale::classic());
            exceptions(std::ios_base::badbit); // lets std::bad_alloc out
        }

        MessageText& text;

    private:
        Appender appender;
    };

    void append(std::string_view bytes) {
        if (handedOut) {
            collected.clear();
            handedOut = false;
        }
        collected.append(bytes);
    }

    const std::string& handOut() {
        if (handedOut) return empty;
        handedOut = true;
        return collected;
    }

    std::ostream& getStream() {
        if (!stream) stream.emplace(*this);
        streamIsUsed = true;
        return *stream;
    }

    /// Makes it as new but for the memory it has, unless that is more than is worth keeping.
    void reset() noexcept {
        constexpr std::size_t keptCapacity = 16 * 1024;
        if (collected.capacity() > keptCapacity) std::string().swap(collected);
        collected.clear();
        handedOut = false;
        if (streamIsUsed) stream->reset(); // costs as much as a line does without it
        streamIsUsed = false;
    }

private:
    std::string collected;
    const std::string empty; ///< what there is to hand out twice
    bool handedOut = false;  ///< the text lives until the next insertion
    std::optional<Stream> stream;
    bool streamIsUsed = false; ///< asked for since it was made or last reset
};

} // namespace NVLog
