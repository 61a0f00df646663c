#include "host/Fact.h"

#include <gtest/gtest.h>

#include <cerrno>

namespace VK::Host {

namespace {

Fact damaged(const char* source) {
    Fact fact = missing(source, EBADMSG);
    fact.problem = "is damaged";
    return fact;
}

TEST(Fact, HasATextUnlessItSaysNothing) {
    EXPECT_EQ(factOf("file", "1234", FirmwareText::Model).text, "1234");
    EXPECT_EQ(factOf("file", "1234").text, "");
    EXPECT_EQ(factOf("file", "1234").placeholder, "1234");
    EXPECT_EQ(factOf("file", "").placeholder, "");
    EXPECT_EQ(factOf("file", "").error, ENOENT);
}

TEST(Fact, ComesFromTheFirstSourceThatHasIt) {
    EXPECT_EQ(firstOf({missing("a", EACCES), factOf("b", "None"), factOf("c", "CZ1"), factOf("d", "CZ2")}).text, "CZ1");
}

TEST(Fact, ThatNoSourceHasNamesTheSourceWithMostToBlame) {
    EXPECT_EQ(firstOf({missing("a", ENOENT), missing("b", ENOENT)}).source, "a");
    EXPECT_EQ(firstOf({missing("a", ENOENT), missing("b", EACCES), damaged("c")}).source, "b");
    EXPECT_EQ(firstOf({missing("a", ENOENT), damaged("b"), missing("c", EACCES)}).source, "b");
    EXPECT_EQ(firstOf({damaged("a"), factOf("b", ""), factOf("c", "None"), factOf("d", "N/A")}).source, "c");
}

} // namespace

} // namespace VK::Host
