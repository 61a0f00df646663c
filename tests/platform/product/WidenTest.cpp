#include "product/Widen.h"

#include <gtest/gtest.h>

using VK::widen;

TEST(Widen, ReadsUtf8) {
    EXPECT_EQ(widen(""), L"");
    EXPECT_EQ(widen("/opt/vk/"), L"/opt/vk/");
    EXPECT_EQ(widen("\x7f\xc2\x80\xdf\xbf\xe0\xa0\x80\xef\xbf\xbf\xf0\x90\x80\x80\xf4\x8f\xbf\xbf"),
              L"\u007f\u0080\u07ff\u0800\uffff\U00010000\U0010ffff");
}

TEST(Widen, ReplacesEveryByteThatIsNoUtf8) {
    const struct {
        const char* text;
        const wchar_t* wide;
    } rows[] = {
        {"\x80", L"\ufffd"},           // a following byte alone
        {"\xff\x41", L"\ufffdA"},      // never a first byte
        {"\xc2", L"\ufffd"},           // cut short
        {"\xc2\x41", L"\ufffdA"},      // not followed
        {"\xc0\x80", L"\ufffd\ufffd"}, // longer than need be
        {"\xe0\x9f\xbf", L"\ufffd\ufffd\ufffd"},
        {"\xed\xa0\x80", L"\ufffd\ufffd\ufffd"}, // half of a surrogate pair
        {"\xf4\x90\x80\x80", L"\ufffd\ufffd\ufffd\ufffd"},
    };
    for (const auto& row : rows) EXPECT_EQ(widen(row.text), row.wide) << row.text;
}
