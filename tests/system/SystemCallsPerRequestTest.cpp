// What a request costs in system calls once the host is known, seen by strace.

#include "support/Command.h"
#include "support/SmbiosImage.h"
#include "support/TemporaryDirectory.h"

#include <gmock/gmock.h>

#include <fstream>
#include <map>
#include <regex>
#include <unistd.h>

namespace {

/// How often each kind of call is made.
using Calls = std::map<std::string, int>;

struct Case {
    const char* name;
    std::vector<std::string> request;
    Calls snapshot;  ///< on a copy of a host
    Calls simulated; ///< on a host that a file describes
};

const std::string computer = "VESKA_ComputerSystem.Name=\"node7\"";

// A name takes one uname where the kernel has it. A stat asks a file whether it has changed: of a snapshot the host
// name, two files that show a shutdown and the directory of memory controllers; of a time zone its link and
// its file. Nothing is opened, listed or started.
// clang-format off
const std::vector<Case> cases = {
    {"NamesOfComputer", {"names", "VESKA_ComputerSystem"}, {{"stat", 1}}, {{"stat", 1}}},
    {"Computer", {"instances", "VESKA_ComputerSystem"}, {{"stat", 4}}, {{"stat", 1}}},
    {"OneComputer", {"get", computer}, {{"stat", 4}}, {{"stat", 1}}},
    {"Package", {"instances", "VESKA_PhysicalPackage"}, {}, {{"stat", 1}}},
    {"Capabilities", {"instances", "VESKA_EnabledLogicalElementCapabilities"}, {{"stat", 1}}, {{"stat", 1}}},
    {"PackagesOfComputers", {"instances", "VESKA_ComputerSystemPackage"}, {{"stat", 1}}, {{"stat", 1}}},
    {"CapabilitiesOfComputers", {"instances", "VESKA_ComputerCapabilities"}, {{"stat", 1}}, {{"stat", 1}}},
    {"PackageOfComputer", {"associators", computer, "--assoc-class", "VESKA_ComputerSystemPackage"}, {{"stat", 1}}, {{"stat", 1}}},
    {"CapabilitiesOfComputer", {"associators", computer, "--assoc-class", "VESKA_ComputerCapabilities"}, {{"stat", 1}}, {{"stat", 1}}},
    {"TimeService", {"instances", "VESKA_TimeService"}, {{"uname", 1}, {"stat", 2}}, {{"uname", 1}, {"stat", 1}}},
    {"TimeServiceOfComputers", {"instances", "VESKA_TimeServiceAffectsElement"}, {{"uname", 2}, {"stat", 1}}, {{"uname", 2}, {"stat", 1}}},
};
// clang-format on

/// The files that make the zone of this host: its links, and what they lead to.
int zoneFiles() {
    int count = 1;
    for (std::filesystem::path file = "/etc/localtime"; std::filesystem::is_symlink(file); ++count)
        file = file.parent_path() / std::filesystem::read_symlink(file);
    return count;
}

/// The calls of one process in a trace.
Calls callsIn(const std::string& file) {
    static const std::regex call("^[0-9]+ +([a-z0-9_]+)\\(");
    static const std::regex status("l?stat|newfstatat|statx");
    Calls calls;
    std::ifstream trace(file);
    for (std::string line; std::getline(trace, line);) {
        std::smatch parts;
        if (!std::regex_search(line, parts, call)) continue;
        const std::string name = parts[1];
        if (name != "mmap" && name != "munmap") ++calls[std::regex_match(name, status) ? "stat" : name];
    }
    return calls;
}

class SystemCallsPerRequest : public testing::TestWithParam<Case> {
protected:
    void SetUp() override {
        if (test::run("strace -f -qq -o /dev/null true 2>&1").exitStatus != 0)
            GTEST_SKIP() << "strace is not there, or may not trace";
    }

