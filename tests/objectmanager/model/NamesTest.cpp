#include "objectmanager/model/Names.h"

#include <gtest/gtest.h>

namespace om {
namespace {

TEST(NamesTest, OnlyLettersOfTheAlphabetHaveCase) {
    EXPECT_TRUE(sameName("OperationalStatus", "operationalSTATUS"));
    EXPECT_FALSE(sameName("Name", "Names"));
    EXPECT_TRUE(sameName({}, {}));      // a pointer that is null has no bytes to compare
    EXPECT_FALSE(sameName("a[", "A{")); // the characters beside the letters, 32 apart
    EXPECT_FALSE(sameName("a@", "a`"));
    EXPECT_EQ(NameHash()("ElementName"), NameHash()("ELEMENTNAME"));
    EXPECT_NE(NameHash()("ElementName"), NameHash()("Name"));
    EXPECT_EQ(NameHash()("OperationalStatus"), NameHash()("operationalstatuS")); // the last one after whole words
    EXPECT_NE(NameHash()("OperationalStatus"), NameHash()("OperationalStatut"));
}

TEST(NamesTest, AReplacedValueKeepsItsPlaceAndSpelling) {
    std::vector<NamedValue> list;
    putValue(list, "A", {CMPI_boolean, true});
    putValue(list, "B", {CMPI_boolean, true});
    putValue(list, "a", {CMPI_boolean, false});
    ASSERT_EQ(list.size(), 2U);
    EXPECT_EQ(list[0], NamedValue("A", {CMPI_boolean, false}));
    EXPECT_EQ(findValue(list, "b"), &list[1].second);
    EXPECT_EQ(findValue(list, "C"), nullptr);
}

TEST(NamesTest, ValuesCompareByContent) {
    const auto path = [](const char* key) {
        return Value{CMPI_ref, std::make_shared<const ObjectPath>(
                                   ObjectPath{"", "n", "C", {{"K", {CMPI_string, std::string(key)}}}})};
    };
    EXPECT_EQ(path("x"), path("x"));
    EXPECT_FALSE(path("x") == path("y"));
    EXPECT_FALSE((Value{CMPI_uint8, std::uint64_t{1}} == Value{CMPI_uint16, std::uint64_t{1}}));
    EXPECT_EQ((Value{CMPI_string, {}}), (Value{CMPI_string, {}}));
}

} // namespace
} // namespace om
