#include "product/HmacSha256.h"

#include <gtest/gtest.h>
#include <string>

using VK::hmacSha256;
using VK::Sha256Digest;

namespace {

std::string hex(const Sha256Digest& digest) {
    std::string text;
    for (const std::uint8_t byte : digest) {
        text += "0123456789abcdef"[byte >> 4];
        text += "0123456789abcdef"[byte & 0xF];
    }
    return text;
}

} // namespace

// The examples of RFC 4231.
TEST(HmacSha256, AgreesWithTheStandardsExamples) {
    EXPECT_EQ(hex(hmacSha256(std::string(20, '\x0b'), "Hi There")),
              "b0344c61d8db38535ca8afceaf0bf12b881dc200c9833da726e9376c2e32cff7");
    EXPECT_EQ(hex(hmacSha256("Jefe", "what do ya want for nothing?")),
              "5bdcc146bf60754e6a042426089575c75a003f089d2739839dec58b964ec3843");
    EXPECT_EQ(hex(hmacSha256(std::string(20, '\xaa'), std::string(50, '\xdd'))),
              "773ea91e36800e46854db8ebd09181a72959098b3ef8c122d9635514ced565fe");
    EXPECT_EQ(hex(hmacSha256(std::string(131, '\xaa'), "Test Using Larger Than Block-Size Key - Hash Key First")),
              "60e431591ee0b67f0d8a26aacbf5b77f8e0bc6213728c5140546040f0ee37f54");
}

// Made with another implementation.
TEST(HmacSha256, HashesAKeyThatIsLongerThanABlockOnly) {
    EXPECT_EQ(hex(hmacSha256(std::string(64, 'k'), "message")),
              "890f3a16e0ca0aaa3bf180f70fa8e3970b3fd6505e98fde157988dcc19d1685c");
    EXPECT_EQ(hex(hmacSha256(std::string(65, 'k'), "message")),
              "0c256505306af48015530c139bb7add5ad7a6a9291cd511278a067e765816fbd");
}
