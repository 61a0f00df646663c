#include "host/Uuid.h"

#include <gtest/gtest.h>

namespace VK::Host {

namespace {

using namespace std::literals;

constexpr std::string_view BYTES = "\x33\x22\x11\x00\x55\x44\x77\x66\x88\x99\xAA\xBB\xCC\xDD\xEE\xFF"sv;

TEST(Uuid, ByteOrderFollowsTheVersion) {
    EXPECT_EQ(uuidFromBytes(BYTES, {2, 6}), "00112233-4455-6677-8899-aabbccddeeff");
    EXPECT_EQ(uuidFromBytes(BYTES, {3, 0}), "00112233-4455-6677-8899-aabbccddeeff");
    EXPECT_EQ(uuidFromBytes(BYTES, {2, 5}), "33221100-5544-7766-8899-aabbccddeeff");
    EXPECT_EQ(uuidFromBytes(BYTES, {2, 3}), "33221100-5544-7766-8899-aabbccddeeff");
}

TEST(Uuid, TakesSixteenBytes) {
    EXPECT_EQ(uuidFromBytes(BYTES.substr(1), {2, 6}), "");
    EXPECT_EQ(uuidFromBytes("", {2, 6}), "");
}

TEST(Uuid, JunkIsNone) {
    EXPECT_EQ(uuidFromText(uuidFromBytes(std::string(16, '\0'), {3, 0})), "");
    EXPECT_EQ(uuidFromText(uuidFromBytes(std::string(16, '\xFF'), {3, 0})), "");
    EXPECT_EQ(uuidFromText(uuidFromBytes("\x00\x02\x00\x03\x00\x04\x00\x05\x00\x06\x00\x07\x00\x08\x00\x09"sv, {3, 0})),
              "");
    EXPECT_EQ(uuidFromText(uuidFromBytes("\x03\x02\x01\x00\x05\x04\x07\x06\x08\x09\x0A\x0B\x0C\x0D\x0E\x0F"sv, {2, 4})),
              "");
    EXPECT_EQ(uuidFromText("10000000-0000-8000-0040-000000000000"), "");
    EXPECT_EQ(uuidFromText("FEFEFEFE-FEFE-FEFE-FEFE-FEFEFEFEFEFE"), "");
}

TEST(Uuid, ZerosBeforeAMacAddressAreOne) {
    EXPECT_EQ(uuidFromBytes("\0\0\0\0\0\0\0\0\0\0\x0C\xC4\x7A\x13\x38\x78"sv, {2, 7}),
              "00000000-0000-0000-0000-0cc47a133878");
}

TEST(Uuid, TextsAreTrimmedAndLowered) {
    EXPECT_EQ(uuidFromText(" 4C4C4544-0031-5910-8052-B4C04F4E4E32\n"), "4c4c4544-0031-5910-8052-b4c04f4e4e32");
}

TEST(Uuid, OtherTextsAreNone) {
    for (const char* text : {"", "4c4c4544", "4c4c4544-0031-5910-8052-b4c04f4e4e3",
                             "4c4c4544-0031-5910-8052-b4c04f4e4e322", "4c4c4544-0031-5910-8052_b4c04f4e4e32",
                             "4c4c4544-0031-5910-8052-b4c04f4e4e3g", "4c4c454400315910-8052-b4c04f4e4e32-a"})
        EXPECT_EQ(uuidFromText(text), "") << text;
}

} // namespace

} // namespace VK::Host
