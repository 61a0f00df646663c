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

TEST(Suggestion, PrefersTheClassesThatAreServed) {
    EXPECT_EQ(nearestClass("ComputerSystem", om::Schema::builtin()), "VESKA_ComputerSystem");
    EXPECT_EQ(nearestClass("CIM_ComputerSytem", om::Schema::builtin()), "CIM_ComputerSystem");
}

TEST(Suggestion, NamesTheNearestOfAnyNames) {
    EXPECT_EQ(nearestName("nam", {"names", "name", "same"}), "name");
    EXPECT_EQ(nearestName("zzz", {"names", "name"}), std::nullopt);
    EXPECT_EQ(nearestName("a", {}), std::nullopt);
    EXPECT_EQ(didYouMean("name"), "; did you mean name?");
    EXPECT_EQ(didYouMean(std::nullopt), "");
}

TEST(Suggestion, NamesNoneWhereNoneIsNearOrNeeded) {
    EXPECT_EQ(nearestClass("Something_Else", testSchema()), std::nullopt);
    EXPECT_EQ(nearestClass("test_thing", testSchema()), std::nullopt);
    EXPECT_EQ(nearestClass("", testSchema()), std::nullopt);
    EXPECT_EQ(nearestClass(std::string(100000, 'x'), testSchema()), std::nullopt);
}

} // namespace
} // namespace vkcim
