#include "logger/Line.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <cstring>

namespace NVLog {

namespace {

std::string_view textOf(const char* text) noexcept {
    return text != nullptr ? text : "(null)";
}

std::string_view bareName(std::string_view file) noexcept {
    file.remove_prefix(file.rfind('/') + 1); // npos + 1 is 0
    return file.substr(0, file.rfind('.'));
}

} // namespace

Line::~Line() {
    if (data != inside) std::free(data);
}

bool Line::reserve(std::size_t more) noexcept {
    if (more <= capacity - size) return true;
    const std::size_t wanted = std::max(size + more, capacity * 2);
    char* const grown = static_cast<char*>(std::realloc(data == inside ? nullptr : data, wanted));
    if (grown == nullptr) {
        outOfMemory = true;
        return false;
    }
    if (data == inside) std::memcpy(grown, inside, size);
    data = grown;
    capacity = wanted;
    return true;
}

void Line::append(std::string_view bytes) noexcept {
    if (!reserve(bytes.size())) return;
    std::copy(bytes.begin(), bytes.end(), data + size);
    size += bytes.size();
}

void Line::append(int number) noexcept {
    std::array<char, 12> digits; // the sign and ten digits
    const auto end = std::to_chars(digits.data(), digits.data() + digits.size(), number).ptr;
    append(std::string_view(digits.data(), static_cast<std::size_t>(end - digits.data())));
}

void Line::appendEscaped(std::string_view text) noexcept {
    constexpr std::string_view hex = "0123456789abcdef";
    const auto plain = [](char c) { return static_cast<unsigned char>(c) >= 0x20 && c != '\\'; };
    while (!text.empty()) {
        const auto end = std::find_if_not(text.begin(), text.end(), plain);
        const auto length = static_cast<std::size_t>(end - text.begin());
        append(text.substr(0, length));
        text.remove_prefix(length);
        if (text.empty()) return;
        const auto c = static_cast<unsigned char>(text.front());
        text.remove_prefix(1);
        append('\\');
        if (c == '\n')
            append('n');
        else if (c == '\r')
            append('r');
        else if (c == '\\')
            append('\\');
        else
            for (const char e : {'x', hex[c >> 4], hex[c & 0xF]}) append(e);
    }
}

void appendTime(Line& line, const timespec& now) noexcept {
    // Not the C library's gmtime: it may read zone files, and takes a lock that is not safe after fork.
    using namespace std::chrono;
    const sys_seconds instant{seconds{now.tv_sec}};
    const auto midnight = floor<days>(instant);
    const year_month_day date{midnight};
    const hh_mm_ss time{instant - midnight};
    std::array<char, 64> text;
    const int length =
        std::snprintf(text.data(), text.size(), "%04d-%02u-%02uT%02ld:%02ld:%02ld.%06ldZ", int{date.year()},
                      unsigned{date.month()}, unsigned{date.day()}, long{time.hours().count()},
                      long{time.minutes().count()}, long{time.seconds().count()}, now.tv_nsec / 1000);
    line.append(std::string_view(text.data(), static_cast<std::size_t>(length)));
}

void appendEvent(Line& line, const Event& event) noexcept {
    line.append(event.channel == Channel::Log ? "LOG " : "TRACE ");
    line.append(event.level);
    line.append(' ');
    line.appendEscaped(event.category);
    line.append(' ');
    line.appendEscaped(bareName(textOf(event.file)));
    line.append(':');
    line.append(event.line);
    line.append(' ');
    line.appendEscaped(textOf(event.function));
    line.append(": ");
    line.appendEscaped(event.text);
}

} // namespace NVLog
