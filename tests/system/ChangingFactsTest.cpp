// What may change of a host that runs: how soon it shows, what forks see of it, and what is left of it where
// descriptors run out. In namespaces of the test's own, with a coarse clock that only the test moves.

#include "support/InChild.h"
#include "support/Provider.h"
#include "support/RunLevel.h"
#include "system/CoarseClock.h"
#include "system/Namespaces.h"

#include <gmock/gmock.h>

#include <fstream>
#include <list>
#include <sys/resource.h>

namespace {

using support::inOwnProcess;
using test::coarseMilliseconds;
using testing::IsEmpty;
using testing::SizeIs;

constexpr char computer[] = "VESKA_ComputerSystem";

void write(const std::filesystem::path& file, const std::string& text) {
    std::filesystem::create_directories(file.parent_path());
    std::ofstream(file) << text;
}

/// A number or flag of the one instance of a class.
std::uint64_t numberOf(const char* className, const char* property) {
    const std::vector<om::Instance> found = test::instancesOf(test::instances(className));
    const om::Value* const value = found.size() == 1 ? test::find(found[0].properties, property) : nullptr;
    if (value == nullptr) return 4711;
    if (const bool* const flag = std::get_if<bool>(&value->data)) return *flag ? 1 : 0;
    return std::get<std::uint64_t>(value->data);
}

std::uint64_t enabledState() {
    return numberOf(computer, "EnabledState");
}

std::uint64_t healthState() {
    return numberOf(computer, "HealthState");
}

std::string name() {
    const std::vector<om::ObjectPath> found = test::paths(test::names(computer));
    return found.size() == 1 ? test::text(*test::find(found[0].keys, "Name")) : std::to_string(found.size()) + " names";
}

/// No descriptor can be opened while it lives.
class NoDescriptors {
public:
    NoDescriptors() {
        getrlimit(RLIMIT_NOFILE, &before);
        const rlimit none{0, before.rlim_max};
        setrlimit(RLIMIT_NOFILE, &none);
    }
    ~NoDescriptors() { setrlimit(RLIMIT_NOFILE, &before); }
    NoDescriptors(const NoDescriptors&) = delete;
    NoDescriptors& operator=(const NoDescriptors&) = delete;

private:
    rlimit before{};
};

/// A host that runs, of which each test asks for the first time: in a process of its own.
class ChangingFacts : public test::NamespaceTest {
protected:
    void SetUp() override {
        NamespaceTest::SetUp();
        if (IsSkipped()) return;
        test::provider();
        for (const char* directory : {"/run", "/etc", "/sys/devices/system"}) covered.emplace_back(directory);
        test::nameHost("node7");
    }

    static void scheduleShutdown() { write("/run/systemd/shutdown/scheduled", "USEC=1\nMODE=reboot\n"); }
    static void countMemoryErrors(const char* count) { write("/sys/devices/system/edac/mc/mc0/ue_count", count); }

