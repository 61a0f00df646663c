// The two readers of date-times, the object manager's and the instrumentation's: each alone, and against each other.
#include "common/CimDateTime.h"
#include "objectmanager/model/DateTime.h"
#include "vk/DateTime.h"

#include <cstdio>
#include <cstdlib>
#include <string>

namespace {

void expect(bool holds, const char* what, const std::string& text) {
    if (holds) return;
    std::fprintf(stderr, "%s: %s\n", what, text.c_str());
    std::abort();
}

constexpr std::int64_t microsecondsPerSecond = 1000000;

void tryInstant(const std::string& text, std::int64_t microseconds) {
    const auto printed = om::formatInstant(microseconds);
    // An offset can move the first or last hours into a year of five digits, or before the year 0.
    if (printed) expect(om::microseconds(*printed) == microseconds, "the printed instant is another one", text);
    const auto parsed = VK::parseCimDateTime(text);
    expect(parsed.has_value(), "only the object manager knows the instant", text);
    expect(parsed->seconds * microsecondsPerSecond + parsed->microseconds == microseconds, "two instants", text);
    if (!printed) return;
    if (parsed->microseconds == 0)
        expect(std::string(VK::DateTime(parsed->seconds, 3)) == *printed, "the common library prints another", text);
    expect(VK::formatCimDateTime(*parsed, 0) == *printed, "the instrumentation prints another", text);
}

void tryText(const std::string& text) {
    const auto parsed = VK::parseCimDateTime(text);
    if (!om::isDateTime(text)) return expect(!parsed, "only the instrumentation takes it", text);
    expect(text.size() == 25, "of another length", text);
    const auto microseconds = om::microseconds(text);
    if (!om::isInterval(text)) {
        if (microseconds) tryInstant(text, *microseconds);
        return;
    }
    expect(!parsed, "the instrumentation takes an interval for an instant", text);
    if (microseconds)
        expect(om::formatInterval(static_cast<std::uint64_t>(*microseconds)) == text, "another interval", text);
}

} // namespace

/// The bytes as they are, and as characters that date-times are made of.
extern "C" int LLVMFuzzerTestOneInput(const unsigned char* data, std::size_t size) {
    constexpr char characters[] = "0123456789.+-:*0";
    std::string text(reinterpret_cast<const char*>(data), size);
    tryText(text);
    for (char& character : text) character = characters[static_cast<unsigned char>(character) % 16];
    tryText(text);
    return 0;
}
