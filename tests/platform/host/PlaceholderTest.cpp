#include "host/Placeholder.h"

#include <gtest/gtest.h>

namespace VK::Host {

namespace {

TEST(Placeholder, IsSeenThrough) {
    for (const char* text : {"",
                             " ",
                             ".",
                             "....",
                             "-",
                             "----",
                             "- -",
                             "x",
                             "xxxx",
                             "XXXXXXX",
                             "x.x.x",
                             "0000000",
                             "aaaa",
                             "*****",
                             "To Be Filled By O.E.M.",
                             "To be filled by O.E.M.",
                             "TO BE FILLED BY OEM",
                             "To Be Filled By O.E.M. by More String",
                             "to be filled by odm",
                             "To be set by OEM.",
                             "To Be Defined By O.E.M",
                             "To Be Filled",
                             "Default string",
                             " default  STRING ",
                             "Not Specified",
                             "not available",
                             "Not Applicable",
                             "Not Defined",
                             "Not set",
                             "Not Present",
                             "Not Supported",
                             "None",
                             "N/A",
                             "na",
                             "NULL",
                             "(none)",
                             "Unknown",
                             "undefined",
                             "INVALID",
                             "empty",
                             "O.E.M.",
                             "OEM",
                             "Standard",
                             "System manufacturer",
                             "System Product Name",
                             "System Serial Number",
                             "Chassis Manufacture",
                             "Chassis Manufacturer",
                             "Chassis Serial Number",
                             "Chassis Version",
                             "Asset Tag",
                             "No Asset Tag",
                             "SKU",
                             "SKU Number",
                             "Base Board Serial Number"})
        EXPECT_TRUE(isPlaceholder(text)) << text;
}

TEST(Placeholder, LeavesWhatTellsSomething) {
    for (const char* text : {"Dell Inc.", "PowerEdge R740", "Standard PC (Q35 + ICH9, 2009)", "SKU=0777", "1.0", "7",
                             "A", "NAS", "Oemtech", "Not Another Box", "To Be Or Not", "xServe", "0123456789",
                             "00000001", "Unknown Pleasures", "None Such Ltd"})
        EXPECT_FALSE(isPlaceholder(text)) << text;
}

TEST(Placeholder, SerialsThatOnlyCountTellNothing) {
    for (const char* text : {"0123456789", " 123456789 ", "1234567890", "9876543210", "0", "00000000", "None"})
        EXPECT_TRUE(isPlaceholderSerial(text)) << text;
    for (const char* text : {"CZ1234", "12345678", "01234567890", "10", "7"})
        EXPECT_FALSE(isPlaceholderSerial(text)) << text;
}

} // namespace

} // namespace VK::Host
