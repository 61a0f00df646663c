// What a request costs in system calls once the host is known, seen by strace.

#include "support/Command.h"
#include "support/SmbiosImage.h"
#include "support/TemporaryDirectory.h"
#include "system/Namespaces.h"

#include <gmock/gmock.h>

#include <fstream>
#include <map>
#include <regex>
#include <set>
#include <unistd.h>

namespace {

/// How often each kind of call is made.
using Calls = std::map<std::string, int>;
using CallsByRequest = std::map<std::string, Calls>;

/// Requests that make the same calls.
struct Group {
    Calls live;      ///< on a host that runs
    Calls snapshot;  ///< on a copy of a host
    Calls simulated; ///< on a host that a file describes
    std::vector<const char*> requests;
};

// A name takes one uname where the kernel has it. A stat asks a file whether it has changed: of a snapshot the host
// name, two files that show a shutdown, the directory of memory controllers and one file for each of them; of a time
// zone its link and its file; of a simulated host the file. What is known of a shutdown is compared with the clock.
// Nothing is opened, listed or started.
// clang-format off
const std::vector<Group> groups = {
    {{}, {}, {{"stat", 1}},
     {"EnumInstanceNames/VESKA_PhysicalPackage",
      "EnumInstances/VESKA_PhysicalPackage",
      "GetInstance/VESKA_PhysicalPackage",
      "EnumInstanceNames/VESKA_EnabledLogicalElementCapabilities"}},
    {{{"uname", 1}}, {{"stat", 1}}, {{"stat", 1}},
     {"EnumInstanceNames/VESKA_ComputerSystem",
      "EnumInstances/VESKA_EnabledLogicalElementCapabilities",
      "GetInstance/VESKA_EnabledLogicalElementCapabilities",
      "Associators/VESKA_ComputerSystem/VESKA_ComputerSystemPackage",
      "AssociatorNames/VESKA_ComputerSystem/VESKA_ComputerSystemPackage",
      "AssociatorNames/VESKA_ComputerSystem/VESKA_ComputerCapabilities"}},
    {{{"uname", 1}}, {{"stat", 5}, {"clock_gettime", 1}}, {{"stat", 1}},
     {"EnumInstances/VESKA_ComputerSystem",
      "GetInstance/VESKA_ComputerSystem"}},
    {{{"uname", 2}}, {{"stat", 1}}, {{"stat", 1}},
     {"EnumInstanceNames/VESKA_ComputerSystemPackage",
      "EnumInstances/VESKA_ComputerSystemPackage",
      "AssociatorNames/VESKA_PhysicalPackage/VESKA_ComputerSystemPackage",
      "EnumInstanceNames/VESKA_ComputerCapabilities",
      "EnumInstances/VESKA_ComputerCapabilities",
      "Associators/VESKA_ComputerSystem/VESKA_ComputerCapabilities",
      "AssociatorNames/VESKA_EnabledLogicalElementCapabilities/VESKA_ComputerCapabilities"}},
    {{{"uname", 2}}, {{"stat", 5}, {"clock_gettime", 1}}, {{"stat", 1}},
     {"Associators/VESKA_PhysicalPackage/VESKA_ComputerSystemPackage",
      "Associators/VESKA_EnabledLogicalElementCapabilities/VESKA_ComputerCapabilities"}},
    {{{"uname", 1}}, {{"uname", 1}}, {{"uname", 1}, {"stat", 1}},
     {"EnumInstanceNames/VESKA_TimeService"}},
    {{{"uname", 1}, {"stat", 2}}, {{"uname", 1}, {"stat", 2}}, {{"uname", 1}, {"stat", 1}},
     {"EnumInstances/VESKA_TimeService",
      "GetInstance/VESKA_TimeService"}},
    {{{"uname", 2}}, {{"uname", 2}}, {{"uname", 2}, {"stat", 1}},
     {"AssociatorNames/VESKA_ComputerSystem/VESKA_TimeServiceAffectsElement"}},
    {{{"uname", 2}, {"stat", 2}}, {{"uname", 2}, {"stat", 2}}, {{"uname", 2}, {"stat", 1}},
     {"Associators/VESKA_ComputerSystem/VESKA_TimeServiceAffectsElement"}},
    {{{"uname", 3}}, {{"uname", 2}, {"stat", 1}}, {{"uname", 2}, {"stat", 1}},
     {"EnumInstanceNames/VESKA_TimeServiceAffectsElement",
      "EnumInstances/VESKA_TimeServiceAffectsElement",
      "Associators/VESKA_TimeService/VESKA_TimeServiceAffectsElement",
      "AssociatorNames/VESKA_TimeService/VESKA_TimeServiceAffectsElement"}},
};
// clang-format on

CallsByRequest expected(Calls Group::*host) {
    CallsByRequest all;
    for (const Group& group : groups)
        for (const char* request : group.requests) all[request] = group.*host;
    return all;
}

/// The kind of a call; empty for what gives memory to the process, which hangs on the allocator and what it was built
/// with.
std::string kindOf(const std::string& call) {
    static const std::set<std::string> memory = {"brk", "mmap", "munmap"};
    static const std::regex status("l?stat|newfstatat|statx");
    if (memory.count(call) != 0) return "";
    return std::regex_match(call, status) ? "stat" : call;
}

/// The calls of ten requests each, between the marks of MarkedRequests.cpp; what stands before the first mark is
/// counted under an empty name.
CallsByRequest callsIn(const std::string& file) {
    static const std::regex call("^[0-9]+ +([a-z0-9_]+)\\(");
    static const std::regex mark("\"mark:([^\"]*)\"");
    CallsByRequest calls;
    Calls between;
    Calls* now = &calls[""];
    std::ifstream trace(file);
    for (std::string line; std::getline(trace, line);) {
        std::smatch parts;
        if (std::regex_search(line, parts, mark))
            now = parts[1].length() == 0 ? &between : &calls[parts[1]];
        else if (std::regex_search(line, parts, call))
            if (const std::string kind = kindOf(parts[1]); !kind.empty()) ++(*now)[kind];
    }
    return calls;
}

class SystemCallsPerRequest : public test::NamespaceTest {
protected:
    void SetUp() override {
        if (test::run("strace -f -qq -o /dev/null true 2>&1").exitStatus != 0)
            GTEST_SKIP() << "strace is not there, or may not trace";
    }

