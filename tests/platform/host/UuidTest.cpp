#include "host/Uuid.h"

#include "host/SmbiosTable.h"
#include "support/RealMachines.h"
#include "vk/Root.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <map>

namespace VK::Host {

namespace {

using namespace std::literals;

constexpr std::string_view eachByte = "\x33\x22\x11\x00\x55\x44\x77\x66\x88\x99\xAA\xBB\xCC\xDD\xEE\xFF"sv;

TEST(Uuid, ByteOrderFollowsTheVersion) {
    EXPECT_EQ(uuidFromBytes(eachByte, {2, 6}), "00112233-4455-6677-8899-aabbccddeeff");
    EXPECT_EQ(uuidFromBytes(eachByte, {3, 0}), "00112233-4455-6677-8899-aabbccddeeff");
    EXPECT_EQ(uuidFromBytes(eachByte, {2, 5}), "33221100-5544-7766-8899-aabbccddeeff");
    EXPECT_EQ(uuidFromBytes(eachByte, {2, 3}), "33221100-5544-7766-8899-aabbccddeeff");
}

TEST(Uuid, TakesSixteenBytes) {
    EXPECT_EQ(uuidFromBytes(eachByte.substr(1), {2, 6}), "");
    EXPECT_EQ(uuidFromBytes("", {2, 6}), "");
}

/// The UUID of a table's bytes, read as tables of that version are; empty for one that machines share.
std::string ofBytes(std::string_view bytes, SmbiosVersion version) {
    return uuidFromText(uuidFromBytes(bytes, version));
}

TEST(Uuid, ThatProductLinesShareIsNoneWhateverTheVersion) {
    for (const std::string_view bytes : {
             "\0\0\0\0\0\0\0\0\0\0\0\0\0\0\0\0"sv,
             "\xFF\xFF\xFF\xFF\xFF\xFF\xFF\xFF\xFF\xFF\xFF\xFF\xFF\xFF\xFF\xFF"sv,
             "\xFE\xFE\xFE\xFE\xFE\xFE\xFE\xFE\xFE\xFE\xFE\xFE\xFE\xFE\xFE\xFE"sv,
             "\0\x02\0\x03\0\x04\0\x05\0\x06\0\x07\0\x08\0\x09"sv,
             "\0\x01\x02\x03\x04\x05\x06\x07\x08\x09\x0A\x0B\x0C\x0D\x0E\x0F"sv,
             "\x10\0\0\0\0\0\x80\0\0\x40\0\0\0\0\0\0"sv,
             "\0\0\0\x10\0\0\0\x80\0\x40\0\0\0\0\0\0"sv,
             "\x78\x56\x34\x12\x34\x12\x78\x56\x90\xAB\xCD\xDE\xEF\xAA\xBB\xCC"sv,
             "\x12\x34\x56\x78\x12\x34\x56\x78\x90\xAB\xCD\xDE\xEF\xAA\xBB\xCC"sv,
             "\0\xFF\xFF\xFF\xFF\xFF\xFF\xFF\xFF\xFF\xFF\xFF\xFF\xFF\xFF\xFF"sv,
             "DELL\0\0\x10 \x80 \x80\xC0\x4F   "sv,
             "DELL\0\0\x10\0\x80\0\x80\xC0\x4F\0\0\0"sv,
             "DELL \0\x10 \x80 \xA0\xC0\x4F   "sv,
         })
        for (const SmbiosVersion version : {SmbiosVersion{2, 3}, SmbiosVersion{2, 6}, SmbiosVersion{3, 2}})
            EXPECT_EQ(ofBytes(bytes, version), "") << uuidFromBytes(bytes, version);
}

TEST(Uuid, ThatProductLinesShareIsNoneAsText) {
    for (const char* text : {"03000200-0400-0500-0006-000700080009", "00020003-0004-0005-0006-000700080009",
                             "03020100-0504-0706-0809-0a0b0c0d0e0f", "00010203-0405-0607-0809-0A0B0C0D0E0F",
                             "10000000-0000-8000-0040-000000000000", "10000000-0000-0000-0000-000000000000",
                             "12345678-1234-5678-90ab-cddeefaabbcc", "ffffff00-ffff-ffff-ffff-ffffffffffff",
                             "FEFEFEFE-FEFE-FEFE-FEFE-FEFEFEFEFEFE", "4c4c4544-0000-2010-8020-80c04f202020"})
        EXPECT_EQ(uuidFromText(text), "") << text;
}

TEST(Uuid, OfOneMachineIsKeptHoweverOdd) {
    for (const char* text : {"4c4c4544-0031-5910-8052-b4c04f4e4e32", // Dell, service tag 1YR4NN2
                             "4c4c4544-0000-2010-8020-80c04f202031", // the last character of a service tag
                             "4c4c4544-0000-2010-8020-80c050202020", // not Dell's form
                             "10000000-0000-0000-0000-0cc47a133878", "ffffff00-ffff-ffff-ffff-0cc47a133878",
                             "12345678-1234-5678-90ab-cddeefaabbcd", "032e02b4-0499-0533-a106-940700080009"})
        EXPECT_EQ(uuidFromText(text), text);
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

std::string hexDigits(std::string_view bytes) {
    std::string digits = uuidFromBytes(bytes, {2, 3});
    digits.erase(std::remove(digits.begin(), digits.end(), '-'), digits.end());
    return digits;
}

TEST(Uuid, SharedOnesStateOnHowManyOfTheTestsMachinesTheyWereSeen) {
    const char* const directory = support::realMachines();
    if (directory == nullptr) GTEST_SKIP() << support::noRealMachines;
    std::map<std::string, unsigned int> machines;
    for (const std::string& name : Root(directory).list("/").names) {
        const std::string table = Root(std::string(directory) + "/" + name).read("/sys/firmware/dmi/tables/DMI").text;
        SmbiosTable structures(table);
        while (const auto structure = structures.next())
            if (structure->type() == 1) ++machines[hexDigits(structure->bytesAt(8, 16).value_or(""))];
    }
    EXPECT_FALSE(machines.empty());
    constexpr unsigned int notCounted = 0;
#define SHARED_UUID(MACHINES, REASON, eachByte) EXPECT_EQ(machines[eachByte], MACHINES) << REASON;
#include "host/Placeholders.inc"
}

} // namespace

} // namespace VK::Host
