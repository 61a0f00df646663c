#include "vk/make_string.h"

#include <gtest/gtest.h>

using VK::make_string;

TEST(MakeString, NarrowsToUtf8) {
    EXPECT_EQ(make_string(L""), "");
    EXPECT_EQ(make_string(L"x86_64"), "x86_64");
    EXPECT_EQ(make_string(L"\u007f\u0080\u07ff\u0800\uffff"), "\x7f\xc2\x80\xdf\xbf\xe0\xa0\x80\xef\xbf\xbf");
    EXPECT_EQ(make_string(L"\U00010000\U0010ffff"), "\xf0\x90\x80\x80\xf4\x8f\xbf\xbf");
    EXPECT_EQ(make_string(std::wstring(L"a\0b", 3)), std::string("a\0b", 3));
}

TEST(MakeString, ReplacesWhatIsNoCharacter) {
    for (const wchar_t bad : {wchar_t{0xD800}, wchar_t{0xDFFF}, wchar_t{0x110000}, static_cast<wchar_t>(-1)})
        EXPECT_EQ(make_string(std::wstring(1, bad)), "\xef\xbf\xbd") << static_cast<long>(bad);
}