    /// The calls of one process that puts the request so many times. Its coarse clock stands still.
    Calls callsOf(const std::string& environment, std::vector<std::string> request, int times) const {
        const std::string trace = directory.path("trace");
        std::string command = environment +
                              // A leak check at the end, where one is built in, fails under a tracer.
                              " strace -E ASAN_OPTIONS=detect_leaks=0:verify_asan_link_order=0 -E LD_PRELOAD=" +
                              test::quoted(STANDING_CLOCK) + " -f -qq -o " + test::quoted(trace) +
                              " -e trace=%file,%desc,%process,%network,uname " + test::quoted(VKCIM) +
                              " --format json --repeat " + std::to_string(times);
        for (const std::string& argument : request) command += " " + test::quoted(argument);
        const test::CommandResult result = test::run(command);
        EXPECT_EQ(result.exitStatus, 0) << command;
        EXPECT_NE(result.output.find("CMPI_RC_OK"), std::string::npos) << result.output;
        return callsIn(trace);
    }

    /// Expects these calls of each further request, and no others but the `ignored` one.
    void expectEach(const Calls& expected, const std::string& environment, const std::string& hostName,
                    const std::string& ignored = "") const {
        std::vector<std::string> request = GetParam().request;
        for (std::string& word : request)
            if (const auto at = word.find("node7"); at != std::string::npos) word.replace(at, 5, hostName);
        usleep(50'000); // until the files' stamps show every change
        Calls few = callsOf("NVLOG_SINK=none " + environment, request, 2);
        Calls more;
        for (const auto& [call, count] : callsOf("NVLOG_SINK=none " + environment, request, 12))
            if (count != few[call] && call != ignored) more[call] = count - few[call];
        Calls ten = expected;
        for (auto& [call, count] : ten) count *= 10;
        EXPECT_EQ(more, ten) << "in ten further requests, " << environment;
        EXPECT_GT(few["openat"], 1) << "the host was not read at all";
    }

    const support::TemporaryDirectory directory;
};

TEST_P(SystemCallsPerRequest, AreTheseOfALiveHost) {
    char name[256] = {};
    gethostname(name, sizeof name - 1);
    // How many names are asked for depends on the chassis that this machine has.
    const bool isTime = std::string(GetParam().name) == "TimeService";
    expectEach(isTime ? Calls{{"stat", zoneFiles()}} : Calls(), "", name, "uname");
}

TEST_P(SystemCallsPerRequest, AreTheseOfASnapshot) {
    support::SmbiosImage(3, 2)
        .add(support::SmbiosSystemImage{"Example", "Rack Server 7", {}, "SYS7", {}, std::string(16, 'u')})
        .add(support::SmbiosChassisImage{23, "Example", {}, "CZ7", {}})
        .end()
        .writeTo(directory);
    directory.write("etc/hostname", "node7\n");
    directory.write("run/utmp", "");
    directory.write("etc/machine-id", "0123456789abcdef0123456789abcdef\n");
    std::filesystem::create_directories(directory.path("usr/share/zoneinfo/Europe"));
    std::filesystem::copy_file("/usr/share/zoneinfo/Europe/Berlin", directory.path("usr/share/zoneinfo/Europe/Berlin"));
    directory.link("/usr/share/zoneinfo/Europe/Berlin", "etc/localtime");
    expectEach(GetParam().snapshot, "VK_INSTRUMENTATION_ROOT=" + test::quoted(directory.path()), "node7");
}

TEST_P(SystemCallsPerRequest, AreTheseOfASimulatedHost) {
    directory.write("tree.json", R"({"nodes":[
        {"type":40,"path":"/c","status":1,"properties":{"108":"node7","64":"u","39":"m","50":"s","123":1,"200":0}},
        {"type":1,"path":"/c/x","parent":"/c","status":1,"properties":{"50":"CZ7"}}]})");
    expectEach(GetParam().simulated, "VK_INSTRUMENTATION_TREE=" + test::quoted(directory.path("tree.json")), "node7");
}

INSTANTIATE_TEST_SUITE_P(, SystemCallsPerRequest, testing::ValuesIn(cases),
                         [](const auto& each) { return std::string(each.param.name); });

} // namespace
