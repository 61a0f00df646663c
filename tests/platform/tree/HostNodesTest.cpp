#include "tree/HostNodes.h"

#include <gtest/gtest.h>

namespace VK::Tree {

namespace {

std::string description(const char* manufacturer, const char* model) {
    Host::HardwareFacts facts;
    facts.architecture = "x86_64";
    facts.manufacturer.text = manufacturer;
    facts.model.text = model;
    return hostNodes(facts).front().description;
}

TEST(HostNodes, DescribeTheComputerByManufacturerAndModel) {
    EXPECT_EQ(description("Veska", "VS 200"), "Veska VS 200");
    EXPECT_EQ(description("Veska", ""), "Veska");
    EXPECT_EQ(description("", "VS 200"), "VS 200");
    EXPECT_EQ(description("", ""), "Linux x86_64");
}

TEST(HostNodes, SayTheManufacturerOnce) {
    EXPECT_EQ(description("Dell Computer Corporation", "Dell PowerEdge 8450"), "Dell PowerEdge 8450");
    EXPECT_EQ(description("LENOVO", "Lenovo V330"), "Lenovo V330");
    EXPECT_EQ(description("Veska, Ltd.", "Veska"), "Veska");
    EXPECT_EQ(description("Dell Inc.", "Dellicious 5"), "Dell Inc. Dellicious 5");
    EXPECT_EQ(description("Hewlett-Packard", "HP Z600 Workstation"), "Hewlett-Packard HP Z600 Workstation");
}

} // namespace

} // namespace VK::Tree
