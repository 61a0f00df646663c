#include "objectmanager/endpoint/Certificate.h"

#include "objectmanager/endpoint/Files.h"
#include "support/TemporaryDirectory.h"

#include <gmock/gmock.h>

#include <filesystem>
#include <fstream>

namespace endpoint {
namespace {

using testing::HasSubstr;
using testing::StartsWith;

class CertificateFiles : public testing::Test {
protected:
    CertificateFiles() { make(certificate, key); }

    static void make(const std::string& certificateFile, const std::string& keyFile) {
        makeCertificate({"host1.example", "127.0.0.1", "::1"}, certificateFile, keyFile);
    }

    static void put(const std::string& file, const std::string& content) { std::ofstream(file) << content; }

    std::string problem() const {
        try {
            const Certificate read(certificate, key);
        } catch (const std::invalid_argument& error) {
            return error.what();
        }
        return {};
    }

    support::TemporaryDirectory directory;
    std::string certificate = directory.path("certificate.pem");
    std::string key = directory.path("key.pem");
};

TEST_F(CertificateFiles, AreMadeForTheHostAloneAndFitEachOther) {
    EXPECT_THAT(contentOf(certificate), StartsWith("-----BEGIN CERTIFICATE-----"));
    using std::filesystem::perms;
    EXPECT_EQ(std::filesystem::status(key).permissions(), perms::owner_read | perms::owner_write);
    EXPECT_EQ(problem(), "");
}

TEST_F(CertificateFiles, AreNotOverwritten) {
    const std::string before = contentOf(key);
    EXPECT_THROW(make(directory.path("other.pem"), key), std::invalid_argument);
    EXPECT_THROW(make(certificate, directory.path("other.pem")), std::invalid_argument);
    EXPECT_EQ(contentOf(key), before);
    EXPECT_FALSE(std::filesystem::exists(directory.path("other.pem"))); // no key without its certificate
}

TEST_F(CertificateFiles, ThatCannotBeUsedAreRefused) {
    const std::string otherKey = directory.path("other-key.pem");
    make(directory.path("other.pem"), otherKey);
    put(key, contentOf(otherKey));
    EXPECT_THAT(problem(), HasSubstr(key + " cannot be used"));
    put(key, "nothing");
    EXPECT_THAT(problem(), HasSubstr(key + " cannot be used"));
    std::filesystem::remove(key);
    EXPECT_EQ(problem(), "cannot read " + key);
}

TEST_F(CertificateFiles, HoldFromWhenBothAreRenewed) {
    Certificate held(certificate, key);
    const std::string first = held.current().chain;
    EXPECT_EQ(first, contentOf(certificate));
    make(directory.path("new.pem"), directory.path("new-key.pem"));
    testing::internal::CaptureStderr();
    std::filesystem::rename(directory.path("new.pem"), certificate);
    EXPECT_EQ(held.current().chain, first); // the key is still the former one's
    std::filesystem::rename(directory.path("new-key.pem"), key);
    EXPECT_EQ(held.current().chain, contentOf(certificate));
    EXPECT_NE(held.current().chain, first);
    const std::string log = testing::internal::GetCapturedStderr();
    EXPECT_THAT(log, HasSubstr("the former certificate stays: " + certificate));
    EXPECT_THAT(log, HasSubstr("another certificate holds from now on"));
}

} // namespace
} // namespace endpoint
