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

TEST(Fact, IsToldUnlessItsTextSaysNothing) {
    EXPECT_EQ(told("file", "1234", FirmwareText::Model).text, "1234");
    EXPECT_EQ(told("file", "1234").text, "");
    EXPECT_EQ(told("file", "1234").useless, "1234");
    EXPECT_EQ(told("file", "").useless, "");
    EXPECT_EQ(told("file", "").error, ENOENT);
}

TEST(Fact, ComesFromTheFirstSourceThatTellsIt) {
    EXPECT_EQ(firstOf({missing("a", EACCES), told("b", "None"), told("c", "CZ1"), told("d", "CZ2")}).text, "CZ1");
}

TEST(Fact, ThatNobodyTellsNamesTheSourceWithMostToBlame) {
    EXPECT_EQ(firstOf({missing("a", ENOENT), missing("b", ENOENT)}).source, "a");
    EXPECT_EQ(firstOf({missing("a", ENOENT), missing("b", EACCES), damaged("c")}).source, "b");
    EXPECT_EQ(firstOf({missing("a", ENOENT), damaged("b"), missing("c", EACCES)}).source, "b");
    EXPECT_EQ(firstOf({damaged("a"), told("b", ""), told("c", "None"), told("d", "N/A")}).source, "c");
}

} // namespace

} // namespace VK::Host
