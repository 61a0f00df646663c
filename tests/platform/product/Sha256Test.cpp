#include "product/Sha256.h"

#include <gtest/gtest.h>
#include <string>

using VK::hmacSha256;
using VK::Sha256;
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

std::string sha256(const std::string& message) {
    Sha256 hash;
    hash.update(message);
    return hex(hash.finish());
}

} // namespace

// The examples of FIPS 180-4.
TEST(Sha256, AgreesWithTheStandardsExamples) {
    EXPECT_EQ(sha256(""), "e3b0c44298fc1c149afbf4c8996fb92427ae41e4649b934ca495991b7852b855");
    EXPECT_EQ(sha256("abc"), "ba7816bf8f01cfea414140de5dae2223b00361a396177a9cb410ff61f20015ad");
    EXPECT_EQ(sha256("abcdbcdecdefdefgefghfghighijhijkijkljklmklmnlmnomnopnopq"),
              "248d6a61d20638b8e5c026930c3e6039a33ce45964ff2167f6ecedd419db06c1");
    EXPECT_EQ(sha256(std::string(1'000'000, 'a')), "cdc76e5c9914fb9281a1c7e284d73e67f1809a48a497200e046d39ccc7112cd0");
}

TEST(Sha256, DoesNotDependOnHowTheMessageIsCut) {
    const std::string message(200, 'x');
    for (std::size_t cut = 0; cut <= message.size(); ++cut) {
        Sha256 hash;
        hash.update(message.substr(0, cut));
        hash.update(message.substr(cut));
        EXPECT_EQ(hex(hash.finish()), sha256(message)) << cut;
    }
}

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
