#include "support/Provider.h"
#include "support/SimulatedHost.h"

#include <gtest/gtest.h>

#include <atomic>
#include <fstream>
#include <mutex>
#include <thread>

#include <unistd.h>

#if defined(__SANITIZE_ADDRESS__) || defined(__SANITIZE_THREAD__)
#define SANITIZED 1
#else
#define SANITIZED 0
#endif

namespace {

using om::Operation;

/// One kind of request and what it must be answered, in one text.
struct Kind {
    om::Request request;
    std::string expected;
};

std::string print(const om::Value& value) {
    if (const auto* text = std::get_if<std::string>(&value.data)) return *text;
    if (const auto* number = std::get_if<std::uint64_t>(&value.data)) return std::to_string(*number);
    if (const auto* flag = std::get_if<bool>(&value.data)) return *flag ? "true" : "false";
    std::string line = "[";
    if (const auto* elements = std::get_if<std::vector<om::Value>>(&value.data))
        for (const om::Value& element : *elements) line += print(element) + ",";
    else if (const auto* reference = std::get_if<std::shared_ptr<const om::ObjectPath>>(&value.data))
        line += test::print(**reference);
    return line + "]";
}

std::string print(const om::Answer& answer) {
    std::string line = std::to_string(answer.code) + (answer.done ? " done" : " open");
    for (const auto& result : answer.results) {
        if (const auto* path = std::get_if<om::ObjectPath>(&result)) {
            line += " " + test::print(*path);
            continue;
        }
        const auto& instance = std::get<om::Instance>(result);
        line += " " + test::print(instance.path) + "{";
        for (const auto& [name, value] : instance.properties) line += name + "=" + print(value) + ";";
        line += "}";
    }
    return line;
}

om::Request request(Operation operation, om::ObjectPath path, std::optional<std::string> assocClass = {}) {
    om::Request made;
    made.operation = operation;
    made.path = std::move(path);
    made.assocClass = std::move(assocClass);
    return made;
}

/// Requests of every kind that starts no process.
std::vector<Kind> kinds() {
    test::simulate({test::computer(0, "node7"), test::chassis(0, 0, "CZ1"), test::computer(1, "node8"),
                    test::chassis(1, 0, "CZ2")});
    const om::ObjectPath computer = test::path("VESKA_ComputerSystem", {{"Name", "node8"}});
    std::vector<Kind> made;
    for (om::Request& each : std::vector<om::Request>{
             request(Operation::EnumInstanceNames, test::path("VESKA_ComputerSystem")),
             request(Operation::EnumInstances, test::path("VESKA_ComputerSystem")),
             request(Operation::GetInstance, computer),
             request(Operation::GetInstance, test::path("VESKA_ComputerSystem", {{"Name", "unknown"}})),
             request(Operation::EnumInstances, test::path("VESKA_PhysicalPackage")),
             request(Operation::EnumInstances, test::path("VESKA_EnabledLogicalElementCapabilities")),
             request(Operation::EnumInstanceNames, test::path("VESKA_ComputerCapabilities")),
             request(Operation::EnumInstances, test::path("VESKA_ComputerSystemPackage")),
             request(Operation::GetInstance, test::path("VESKA_ComputerSystemPackage", {{"Odd", "key"}})),
             request(Operation::Associators, computer, "CIM_ElementCapabilities"),
             request(Operation::AssociatorNames, computer, "VESKA_ComputerSystemPackage"),
             request(Operation::EnumInstances, test::path("NoSuchClass")),
             request(Operation::ModifyInstance, computer),
             request(Operation::DeleteInstance, computer),
         }) {
        std::string expected = print(test::provider().run(each));
        made.push_back({std::move(each), std::move(expected)});
    }
    return made;
}

long residentBytes() {
    std::ifstream file("/proc/self/statm");
    long size = 0;
    long resident = 0;
    file >> size >> resident;
    return resident * sysconf(_SC_PAGESIZE);
}

TEST(NoState, AnswersOfEveryKindDiffer) {
    // Guards the two tests below: they compare answers that say something.
    const std::vector<Kind> all = kinds();
    EXPECT_NE(all[0].expected.find("Name=\"node8\""), std::string::npos) << all[0].expected;
    EXPECT_NE(all[1].expected.find("OperationalStatus=[2,11,]"), std::string::npos) << all[1].expected;
    EXPECT_EQ(all[3].expected, "0 done");
    EXPECT_NE(all[9].expected.find("VESKA_EnabledLogicalElementCapabilities"), std::string::npos) << all[9].expected;
    EXPECT_NE(all[10].expected.find("CZ2"), std::string::npos) << all[10].expected;
    EXPECT_EQ(all[11].expected, "5 open");
}

TEST(NoState, TwentyThousandRequestsDoNotGrowTheProcess) {
    if (SANITIZED) GTEST_SKIP() << "a sanitizer keeps freed memory";
    const std::vector<Kind> all = kinds();
    const auto ask = [&](int times) {
        for (int i = 0; i < times; ++i) {
            const Kind& kind = all[static_cast<std::size_t>(i) % all.size()];
            ASSERT_EQ(print(test::provider().run(kind.request)), kind.expected);
        }
    };
    ask(1000);
    const long before = residentBytes();
    ASSERT_GT(before, 0);
    ask(20000);
    EXPECT_LT(residentBytes() - before, 2 * 1024 * 1024);
}

TEST(NoState, EightThreadsAreAllAnsweredRight) {
    constexpr int threads = 8;
    constexpr int requests = 2000;
    const std::vector<Kind> all = kinds();
    std::atomic<int> right{0};
    std::mutex mutex;
    std::string firstWrong;
    const auto work = [&](int thread) {
        for (int i = 0; i < requests; ++i) {
            const Kind& kind = all[static_cast<std::size_t>(i * 5 + thread) % all.size()];
            const std::string answer = print(test::provider().run(kind.request));
            if (answer == kind.expected) {
                ++right;
                continue;
            }
            const std::lock_guard<std::mutex> lock(mutex);
            if (firstWrong.empty()) firstWrong = answer + " instead of " + kind.expected;
        }
    };
    std::vector<std::thread> running;
    for (int thread = 0; thread < threads; ++thread) running.emplace_back(work, thread);
    for (std::thread& thread : running) thread.join();
    EXPECT_EQ(right, threads * requests) << firstWrong;
}

} // namespace
