#include "Linux/ComputerSystemPackage.h"
#include "include/Exceptions.h"
#include "support/Monikers.h"
#include "support/SimulatedHost.h"

#include <gmock/gmock.h>

namespace {

using test::moniker;
using test::print;
using test::thrownText;
using VK::BaseServerProvider::ComputerSystemPackage;

std::string failureFrom(VK::Moniker end) {
    return thrownText<VK::InstrumentationException>([&] { ComputerSystemPackage().getComputerSystemMoniker(end); });
}

TEST(ComputerSystemPackage, LeadsFromAChassisToItsComputer) {
    test::simulate(
        {test::computer(0, "a"), test::computer(1, "b"), test::chassis(0, 0, "A"), test::chassis(1, 0, "B")});
    VK::Moniker end = moniker({{"Tag", "B"}});
    ComputerSystemPackage().getComputerSystemMoniker(end);
    EXPECT_EQ(print(end), "Name=b");
}

TEST(ComputerSystemPackage, LeadsFromAComputerToItsChassis) {
    test::simulate({test::computer(0, "a"), test::computer(1, "b")});
    VK::Moniker end = moniker({{"Name", "b"}});
    ComputerSystemPackage().getPhysicalPackageMoniker(end);
    EXPECT_EQ(print(end), "SystemName=/computer/1");
}

TEST(ComputerSystemPackage, NeedsTheKeysInExactlyThatSpelling) {
    test::simulate({test::computer(0, "a")});
    VK::Moniker end = moniker({{"tag", "A"}, {"name", "a"}});
    EXPECT_EQ(thrownText<VK::FrameworkException>([&] { ComputerSystemPackage().getComputerSystemMoniker(end); }),
              "Could not find 'Tag' Key in Moniker");
    EXPECT_EQ(thrownText<VK::FrameworkException>([&] { ComputerSystemPackage().getPhysicalPackageMoniker(end); }),
              "Could not find 'Name' Key in Moniker");
}

TEST(ComputerSystemPackage, FailsForAnUnknownComputer) {
    test::simulate({test::computer(0, "a")});
    VK::Moniker end = moniker({{"Name", "b"}});
    EXPECT_EQ(thrownText<VK::InstrumentationException>([&] { ComputerSystemPackage().getPhysicalPackageMoniker(end); }),
              "Concerned Computer Could Not Be Found.");
    EXPECT_EQ(print(end), "Name=b") << "replaced only on success";
}

TEST(ComputerSystemPackage, FailsWhereAComputerOnTheWayHasNoName) {
    test::simulate({test::without(test::computer(0, ""), 108), test::computer(1, "b")});
    VK::Moniker end = moniker({{"Name", "b"}});
    EXPECT_EQ(thrownText<VK::InstrumentationException>([&] { ComputerSystemPackage().getPhysicalPackageMoniker(end); }),
              "Name Property on Computer Node not available.");
}

TEST(ComputerSystemPackage, FailsWhereAChassisOnTheWayHasNoSerialNumber) {
    test::simulate({test::computer(0, "a"), test::without(test::chassis(0, 0, ""), 50), test::chassis(0, 1, "B")});
    EXPECT_EQ(failureFrom(moniker({{"Tag", "B"}})), "Serial Property on Chassis not available.");
}

TEST(ComputerSystemPackage, DoesNotMindAChassisWithoutSerialNumberBehindTheOneWanted) {
    test::simulate({test::computer(0, "a"), test::chassis(0, 0, "A"), test::without(test::chassis(0, 1, ""), 50)});
    VK::Moniker end = moniker({{"Tag", "A"}});
    ComputerSystemPackage().getComputerSystemMoniker(end);
    EXPECT_EQ(print(end), "Name=a");
}

TEST(ComputerSystemPackage, TellsAMissingChassisByTheMissingNameInItsOwnWords) {
    test::simulate({test::computer(0, "a"), test::chassis(0, 0, "A")});
    EXPECT_EQ(failureFrom(moniker({{"Tag", "B"}})), "Name Property on Computer not available.");
    test::simulate({test::without(test::computer(0, ""), 108), test::chassis(0, 0, "A")});
    EXPECT_EQ(failureFrom(moniker({{"Tag", "A"}})), "Name Property on Computer not available.");
    test::simulate({test::chassis(3, 0, "A")}); // its parent is not there
    EXPECT_EQ(failureFrom(moniker({{"Tag", "A"}})), "Name Property on Computer not available.");
}

TEST(ComputerSystemPackage, TakesThePlatformGUIDFromTheFirstComputer) {
    test::simulate({test::computer(0, "a"), test::computer(1, "b")});
    std::string guid;
    EXPECT_TRUE(ComputerSystemPackage().getPlatformGUID(guid));
    EXPECT_EQ(guid, "4c4c4544-0043-3010-8052-000000000000");
}

TEST(ComputerSystemPackage, HasNoPlatformGUIDWithoutAUUIDOnTheFirstComputer) {
    std::string guid = "untouched";
    test::simulate({test::without(test::computer(0, "a"), 64), test::computer(1, "b")});
    EXPECT_FALSE(ComputerSystemPackage().getPlatformGUID(guid));
    test::simulate({});
    EXPECT_FALSE(ComputerSystemPackage().getPlatformGUID(guid));
    EXPECT_EQ(guid, "untouched");
}

} // namespace
