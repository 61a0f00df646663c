#include "host/Smbios.h"

#include "support/SmbiosImage.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <random>

namespace VK::Host {

namespace {

using namespace std::literals;
using support::SmbiosChassisImage;
using support::SmbiosImage;
using support::SmbiosStructureImage;
using support::SmbiosSystemImage;
using testing::ElementsAre;

Smbios parse(const SmbiosImage& image) {
    return parseSmbios(image.entryPoint(), image.table());
}

TEST(Smbios, ReadsTheSystem) {
    const Smbios smbios = parse(
        SmbiosImage(3, 2).add(SmbiosSystemImage{"Veska", "VS 200", "A1", "CZ1234", "P0815-A",
                                                "\x33\x22\x11\x00\x55\x44\x77\x66\x88\x99\xAA\xBB\xCC\xDD\xEE\xFF"s}));
    ASSERT_TRUE(smbios.system.has_value());
    EXPECT_EQ(smbios.system->manufacturer, "Veska");
    EXPECT_EQ(smbios.system->product, "VS 200");
    EXPECT_EQ(smbios.system->version, "A1");
    EXPECT_EQ(smbios.system->serial, "CZ1234");
    EXPECT_EQ(smbios.system->sku, "P0815-A");
    EXPECT_EQ(smbios.system->uuid, "00112233-4455-6677-8899-aabbccddeeff");
    EXPECT_THAT(smbios.problems, ElementsAre());
}

TEST(Smbios, ReadsTheFirstSystemAndEveryChassis) {
    const Smbios smbios = parse(SmbiosImage(3, 2)
                                    .add(SmbiosChassisImage{23, "Veska", "V1", "C1", "S1", 3, 4, 5})
                                    .add(SmbiosSystemImage{"first", {}, {}, {}, {}, {}})
                                    .add(SmbiosChassisImage{28 | 0x80, "", "", "C2", "", 6, 2, 1})
                                    .add(SmbiosSystemImage{"second", {}, {}, {}, {}, {}})
                                    .end());
    EXPECT_EQ(smbios.system->manufacturer, "first");
    ASSERT_EQ(smbios.chassis.size(), 2U);
    const SmbiosChassis& rack = smbios.chassis[0];
    EXPECT_EQ(rack.manufacturer, "Veska");
    EXPECT_EQ(rack.version, "V1");
    EXPECT_EQ(rack.serial, "C1");
    EXPECT_EQ(rack.sku, "S1"); // behind a contained element
    EXPECT_EQ(rack.type, 23U);
    EXPECT_EQ(rack.bootUpState, 3U);
    EXPECT_EQ(rack.powerSupplyState, 4U);
    EXPECT_EQ(rack.thermalState, 5U);
    EXPECT_EQ(smbios.chassis[1].type, 28U); // without the lock bit
    EXPECT_EQ(smbios.chassis[1].serial, "C2");
}

TEST(Smbios, TellsAChassisThatIsRepeatedOnce) {
    const SmbiosChassisImage rack{23, "Veska", "V1", "C1", "S1", 3, 3, 3};
    SmbiosChassisImage other = rack;
    other.serial = "C2";
    const SmbiosStructureImage longer = SmbiosStructureImage(3, 0x1A).text(4, "Veska");
    const SmbiosStructureImage shorter = SmbiosStructureImage(3, 0x19).text(4, "Veska");
    const Smbios smbios = parse(SmbiosImage(3, 2).add(rack).add(other).add(rack).add(longer).add(shorter).add(other));
    ASSERT_EQ(smbios.chassis.size(), 4U); // the handles differ
    EXPECT_EQ(smbios.chassis[0].serial, "C1");
    EXPECT_EQ(smbios.chassis[1].serial, "C2");
}

TEST(Smbios, ReadsTheFirstBaseBoard) {
    const Smbios smbios = parse(SmbiosImage(3, 2)
                                    .add(SmbiosStructureImage(2, 8).text(4, " Veska ").text(5, "VB 7"))
                                    .add(SmbiosStructureImage(2, 8).text(4, "Veska").text(5, "VB 8")));
    ASSERT_TRUE(smbios.baseBoard.has_value());
    EXPECT_EQ(smbios.baseBoard->manufacturer, "Veska");
    EXPECT_EQ(smbios.baseBoard->product, "VB 7");
}

TEST(Smbios, ReadsOnlyTheFieldsOfAShortStructure) {
    const Smbios smbios = parse(SmbiosImage(2, 0, SmbiosImage::Version2)
                                    .add(SmbiosStructureImage(1, 8).text(4, "Veska").text(7, "CZ1"))
                                    .add(SmbiosStructureImage(3, 9).text(4, "Veska").byte(5, 17)));
    EXPECT_EQ(smbios.system->serial, "CZ1");
    EXPECT_EQ(smbios.system->uuid, "");
    EXPECT_EQ(smbios.system->sku, "");
    EXPECT_EQ(smbios.chassis.at(0).type, 17U);
    EXPECT_EQ(smbios.chassis.at(0).bootUpState, 0U);
    EXPECT_EQ(smbios.chassis.at(0).sku, "");
}

TEST(Smbios, AChassisWithMoreElementsThanItHoldsHasNoSku) {
    const Smbios smbios = parse(SmbiosImage(3, 0).add(
        SmbiosStructureImage(3, 0x19).text(4, "Veska").byte(0x13, 255).byte(0x14, 255).byte(0x18, 1)));
    EXPECT_EQ(smbios.chassis.at(0).manufacturer, "Veska");
    EXPECT_EQ(smbios.chassis.at(0).sku, "");
}

TEST(Smbios, CleansTexts) {
    const Smbios smbios = parse(SmbiosImage(3, 0).add(
        SmbiosSystemImage{"  Veska\t", "a\x01"s + "b\x7F\xC3\xA9", " ", std::string(300, 's'), {}, {}}));
    EXPECT_EQ(smbios.system->manufacturer, "Veska");
    EXPECT_EQ(smbios.system->product, "a.b...");
    EXPECT_EQ(smbios.system->version, "");
    EXPECT_EQ(smbios.system->serial, std::string(256, 's'));
}

TEST(Smbios, NeverReadsBeyondTheStatedLength) {
    SmbiosImage image(3, 0);
    image.add(SmbiosSystemImage{"Veska", {}, {}, {}, {}, {}});
    const std::string entryPoint = image.entryPoint();
    image.add(SmbiosChassisImage());
    EXPECT_EQ(parseSmbios(entryPoint, image.table()).chassis.size(), 0U);
    EXPECT_EQ(parseSmbios(image.entryPoint(), image.table()).chassis.size(), 1U);
}

TEST(Smbios, TellsWhatIsWrong) {
    SmbiosImage image(3, 0);
    image.add(SmbiosStructureImage(1, 8).byte(4, 1).byte(5, 7)).add(SmbiosStructureImage(3, 9).byte(4, 2));
    EXPECT_THAT(parse(image).problems, ElementsAre("3 string(s) that the table refers to are not there"));
    image.addRaw("\x03\x02\0\0\0\0"s);
    EXPECT_THAT(parse(image).problems, ElementsAre("structure shorter than 4 bytes at byte 21",
                                                   "3 string(s) that the table refers to are not there"));
    EXPECT_EQ(parse(image).breakOff, "structure shorter than 4 bytes at byte 21");
    const Smbios none = parseSmbios("_SM3_", image.table());
    EXPECT_EQ(none.entryPointProblem, "entry point too short");
    EXPECT_FALSE(none.system.has_value());
    EXPECT_TRUE(none.chassis.empty());
}

TEST(Smbios, SurvivesRandomTables) {
    std::mt19937 random(4711); // the same bytes each time
    const std::string entryPoint = SmbiosImage(3, 0).addRaw(std::string(4096, ' ')).entryPoint();
    std::size_t chassis = 0;
    for (int round = 0; round < 2000; ++round) {
        std::string table;
        while (table.size() < 4096) table += static_cast<char>(random() % (round % 2 == 0 ? 256 : 6));
        chassis += parseSmbios(entryPoint, table).chassis.size();
    }
    EXPECT_GT(chassis, 0U); // some bytes made sense
}

TEST(Smbios, ReadsAMegabyteOfChassisInReasonableTime) {
    SmbiosImage image(3, 0);
    SmbiosStructureImage one(3, 0x0F);
    one.byte(4, 255).byte(6, 255);
    const std::size_t length = one.image(0).size();
    std::string table;
    for (unsigned int i = 0; table.size() + length <= (1U << 20); ++i) // each another one
        table += one.byte(0x0C, i & 255).byte(0x0D, i >> 8 & 255).byte(0x0E, i >> 16 & 255).image(0);
    image.addRaw(table);
    EXPECT_EQ(parse(image).chassis.size(), table.size() / length);
}

} // namespace

} // namespace VK::Host
