// Many requests at once, with commands among them.

#include "support/FakeCommands.h"
#include "support/HostName.h"
#include "support/OpenDescriptors.h"
#include "support/Provider.h"
#include "support/SimulatedHost.h"

#include <gmock/gmock.h>

#include <atomic>
#include <cerrno>
#include <sys/wait.h>
#include <thread>

namespace {

using support::openDescriptors;
using testing::SizeIs;

constexpr unsigned threads = 8;
constexpr unsigned requestsOfAThread = 500;

/// Whether the request of that number was answered as it has to be.
bool ask(unsigned number) {
    switch (number % 8) {
    case 0: {
        const om::Answer answer =
            test::invoke(test::path("VESKA_TimeService"), "ManageTime",
                         {{"GetRequest", {CMPI_boolean, true}}, {"ManagedElement", {CMPI_ref, {}}}});
        return answer.code == CMPI_RC_OK && test::find(answer.out, "TimeData") != nullptr;
    }
    case 1: {
        const om::Answer answer = test::instances("VESKA_CIMServiceConfig");
        if (answer.code != CMPI_RC_OK || answer.results.size() != 1) return false;
        const om::Instance instance = test::instancesOf(answer)[0];
        const om::Value* const value = test::find(instance.properties, "deliveryRetryAttempts");
        return value != nullptr && std::get<std::uint64_t>(value->data) == 20;
    }
    case 2:
        return test::instances("VESKA_ComputerSystem").results.size() == 1;
    case 3:
        return test::names("VESKA_TimeServiceAffectsElement").results.size() == 1;
    case 4:
        return test::associators(test::path("VESKA_TimeService"), "VESKA_TimeServiceAffectsElement").results.size() ==
               1;
    case 5:
        return test::get(test::path("VESKA_PhysicalPackage")).results.size() == 1;
    case 6:
        return test::invoke(test::path("VESKA_ComputerSystem"), "Any", {}).code == CMPI_RC_ERR_INVALID_CLASS;
    default:
        return test::instances("VESKA_TimeService").results.size() == 1;
    }
}

TEST(ConcurrentRequests, AreAnsweredRightAndLeaveNothingBehind) {
    test::FakeCommands commands;
    commands.add(commands.path("product/vcm/bin/cimconfig"), "echo 'Current value: 20'");
    test::simulate({test::computer(0, test::hostName()), test::chassis(0, 0, "CZ1")},
                   {{"rootDirectory", commands.path("product/platform/").string()}, {"kvm", false}});
    for (unsigned number = 0; number < 8; ++number) EXPECT_TRUE(ask(number)) << number;
    commands.take();
    const std::size_t before = openDescriptors();

    std::atomic<unsigned> wrong{0};
    std::vector<std::thread> running;
    for (unsigned thread = 0; thread < threads; ++thread)
        running.emplace_back([&wrong, thread] {
            for (unsigned number = 0; number < requestsOfAThread; ++number)
                if (!ask(number + thread)) ++wrong;
        });
    for (std::thread& thread : running) thread.join();

    EXPECT_EQ(wrong, 0U);
    EXPECT_EQ(openDescriptors(), before);
    EXPECT_EQ(waitpid(-1, nullptr, WNOHANG), -1) << "no child is left, running or dead";
    EXPECT_EQ(errno, ECHILD);
    EXPECT_THAT(commands.take(), SizeIs(2 * threads * requestsOfAThread / 8)) << "two commands for every instance";
}

} // namespace
