#include "tools/snapshot/MaskedFiles.h"

#include "host/Smbios.h"
#include "support/SmbiosImage.h"

#include <gtest/gtest.h>

using namespace std::literals;

namespace snapshot {

TEST(MaskedFiles, MasksSerialNumbersBeforeWhatTheyMayStandIn) {
    EXPECT_LT(contentOf("/sys/firmware/dmi/tables/DMI"), contentOf("/sys/class/dmi/id/product_serial"));
    EXPECT_LT(contentOf("/sys/class/dmi/id/product_serial"), contentOf("/proc/device-tree/compatible"));
}

TEST(MaskedFiles, MasksWholeWhatNobodyKnows) {
    Mask mask("salt");
    EXPECT_EQ(contentOf("/etc/a-new-file"), Content::Unknown);
    const std::string masked = maskedFile(Content::Unknown, "tag 4711-QX\n", "", mask);
    EXPECT_EQ(masked.size(), 12U);
    EXPECT_EQ(masked.back(), '\n');
    EXPECT_EQ(masked.find("4711"), std::string::npos);
    EXPECT_EQ(masked.find("tag"), std::string::npos);
}

TEST(MaskedFiles, KeepsTheEndOfAFile) {
    Mask mask("salt");
    EXPECT_EQ(maskedFile(Content::Serial, "CZJ1\0\n"s, "", mask), mask.serial("CZJ1") + "\0\n"s);
}

TEST(MaskedFiles, MasksATableByTheOrderOfItsUuid) {
    for (const unsigned int minor : {5U, 6U}) {
        support::SmbiosSystemImage system{"Example", "RX200", "", "CZJ1234567", ""};
        system.uuid = "LLED\x43\x00\x10\x30\x80\x52\xb4\xc0OVB1"s;
        support::SmbiosImage image(2, minor, support::SmbiosImage::Version2);
        image.add(system).end();
        Mask mask("salt");
        const std::string masked = maskedTable(image.table(), image.entryPoint(), mask);
        const auto before = VK::Host::parseSmbios(image.entryPoint(), image.table()).system;
        const auto after = VK::Host::parseSmbios(image.entryPoint(), masked).system;
        ASSERT_TRUE(before && after);
        EXPECT_EQ(masked.size(), image.table().size());
        EXPECT_EQ(after->uuid, mask.uuid(before->uuid));
        EXPECT_EQ(after->serial, mask.serial("CZJ1234567"));
        EXPECT_EQ(after->product, "RX200");
    }
}

} // namespace snapshot
