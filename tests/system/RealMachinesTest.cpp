#include "support/RealMachines.h"
#include "support/Command.h"

#include <gmock/gmock.h>

#include <filesystem>

// What the tables of real machines come to. The directory of their snapshots is named by VK_TEST_HOSTS.

namespace {

using nlohmann::json;
using testing::Contains;
using testing::Each;
using testing::IsEmpty;
using testing::Not;
using testing::StartsWith;

struct Machine {
    const char* directory;
    const char* name;
    const char* uuid; ///< empty: none, or one that many machines share
    const char* tag;  ///< empty: no serial number, or a placeholder
    const char* manufacturer;
    const char* model;
    int packageType;
    const char* description;
    const char* sku; ///< empty: none
    const char* chassisName;
};

void PrintTo(const Machine& machine, std::ostream* stream) {
    *stream << machine.directory;
}

constexpr Machine machines[] = {
    {"workstation-2.6", "workstation-26", "30d3f174-7f5d-11e1-bbda-5f0d3dbc082e", "CZC214446Z", "Hewlett-Packard",
     "HP Z600 Workstation", 3, "Hewlett-Packard HP Z600 Workstation", "WD059AV", "Mini Tower"},
    {"rack-server-2.7", "rack-server-27", "00000000-0000-0000-0000-0cc47a133878", "9000116105", "Supermicro",
     "X9DBL-3F/X9DBL-iF", 3, "Thomas-Krenn.AG X9DBL-3F/X9DBL-iF", "", "Main Server Chassis"},
    {"rack-server-3.2", "rack-server-32", "00112233-4455-6677-8899-aabbccddeeff", "", "Dell Inc.", "PowerEdge R777sd",
     2, "Dell Inc. PowerEdge R777sd", "SKU=0777;ModelName=PowerEdge R777sd", "Rack Mount Chassis"},
    {"desktop-3.1", "desktop-31", "032e02b4-0499-0533-a106-940700080009", "", "Gigabyte Technology Co., Ltd.",
     "X399 AORUS XTREME", 3, "Gigabyte Technology Co., Ltd. X399 AORUS XTREME", "", "Desktop"},
    {"mini-pc-3.5", "mini-pc-35", "", "BN1004GH10075", "AZW", "EQ", 3, "AZW EQ", "", "Desktop"},
    {"storage-2.7", "storage-27", "", "", "Synology", "RS3614xs+", 2, "Synology RS3614xs+", "", "Rack Mount Chassis"},
};

class RealMachines : public testing::TestWithParam<Machine> {
protected:
    void SetUp() override {
        const char* const hosts = support::realMachines();
        if (hosts == nullptr) GTEST_SKIP() << support::noRealMachines;
        const std::filesystem::path directory = std::filesystem::path(hosts) / GetParam().directory;
        ASSERT_TRUE(std::filesystem::is_directory(directory)) << directory;
        environment = "NVLOG_SINK=none VK_INSTRUMENTATION_ROOT=" + test::quoted(directory.string());
    }

    json results(const std::vector<std::string>& arguments) const {
        return test::vkcim(arguments, environment)["results"];
    }
    json instance(const std::string& className) const {
        const json found = results({"instances", className});
        EXPECT_EQ(found.size(), 1U) << className;
        return found.empty() ? json::object() : found[0]["properties"];
    }
    std::vector<std::string> paths(const std::vector<std::string>& arguments) const {
        std::vector<std::string> found;
        for (const json& result : results(arguments)) found.push_back(result["path"]);
        return found;
    }

    std::string environment;
};

std::string text(const json& properties, const char* name) {
    return properties.contains(name) ? properties[name]["value"].get<std::string>() : "";
}

TEST_P(RealMachines, PublishTheirComputerSystem) {
    const json computer = instance("VESKA_ComputerSystem");
    EXPECT_EQ(text(computer, "Name"), GetParam().name);
    EXPECT_EQ(text(computer, "UUID"), GetParam().uuid);
    EXPECT_EQ(text(computer, "Description"), GetParam().description);
    EXPECT_EQ(computer["HealthState"]["value"], 5);
    const auto information = computer["OtherIdentifyingInfo"]["value"].get<std::vector<std::string>>();
    const std::string tag = GetParam().tag;
    EXPECT_THAT(information, Contains(GetParam().model + (":" + tag)).Times(tag.empty() ? 0 : 1));
    EXPECT_THAT(information, Contains(tag).Times(tag.empty() ? 0 : 1));
}

TEST_P(RealMachines, HaveTablesWithoutAProblem) {
    const auto notes = test::vkcim({"report"}, environment)["notes"].get<std::vector<std::string>>();
    EXPECT_THAT(notes, Each(Not(StartsWith("/")))) << "which the line about a table's fault begins with";
}

TEST_P(RealMachines, PublishTheirChassis) {
    const json chassis = instance("VESKA_PhysicalPackage");
    EXPECT_EQ(text(chassis, "Tag"), GetParam().tag);
    EXPECT_EQ(text(chassis, "SerialNumber"), GetParam().tag);
    EXPECT_EQ(text(chassis, "Manufacturer"), GetParam().manufacturer);
    EXPECT_EQ(text(chassis, "Model"), GetParam().model);
    EXPECT_EQ(chassis["PackageType"]["value"], GetParam().packageType);
    EXPECT_EQ(text(chassis, "SKU"), GetParam().sku);
    EXPECT_EQ(text(chassis, "ElementName"), GetParam().chassisName);
}

TEST_P(RealMachines, CarryTheComputersUUIDAsPlatformGUID) {
    const json package = instance("VESKA_ComputerSystemPackage");
    EXPECT_EQ(text(package, "PlatformGUID"), GetParam().uuid);
    EXPECT_EQ(package.contains("PlatformGUID"), *GetParam().uuid != '\0');
}

TEST_P(RealMachines, LeadFromTheComputerToItsChassisAndBack) {
    const std::vector<std::string> computer = paths({"names", "VESKA_ComputerSystem"});
    ASSERT_EQ(computer.size(), 1U);
    const std::vector<std::string> chassis =
        paths({"associators", computer[0], "--assoc-class", "VESKA_ComputerSystemPackage"});
    ASSERT_EQ(chassis.size(), 1U);
    const std::vector<std::string> back =
        paths({"associators", chassis[0], "--assoc-class", "VESKA_ComputerSystemPackage"});
    if (*GetParam().tag != '\0')
        EXPECT_EQ(back, computer);
    else
        EXPECT_THAT(back, IsEmpty()) << "a chassis without a Tag cannot be followed";
}

TEST_P(RealMachines, LeadFromTheCapabilitiesToTheComputerAndBack) {
    const std::vector<std::string> capabilities = paths({"names", "VESKA_EnabledLogicalElementCapabilities"});
    ASSERT_EQ(capabilities.size(), 1U);
    const std::vector<std::string> computer =
        paths({"associators", capabilities[0], "--assoc-class", "VESKA_ComputerCapabilities"});
    ASSERT_EQ(computer, paths({"names", "VESKA_ComputerSystem"}));
    EXPECT_EQ(paths({"associators", computer[0], "--assoc-class", "VESKA_ComputerCapabilities"}), capabilities);
}

std::string testName(const testing::TestParamInfo<Machine>& info) {
    std::string name = info.param.directory;
    for (char& character : name)
        if (std::isalnum(static_cast<unsigned char>(character)) == 0) character = '_';
    return name;
}

INSTANTIATE_TEST_SUITE_P(, RealMachines, testing::ValuesIn(machines), testName);

} // namespace
