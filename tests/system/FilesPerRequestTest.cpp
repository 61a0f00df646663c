#include "support/Command.h"
#include "support/SmbiosImage.h"
#include "support/TemporaryDirectory.h"

#include <gmock/gmock.h>

#include <algorithm>
#include <fstream>
#include <map>
#include <regex>

// What a request opens and starts once the host is known, seen by strace.

namespace {

using testing::IsEmpty;

/// The calls that a process made, by what they are about: a file's path, or `start` for a process or thread.
using Calls = std::map<std::string, int>;

constexpr char starting[] = "start";

/// Facts that may change while the host runs; every other file is read for the first request alone.
bool mayChange(const std::string& path) {
    static const std::regex changing("/etc/hostname|/run/utmp|/run/systemd/shutdown/scheduled|"
                                     "/sys/devices/system/edac/mc(/.*)?|/etc/localtime|/usr/share/zoneinfo/.*");
    return std::regex_match(path, changing);
}

class FilesPerRequest : public testing::TestWithParam<std::vector<std::string>> {
protected:
    void SetUp() override {
        if (test::run("strace -f -qq -o /dev/null true 2>&1").exitStatus != 0)
            GTEST_SKIP() << "strace is not there, or may not trace";
        support::SmbiosSystemImage system;
        system.manufacturer = "Example";
        system.product = "Rack Server 7";
        system.serial = "SYS7";
        system.uuid = std::string("\x33\x22\x11\x00\x55\x44\x77\x66\x88\x99\xAA\xBB\xCC\xDD\xEE\xFF", 16);
        support::SmbiosChassisImage chassis;
        chassis.manufacturer = "Example";
        chassis.serial = "CZ7";
        support::SmbiosImage(3, 2).add(system).add(chassis).end().writeTo(host);
        host.write("etc/hostname", "node7\n");
        host.write("etc/machine-id", "0123456789abcdef0123456789abcdef\n");
    }

    /// The calls of one process that puts the request so many times.
    Calls callsOf(int times) const {
        std::string command = "NVLOG_SINK=none VK_INSTRUMENTATION_ROOT=" + test::quoted(host.path()) +
                              // A leak check at the end, where one is built in, fails under a tracer.
                              " strace -E ASAN_OPTIONS=detect_leaks=0 -f -qq -s 4096 -o " + test::quoted(trace()) +
                              " -e trace=open,openat,openat2,creat,execve,fork,vfork,clone,clone3 " +
                              test::quoted(VKCIM) + " --format json --repeat " + std::to_string(times);
        for (const std::string& argument : GetParam()) command += " " + test::quoted(argument);
        const test::CommandResult result = test::run(command);
        EXPECT_EQ(result.exitStatus, 0) << command;
        EXPECT_NE(result.output.find("CMPI_RC_OK"), std::string::npos) << result.output;
        return read();
    }

    support::TemporaryDirectory host;

private:
    std::string trace() const { return host.path() + ".strace"; }

    Calls read() const {
        static const std::regex call("^[0-9]+ +([a-z0-9]+)\\([^\"]*(?:\"([^\"]*)\")?");
        Calls calls;
        std::ifstream file(trace());
        for (std::string line; std::getline(file, line);) {
            std::smatch parts;
            if (!std::regex_search(line, parts, call)) continue;
            const std::string name = parts[1];
            const bool opens = name.rfind("open", 0) == 0 || name == "creat";
            if (opens && parts[2] == host.path()) continue; // the folder below which a file is opened next
            ++calls[opens ? parts[2].str() : starting];
        }
        std::remove(trace().c_str());
        return calls;
    }
};

TEST_P(FilesPerRequest, AreThoseOfFactsThatMayChangeAndNoProcessIsStarted) {
    const Calls few = callsOf(10);
    const Calls many = callsOf(30);
    EXPECT_EQ(few.count("/sys/firmware/dmi/tables/DMI"), 1U) << "the host's tables were not read at all";

    std::vector<std::string> offences;
    for (const auto& [path, count] : many) {
        const auto before = few.find(path);
        const int more = count - (before == few.end() ? 0 : before->second);
        if (more != 0 && !mayChange(path)) offences.push_back(path + ", " + std::to_string(more) + " times more");
    }
    EXPECT_THAT(offences, IsEmpty()) << "in 20 further requests";
}

INSTANTIATE_TEST_SUITE_P(, FilesPerRequest,
                         testing::Values(std::vector<std::string>{"names", "VESKA_ComputerSystem"},
                                         std::vector<std::string>{"instances", "VESKA_ComputerSystem"},
                                         std::vector<std::string>{"get", "VESKA_ComputerSystem.Name=\"node7\""},
                                         std::vector<std::string>{"get", "VESKA_ComputerSystem.Name=\"unknown\""},
                                         std::vector<std::string>{"instances", "VESKA_PhysicalPackage"},
                                         std::vector<std::string>{"instances",
                                                                  "VESKA_EnabledLogicalElementCapabilities"},
                                         std::vector<std::string>{"associators", "VESKA_ComputerSystem.Name=\"node7\"",
                                                                  "--assoc-class", "VESKA_ComputerSystemPackage"}));

TEST(FilesPerRequestCheck, KnowsWhatMayChange) {
    EXPECT_TRUE(mayChange("/etc/hostname"));
    EXPECT_TRUE(mayChange("/sys/devices/system/edac/mc/mc0/ue_count"));
    for (const char* fixed : {"start", "/sys/firmware/dmi/tables/DMI", "/etc/machine-id", "/etc/hostname.d/x"})
        EXPECT_FALSE(mayChange(fixed)) << fixed;
}

} // namespace
