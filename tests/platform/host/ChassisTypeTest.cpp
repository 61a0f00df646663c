#include "host/ChassisType.h"

#include <gtest/gtest.h>

namespace VK::Host {

namespace {

TEST(ChassisType, HasThePackageTypeOfItsKind) {
    constexpr unsigned int expected[] = {0, 4, 0, 1, 1, 1, 1, 1, 4, 4, 4, 4, 4, 4, 4, 4, 4, 1, 1, 1,
                                         1, 1, 1, 2, 1, 1, 1, 1, 3, 1, 4, 4, 4, 4, 4, 4, 4, 0, 0};
    for (ChassisType type = 0; type < sizeof expected / sizeof *expected; ++type)
        EXPECT_EQ(packageType(type), expected[type]) << type;
    EXPECT_EQ(packageType(4294967295), 0U);
}

TEST(ChassisType, IsNamedInSmbiosWords) {
    EXPECT_EQ(chassisTypeName(1), "Other");
    EXPECT_EQ(chassisTypeName(13), "All in One");
    EXPECT_EQ(chassisTypeName(17), "Main Server Chassis");
    EXPECT_EQ(chassisTypeName(19), "SubChassis");
    EXPECT_EQ(chassisTypeName(23), "Rack Mount Chassis");
    EXPECT_EQ(chassisTypeName(25), "Multi-system Chassis");
    EXPECT_EQ(chassisTypeName(26), "CompactPCI");
    EXPECT_EQ(chassisTypeName(27), "AdvancedTCA");
    EXPECT_EQ(chassisTypeName(28), "Blade");
    EXPECT_EQ(chassisTypeName(29), "Blade Enclosure");
    EXPECT_EQ(chassisTypeName(36), "Stick PC");
    for (const ChassisType type : {0U, 2U, 37U, 127U, 4294967295U}) EXPECT_EQ(chassisTypeName(type), "Unknown");
}

TEST(ChassisType, IsReadFromWords) {
    EXPECT_EQ(chassisTypeFromWord("server"), 17U);
    EXPECT_EQ(chassisTypeFromWord("laptop"), 9U);
    EXPECT_EQ(chassisTypeFromWord("Server"), 0U);
    EXPECT_EQ(chassisTypeFromWord(""), 0U);
}

} // namespace

} // namespace VK::Host
