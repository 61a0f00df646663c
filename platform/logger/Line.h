#pragma once

#include "logger/Settings.h"

#include <cstddef>
#include <ctime>
#include <string_view>

namespace NVLog {

/// A text that grows without ever throwing: short ones need no memory of their own, and a text for which there is
/// no memory is marked as failed.
class Line {
public:
    Line() noexcept = default;
    ~Line();
    Line(const Line&) = delete;
    Line& operator=(const Line&) = delete;

    void append(std::string_view bytes) noexcept;
    void append(char c) noexcept { append(std::string_view(&c, 1)); }
    void append(int number) noexcept;
    /// A line feed is written `\n`, a carriage return `\r`, a backslash `\\`, other bytes below 0x20 `\xNN`.
    void appendEscaped(std::string_view text) noexcept;

    bool failed() const noexcept { return outOfMemory; }
    std::string_view text() const noexcept { return {data, size}; }

private:
    bool reserve(std::size_t more) noexcept;

    char inside[1024];
    char* data = inside;
    std::size_t size = 0;
    std::size_t capacity = sizeof inside;
    bool outOfMemory = false;
};

/// One call of the logger.
struct Event {
    Channel channel;
    const char* function;
    const char* file;
    int line;
    std::string_view category;
    int level;
    std::string_view text;
};

/// Appends `2026-11-21T06:00:00.123456Z`.
void appendTime(Line& line, const timespec& now) noexcept;

/// Appends `LOG 4000 CATEGORY FILE:LINE FUNCTION: TEXT`; of the file's path, its bare name.
void appendEvent(Line& line, const Event& event) noexcept;

} // namespace NVLog
