#include "logger/Settings.h"

#include <gtest/gtest.h>
#include <string>

using NVLog::Channel;
using NVLog::parseSettings;
using NVLog::Settings;

namespace {

Settings withLevels(const char* levels) {
    return parseSettings("stderr", levels, nullptr);
}

/// Which channels keep a failure, and whether trace lines may go to syslog instead.
std::string channels(const char* sink, const char* list) {
    const Settings settings = parseSettings(sink, nullptr, list);
    return std::string(settings.keeps(Channel::Log, 6000) ? "log " : "") +
           (settings.keeps(Channel::Trace, 6000) ? "trace " : "") + (settings.traceInSyslog ? "syslog" : "");
}

} // namespace

TEST(Settings, KeepNoticesAndFailuresInSyslogsLogChannelByDefault) {
    for (const char* empty : {static_cast<const char*>(nullptr), ""}) {
        const Settings settings = parseSettings(empty, empty, empty);
        EXPECT_EQ(settings.sink, Settings::Syslog);
        EXPECT_TRUE(settings.keeps(Channel::Log, 3000));
        EXPECT_TRUE(settings.keeps(Channel::Log, 6000));
        EXPECT_FALSE(settings.keeps(Channel::Log, 4000));
        EXPECT_FALSE(settings.keeps(Channel::Trace, 6000));
    }
}

TEST(Settings, NameTheSink) {
    EXPECT_EQ(parseSettings("syslog", nullptr, nullptr).sink, Settings::Syslog);
    EXPECT_EQ(parseSettings("stderr", nullptr, nullptr).sink, Settings::Stderr);
    EXPECT_EQ(parseSettings("none", nullptr, nullptr).sink, Settings::None);
    const Settings file = parseSettings("file:/var/log/a b:c.log", nullptr, nullptr);
    EXPECT_EQ(file.sink, Settings::File);
    EXPECT_STREQ(file.path.data(), "/var/log/a b:c.log");
}

TEST(Settings, TakeSyslogForAnUnknownSink) {
    const std::string tooLong = "file:" + std::string(PATH_MAX, 'x');
    for (const char* bad : {"console", "STDERR", "stderr ", "file:", "file", "none,stderr", tooLong.c_str()})
        EXPECT_EQ(parseSettings(bad, nullptr, nullptr).sink, Settings::Syslog) << bad;
}

TEST(Settings, KeepTheLevelsListed) {
    const Settings settings = withLevels("4000, 17,-5");
    for (const int kept : {4000, 17, -5}) EXPECT_TRUE(settings.keeps(Channel::Log, kept)) << kept;
    for (const int dropped : {3000, 6000, 0, 5}) EXPECT_FALSE(settings.keeps(Channel::Log, dropped)) << dropped;
}

TEST(Settings, AQuickLookHidesNoLineThatIsKept) {
    for (const char* list : {"", "4000, 17,-5", "3000", "2147483647,-2147483648", "all"}) {
        const Settings settings = withLevels(list);
        for (const int level : {-2147483647 - 1, -5, 0, 16, 17, 511, 3000, 3007, 4000, 6000, 2147483647}) {
            for (const Channel channel : {Channel::Log, Channel::Trace}) {
                const bool seen = (settings.bits(channel) & Settings::bitOf(level)) != 0;
                EXPECT_TRUE(seen || !settings.keeps(channel, level)) << list << ' ' << level;
            }
        }
    }
}

TEST(Settings, AQuickLookSeparatesTheLevelsInUse) {
    const std::uint64_t bits = parseSettings(nullptr, nullptr, nullptr).bits(Channel::Log);
    EXPECT_NE(bits & Settings::bitOf(3000), 0U);
    EXPECT_NE(bits & Settings::bitOf(6000), 0U);
    EXPECT_EQ(bits & Settings::bitOf(4000), 0U);
    EXPECT_EQ(parseSettings("none", "all", nullptr).bits(Channel::Log), 0U);
}

TEST(Settings, KeepAllLevels) {
    for (const char* list : {"all", "3000,all", " all "})
        for (const int level : {0, 1, 4000, -1, 2147483647})
            EXPECT_TRUE(withLevels(list).keeps(Channel::Trace, level)) << list << level;
}

TEST(Settings, PassOverWhatIsNoLevel) {
    const Settings settings = withLevels("abc,,4000,50x,99999999999,ALL,");
    EXPECT_TRUE(settings.keeps(Channel::Log, 4000));
    EXPECT_FALSE(settings.keeps(Channel::Log, 50));
    EXPECT_FALSE(settings.keeps(Channel::Log, 6000));
    for (const char* noNumbers : {"abc", ",", "x,y", " "}) {
        EXPECT_TRUE(withLevels(noNumbers).keeps(Channel::Log, 6000)) << noNumbers;
        EXPECT_FALSE(withLevels(noNumbers).keeps(Channel::Log, 4000)) << noNumbers;
    }
}

TEST(Settings, NoteWhatCannotBeUsed) {
    const auto unknown = [](const char* sink, const char* levels, const char* channels) {
        return std::string(parseSettings(sink, levels, channels).unknown.data());
    };
    EXPECT_EQ(unknown(nullptr, nullptr, nullptr), "");
    for (const char* sink : {"", "syslog", "stderr", "none", "file:/x"}) EXPECT_EQ(unknown(sink, "all", "log"), "");
    EXPECT_EQ(unknown("STDERR", "50x, all,Lots", "log,x"),
              "NVLOG_SINK=STDERR, NVLOG_LEVELS=50x, NVLOG_LEVELS=Lots, NVLOG_CHANNELS=x");
    EXPECT_EQ(unknown("file:", nullptr, nullptr), "NVLOG_SINK=file:");
    const std::string tooLong = "file:" + std::string(PATH_MAX, 'x');
    EXPECT_EQ(unknown(tooLong.c_str(), nullptr, nullptr), "NVLOG_SINK=" + tooLong.substr(0, 40));
    std::string many;
    for (int i = 0; i < 100; ++i) many += "level,";
    EXPECT_EQ(unknown(nullptr, many.c_str(), nullptr).size(), 239U) << "as much as there is room for";
}

TEST(Settings, KeepAllLevelsWhenTheListIsTooLong) {
    std::string list;
    for (std::size_t i = 0; i < Settings::maxLevels; ++i) list += std::to_string(i) + ",";
    EXPECT_FALSE(withLevels(list.c_str()).keeps(Channel::Log, 6000));
    EXPECT_TRUE(withLevels((list + "9999").c_str()).keeps(Channel::Log, 6000));
}

TEST(Settings, OpenTheChannelsListed) {
    EXPECT_EQ(channels("stderr", nullptr), "log trace ");
    EXPECT_EQ(channels("file:/x", ""), "log trace ");
    EXPECT_EQ(channels("syslog", nullptr), "log ");
    EXPECT_EQ(channels("unknown", nullptr), "log ");
    EXPECT_EQ(channels("syslog", "log,trace"), "log trace syslog");
    EXPECT_EQ(channels("stderr", "trace"), "trace syslog");
    EXPECT_EQ(channels("stderr", " log "), "log ");
    EXPECT_EQ(channels("stderr", "nonsense"), "log trace ");
    EXPECT_EQ(channels("none", "log,trace"), "syslog");
}
