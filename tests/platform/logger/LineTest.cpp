#include "logger/Line.h"

#include <gtest/gtest.h>
#include <string>

using namespace std::string_literals;
using NVLog::appendEvent;
using NVLog::appendTime;
using NVLog::Channel;
using NVLog::Event;
using NVLog::Line;

namespace {

std::string escaped(const std::string& text) {
    Line line;
    line.appendEscaped(text);
    return std::string(line.text());
}

std::string time(long seconds, long nanoseconds) {
    Line line;
    appendTime(line, {seconds, nanoseconds});
    return std::string(line.text());
}

std::string event(const Event& event) {
    Line line;
    appendEvent(line, event);
    return std::string(line.text());
}

} // namespace

TEST(Line, EscapesWhatWouldBreakIt) {
    EXPECT_EQ(escaped(""), "");
    EXPECT_EQ(escaped("plain text"), "plain text");
    EXPECT_EQ(escaped("a\nb\rc\\d"), "a\\nb\\rc\\\\d");
    EXPECT_EQ(escaped("\n\n"), "\\n\\n");
    EXPECT_EQ(escaped("\0\x01\t\x1b\x1f"s), "\\x00\\x01\\x09\\x1b\\x1f");
    EXPECT_EQ(escaped("\x20\x7f\x80\xff\xc3\xa4"), "\x20\x7f\x80\xff\xc3\xa4");
}

TEST(Line, PrintsTheTimeInUtcToTheMicrosecond) {
    EXPECT_EQ(time(1795240800, 123456789), "2026-11-21T06:00:00.123456Z");
    EXPECT_EQ(time(0, 999), "1970-01-01T00:00:00.000000Z");
    EXPECT_EQ(time(951827696, 1000), "2000-02-29T12:34:56.000001Z");
}

TEST(Line, TellsTheWholeEvent) {
    EXPECT_EQ(event({Channel::Log, "BaseServer_GetInstance", "BaseServerProvider", 573, "Norvane.BaseServerProvider",
                     4000, "TEXT"}),
              "LOG 4000 Norvane.BaseServerProvider BaseServerProvider:573 BaseServer_GetInstance: TEXT");
    EXPECT_EQ(event({Channel::Trace, "f", "g", -1, "", -2147483647 - 1, ""}), "TRACE -2147483648  g:-1 f: ");
}

TEST(Line, NamesTheFileBare) {
    const auto fileOf = [](const char* file) { return event({Channel::Log, "f", file, 1, "c", 1, "t"}); };
    for (const char* file : {"Trace", "Trace.h", "include/Trace.h", "/a.b/Trace", "./Trace.cpp"})
        EXPECT_EQ(fileOf(file), "LOG 1 c Trace:1 f: t") << file;
}

TEST(Line, SaysNullForMissingNames) {
    EXPECT_EQ(event({Channel::Log, nullptr, nullptr, 1, "c", 1, "t"}), "LOG 1 c (null):1 (null): t");
}

TEST(Line, EscapesNamesToo) {
    EXPECT_EQ(event({Channel::Log, "f\n", "g\n", 1, "c\n", 1, "t"}), "LOG 1 c\\n g\\n:1 f\\n: t");
}

TEST(Line, GrowsAsItMust) {
    const std::string text(3'000'000, 'x');
    EXPECT_EQ(escaped(text), text);
    const std::string feeds(2000, '\n');
    EXPECT_EQ(escaped(feeds).size(), 4000U);
    Line line;
    for (int i = 0; i < 1025; ++i) line.append('y');
    EXPECT_EQ(line.text(), std::string(1025, 'y'));
    EXPECT_FALSE(line.failed());
}
