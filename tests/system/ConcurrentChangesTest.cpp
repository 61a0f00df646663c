// Many threads ask about a host whose facts change meanwhile: each answer holds what was or what is, and in the end all
// hold what is. In namespaces of the test's own, with a coarse clock that runs ahead.

#include "support/HostCopy.h"
#include "support/InChild.h"
#include "support/Provider.h"
#include "support/RunLevel.h"
#include "system/CoarseClock.h"
#include "system/Namespaces.h"

#include <gmock/gmock.h>

#include <atomic>
#include <chrono>
#include <filesystem>
#include <fstream>
#include <list>
#include <set>
#include <stdexcept>
#include <thread>

namespace {

namespace fs = std::filesystem;

constexpr unsigned threads = 8;
constexpr int changes = 20;

/// What a request sees of the host.
struct Sight {
    std::string name;
    std::uint64_t enabledState, healthState;
    bool daylightSaving;

    bool operator==(const Sight&) const = default;
};

const Sight before = {"node7", 2, 0, true};
const Sight after = {"node8", 4, 10, false};

/// The host below a directory.
class ChangingHost {
public:
    explicit ChangingHost(fs::path theRoot) : root(std::move(theRoot)) {}

    /// Puts each fact in its place with one step.
    void show(bool isAfter) const {
        if (root == "/")
            test::nameHost((isAfter ? after : before).name);
        else
            exchange("etc/hostname", (isAfter ? after : before).name + "\n");
        exchange("run/utmp", support::runLevel(isAfter ? '6' : '5'));
        exchange("sys/devices/system/edac/mc/mc0/ue_count", isAfter ? "3\n" : "0\n");
        const fs::path zone = root / "etc/localtime";
        fs::create_symlink(isAfter ? "/usr/share/zoneinfo/Asia/Kolkata" : "/usr/share/zoneinfo/Europe/Berlin",
                           zone.string() + ".new");
        fs::rename(zone.string() + ".new", zone);
    }

private:
    void exchange(const char* name, const std::string& bytes) const {
        const fs::path file = root / name;
        fs::create_directories(file.parent_path());
        std::ofstream(file.string() + ".new") << bytes;
        fs::rename(file.string() + ".new", file);
    }

    const fs::path root;
};

om::Instance theOne(const char* className) {
    const std::vector<om::Instance> found = test::instancesOf(test::instances(className));
    if (found.size() != 1) throw std::runtime_error(std::to_string(found.size()) + " of " + className);
    return found[0];
}

template <class T>
T valueOf(const om::Instance& instance, const char* property) {
    const om::Value* const value = test::find(instance.properties, property);
    if (value == nullptr) throw std::runtime_error(std::string("no ") + property);
    return std::get<T>(value->data);
}

/// Asks, and throws where an answer is none or its parts do not fit together.
Sight look() {
    const om::Instance computer = theOne("VESKA_ComputerSystem");
    const std::string name = valueOf<std::string>(computer, "Name");
    if (test::text(*test::find(computer.path.keys, "Name")) != name)
        throw std::runtime_error("two names in one answer");
    return {name, valueOf<std::uint64_t>(computer, "EnabledState"), valueOf<std::uint64_t>(computer, "HealthState"),
            valueOf<bool>(theOne("VESKA_TimeService"), "AutomaticDSTAdjustment")};
}

/// What a thread saw of each fact.
struct Seen {
    std::set<std::string> names;
    std::set<std::uint64_t> enabledStates, healthStates;
    std::set<bool> daylightSaving;

    void add(const Sight& sight) {
        names.insert(sight.name);
        enabledStates.insert(sight.enabledState);
        healthStates.insert(sight.healthState);
        daylightSaving.insert(sight.daylightSaving);
    }
};

/// One of the threads: what it saw until it was to end, and what it saw then.
class Asking {
public:
    explicit Asking(const std::atomic<bool>& ended)
        : thread([this, &ended] {
              try {
                  for (; !ended; ++looks) seen.add(look());
                  last = look();
              } catch (const std::exception& error) {
                  failure = error.what();
                  failed = true;
              }
          }) {}

    /// How often it has looked.
    unsigned count() const { return looks; }
    /// Waits until it has looked so often.
    void waitFor(unsigned enough) const {
        while (looks < enough && !failed) std::this_thread::sleep_for(std::chrono::milliseconds(1));
    }

    void expectAllRight() {
        thread.join();
        EXPECT_EQ(failure, "");
        EXPECT_THAT(seen.names, testing::ElementsAre(before.name, after.name));
        EXPECT_THAT(seen.enabledStates, testing::ElementsAre(before.enabledState, after.enabledState));
        EXPECT_THAT(seen.healthStates, testing::ElementsAre(before.healthState, after.healthState));
        EXPECT_THAT(seen.daylightSaving, testing::ElementsAre(after.daylightSaving, before.daylightSaving));
        EXPECT_TRUE(last == after) << last.name << ' ' << last.enabledState << ' ' << last.healthState;
    }

private:
    Seen seen;
    Sight last;
    std::string failure;
    std::atomic<bool> failed{false};
    std::atomic<unsigned> looks{0};
    std::thread thread; ///< made when the rest is there
};

/// Until the files are older than their clock is coarse, and are not read again; and all have seen them.
void stayAsItIs(const std::list<Asking>& all) {
    std::this_thread::sleep_for(std::chrono::milliseconds(30));
    std::vector<unsigned> counts;
    for (const Asking& each : all) counts.push_back(each.count());
    auto count = counts.begin();
    for (const Asking& each : all) each.waitFor(*count++ + 2); // one of them was under way
}

void expectOldOrNew(const ChangingHost& host) {
    test::coarseStep = 100;
    host.show(false);
    EXPECT_TRUE(look() == before);
    std::atomic<bool> ended{false};
    std::list<Asking> all;
    for (unsigned i = 0; i < threads; ++i) all.emplace_back(ended);
    for (int i = 0; i < changes; ++i) {
        if (i % 5 == 0) stayAsItIs(all);
        host.show(i % 2 == 0);
    }
    stayAsItIs(all);
    host.show(true);
    test::coarseMilliseconds += 1000;
    ended = true;
    for (Asking& each : all) each.expectAllRight();
}

class ConcurrentChanges : public test::NamespaceTest {};

TEST_F(ConcurrentChanges, OfAHostThatRunsAreSeenOldOrNew) {
    support::inOwnProcess([] {
        test::provider(); // loaded while the whole of /etc is there
        std::list<test::CoveredDirectory> covered;
        for (const char* directory : {"/run", "/etc", "/sys"}) covered.emplace_back(directory);
        expectOldOrNew(ChangingHost("/"));
    });
}

TEST_F(ConcurrentChanges, OfASnapshotAreSeenOldOrNew) {
    support::inOwnProcess([] {
        const support::HostCopy copy;
        setenv("VK_INSTRUMENTATION_ROOT", copy.path().c_str(), 1);
        expectOldOrNew(ChangingHost(copy.path()));
    });
}

} // namespace
