#include "host/ServiceNotes.h"

#include "support/TemporaryDirectory.h"

#include <gmock/gmock.h>

#include <filesystem>
#include <fstream>

namespace {

namespace fs = std::filesystem;
using namespace VK::Host;

TEST(ServiceNotes, TellTheTimeServiceInOneLine) {
    EXPECT_EQ(timeNote({"20240101120000.000000+060", "Europe/Berlin", 1U, true}),
              "time service: time 20240101120000.000000+060, zone Europe/Berlin, automatic daylight saving on, "
              "NTP daemon ntpd running");
    EXPECT_EQ(timeNote({"", "", 0U, false}),
              "time service: automatic daylight saving off, NTP daemon ntpd not running");
    EXPECT_EQ(timeNote({}), "time service: NTP daemon ntpd not running");
}

TEST(ServiceNotes, FindTheDaemonAmongTheProcesses) {
    const support::TemporaryDirectory directory;
    const fs::path proc = fs::path(directory.path()) / "proc";
    const auto process = [&](const char* name, const std::string& commandLine) {
        fs::create_directories(proc / name);
        std::ofstream(proc / name / "cmdline") << commandLine;
    };
    const VK::Root root(directory.path());
    EXPECT_FALSE(isNtpDaemonRunning(root));
    process("1", "/sbin/init");
    process("self", "/usr/sbin/ntpd"); // no process of its own
    EXPECT_FALSE(isNtpDaemonRunning(root));
    process("812", std::string("/usr/sbin/NTPD\0-p\0/run/ntpd.pid", 31));
    EXPECT_TRUE(isNtpDaemonRunning(root));
}

TEST(ServiceNotes, LookForTheCommandsWhereTheProviderDoes) {
    EXPECT_EQ(commandDirectory("/opt/vk/platform/", false), "/opt/vk/vcm/bin/");
    EXPECT_EQ(commandDirectory("/opt/vk/", false), "/opt/vk/vcm/bin/");
    EXPECT_EQ(commandDirectory("/opt/vk/platform/", true), "/usr/sbin/");
}

TEST(ServiceNotes, SayThatTheConfigurationCommandIsMissing) {
    const support::TemporaryDirectory directory;
    const std::string bin = std::string(directory.path()) + "/";
    EXPECT_EQ(commandNote(bin),
              "no " + bin + "cimconfig: the delivery settings of the CIM server read as 0, which then means nothing");
    std::ofstream(bin + "cimconfig") << "#!/bin/sh\n";
    EXPECT_NE(commandNote(bin), "") << "it cannot be run";
    fs::permissions(bin + "cimconfig", fs::perms::owner_all);
    EXPECT_EQ(commandNote(bin), "");
}

} // namespace
