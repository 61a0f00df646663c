#include "objectmanager/vkcim/Suggestion.h"
#include "tests/objectmanager/vkcim/TestSchema.h"

#include <gtest/gtest.h>

namespace vkcim {
namespace {

TEST(Suggestion, NamesTheClassThatWasProbablyMeant) {
    EXPECT_EQ(nearestClass("Test_Thnig", testSchema()), "Test_Thing");
    EXPECT_EQ(nearestClass("test_specialthings", testSchema()), "Test_SpecialThing");
    EXPECT_EQ(nearestClass("link", testSchema()), "Test_Link");
}

TEST(Suggestion, NamesNoneWhereNoneIsNearOrNeeded) {
    EXPECT_EQ(nearestClass("Something_Else", testSchema()), std::nullopt);
    EXPECT_EQ(nearestClass("test_thing", testSchema()), std::nullopt);
    EXPECT_EQ(nearestClass("", testSchema()), std::nullopt);
    EXPECT_EQ(nearestClass(std::string(100000, 'x'), testSchema()), std::nullopt);
}

} // namespace
} // namespace vkcim
