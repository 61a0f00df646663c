#include "include/Exceptions.h"

#include <gtest/gtest.h>

#include <string>

namespace {

TEST(Exceptions, CarryTheirText) {
    EXPECT_STREQ(VK::InstrumentationException("Could not find instance").what(), "Could not find instance");
    EXPECT_STREQ(VK::FrameworkException("Could not find 'Name' Key in Moniker").what(),
                 "Could not find 'Name' Key in Moniker");
}

TEST(Exceptions, CopyTheTextTheyAreMadeFrom) {
    std::string text = "first";
    const VK::InstrumentationException exception(text.c_str());
    const VK::InstrumentationException copy(exception);
    text = "later";
    EXPECT_STREQ(copy.what(), "first");
}

TEST(Exceptions, AreCaughtAsStandardExceptions) {
    try {
        throw VK::FrameworkException("text");
    } catch (const std::exception& exception) {
        EXPECT_STREQ(exception.what(), "text");
    }
}

} // namespace
