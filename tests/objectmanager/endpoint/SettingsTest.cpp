#include "objectmanager/endpoint/Settings.h"

#include "objectmanager/endpoint/Log.h"
#include "objectmanager/endpoint/Rights.h"
#include "support/TemporaryDirectory.h"

#include <gmock/gmock.h>

#include <fstream>

namespace endpoint {
namespace {

using testing::HasSubstr;

TEST(ListenUrl, TakesSocketsAndNumericAddresses) {
    struct {
        const char* url;
        Listener::Kind kind;
        const char* host;
        const char* port;
    } const good[] = {{"unix:/run/x.sock", Listener::Kind::Unix, "/run/x.sock", ""},
                      {"http://127.0.0.1:5988", Listener::Kind::Http, "127.0.0.1", "5988"},
                      {"http://127.9.9.9/", Listener::Kind::Http, "127.9.9.9", "5988"},
                      {"http://[::1]", Listener::Kind::Http, "::1", "5988"},
                      {"https://[::]:5989", Listener::Kind::Https, "::", "5989"},
                      {"https://192.0.2.1", Listener::Kind::Https, "192.0.2.1", "5989"}};
    for (const auto& each : good) {
        const ListenUrl url(each.url);
        EXPECT_EQ(url.kind, each.kind) << each.url;
        EXPECT_EQ(url.host, each.host) << each.url;
        EXPECT_EQ(url.port, each.port) << each.url;
    }
}

TEST(ListenUrl, RefusesTheRest) {
    for (const char* url : {"", "/run/x.sock", "unix:", "unix:x.sock", "ftp://127.0.0.1", "http://",
                            "http://0.0.0.0:5988", "http://192.0.2.1:5988", "http://[::]:5988", "http://localhost:5988",
                            "https://example.org", "https://127.0.0.1:x", "http://127.0.0.1:99999999"}) {
        EXPECT_THROW(ListenUrl{url}, std::invalid_argument) << url;
    }
    EXPECT_THROW(ListenUrl{"unix:/" + std::string(200, 'x')}, std::invalid_argument);
}

class SettingsFile : public testing::Test {
protected:
    ParsedSettings parse(const std::string& content, std::vector<std::string> more = {}) const {
        std::ofstream(file) << content;
        more.insert(more.begin(), {"--config", file});
        return parseSettings(more);
    }

    support::TemporaryDirectory directory;
    std::string file = directory.path("vkcimd.conf");
};

TEST_F(SettingsFile, EverySettingIsAKey) {
    const ParsedSettings parsed = parse("listen = [\"unix:/run/a\", \"https://[::]:5989\"]\ncertificate = \"/c\"\n"
                                        "key = \"/k\"\nanonymous-read = true\nlibrary = \"/l\"\nprovider = \"P\"\n"
                                        "schema = [\"/a.mof\", \"/b.mof\"]\nidle-exit = 60\n# a comment\n");
    ASSERT_TRUE(parsed.settings) << parsed.error;
    EXPECT_EQ(parsed.settings->listen.size(), 2U);
    EXPECT_EQ(parsed.settings->certificate, "/c");
    EXPECT_TRUE(parsed.settings->anonymousRead);
    EXPECT_EQ(parsed.settings->provider, "P");
    EXPECT_THAT(parsed.settings->schema, testing::ElementsAre("/a.mof", "/b.mof"));
    EXPECT_EQ(parsed.settings->idleExit, std::chrono::seconds(60));
}

TEST_F(SettingsFile, TheCommandLineGoesBeforeTheFile) {
    const ParsedSettings parsed = parse("provider = \"P\"\n", {"--provider", "Q", "--foreground"});
    ASSERT_TRUE(parsed.settings) << parsed.error;
    EXPECT_EQ(parsed.settings->provider, "Q");
    EXPECT_TRUE(parsed.settings->foreground);
}

TEST_F(SettingsFile, ACertificateIsMadeForNamesOrForTheHost) {
    const std::string files = "certificate = \"/c\"\nkey = \"/k\"\n";
    const ParsedSettings named = parse(files, {"--make-certificate", "host1.example", "192.0.2.1"});
    ASSERT_TRUE(named.settings && named.settings->makeCertificate) << named.error;
    EXPECT_THAT(*named.settings->makeCertificate, testing::ElementsAre("host1.example", "192.0.2.1"));
    const ParsedSettings host = parse(files, {"--make-certificate"});
    ASSERT_TRUE(host.settings && host.settings->makeCertificate) << host.error;
    EXPECT_THAT(*host.settings->makeCertificate, testing::IsEmpty());
    EXPECT_FALSE(parse(files).settings->makeCertificate);
    EXPECT_THAT(parse("", {"--make-certificate"}).error, HasSubstr("--certificate"));
}

TEST_F(SettingsFile, WhatCannotBeUsedIsSaid) {
    struct {
        const char* content;
        const char* what;
    } const bad[] = {{"unknown = 1\n", "unknown"},
                     {"listen = \"http://0.0.0.0:5988\"\n", "loopback"},
                     {"listen = \"https://[::]:5989\"\n", "--certificate"},
                     {"certificate = \"/c\"\n", "together"},
                     {"idle-exit = -1\n", "idle-exit"},
                     {"idle-exit = \"soon\"\n", "idle-exit"},
                     {"provider = \"\"\n", "provider"}};
    for (const auto& each : bad) {
        const ParsedSettings parsed = parse(each.content);
        EXPECT_EQ(parsed.exitStatus, 2) << each.content;
        EXPECT_THAT(parsed.error, HasSubstr(each.what)) << each.content;
    }
    EXPECT_EQ(parseSettings({"--config", "/nonexistent"}).exitStatus, 2);
    EXPECT_EQ(parseSettings({"--nonsense"}).exitStatus, 2);
    EXPECT_THAT(parseSettings({"--help"}).output, HasSubstr("--listen"));
}

TEST(Rights, RootMayChangeAndAStrangerMayDoNothing) {
    EXPECT_TRUE(rightsOf(uid_t{0}).mayChange);
    EXPECT_TRUE(rightsOf(uid_t{0}).mayRead);
    const Caller stranger = rightsOf(uid_t{4242424});
    EXPECT_FALSE(stranger.mayRead || stranger.mayChange);
    EXPECT_FALSE(rightsOf(std::string("no such user")).mayRead);
    EXPECT_FALSE(rightsOf(std::string("nobody")).mayRead);
}

TEST(Rights, ReadsBasicCredentials) {
    const auto pair = basicCredentials("Basic YTpiOmM="); // a:b:c
    ASSERT_TRUE(pair);
    EXPECT_EQ(pair->first, "a");
    EXPECT_EQ(pair->second, "b:c");
    EXPECT_TRUE(basicCredentials("basic YTo=")); // a:
    for (const char* bad : {"", "Basic", "Basic ", "Digest YTpi", "Basic YTpi!", "Basic OmI=", "Basic YWI="}) {
        EXPECT_FALSE(basicCredentials(bad)) << bad;
    }
}

TEST(Log, WhatAClientSendsStaysOnItsLine) {
    testing::internal::CaptureStderr();
    log("a\nvkcimd: root \x1b[1m " + logged("b c") + logged(""));
    EXPECT_EQ(testing::internal::GetCapturedStderr(), "vkcimd: a\\x0avkcimd: root \\x1b[1m \"b c\"-\n");
    EXPECT_EQ(logged(std::string(500, 'x')).size(), 128U);
}

} // namespace
} // namespace endpoint
