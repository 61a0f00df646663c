#include "host/HardwareFacts.h"

#include "host/HardwareNotes.h"
#include "support/SmbiosImage.h"
#include "tree/HostNodes.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <algorithm>
#include <cerrno>
#include <sys/stat.h>
#include <sys/utsname.h>
#include <unistd.h>

namespace VK::Host {

namespace {

using namespace std::literals;
using support::SmbiosChassisImage;
using support::SmbiosImage;
using support::SmbiosStructureImage;
using support::SmbiosSystemImage;
using testing::Contains;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::StartsWith;

const std::string uuidBytes = "\x33\x22\x11\x00\x55\x44\x77\x66\x88\x99\xAA\xBB\xCC\xDD\xEE\xFF"s;
constexpr const char* uuidText = "00112233-4455-6677-8899-aabbccddeeff";

class HardwareFactsTest : public testing::Test {
protected:
    HardwareFacts read() const { return readHardware(Root(host.path())); }
    void tables(const SmbiosSystemImage& system) const { SmbiosImage(3, 2).add(system).writeTo(host); }

    support::TemporaryDirectory host;
};

TEST_F(HardwareFactsTest, ComeFromTheTables) {
    SmbiosImage(3, 2)
        .add(SmbiosSystemImage{"Veska", "VS 200", "A1", "CZ1234", "P0815", uuidBytes})
        .add(SmbiosChassisImage{23, "Veska Boxes", "V1", "C1", "S1", 3, 4, 3})
        .writeTo(host);
    host.write("sys/class/dmi/id/sys_vendor", "Somebody else\n");
    const HardwareFacts facts = read();
    EXPECT_EQ(facts.noTables.error, 0);
    EXPECT_EQ(facts.manufacturer.text, "Veska");
    EXPECT_EQ(facts.manufacturer.source, "/sys/firmware/dmi/tables/DMI");
    EXPECT_EQ(facts.model.text, "VS 200");
    EXPECT_EQ(facts.serial.text, "CZ1234");
    EXPECT_EQ(facts.sku.text, "P0815");
    EXPECT_EQ(facts.uuid.text, uuidText);
    ASSERT_EQ(facts.chassis.size(), 1U);
    EXPECT_EQ(facts.chassis[0].manufacturer.text, "Veska Boxes");
    EXPECT_EQ(facts.chassis[0].serial.text, "C1");
    EXPECT_EQ(facts.chassis[0].sku.text, "S1");
    EXPECT_EQ(facts.chassis[0].type, 23U);
    EXPECT_EQ(facts.chassis[0].status, 21U); // the worst state, a warning
}

TEST_F(HardwareFactsTest, WhatAnAdministratorWroteComesFirst) {
    SmbiosImage(3, 2)
        .add(SmbiosSystemImage{"QEMU", "KVM guest", {}, {}, {}, {}})
        .add(SmbiosChassisImage{1, {}, {}, {}, {}, 3, 3, 3})
        .writeTo(host);
    host.write("etc/machine-info",
               "HARDWARE_VENDOR=\"Our Own\"\nHARDWARE_MODEL='Mk 3'\nCHASSIS=server\n"
               "PRIMARY_OWNER_CONTACT=admin@example.org\nPRIMARY_OWNER_NAME=\"J\xC3\xA9r\xC3\xB4me\"\n");
    const HardwareFacts facts = read();
    EXPECT_EQ(facts.manufacturer.text, "Our Own");
    EXPECT_EQ(facts.manufacturer.source, "/etc/machine-info");
    EXPECT_EQ(facts.model.text, "Mk 3");
    EXPECT_EQ(facts.firmwareManufacturer.text, "QEMU"); // for those that ask whether this is a guest
    EXPECT_EQ(facts.firmwareModel.text, "KVM guest");
    EXPECT_EQ(facts.ownerContact.text, "admin@example.org");
    EXPECT_EQ(facts.ownerName.text, "J\xC3\xA9r\xC3\xB4me");
    EXPECT_EQ(facts.chassis.at(0).type, 17U);
}

TEST_F(HardwareFactsTest, PlaceholdersInTheTablesGiveWayToTheNextSource) {
    tables(
        {"To Be Filled By O.E.M.", "System Product Name", {}, "0123456789", "Default string", std::string(16, '\xFF')});
    host.write("proc/device-tree/model", "Board Mk 2\0"s);
    const HardwareFacts facts = read();
    EXPECT_EQ(facts.model.text, "Board Mk 2");
    EXPECT_EQ(facts.manufacturer.text, "");
    EXPECT_EQ(facts.manufacturer.placeholder, "To Be Filled By O.E.M.");
    EXPECT_EQ(facts.serial.text, "");
    EXPECT_EQ(facts.serial.placeholder, "0123456789");
    EXPECT_EQ(facts.uuid.text, "");
    EXPECT_THAT(notesOn(facts), Contains("no UUID: /sys/firmware/dmi/tables/DMI holds a placeholder, "
                                         "\"ffffffff-ffff-ffff-ffff-ffffffffffff\""));
}

TEST_F(HardwareFactsTest, WithoutTablesTheKernelTells) {
    const std::pair<const char*, const char*> files[] = {{"sys_vendor", "Veska\n"},
                                                         {"product_name", " VS 200 \n"},
                                                         {"product_serial", "CZ1234\n"},
                                                         {"product_sku", "P0815\n"},
                                                         {"product_uuid", "00112233-4455-6677-8899-AABBCCDDEEFF\n"},
                                                         {"chassis_vendor", "Boxes\n"},
                                                         {"chassis_type", "151\n"},
                                                         {"chassis_serial", "None\n"}};
    for (const auto& [name, text] : files) host.write("sys/class/dmi/id/"s + name, text);
    const HardwareFacts facts = read();
    EXPECT_EQ(facts.noTables.error, ENOENT);
    EXPECT_EQ(facts.manufacturer.text, "Veska");
    EXPECT_EQ(facts.model.text, "VS 200");
    EXPECT_EQ(facts.serial.text, "CZ1234");
    EXPECT_EQ(facts.sku.text, "P0815");
    EXPECT_EQ(facts.uuid.text, uuidText);
    ASSERT_EQ(facts.chassis.size(), 1U);
    EXPECT_EQ(facts.chassis[0].manufacturer.text, "Boxes");
    EXPECT_EQ(facts.chassis[0].type, 23U); // 151 without the lock bit
    EXPECT_EQ(facts.chassis[0].serial.placeholder, "None");
    EXPECT_EQ(facts.chassis[0].status, 0U);
}

TEST_F(HardwareFactsTest, ADeviceTreeTells) {
    host.write("proc/device-tree/model", "Board Mk 2\0"s);
    host.write("proc/device-tree/serial-number", "100000001234\0"s);
    host.write("proc/device-tree/chassis-type", "server\0"s);
    host.write("proc/device-tree/vm,uuid", "00112233-4455-6677-8899-aabbccddeeff\0"s);
    const HardwareFacts facts = read();
    EXPECT_EQ(facts.model.text, "Board Mk 2");
    EXPECT_EQ(facts.serial.text, "100000001234");
    EXPECT_EQ(facts.uuid.text, uuidText);
    EXPECT_EQ(facts.chassis.at(0).type, 17U);
}

TEST_F(HardwareFactsTest, S390AndXenTell) {
    host.write("proc/sysinfo", "Manufacturer:         IBM\nType:                 2964\nModel:                701 N63\n"
                               "Sequence Code:        00000000000AB1C7\n");
    host.write("sys/hypervisor/uuid", "00112233-4455-6677-8899-aabbccddeeff\n");
    const HardwareFacts facts = read();
    EXPECT_EQ(facts.manufacturer.text, "IBM");
    EXPECT_EQ(facts.model.text, "2964 701 N63");
    EXPECT_EQ(facts.serial.text, "00000000000AB1C7");
    EXPECT_EQ(facts.uuid.text, uuidText);
    ASSERT_EQ(facts.chassis.size(), 1U);
    EXPECT_EQ(facts.chassis[0].manufacturer.text, "IBM");
    EXPECT_EQ(facts.chassis[0].type, 0U);
}

TEST_F(HardwareFactsTest, NothingTellsOfNothing) {
    const HardwareFacts facts = read();
    EXPECT_TRUE(facts.chassis.empty());
    EXPECT_EQ(facts.model.error, ENOENT);
    EXPECT_THAT(notesOn(facts), Contains(StartsWith("no SMBIOS tables: the firmware provides none")));
    EXPECT_THAT(notesOn(facts), Contains("no serial number: the host has none"));
    EXPECT_THAT(notesOn(facts), Contains("no chassis: the host has none"));
}

TEST_F(HardwareFactsTest, ASnapshotTellsItsOwnArchitecture) {
    utsname here{};
    ASSERT_EQ(uname(&here), 0);
    EXPECT_EQ(read().architecture, here.machine);
    host.write("proc/sys/kernel/arch", "riscv64\n");
    EXPECT_EQ(read().architecture, "riscv64");
    EXPECT_EQ(Tree::hostNodes(read()).front().description, "Linux riscv64");
}

TEST_F(HardwareFactsTest, TablesWithoutChassisHaveNone) {
    tables({"Veska", "VS 200", {}, {}, {}, {}});
    host.write("sys/class/dmi/id/chassis_type", "3\n");
    EXPECT_TRUE(read().chassis.empty());
}

TEST_F(HardwareFactsTest, TheFirstChassisTellsTheSerialNumberThatTheSystemDoesNot) {
    SmbiosImage(3, 2)
        .add(SmbiosSystemImage{"Dell Inc.", "PowerEdge R610", {}, "Not Specified", {}, {}})
        .add(SmbiosChassisImage{23, "Dell Inc.", {}, "C1JXK5J", {}, 3, 3, 3})
        .add(SmbiosChassisImage{28, "Dell Inc.", {}, "OTHER77", {}, 3, 3, 3})
        .writeTo(host);
    EXPECT_EQ(read().serial.text, "C1JXK5J");
}

TEST_F(HardwareFactsTest, TheSystemsOwnSerialNumberComesBeforeTheChassis) {
    SmbiosImage(3, 2)
        .add(SmbiosSystemImage{"Veska", "VS 200", {}, {}, {}, {}})
        .add(SmbiosChassisImage{23, {}, {}, "C1", {}, 3, 3, 3})
        .writeTo(host);
    host.write("sys/class/dmi/id/product_serial", "CZ1234\n");
    EXPECT_EQ(read().serial.text, "CZ1234");
}

TEST_F(HardwareFactsTest, ASecondChassisTellsNothingOfTheComputer) {
    SmbiosImage(3, 2)
        .add(SmbiosChassisImage{23, {}, {}, "Chassis Serial Number", {}, 3, 3, 3})
        .add(SmbiosChassisImage{28, {}, {}, "OTHER77", {}, 3, 3, 3})
        .writeTo(host);
    EXPECT_EQ(read().serial.text, "");
}

/// A system, which may be placeholders, and a base board.
SmbiosImage withBoard(const SmbiosSystemImage& system, const char* manufacturer, const char* product) {
    return SmbiosImage(3, 2).add(system).add(SmbiosStructureImage(2, 8).text(4, manufacturer).text(5, product));
}

const SmbiosSystemImage leftAsItCame{
    "To Be Filled By O.E.M.", "System Product Name", "System Version", "System Serial Number", "SKU", {}};

TEST_F(HardwareFactsTest, ABoardThatIsSoldAloneTellsModelAndManufacturer) {
    withBoard(leftAsItCame, "ASRockRack", "X570D4U").writeTo(host);
    EXPECT_EQ(read().model.text, "X570D4U");
    EXPECT_EQ(read().manufacturer.text, "ASRockRack");
    EXPECT_EQ(Tree::hostNodes(read()).front().description, "ASRockRack X570D4U");
}

TEST_F(HardwareFactsTest, TheKernelTellsOfTheBoardWhereTheTablesCannotBeRead) {
    host.write("sys/class/dmi/id/sys_vendor", "To Be Filled By O.E.M.\n");
    host.write("sys/class/dmi/id/board_vendor", "ASRockRack\n");
    host.write("sys/class/dmi/id/board_name", "X570D4U\n");
    EXPECT_EQ(read().model.text, "X570D4U");
    EXPECT_EQ(read().manufacturer.text, "ASRockRack");
}

TEST_F(HardwareFactsTest, TheBoardIsNotAskedWhereTheSystemTellsItsMaker) {
    withBoard({"Veska", "System Product Name", {}, {}, {}, {}}, "ASRockRack", "X570D4U").writeTo(host);
    EXPECT_EQ(read().model.text, "");
    EXPECT_EQ(read().manufacturer.text, "Veska");
}

TEST_F(HardwareFactsTest, ABoardWithoutProductTellsNoManufacturerEither) {
    withBoard(leftAsItCame, "ASRockRack", "Base Board Product Name").writeTo(host);
    EXPECT_EQ(read().model.text, "");
    EXPECT_EQ(read().manufacturer.text, "");
    EXPECT_EQ(read().manufacturer.placeholder, "To Be Filled By O.E.M.");
}

TEST_F(HardwareFactsTest, LenovosModelStandsInTheVersion) {
    for (const char* version : {"ThinkPad T480s", "ThinkCentre M920q", "ThinkStation P520", "Thinkpad X1"}) {
        tables({"LENOVO", "20L7CTO1WW", version, {}, {}, {}});
        EXPECT_EQ(read().model.text, version);
    }
    for (const char* version : {"ThinkSystem SR650", "Lenovo V330", "ThinkPad", ""}) {
        tables({"LENOVO", "20L7CTO1WW", version, {}, {}, {}});
        EXPECT_EQ(read().model.text, "20L7CTO1WW") << version;
    }
    tables({"Veska", "VS 200", "ThinkPad T480s", {}, {}, {}});
    EXPECT_EQ(read().model.text, "VS 200");
}

TEST_F(HardwareFactsTest, TheKernelTellsLenovosModelToo) {
    host.write("sys/class/dmi/id/sys_vendor", "LENOVO\n");
    host.write("sys/class/dmi/id/product_name", "20L7CTO1WW\n");
    host.write("sys/class/dmi/id/product_version", "ThinkPad T480s\n");
    EXPECT_EQ(read().model.text, "ThinkPad T480s");
}

TEST_F(HardwareFactsTest, AChassisSkuThatOnlyNamesItsTypeGivesWayToTheSystems) {
    SmbiosImage(3, 2)
        .add(SmbiosSystemImage{"Veska", "VS 200", {}, {}, "P0815", {}})
        .add(SmbiosChassisImage{10, {}, {}, {}, "Notebook", 3, 3, 3})
        .writeTo(host);
    const Tree::Node chassis = Tree::hostNodes(read()).at(1);
    EXPECT_EQ(chassis.properties.at(86), Tree::Value("P0815"));
}

TEST_F(HardwareFactsTest, AChassisWithoutManufacturerHasTheSystems) {
    SmbiosImage(3, 2)
        .add(SmbiosSystemImage{"VMware, Inc.", "VMware Virtual Platform", {}, {}, {}, {}})
        .add(SmbiosChassisImage{1, "No Enclosure", "N/A", {}, {}, 3, 3, 3})
        .writeTo(host);
    EXPECT_EQ(Tree::hostNodes(read()).at(1).properties.at(36), Tree::Value("VMware, Inc."));
}

TEST_F(HardwareFactsTest, ShortModelsThatCountAreModels) {
    SmbiosImage(3, 2)
        .add(SmbiosSystemImage{"Veska", "1234", {}, "1234", {}, {}})
        .add(SmbiosChassisImage{23, {}, {}, {}, {}, 3, 3, 3})
        .add(SmbiosChassisImage{28, {}, "4321", "4321", {}, 3, 3, 3})
        .writeTo(host);
    const HardwareFacts facts = read();
    EXPECT_EQ(facts.model.text, "1234");
    EXPECT_EQ(facts.serial.placeholder, "1234");
    EXPECT_EQ(facts.chassis.at(1).version.text, "4321");
    EXPECT_EQ(facts.chassis.at(1).serial.text, "");
}

TEST_F(HardwareFactsTest, TheKernelTellsOfTheChassisThatABrokenTableDoesNotReach) {
    SmbiosImage(3, 2)
        .add(SmbiosSystemImage{"Veska", "VS 200", {}, {}, {}, {}})
        .addRaw("\x03\x02\0\0\0\0"s)
        .writeTo(host);
    host.write("sys/class/dmi/id/chassis_type", "23\n");
    host.write("sys/class/dmi/id/chassis_serial", "C1\n");
    const HardwareFacts facts = read();
    EXPECT_EQ(facts.manufacturer.text, "Veska");
    ASSERT_EQ(facts.chassis.size(), 1U);
    EXPECT_EQ(facts.chassis[0].type, 23U);
    EXPECT_EQ(facts.chassis[0].serial.text, "C1");
    EXPECT_EQ(facts.chassis[0].serial.source, "/sys/class/dmi/id/chassis_serial");
}

TEST_F(HardwareFactsTest, ABrokenTableStillTellsOfTheChassisBeforeItsFault) {
    SmbiosImage(3, 2).add(SmbiosChassisImage{28, {}, {}, "C2", {}, 3, 3, 3}).addRaw("\x03\x02\0\0\0\0"s).writeTo(host);
    host.write("sys/class/dmi/id/chassis_serial", "C1\n");
    const HardwareFacts facts = read();
    ASSERT_EQ(facts.chassis.size(), 1U);
    EXPECT_EQ(facts.chassis[0].serial.text, "C2");
}

TEST_F(HardwareFactsTest, BrokenTablesGiveWayToTheKernelAndAreNamed) {
    tables({"Veska", "VS 200", {}, {}, {}, {}});
    host.write("sys/firmware/dmi/tables/smbios_entry_point", "_SM3_ and nothing more, but long");
    host.write("sys/class/dmi/id/sys_vendor", "Kernel\n");
    const HardwareFacts facts = read();
    EXPECT_EQ(facts.manufacturer.text, "Kernel");
    EXPECT_THAT(facts.problems, ElementsAre(StartsWith("/sys/firmware/dmi/tables/smbios_entry_point: entry point")));
    EXPECT_THAT(notesOn(facts), Contains(HasSubstr("smbios_entry_point: entry point")));
}

TEST_F(HardwareFactsTest, HugeTablesAreReadUpToOneMegabyte) {
    SmbiosImage image(3, 2);
    image.add(SmbiosSystemImage{"Veska", {}, {}, {}, {}, {}});
    image.addRaw(SmbiosStructureImage(127 - 1, 4).image(0).substr(0, 4) + std::string(3U << 20, 'x'));
    image.writeTo(host);
    const HardwareFacts facts = read();
    EXPECT_EQ(facts.manufacturer.text, "Veska");
    EXPECT_THAT(facts.problems, ElementsAre(HasSubstr("DMI: structure whose strings do not end at byte")));
}

TEST_F(HardwareFactsTest, TellThatOnlyRootMayKnow) {
    if (geteuid() != 0) GTEST_SKIP() << "takes root, to become somebody else";
    tables({"Veska", "VS 200", {}, "CZ1234", {}, {}});
    host.write("sys/class/dmi/id/product_serial", "CZ1234\n");
    host.write("sys/class/dmi/id/sys_vendor", "Veska\n");
    for (const char* name : {"sys/firmware/dmi/tables/smbios_entry_point", "sys/firmware/dmi/tables/DMI",
                             "sys/class/dmi/id/product_serial"})
        ASSERT_EQ(chmod(host.path(name).c_str(), 0400), 0);
    ASSERT_EQ(chmod(host.path().c_str(), 0755), 0);
    const auto asNobody = [this] {
        if (setgid(65534) != 0 || setuid(65534) != 0) _exit(10);
        const HardwareFacts facts = read();
        if (facts.noTables.error != EACCES || facts.serial.error != EACCES) _exit(11);
        if (facts.manufacturer.text != "Veska") _exit(12);
        const std::vector<std::string> notes = notesOn(facts);
        const auto has = [&notes](const std::string& note) {
            return std::find(notes.begin(), notes.end(), note) != notes.end();
        };
        const std::string file = "/sys/firmware/dmi/tables/smbios_entry_point"; // the first that is refused
        if (!has("no SMBIOS tables: " + file + " may be read by root alone")) _exit(13);
        if (!has("no chassis: " + file + " may be read by root alone")) _exit(14);
        _exit(has("no serial number: " + file + " may be read by root alone") ? 0 : 15);
    };
    EXPECT_EXIT(asNobody(), testing::ExitedWithCode(0), "");
}

} // namespace

} // namespace VK::Host
