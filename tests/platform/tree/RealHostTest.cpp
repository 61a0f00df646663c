#include "tree/RealHost.h"

#include "support/LogCapture.h"
#include "support/SmbiosImage.h"
#include "tree/SimulatedHost.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <filesystem>
#include <memory>
#include <unistd.h>

namespace VK::Tree {

namespace {

using support::SmbiosChassisImage;
using support::SmbiosImage;
using support::SmbiosSystemImage;
using support::takeLog;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::StartsWith;

class RealHostTest : public testing::Test {
protected:
    RealHostTest() {
        takeLog();
        files.write("etc/hostname", "node7\n");
    }

    RealHost& host() {
        if (!made) made = std::make_unique<RealHost>(Root(files.path()));
        return *made;
    }
    const Node& node(const std::string& path) { return *host().tree()->find(path).node; }
    std::optional<Value> read(const std::string& path, unsigned int property) {
        return host().read(node(path), property);
    }

    support::TemporaryDirectory files;
    std::unique_ptr<RealHost> made;
};

TEST_F(RealHostTest, HasOneComputerAndEachChassisInTableOrder) {
    SmbiosImage(3, 2)
        .add(SmbiosSystemImage{"Veska", "VS 200", {}, "CZ1234", "P0815", std::string(16, 'u')})
        .add(SmbiosChassisImage{23, "Boxes", "V1", {}, {}, 3, 3, 3})
        .add(SmbiosChassisImage{28, {}, "V2", {}, {}, 5, 3, 3})
        .writeTo(files);
    const auto tree = host().tree();
    ASSERT_EQ(tree->ofType(40).size(), 1U);
    ASSERT_EQ(tree->ofType(1).size(), 2U);

    const Node& computer = node("/computer/0");
    EXPECT_EQ(computer.parent, "");
    EXPECT_EQ(computer.description, "Veska VS 200");
    EXPECT_EQ(host().status(computer), 1U); // the first chassis' status
    EXPECT_EQ(read("/computer/0", 39), Value("VS 200"));
    EXPECT_EQ(read("/computer/0", 50), Value("CZ1234"));
    EXPECT_EQ(read("/computer/0", 64), Value("75757575-7575-7575-7575-757575757575"));
    EXPECT_EQ(read("/computer/0", 108), Value("node7"));
    EXPECT_EQ(read("/computer/0", 115), std::nullopt);
    EXPECT_EQ(read("/computer/0", 123), Value(1U));
    EXPECT_EQ(read("/computer/0", 127), Value(0U));
    EXPECT_EQ(read("/computer/0", 200), Value(0U));
    EXPECT_EQ(read("/computer/0", 4711), std::nullopt);

    const std::string first = "/computer/0/chassis/0";
    EXPECT_EQ(node(first).parent, "/computer/0");
    EXPECT_EQ(node(first).description, "Rack Mount Chassis");
    EXPECT_EQ(read(first, 36), Value("Boxes"));
    EXPECT_EQ(read(first, 39), Value("VS 200")); // the system's, as are the next two
    EXPECT_EQ(read(first, 50), Value("CZ1234"));
    EXPECT_EQ(read(first, 86), Value("P0815"));
    EXPECT_EQ(read(first, 108), Value("Rack Mount Chassis"));
    EXPECT_EQ(read(first, 128), Value(2U));

    const std::string second = "/computer/0/chassis/1";
    EXPECT_EQ(host().status(node(second)), 23U);
    EXPECT_EQ(read(second, 36), Value("Veska"));
    EXPECT_EQ(read(second, 39), Value("V2"));
    EXPECT_EQ(read(second, 50), std::nullopt);
    EXPECT_EQ(read(second, 86), std::nullopt);
    EXPECT_EQ(read(second, 128), Value(3U));
    EXPECT_EQ(read(second, 123), std::nullopt);
}

TEST_F(RealHostTest, WithoutHardwareDataIsStillAComputer) {
    EXPECT_THAT(node("/computer/0").description, StartsWith("Linux "));
    EXPECT_EQ(host().status(node("/computer/0")), 0U);
    EXPECT_TRUE(host().tree()->ofType(1).empty());
    EXPECT_THAT(takeLog(), ElementsAre("4000 no SMBIOS tables: /sys/firmware/dmi/tables: No such file or directory"));
}

TEST_F(RealHostTest, LogsWhichOfTheTablesIsMissingOrDamagedOnce) {
    const std::string tables = "/sys/firmware/dmi/tables/";
    files.write(tables.substr(1) + "smbios_entry_point", SmbiosImage(3, 2).entryPoint());
    host().tree();
    EXPECT_THAT(takeLog(), ElementsAre("4000 no SMBIOS tables: " + tables + "DMI: No such file or directory"));
    files.write(tables.substr(1) + "smbios_entry_point", std::string(24, 'x'));
    files.write(tables.substr(1) + "DMI", "");
    RealHost(Root(files.path())).tree();
    EXPECT_THAT(takeLog(), ElementsAre("6000 " + tables + "smbios_entry_point: no entry point"));
}

TEST_F(RealHostTest, ReadsWhatCannotChangeOnceAndTheRestEachTime) {
    files.write("etc/machine-info", "HARDWARE_MODEL=one\n");
    EXPECT_EQ(read("/computer/0", 39), Value("one"));
    EXPECT_EQ(read("/computer/0", 108), Value("node7"));
    files.write("etc/machine-info", "HARDWARE_MODEL=two\n");
    files.write("etc/hostname", "node8\n");
    files.write("run/systemd/shutdown/scheduled", "USEC=1\nMODE=reboot\n");
    EXPECT_EQ(read("/computer/0", 39), Value("one"));
    EXPECT_EQ(read("/computer/0", 108), Value("node8"));
    EXPECT_EQ(read("/computer/0", 123), Value(16U));
    files.write("etc/hostname", "");
    EXPECT_EQ(read("/computer/0", 108), std::nullopt);
}

TEST_F(RealHostTest, UncorrectableMemoryErrorsShowAtOnce) {
    files.write("sys/devices/system/edac/mc/mc0/ue_count", "0\n");
    files.write("sys/devices/system/edac/mc/power/ue_count", "7\n"); // no controller
    EXPECT_EQ(host().status(node("/computer/0")), 0U);
    files.write("sys/devices/system/edac/mc/mc1/ue_count", "10\n");
    EXPECT_EQ(host().status(node("/computer/0")), 22U);
}

TEST_F(RealHostTest, AWorseStateCountsMoreThanMemoryErrors) {
    SmbiosImage(3, 2).add(SmbiosChassisImage{23, {}, {}, {}, {}, 3, 6, 3}).writeTo(files);
    files.write("sys/devices/system/edac/mc/mc0/ue_count", "1\n");
    EXPECT_EQ(host().status(node("/computer/0")), 26U);
    EXPECT_EQ(host().status(node("/computer/0/chassis/0")), 26U);
}

TEST_F(RealHostTest, LetsOnlyTheZoneOfASnapshotBeWritten) {
    const Node& computer = node("/computer/0");
    EXPECT_EQ(host().isReadOnly(computer, 108), true);
    EXPECT_EQ(host().isReadOnly(computer, 126), true);
    EXPECT_EQ(host().isReadOnly(computer, 127), false);
    EXPECT_EQ(host().isReadOnly(computer, 200), false);
    takeLog();
    EXPECT_FALSE(host().write(computer, 108, Value("other")));
    EXPECT_FALSE(host().write(computer, 126, Value("20260101000000.000000+000")));
    EXPECT_FALSE(host().write(computer, 127, Value("60")));
    EXPECT_FALSE(host().write(computer, 200, Value(2U)));
    EXPECT_EQ(takeLog().size(), 4U);
    files.write("etc/timezone", "Etc/UTC\n");
    EXPECT_TRUE(host().write(computer, 127, Value(4294966996U))); // -300
    EXPECT_EQ(host().read(computer, 127), Value(4294966996U));
}

TEST_F(RealHostTest, TrustsAZoneFromWhenItsDirectoryIsTheZoneDirectory) {
    files.write("usr/share/zoneinfo/Etc/UTC", "");
    std::filesystem::create_directories(files.path("opt/zones"));
    std::filesystem::copy_file("/usr/share/zoneinfo/Asia/Kolkata", files.path("opt/zones/Kolkata"));
    files.link("/opt/zones/Kolkata", "etc/localtime");
    usleep(50'000); // until the stamps show every change
    EXPECT_EQ(read("/computer/0", 127), Value(0U));
    std::filesystem::remove_all(files.path("usr/share/zoneinfo"));
    files.link("/opt/zones", "usr/share/zoneinfo");
    EXPECT_EQ(read("/computer/0", 127), Value(330U));
}

TEST_F(RealHostTest, NothingOfAChassisCanBeWritten) {
    SmbiosImage(3, 2).add(SmbiosChassisImage()).writeTo(files);
    const Node& chassis = node("/computer/0/chassis/0");
    EXPECT_EQ(host().isReadOnly(chassis, 127), true);
    EXPECT_FALSE(host().write(chassis, 127, Value(60U)));
}

TEST(RealHost, ThatIsNotThereIsAnEmptyTree) {
    takeLog();
    RealHost host(Root("/no/such/directory"));
    EXPECT_TRUE(host.tree()->isEmpty());
    EXPECT_TRUE(host.tree()->isEmpty());
    EXPECT_EQ(host.reading()->problem, "/no/such/directory: No such file or directory");
    EXPECT_THAT(takeLog(), ElementsAre("6000 /no/such/directory: No such file or directory"));
}

TEST(SimulatedHostLog, NamesABrokenFileOnce) {
    const support::TemporaryDirectory directory;
    directory.write("tree.json", "{\"nodes\":[{}]}");
    SimulatedHost host(directory.path("tree.json"));
    takeLog();
    for (int i = 0; i < 5; ++i) host.tree();
    EXPECT_THAT(takeLog(), ElementsAre("6000 " + directory.path("tree.json") + ": nodes[0]: no \"type\""));
    directory.write("tree.json", "{\"nodes\":[]}");
    host.tree();
    EXPECT_THAT(takeLog(), ElementsAre());
    directory.write("tree.json", "{");
    host.tree();
    EXPECT_THAT(takeLog(), ElementsAre(HasSubstr("not JSON at byte 2")));
}

} // namespace

} // namespace VK::Tree
