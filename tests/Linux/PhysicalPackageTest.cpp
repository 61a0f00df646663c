#include "Linux/PhysicalPackage.h"
#include "Linux/Untouched.h"
#include "support/SimulatedHost.h"

#include <gmock/gmock.h>

namespace {

using testing::Contains;
using testing::HasSubstr;
using VK::BaseServerProvider::PhysicalPackage;

std::vector<std::string> serials(PhysicalPackage& package) {
    std::vector<std::string> found;
    for (; package; ++package) {
        std::string serial = "(none)";
        package.getSerialNumber(serial);
        found.push_back(serial);
    }
    return found;
}

TEST(PhysicalPackage, IsFalseAtOnceOnAHostWithoutChassis) {
    test::simulate({test::computer(0, "node7")});
    EXPECT_FALSE(PhysicalPackage());
}

TEST(PhysicalPackage, WalksEveryChassisInTableOrder) {
    test::simulate({test::computer(0, "node7"), test::chassis(0, 0, "A"), test::chassis(0, 1, "B")});
    PhysicalPackage package;
    EXPECT_THAT(serials(package), testing::ElementsAre("A", "B"));
}

TEST(PhysicalPackage, HasNoTagWithoutASerialNumber) {
    test::simulate({test::without(test::chassis(0, 0, ""), 50)});
    const PhysicalPackage package;
    std::string tag = "untouched";
    EXPECT_FALSE(package.getTag(tag));
    EXPECT_EQ(tag, "untouched");
}

TEST(PhysicalPackage, IsNotExcludedByATagFilterWithoutASerialNumber) {
    test::simulate({test::without(test::chassis(0, 0, ""), 50), test::chassis(0, 1, "A"), test::chassis(0, 2, "B")});
    PhysicalPackage package;
    package.setFilter(PhysicalPackage::FilterType::TAG, "B");
    EXPECT_THAT(serials(package), testing::ElementsAre("(none)", "B"));
}

TEST(PhysicalPackage, ComparesTagsExactly) {
    test::simulate({test::chassis(0, 0, "cz"), test::chassis(0, 1, "CZ1"), test::chassis(0, 2, "CZ")});
    PhysicalPackage package;
    package.setFilter(PhysicalPackage::FilterType::TAG, "CZ");
    EXPECT_THAT(serials(package), testing::ElementsAre("CZ"));
}

TEST(PhysicalPackage, MustMatchBothFilters) {
    test::simulate({test::chassis(0, 0, "A"), test::chassis(1, 0, "A"), test::chassis(1, 1, "B")});
    PhysicalPackage package;
    package.setFilter(PhysicalPackage::FilterType::TAG, "A");
    package.setFilter(PhysicalPackage::FilterType::SYSTEM_NAME, "/computer/1");
    std::string serial;
    ASSERT_TRUE(package);
    EXPECT_TRUE(package.getSerialNumber(serial));
    EXPECT_EQ(serial, "A");
    ++package;
    EXPECT_FALSE(package);
}

TEST(PhysicalPackage, LetsAFilterOfAnotherTypePass) {
    test::simulate({test::chassis(0, 0, "A")});
    PhysicalPackage package;
    package.setFilter(static_cast<PhysicalPackage::FilterType>(2), "no such thing");
    EXPECT_TRUE(package);
}

TEST(PhysicalPackage, DropsItsFiltersAndStartsAgainWhenInitialized) {
    test::simulate({test::chassis(0, 0, "A"), test::chassis(0, 1, "B")});
    PhysicalPackage package;
    package.setFilter(PhysicalPackage::FilterType::TAG, "B");
    ++package;
    EXPECT_FALSE(package);
    package.initialize();
    EXPECT_THAT(serials(package), testing::ElementsAre("A", "B"));
}

TEST(PhysicalPackage, MapsThePackageTypeOfTheNode) {
    const std::pair<unsigned, unsigned short> types[] = {{0, 0}, {1, 3},  {2, 2}, {3, 16}, {4, 1},
                                                         {5, 1}, {6, 12}, {7, 1}, {8, 1},  {4294967295U, 1}};
    for (const auto& [raw, expected] : types) {
        test::Node chassis = test::chassis(0, 0, "A");
        chassis.properties[128] = raw;
        test::simulate({chassis});
        unsigned short type = 99;
        EXPECT_TRUE(PhysicalPackage().getPackageType(type));
        EXPECT_EQ(type, expected) << "for " << raw;
    }
}

TEST(PhysicalPackage, SuppliesPackageTypeUnknownWhenItCannotBeRead) {
    test::Node chassis = test::chassis(0, 0, "A");
    chassis.properties.erase(128);
    test::simulate({chassis});
    unsigned short type = 99;
    EXPECT_TRUE(PhysicalPackage().getPackageType(type));
    EXPECT_EQ(type, 0);
}

TEST(PhysicalPackage, HasADescriptionButNoElementNameWhenTheNodeHasNone) {
    test::Node chassis = test::chassis(0, 0, "A");
    chassis.description.clear();
    test::simulate({chassis});
    const PhysicalPackage package;
    std::string text = "untouched";
    EXPECT_FALSE(package.getElementName(text));
    EXPECT_EQ(text, "untouched");
    EXPECT_TRUE(package.getDescription(text));
    EXPECT_EQ(text, "");
}

TEST(PhysicalPackage, ReadsItsTextsFromTheNode) {
    test::simulate({test::chassis(0, 0, "CZ1234")});
    const PhysicalPackage package;
    const std::tuple<bool (PhysicalPackage::*)(std::string&) const, const char*> texts[] = {
        {&PhysicalPackage::getCreationClassName, "VESKA_PhysicalPackage"},
        {&PhysicalPackage::getTag, "CZ1234"},
        {&PhysicalPackage::getSerialNumber, "CZ1234"},
        {&PhysicalPackage::getManufacturer, "Example"},
        {&PhysicalPackage::getModel, "Box"},
        {&PhysicalPackage::getSKU, "SKU-1"},
        {&PhysicalPackage::getElementName, "Rack Mount Chassis"},
        {&PhysicalPackage::getDescription, "Rack Mount Chassis"},
    };
    for (const auto& [getter, expected] : texts) {
        std::string value;
        EXPECT_TRUE((package.*getter)(value));
        EXPECT_EQ(value, expected);
    }
}

TEST(PhysicalPackage, LeavesTheOutputOfWhatTheHostCannotSupply) {
    test::simulate({test::chassis(0, 0, "A")});
    test::expectUntouched(
        PhysicalPackage(), &PhysicalPackage::getCaption, &PhysicalPackage::getInstallDate, &PhysicalPackage::getName,
        &PhysicalPackage::getOperationalStatus, &PhysicalPackage::getStatusDescriptions,
        &PhysicalPackage::getHealthState, &PhysicalPackage::getPrimaryStatus, &PhysicalPackage::getDetailedStatus,
        &PhysicalPackage::getOperatingStatus, &PhysicalPackage::getCommunicationStatus, &PhysicalPackage::getVersion,
        &PhysicalPackage::getPartNumber, &PhysicalPackage::getOtherIdentifyingInfo, &PhysicalPackage::isPoweredOn,
        &PhysicalPackage::getManufactureDate, &PhysicalPackage::getVendorEquipmentType,
        &PhysicalPackage::getUserTracking, &PhysicalPackage::canBeFRUed, &PhysicalPackage::getRemovalConditions,
        &PhysicalPackage::getHeight, &PhysicalPackage::getDepth, &PhysicalPackage::getWidth,
        &PhysicalPackage::getWeight, &PhysicalPackage::getOtherPackageType,
        &PhysicalPackage::getVendorCompatibilityStrings);
}

} // namespace
