#include "product/UniqueIdentifier.h"

#include <gmock/gmock.h>

using testing::MatchesRegex;
using testing::Not;
using VK::uniqueIdentifier;

TEST(UniqueIdentifier, IsTheSameForeverForOneHost) {
    // Made with another implementation of HMAC-SHA256.
    EXPECT_EQ(uniqueIdentifier("0123456789abcdef0123456789abcdef"), "258a5ac3-636a-8d9b-a53c-0b8c5f81a488");
}

TEST(UniqueIdentifier, DiffersBetweenHosts) {
    EXPECT_NE(uniqueIdentifier("0123456789abcdef0123456789abcdef"),
              uniqueIdentifier("0123456789abcdef0123456789abcdee"));
}

TEST(UniqueIdentifier, HasTheFormOfAUuid) {
    for (const char* secret : {"a", "0123456789abcdef0123456789abcdef", "4c4c4544-0042-4a10-8053-b4c04f4d3132"})
        EXPECT_THAT(uniqueIdentifier(secret),
                    MatchesRegex("[0-9a-f]{8}-[0-9a-f]{4}-8[0-9a-f]{3}-[89ab][0-9a-f]{3}-[0-9a-f]{12}"));
}

TEST(UniqueIdentifier, IsEmptyForAnUnknownHost) {
    EXPECT_EQ(uniqueIdentifier(""), "");
}