    /// Expects these calls of each further request, and no others. The object manager times each with two looks at
    /// the clock.
    void expectEach(const CallsByRequest& each, const std::string& environment) const {
        usleep(50'000); // until the files' stamps show every change
        const std::string trace = directory.path("trace");
        const std::string command = "NVLOG_SINK=none " + environment +
                                    // A leak check at the end, where one is built in, fails under a tracer.
                                    " strace -E ASAN_OPTIONS=detect_leaks=0 -f -qq -s 200 -o " + test::quoted(trace) +
                                    " " + test::quoted(MARKED_REQUESTS);
        EXPECT_EQ(test::run(command).exitStatus, 0) << command;
        CallsByRequest found = callsIn(trace);
        EXPECT_GT(found[""]["openat"], 1) << "the host was not read at all";
        found.erase("");
        for (const auto& [request, calls] : each) {
            Calls ten = calls;
            ten["clock_gettime"] += 2;
            for (auto& [call, count] : ten) count *= 10;
            EXPECT_EQ(found[request], ten) << "ten of " << request << ", " << environment;
        }
        for (const auto& [request, calls] : found) EXPECT_EQ(each.count(request), 1U) << request;
    }

    static support::SmbiosImage tables() {
        return support::SmbiosImage(3, 2)
            .add(support::SmbiosSystemImage{"Example", "Rack Server 7", {}, "SYS7", {}, std::string(16, 'u')})
            .add(support::SmbiosChassisImage{23, "Example", {}, "CZ7", {}})
            .end();
    }

    const support::TemporaryDirectory directory;
};

TEST_F(SystemCallsPerRequest, AreTheseOfALiveHost) {
    NamespaceTest::SetUp();
    if (IsSkipped()) return;
    // With one chassis and a linked zone, whatever this machine has.
    const test::CoveredDirectory sys("/sys");
    const test::CoveredDirectory etc("/etc");
    tables().writeTo(directory);
    std::filesystem::copy(directory.path("sys"), "/sys", std::filesystem::copy_options::recursive);
    std::filesystem::create_symlink("/usr/share/zoneinfo/Europe/Berlin", "/etc/localtime");
    expectEach(expected(&Group::live), "");
}

TEST_F(SystemCallsPerRequest, AreTheseOfASnapshot) {
    tables().writeTo(directory);
    directory.write("etc/hostname", "node7\n");
    directory.write("run/utmp", "");
    directory.write("etc/machine-id", "0123456789abcdef0123456789abcdef\n");
    directory.write("sys/devices/system/edac/mc/mc0/ue_count", "0\n");
    std::filesystem::create_directories(directory.path("usr/share/zoneinfo/Europe"));
    std::filesystem::copy_file("/usr/share/zoneinfo/Europe/Berlin", directory.path("usr/share/zoneinfo/Europe/Berlin"));
    directory.link("/usr/share/zoneinfo/Europe/Berlin", "etc/localtime");
    expectEach(expected(&Group::snapshot), "VK_INSTRUMENTATION_ROOT=" + test::quoted(directory.path()));
}

TEST_F(SystemCallsPerRequest, AreTheseOfASimulatedHost) {
    directory.write("tree.json", R"({"nodes":[
        {"type":40,"path":"/c","status":1,"properties":{"108":"node7","64":"u","39":"m","50":"s","123":1,"200":0}},
        {"type":1,"path":"/c/x","parent":"/c","status":1,"properties":{"50":"CZ7"}}]})");
    expectEach(expected(&Group::simulated), "VK_INSTRUMENTATION_TREE=" + test::quoted(directory.path("tree.json")));
}

} // namespace
