#include "Linux/ElementCapabilities.h"
#include "include/Exceptions.h"
#include "support/Monikers.h"
#include "support/SimulatedHost.h"

#include <gmock/gmock.h>

namespace {

using test::moniker;
using test::print;
using test::thrownText;
using VK::BaseServerProvider::ElementCapabilities;

TEST(ElementCapabilities, LeadFromAComputerToItsCapabilities) {
    test::simulate({test::computer(0, "a"), test::computer(1, "node7")});
    VK::Moniker end = moniker({{"CreationClassName", "VESKA_ComputerSystem"}, {"Name", "node7"}});
    ElementCapabilities().getCapabilitiesMoniker(end);
    EXPECT_EQ(print(end), "InstanceID=/computer/1");
}

TEST(ElementCapabilities, GiveAnUnknownComputerAnEmptyInstanceIDAndNoError) {
    test::simulate({test::computer(0, "a")});
    VK::Moniker end = moniker({{"Name", "node7"}});
    ElementCapabilities().getCapabilitiesMoniker(end);
    EXPECT_EQ(print(end), "InstanceID=");
}

TEST(ElementCapabilities, LeadFromCapabilitiesToTheirComputer) {
    test::simulate({test::computer(0, "a"), test::computer(1, "node7")});
    VK::Moniker end = moniker({{"InstanceID", "/computer/1"}});
    ElementCapabilities().getComputerMoniker(end);
    EXPECT_EQ(print(end), "Name=node7");
}

TEST(ElementCapabilities, NeedTheKeyInExactlyThatSpelling) {
    test::simulate({test::computer(0, "node7")});
    VK::Moniker end = moniker({{"name", "node7"}});
    EXPECT_EQ(thrownText<VK::FrameworkException>([&] { ElementCapabilities().getCapabilitiesMoniker(end); }),
              "Could not find 'Name' Key in Moniker");
    EXPECT_EQ(print(end), "name=node7") << "replaced only on success";
    EXPECT_EQ(thrownText<VK::FrameworkException>([&] { ElementCapabilities().getComputerMoniker(end); }),
              "Could not find 'InstanceID' Key in Moniker");
}

TEST(ElementCapabilities, FailWhereAComputerOnTheWayHasNoName) {
    test::simulate({test::without(test::computer(0, ""), 108), test::computer(1, "node7")});
    VK::Moniker end = moniker({{"Name", "node7"}});
    EXPECT_EQ(thrownText<VK::InstrumentationException>([&] { ElementCapabilities().getCapabilitiesMoniker(end); }),
              "Name Property on Computer Node not available.");
    VK::Moniker id = moniker({{"InstanceID", "/computer/0"}});
    EXPECT_EQ(thrownText<VK::InstrumentationException>([&] { ElementCapabilities().getComputerMoniker(id); }),
              "Name Property on Computer Node not available.");
}

TEST(ElementCapabilities, FailForAnInstanceIDThatNamesNoComputer) {
    test::simulate({test::computer(0, "node7"), test::chassis(0, 0, "A")});
    for (const char* id : {"", "/computer/1", "/computer/0/chassis/0"}) {
        VK::Moniker end = moniker({{"InstanceID", id}});
        EXPECT_EQ(thrownText<VK::InstrumentationException>([&] { ElementCapabilities().getComputerMoniker(end); }),
                  "Concerned Computer Could Not Be Found.")
            << id;
    }
}

} // namespace
