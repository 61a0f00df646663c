#include "host/HardwareNotes.h"

#include "support/SmbiosImage.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace VK::Host {

namespace {

using namespace std::literals;
using support::SmbiosChassisImage;
using support::SmbiosImage;
using support::SmbiosSystemImage;
using testing::AllOf;
using testing::Contains;
using testing::Each;
using testing::HasSubstr;
using testing::Not;

const std::string entryPointFile = "/sys/firmware/dmi/tables/smbios_entry_point";
const std::string tableFile = "/sys/firmware/dmi/tables/DMI";

class HostNotes : public testing::Test {
protected:
    std::vector<std::string> notes() const { return notesOn(readHardware(Root(host.path()))); }

    support::TemporaryDirectory host;
    SmbiosImage image = SmbiosImage(3, 2).add(SmbiosSystemImage{"Veska", "VS 200", {}, {}, {}, {}});
};

TEST_F(HostNotes, SayThatTheHostDoesNotTellWhatWholeTablesLack) {
    image.writeTo(host);
    EXPECT_THAT(notes(),
                AllOf(Contains("no serial number: the host has none"), Contains("no chassis: the host has none")));
}

TEST_F(HostNotes, SayThatTheFirmwareHasNoTablesOnlyWithoutTheirDirectory) {
    EXPECT_THAT(notes(), AllOf(Contains("no SMBIOS tables: the firmware provides none (/sys/firmware/dmi/tables is not "
                                        "there)"),
                               Contains("no UUID: the host has none"), Contains("no chassis: the host has none")));
}

TEST_F(HostNotes, NameTheTableThatIsMissing) {
    host.write(entryPointFile.substr(1), image.entryPoint());
    EXPECT_THAT(notes(), AllOf(Contains("no SMBIOS tables: " + tableFile + " is missing"),
                               Contains("no UUID: " + tableFile + " is missing"),
                               Contains("no chassis: " + tableFile + " is missing")));
}

TEST_F(HostNotes, NameTheTableThatIsEmpty) {
    host.write(entryPointFile.substr(1), image.entryPoint());
    host.write(tableFile.substr(1), "");
    EXPECT_THAT(notes(), AllOf(Contains(tableFile + ": table is empty"),
                               Contains("no UUID: " + tableFile + " is damaged: table is empty"),
                               Contains("no chassis: " + tableFile + " is damaged: table is empty")));
}

TEST_F(HostNotes, NameTheEntryPointThatIsMissing) {
    host.write(tableFile.substr(1), image.table());
    EXPECT_THAT(notes(), Contains("no SMBIOS tables: " + entryPointFile + " is missing"));
}

TEST_F(HostNotes, BlameTheEntryPointForItsChecksum) {
    image.writeTo(host);
    std::string damaged = image.entryPoint();
    damaged[5] = static_cast<char>(damaged[5] + 1);
    host.write(entryPointFile.substr(1), damaged);
    EXPECT_THAT(notes(),
                AllOf(Contains(entryPointFile + ": entry point's checksum is wrong"),
                      Contains("no UUID: " + entryPointFile + " is damaged: entry point's checksum is wrong"),
                      Contains("no chassis: " + entryPointFile + " is damaged: entry point's checksum is wrong"),
                      Each(Not(HasSubstr("DMI")))));
}

TEST_F(HostNotes, DoNotSayThatTheHostHasNoneOfWhatStandsBehindAFault) {
    SmbiosImage broken(3, 2);
    broken.addRaw("\x01\x02\0\0\0\0"s).writeTo(host);
    const std::string damage = tableFile + " is damaged: structure shorter than 4 bytes at byte 0";
    EXPECT_THAT(notes(), AllOf(Contains("no UUID: " + damage), Contains("no serial number: " + damage),
                               Contains("no model: " + damage), Contains("no chassis: " + damage)));
}

TEST_F(HostNotes, NameThePlaceholderAndItsFile) {
    host.write("sys/class/dmi/id/product_serial", "Default_string\n");
    EXPECT_THAT(notes(), Contains("no serial number: /sys/class/dmi/id/product_serial holds a placeholder, "
                                  "\"Default_string\""));
}

} // namespace

} // namespace VK::Host
