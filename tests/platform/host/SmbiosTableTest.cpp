#include "host/SmbiosTable.h"

#include "support/SmbiosImage.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace VK::Host {

namespace {

using namespace std::literals;
using support::SmbiosImage;
using support::SmbiosStructureImage;

std::string versionOf(const std::string& entryPoint) {
    const SmbiosEntryPoint entry = parseSmbiosEntryPoint(entryPoint);
    if (!entry.problem.empty()) return entry.problem;
    return std::to_string(entry.version.major) + "." + std::to_string(entry.version.minor);
}

TEST(SmbiosEntryPoint, IsReadInAllThreeKinds) {
    for (const auto kind : {SmbiosImage::Version3, SmbiosImage::Version2, SmbiosImage::Legacy}) {
        SmbiosImage image(2, 7, kind);
        image.addRaw(std::string(513, 'x'));
        const SmbiosEntryPoint entry = parseSmbiosEntryPoint(image.entryPoint());
        EXPECT_EQ(entry.problem, "");
        EXPECT_EQ(entry.version.major, 2U);
        EXPECT_EQ(entry.version.minor, 7U);
        EXPECT_EQ(entry.tableLength, 513U);
    }
}

TEST(SmbiosEntryPoint, MendsVersionsThatAreMisprinted) {
    EXPECT_EQ(versionOf(SmbiosImage(2, 31, SmbiosImage::Version2).entryPoint()), "2.3");
    EXPECT_EQ(versionOf(SmbiosImage(2, 33, SmbiosImage::Version2).entryPoint()), "2.3");
    EXPECT_EQ(versionOf(SmbiosImage(2, 51, SmbiosImage::Version2).entryPoint()), "2.6");
    EXPECT_EQ(versionOf(SmbiosImage(3, 31, SmbiosImage::Version3).entryPoint()), "3.31");
}

TEST(SmbiosEntryPoint, MayStateThirtyBytesWhereThereAre31) {
    std::string entry = SmbiosImage(2, 4, SmbiosImage::Version2).entryPoint();
    // The last byte is beyond the stated length, so the outer sum is another one.
    entry[5] = 30;
    entry[4] = static_cast<char>(entry[4] + 1 + entry[30]);
    EXPECT_EQ(versionOf(entry), "2.4");
    EXPECT_EQ(versionOf(entry.substr(0, 30)), "2.4");
    EXPECT_EQ(versionOf(entry.substr(0, 29)), "entry point too short");
}

TEST(SmbiosEntryPoint, IsRefusedWhenAnyByteIsWrong) {
    for (const auto kind : {SmbiosImage::Version3, SmbiosImage::Version2, SmbiosImage::Legacy}) {
        const std::string good = SmbiosImage(2, 8, kind).entryPoint();
        for (std::size_t i = 0; i < good.size(); ++i) {
            std::string bad = good;
            bad[i] = static_cast<char>(bad[i] + 1);
            EXPECT_NE(parseSmbiosEntryPoint(bad).problem, "") << "byte " << i << " of kind " << kind;
            EXPECT_NE(parseSmbiosEntryPoint(good.substr(0, i)).problem, "") << i << " bytes of kind " << kind;
        }
    }
    EXPECT_EQ(versionOf(""), "no entry point");
    EXPECT_EQ(versionOf("_SM4_"), "no entry point");
}

/// The types of a table's structures and how it ended.
std::string walk(const std::string& bytes) {
    std::string result;
    SmbiosTable table(bytes);
    while (const auto structure = table.next()) result += std::to_string(structure->type()) + " ";
    return result + (table.problem().empty() ? "end" : table.problem());
}

TEST(SmbiosTable, EndsAtItsMarkerItsPaddingOrItsLastByte) {
    SmbiosImage image(3, 0);
    image.add(SmbiosStructureImage(1, 8).text(4, "a")).add(SmbiosStructureImage(2, 4));
    EXPECT_EQ(walk(image.table()), "1 2 end");
    EXPECT_EQ(walk(image.table() + std::string(100, '\0')), "1 2 end");
    image.end().addRaw("garbage");
    EXPECT_EQ(walk(image.table()), "1 2 end");
    EXPECT_EQ(walk(""), "end");
}

TEST(SmbiosTable, KeepsWhatStandsBeforeAFault) {
    const std::string good = SmbiosImage(3, 0).add(SmbiosStructureImage(1, 8).text(4, "a")).table();
    ASSERT_EQ(good.size(), 11U);
    EXPECT_EQ(walk(good + "\x03\x03\0\0\0\0"s), "1 structure shorter than 4 bytes at byte 11");
    EXPECT_EQ(walk(good + "\x03\0\0\0\0\0"s), "1 structure shorter than 4 bytes at byte 11");
    EXPECT_EQ(walk(good + "\x03\x04\0"s), "1 structure cut off at byte 11");
    EXPECT_EQ(walk(good + "\x03\x07\0\0\0\0"s), "1 structure cut off at byte 11");
    EXPECT_EQ(walk(good + "\x03\x04\0\0"s), "1 structure whose strings do not end at byte 11");
    EXPECT_EQ(walk(good + "\x03\x04\0\0text"s), "1 structure whose strings do not end at byte 11");
    EXPECT_EQ(walk(good + "\x03\x04\0\0text\0"s), "1 structure whose strings do not end at byte 11");
}

TEST(SmbiosTable, CutOffAnywhereKeepsTheWholeStructures) {
    const std::string whole = SmbiosImage(3, 0)
                                  .add(SmbiosStructureImage(1, 8).text(4, "a").text(5, "b"))
                                  .add(SmbiosStructureImage(3, 0x10).text(4, "c"))
                                  .table();
    for (std::size_t length = 0; length < whole.size(); ++length) {
        const std::string ending = walk(whole.substr(0, length));
        EXPECT_EQ(ending.rfind("1 ", 0) == 0, length >= 13) << length;
        EXPECT_EQ(ending.find("1 3 "), std::string::npos) << length;
    }
    EXPECT_EQ(walk(whole), "1 3 end");
}

class SmbiosStructureTest : public testing::Test {
protected:
    std::string text(const std::string& bytes, std::size_t offset) {
        SmbiosTable table(bytes);
        return std::string(table.next().value().stringAt(offset, badIndexes));
    }
    std::size_t badIndexes = 0;
};

TEST_F(SmbiosStructureTest, FindsStringsByTheirIndex) {
    const std::string bytes =
        SmbiosStructureImage(1, 10).text(4, "one").text(6, "two").byte(7, 3).byte(8, 255).image(0);
    EXPECT_EQ(text(bytes, 4), "one");
    EXPECT_EQ(text(bytes, 6), "two");
    EXPECT_EQ(text(bytes, 5), "");  // not specified
    EXPECT_EQ(text(bytes, 10), ""); // beyond the structure
    EXPECT_EQ(badIndexes, 0U);
    EXPECT_EQ(text(bytes, 7), "");
    EXPECT_EQ(text(bytes, 8), "");
    EXPECT_EQ(badIndexes, 2U);
}

TEST_F(SmbiosStructureTest, HasOnlyTheFieldsThatItsLengthReaches) {
    const std::string bytes = SmbiosStructureImage(1, 8).byte(7, 9).image(0);
    SmbiosTable table(bytes);
    const SmbiosStructure structure = table.next().value();
    EXPECT_EQ(structure.byteAt(7), 9U);
    EXPECT_EQ(structure.byteAt(8), std::nullopt);
    EXPECT_EQ(structure.bytesAt(6, 2), "\0\x09"sv);
    EXPECT_EQ(structure.bytesAt(7, 2), std::nullopt);
    EXPECT_EQ(structure.bytesAt(9, 0), std::nullopt);
}

} // namespace

} // namespace VK::Host
