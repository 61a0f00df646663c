#include "objectmanager/endpoint/Certificate.h"

#include "objectmanager/endpoint/Files.h"
#include "support/TemporaryDirectory.h"

#include <gmock/gmock.h>

#include <sys/stat.h>

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

TEST_F(CertificateFiles, HaveTheirModesWhateverTheUmaskIs) {
    const mode_t former = umask(0277);
    make(directory.path("other.pem"), directory.path("other-key.pem"));
    umask(former);
    EXPECT_EQ(std::filesystem::status(directory.path("other.pem")).permissions(), std::filesystem::perms{0644});
    EXPECT_EQ(std::filesystem::status(directory.path("other-key.pem")).permissions(), std::filesystem::perms{0600});
}

TEST_F(CertificateFiles, AreForNamesThatHostsCanHave) {
    for (const char* name : {"*.a b", "", "a..b", "-a", "a.", "host:5989", "*.*.example", "a\nb"}) {
        EXPECT_THROW(makeCertificate({name}, directory.path("n"), directory.path("n-key")), std::invalid_argument);
        EXPECT_FALSE(std::filesystem::exists(directory.path("n-key"))) << name;
    }
    makeCertificate({"*.rack_1.example", "Node-7"}, directory.path("n"), directory.path("n-key"));
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
