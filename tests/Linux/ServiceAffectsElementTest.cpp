#include "Linux/ServiceAffectsElement.h"
#include "support/HostName.h"
#include "support/Monikers.h"

#include <gtest/gtest.h>

namespace {

using test::moniker;
using VK::BaseServerProvider::TimeServiceAffectsElement;

TEST(TimeServiceAffectsElement, MapsAnyEndToTheOtherOneOfThisHostAndLeavesItsKeys) {
    for (VK::Moniker end : {moniker({}), moniker({{"Name", test::hostName()}}), moniker({{"SystemName", "another"}}),
                            moniker({{"Colour", "red"}, {"Name", ""}})}) {
        const std::string before = test::print(end);
        EXPECT_EQ(test::print(TimeServiceAffectsElement().getTimeMoniker(end)), "SystemName=" + test::hostName());
        EXPECT_EQ(test::print(TimeServiceAffectsElement().getComputerMoniker(end)), "Name=" + test::hostName());
        EXPECT_EQ(test::print(end), before);
    }
}

} // namespace