    static void useZone(const char* zone) {
        std::filesystem::remove("/etc/localtime");
        std::filesystem::create_symlink(std::string("/usr/share/zoneinfo/") + zone, "/etc/localtime");
    }

private:
    std::list<test::CoveredDirectory> covered;
};

TEST_F(ChangingFacts, PowerStateAndMemoryErrorsShowWithinASecond) {
    inOwnProcess([] {
        countMemoryErrors("0\n");
        EXPECT_EQ(enabledState(), 2U);
        EXPECT_EQ(healthState(), 0U);
        scheduleShutdown();
        countMemoryErrors("3\n");
        coarseMilliseconds += 999;
        EXPECT_EQ(enabledState(), 2U) << "nothing is read within the second";
        EXPECT_EQ(healthState(), 0U);
        coarseMilliseconds += 1;
        EXPECT_EQ(enabledState(), 4U);
        EXPECT_EQ(healthState(), 10U);
        std::filesystem::remove("/run/systemd/shutdown/scheduled");
        countMemoryErrors("0\n");
        coarseMilliseconds += 1000;
        EXPECT_EQ(enabledState(), 2U);
        EXPECT_EQ(healthState(), 0U);
    });
}

TEST_F(ChangingFacts, TheRunLevelOfAShutdownShowsWithinASecond) {
    inOwnProcess([] {
        const std::string running = support::runLevel('5');
        write("/run/utmp", running);
        EXPECT_EQ(enabledState(), 2U);
        write("/run/utmp", running + support::runLevel('6', '5'));
        coarseMilliseconds += 999;
        EXPECT_EQ(enabledState(), 2U) << "nothing is read within the second";
        coarseMilliseconds += 1;
        EXPECT_EQ(enabledState(), 4U);
        write("/run/utmp", running);
        coarseMilliseconds += 1000;
        EXPECT_EQ(enabledState(), 2U);
    });
}

TEST_F(ChangingFacts, NameAndZoneShowAtOnce) {
    inOwnProcess([] {
        EXPECT_EQ(name(), "node7");
        test::nameHost("node8");
        EXPECT_EQ(name(), "node8");
        const auto daylightSaving = [] { return numberOf("VESKA_TimeService", "AutomaticDSTAdjustment"); };
        EXPECT_EQ(daylightSaving(), 0U) << "without /etc/localtime it is UTC";
        for (int i = 0; i < 20; ++i) {
            useZone("Europe/Berlin");
            EXPECT_EQ(daylightSaving(), 1U);
            useZone("Asia/Kolkata");
            EXPECT_EQ(daylightSaving(), 0U);
        }
    });
}

TEST_F(ChangingFacts, ShowInAForkAsInItsParent) {
    inOwnProcess([] {
        EXPECT_EQ(enabledState(), 2U);
        scheduleShutdown();
        coarseMilliseconds += 1000;
        inOwnProcess([] { EXPECT_EQ(enabledState(), 4U); });
        EXPECT_EQ(enabledState(), 4U);
    });
}

TEST_F(ChangingFacts, StayWhereDescriptorsRunOutAndShowAfterwards) {
    inOwnProcess([] {
        countMemoryErrors("1\n");
        useZone("Europe/Berlin");
        EXPECT_EQ(healthState(), 10U);
        EXPECT_EQ(numberOf("VESKA_TimeService", "AutomaticDSTAdjustment"), 1U);
        countMemoryErrors("0\n");
        useZone("Asia/Kolkata");
        coarseMilliseconds += 1000;
        {
            const NoDescriptors none;
            EXPECT_EQ(name(), "node7");
            EXPECT_EQ(healthState(), 10U);
            EXPECT_EQ(numberOf("VESKA_TimeService", "AutomaticDSTAdjustment"), 1U);
        }
        EXPECT_EQ(healthState(), 0U);
        EXPECT_EQ(numberOf("VESKA_TimeService", "AutomaticDSTAdjustment"), 0U);
    });
}

TEST_F(ChangingFacts, AreAllThereAfterAFirstRequestWithoutDescriptors) {
#ifdef __SANITIZE_ADDRESS__
    GTEST_SKIP() << "the undefined-behaviour sanitizer looks at an object's type through a pipe";
#endif
    inOwnProcess([] {
        write("/etc/machine-info", "PRIMARY_OWNER_NAME=Operations\n");
        {
            const NoDescriptors none;
            EXPECT_THAT(test::instances(computer).results, IsEmpty());
            EXPECT_EQ(test::instances(computer).code, CMPI_RC_OK);
        }
        const std::vector<om::Instance> found = test::instancesOf(test::instances(computer));
        ASSERT_THAT(found, SizeIs(1));
        const om::Value* const owner = test::find(found[0].properties, "PrimaryOwnerName");
        ASSERT_NE(owner, nullptr);
        EXPECT_EQ(test::text(*owner), "Operations");
    });
}

} // namespace
