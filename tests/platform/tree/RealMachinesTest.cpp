#include "tree/RealHost.h"

#include <gtest/gtest.h>

#include <cstdlib>

namespace VK::Tree {
#include <ostream>

namespace {

/// What we read of the tables of a real machine; null is absent.
struct Machine {
    const char* folder;
    const char* description;
    unsigned int status;
    const char *model, *serial, *uuid;
    const char *manufacturer, *chassisSerial, *sku, *chassisName;
    unsigned int packageType;
};

void PrintTo(const Machine& machine, std::ostream* stream) {
    *stream << machine.folder;
}

constexpr Machine MACHINES[] = {
    {"desktop-3.1", "Gigabyte Technology Co., Ltd. X399 AORUS XTREME", 1, "X399 AORUS XTREME", nullptr,
     "032e02b4-0499-0533-a106-940700080009", "Gigabyte Technology Co., Ltd.", nullptr, nullptr, "Desktop", 1},
    {"mini-pc-3.5", "AZW EQ", 1, "EQ", "BN1004GH10075", nullptr, "AZW", "BN1004GH10075", nullptr, "Desktop", 1},
    {"rack-server-2.7", "Thomas-Krenn.AG X9DBL-3F/X9DBL-iF", 1, "X9DBL-3F/X9DBL-iF", "9000116105",
     "00000000-0000-0000-0000-0cc47a133878", "Supermicro", "9000116105", nullptr, "Main Server Chassis", 1},
    {"rack-server-3.2", "Dell Inc. PowerEdge R777sd", 1, "PowerEdge R777sd", nullptr,
     "00112233-4455-6677-8899-aabbccddeeff", "Dell Inc.", nullptr, "SKU=0777;ModelName=PowerEdge R777sd",
     "Rack Mount Chassis", 2},
    {"storage-2.7", "Synology RS3614xs+", 1, "RS3614xs+", nullptr, nullptr, "Synology", nullptr, nullptr,
     "Rack Mount Chassis", 2},
    {"workstation-2.6", "Hewlett-Packard HP Z600 Workstation", 1, "HP Z600 Workstation", "CZC214446Z",
     "30d3f174-7f5d-11e1-bbda-5f0d3dbc082e", "Hewlett-Packard", "CZC214446Z", "WD059AV", "Mini Tower", 1},
};

std::optional<Value> text(const char* expected) {
    return expected != nullptr ? std::optional<Value>(std::string(expected)) : std::nullopt;
}

class RealMachines : public testing::TestWithParam<Machine> {};

TEST_P(RealMachines, AreReadRight) {
    const char* folder = std::getenv("VK_TEST_HOSTS");
    if (folder == nullptr) GTEST_SKIP() << "VK_TEST_HOSTS does not name a folder with snapshots of real machines";
    const Machine& machine = GetParam();
    RealHost host(Root(std::string(folder) + "/" + machine.folder));
    const auto tree = host.tree();
    ASSERT_EQ(tree->ofType(40).size(), 1U);
    ASSERT_EQ(tree->ofType(1).size(), 1U);
    const Node& computer = *tree->ofType(40)[0];
    EXPECT_EQ(computer.description, machine.description);
    EXPECT_EQ(host.status(computer), machine.status);
    EXPECT_EQ(host.read(computer, 39), text(machine.model));
    EXPECT_EQ(host.read(computer, 50), text(machine.serial));
    EXPECT_EQ(host.read(computer, 64), text(machine.uuid));
    const Node& chassis = *tree->ofType(1)[0];
    EXPECT_EQ(host.read(chassis, 36), text(machine.manufacturer));
    EXPECT_EQ(host.read(chassis, 39), text(machine.model));
    EXPECT_EQ(host.read(chassis, 50), text(machine.chassisSerial));
    EXPECT_EQ(host.read(chassis, 86), text(machine.sku));
    EXPECT_EQ(host.read(chassis, 108), text(machine.chassisName));
    EXPECT_EQ(host.read(chassis, 128), Value(machine.packageType));
    EXPECT_TRUE(host.hardware().problems.empty());
}

INSTANTIATE_TEST_SUITE_P(All, RealMachines, testing::ValuesIn(MACHINES), [](const auto& machine) {
    std::string name = machine.param.folder;
    for (char& c : name)
        if (c == '-' || c == '.') c = '_';
    return name;
});

} // namespace

} // namespace VK::Tree
