#include "tools/snapshot/Mask.h"

#include "common/Text.h"
#include "host/Placeholder.h"

#include <gmock/gmock.h>

using testing::MatchesRegex;
using VK::Host::FirmwareText;

namespace snapshot {

namespace {

struct Row {
    FirmwareText kind;
    const char* text;
    bool saysSomething;
};

constexpr Row rows[] = {
#define SAYS_NOTHING(KIND, TEXT) {FirmwareText::KIND, TEXT, false},
#define SAYS_SOMETHING(KIND, TEXT) {FirmwareText::KIND, TEXT, true},
#include "support/FirmwareTexts.inc"
};

class MaskTest : public testing::Test {
protected:
    Mask mask{"0123456789abcdef"};
};

} // namespace

TEST_F(MaskTest, KeepsTheShapeOfAName) {
    EXPECT_THAT(mask.name("CZJ-1234.ab Z"), MatchesRegex("[A-Z][A-Z][A-Z]-[0-9][0-9][0-9][0-9][.][a-z][a-z] [A-Z]"));
    EXPECT_NE(mask.name("CZJ-1234.ab Z"), "CZJ-1234.ab Z");
    EXPECT_EQ(mask.name("CZJ-1234"), mask.name("CZJ-1234"));
    EXPECT_NE(mask.name("CZJ-1234"), Mask("another salt").name("CZJ-1234"));
}

TEST_F(MaskTest, LeavesPlaceholdersAndOnlyThem) {
    for (const Row& row : rows) {
        if (row.kind != FirmwareText::Other) continue; // serial numbers, which alone are masked, are no other kind
        const std::string masked = mask.name(row.text);
        EXPECT_EQ(VK::Host::isPlaceholder(VK::cleanText(masked)), !row.saysSomething) << row.text;
        EXPECT_TRUE(!row.saysSomething || masked != row.text) << row.text;
    }
}

TEST_F(MaskTest, HidesWhatStandsBehindAPlaceholder) {
    EXPECT_EQ(mask.name("To be filled by O.E.M. SN-77"), "To be filled by O.E.M.......");
}

TEST_F(MaskTest, PutsSerialNumbersEverywhereTheLongestFirst) {
    const std::string part = mask.serial("AB12CD");
    const std::string whole = mask.serial(" AB12CD34\n");
    EXPECT_EQ(mask.everywhere("x AB12CD34 AB12CD y"), "x " + std::string(VK::trimmed(whole)) + " " + part + " y");
}

TEST_F(MaskTest, LeavesShortSerialNumbersToChance) {
    mask.serial("A1");
    EXPECT_EQ(mask.everywhere("A1"), "A1");
}

TEST_F(MaskTest, MasksAUuidInItsShape) {
    const std::string lower = "4c4c4544-0043-3010-8052-b4c04f564231";
    EXPECT_THAT(mask.uuid(lower), MatchesRegex("[0-9a-f]+-[0-9a-f]+-[0-9a-f]+-[0-9a-f]+-[0-9a-f]+"));
    EXPECT_NE(mask.uuid(lower), lower);
    EXPECT_EQ(VK::lowerCase(mask.uuid("{4C4C4544-0043-3010-8052-B4C04F564231}")), "{" + mask.uuid(lower) + "}");
    EXPECT_EQ(mask.uuid("urn:uuid:1"), mask.name("urn:uuid:1"));
}

TEST_F(MaskTest, LeavesSharedUuidsInEitherOrder) {
    for (const char* text : {"00020003-0004-0005-0006-000700080009", "03000200-0400-0500-0006-000700080009",
                             "FFFFFF00-FFFF-FFFF-FFFF-FFFFFFFFFFFF", "4c4c4544-0000-2010-8020-80c04f202020"})
        EXPECT_EQ(mask.uuid(text), text);
    for (const char* text : {"4c4c4544-0000-2010-8020-80c04f202031", "10000000-0000-0000-0000-0cc47a133878"})
        EXPECT_NE(mask.uuid(text), text);
}

} // namespace snapshot
