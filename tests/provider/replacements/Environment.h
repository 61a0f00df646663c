#pragma once

#include <cstdlib>
#include <cstring>
#include <stdexcept>

/// The environment variables through which the tests say what a replaced library does.
namespace replacement {

inline const char* setting(const char* name) {
    const char* const value = std::getenv(name);
    return value == nullptr ? "" : value;
}

inline bool is(const char* name, const char* value) {
    return std::strcmp(setting(name), value) == 0;
}

/// Throws what REPLACEMENT_THROWS names: `exception`, `text` or `number`.
[[noreturn]] inline void fail() {
    if (is("REPLACEMENT_THROWS", "text")) throw "a text";
    if (is("REPLACEMENT_THROWS", "number")) throw 42;
    throw std::runtime_error("the replaced library failed");
}

/// Fails in the operation that REPLACEMENT_IN names: at each call, or with REPLACEMENT_SELDOM=1 after one call, after
/// two more, after three more, and so on, which comes to every place in time. For programs of one thread.
inline void failIn(const char* operation) {
    static unsigned long calls = 0;
    static unsigned long wanted = 0;
    if (!is("REPLACEMENT_IN", operation)) return;
    if (is("REPLACEMENT_SELDOM", "1") && calls++ < wanted) return;
    calls = 0;
    ++wanted;
    fail();
}

} // namespace replacement
