#include "include/MachineLock.h"

#include "support/Isolated.h"
#include "support/TemporaryDirectory.h"

#include <gmock/gmock.h>

#include <array>
#include <atomic>
#include <csignal>
#include <cstdlib>
#include <filesystem>
#include <optional>
#include <pthread.h>
#include <sys/stat.h>
#include <thread>

/// The address sanitizer mistakes the frames of a cancelled thread for ones in use when it takes its signal stack back.
extern "C" __attribute__((visibility("default"))) const char* __asan_default_options() {
    return "use_sigaltstack=0";
}

namespace {

namespace fs = std::filesystem;
using support::TemporaryDirectory;
using testing::IsEmpty;
using VK::MachineLock;

/// A child of this process that goes on while the test does, killed by SIGALRM if it hangs.
class Child {
public:
    template <class Work>
    explicit Child(Work work) : process(fork()) {
        if (process != 0) return;
        alarm(60);
        work();
        _exit(testing::Test::HasFailure() ? 1 : 0);
    }
    ~Child() {
        if (!waited) wait();
    }
    Child(const Child&) = delete;
    Child& operator=(const Child&) = delete;

    void send(int signal) const { kill(process, signal); }
    int wait() {
        int status = -1;
        while (waitpid(process, &status, 0) < 0 && errno == EINTR) {
        }
        waited = true;
        return status;
    }

private:
    const pid_t process;
    bool waited = false;
};

/// Lets one process wait for a word of another.
class Signal {
public:
    Signal() { EXPECT_EQ(pipe(ends.data()), 0); }
    ~Signal() {
        for (const int end : ends) close(end);
    }
    Signal(const Signal&) = delete;
    Signal& operator=(const Signal&) = delete;

    void give() const { EXPECT_EQ(write(ends[1], "x", 1), 1); }
    void await() const {
        char word = 0;
        EXPECT_EQ(read(ends[0], &word, 1), 1);
    }

private:
    std::array<int, 2> ends{};
};

/// Tests with a lock file, whose directory must be root's.
class MachineLockAmongProcesses : public testing::Test {
protected:
    void SetUp() override {
        if (geteuid() != 0) GTEST_SKIP() << "only root has directories that only root can write";
    }

    /// Appends a word to the file `events`.
    void note(const std::string& word) const { std::ofstream(directory.path("events"), std::ios::app) << word << "\n"; }

    /// Another process gets the lock when it is given back, and not before, also where a signal comes meanwhile.
    void expectAnotherProcessToWait(std::optional<MachineLock>& held) const {
        Signal waiting;
        Child other([&] {
            struct sigaction interrupting {}; // without SA_RESTART: the wait ends with EINTR
            interrupting.sa_handler = [](int) {};
            sigaction(SIGUSR1, &interrupting, nullptr);
            waiting.give();
            const MachineLock lock("x", directory.path());
            note(lock.keepsProcessesOut() ? "taken" : "not taken");
        });
        waiting.await();
        std::this_thread::sleep_for(std::chrono::milliseconds(50)); // in which it would be overtaken
        other.send(SIGUSR1);
        std::this_thread::sleep_for(std::chrono::milliseconds(50));
        note("given back");
        held.reset();
        EXPECT_EQ(other.wait(), 0);
        EXPECT_EQ(directory.read("events"), "given back\ntaken\n");
    }

    const TemporaryDirectory directory;
};

TEST(MachineLock, LetsOneThreadInAtATime) {
    std::atomic<int> inside{0};
    std::atomic<int> overlaps{0};
    std::array<std::thread, 4> threads;
    for (std::thread& thread : threads)
        thread = std::thread([&] {
            for (int i = 0; i < 200; ++i) {
                const MachineLock lock("x", "/nowhere");
                if (++inside != 1) ++overlaps;
                std::this_thread::yield();
                --inside;
            }
        });
    for (std::thread& thread : threads) thread.join();
    EXPECT_EQ(overlaps, 0);
}

TEST(MachineLock, IsAmongThreadsOnlyWhereItsDirectoryIsMissing) {
    EXPECT_FALSE(MachineLock("x", "/nowhere").keepsProcessesOut());
}

TEST(MachineLock, UsesNoDirectoryThatOthersThanRootCanWrite) {
    const TemporaryDirectory directory;
    fs::create_directory(directory.path("open"));
    for (const mode_t mode : {0777, 0770, 01777}) {
        ASSERT_EQ(chmod(directory.path("open").c_str(), mode), 0);
        EXPECT_FALSE(MachineLock("x", directory.path("open")).keepsProcessesOut()) << mode;
        EXPECT_TRUE(fs::is_empty(directory.path("open"))) << mode;
    }
    ASSERT_EQ(chmod(directory.path("open").c_str(), 0700), 0);
    EXPECT_TRUE(geteuid() != 0 || chown(directory.path("open").c_str(), 65534, 65534) == 0);
    EXPECT_FALSE(MachineLock("x", directory.path("open")).keepsProcessesOut()) << "another one's directory";
}

TEST(MachineLock, CanBeHadInAChildThatWasForkedWhileAThreadHeldIt) {
    std::optional<MachineLock> held(std::in_place, "x", "/nowhere");
    std::thread([&] {
        Child child([] { const MachineLock lock("x", "/nowhere"); });
        EXPECT_EQ(child.wait(), 0);
        Child holdersCopy([&] {
            held.reset();
            const MachineLock lock("x", "/nowhere");
        });
        Child holdersCopyAfterwards([&] {
            std::optional<MachineLock> own(std::in_place, "x", "/nowhere");
            held.reset();
            std::atomic<bool> isIn{false};
            std::thread other([&] {
                const MachineLock lock("x", "/nowhere");
                isIn = true;
            });
            std::this_thread::sleep_for(std::chrono::milliseconds(50));
            EXPECT_FALSE(isIn) << "what is lost is no lock of this process";
            own.reset();
            other.join();
        });
        EXPECT_EQ(holdersCopyAfterwards.wait(), 0);
        EXPECT_EQ(holdersCopy.wait(), 0);
    }).join();
}

TEST_F(MachineLockAmongProcesses, IsGivenBackByAThreadThatIsCancelledMeanwhile) {
    const auto start = [](void* own) -> void* {
        {
            const MachineLock lock("x", static_cast<const TemporaryDirectory*>(own)->path());
            pthread_cancel(pthread_self());
        }
        pthread_testcancel();
        return own;
    };
    pthread_t thread{};
    ASSERT_EQ(pthread_create(&thread, nullptr, start, const_cast<TemporaryDirectory*>(&directory)), 0);
    void* answer = nullptr;
    ASSERT_EQ(pthread_join(thread, &answer), 0);
    EXPECT_EQ(answer, PTHREAD_CANCELED);
    EXPECT_TRUE(MachineLock("x", directory.path()).keepsProcessesOut());
}

TEST_F(MachineLockAmongProcesses, KeepsAnotherProcessWaiting) {
    std::optional<MachineLock> held(std::in_place, "x", directory.path());
    EXPECT_TRUE(held->keepsProcessesOut());
    expectAnotherProcessToWait(held);
}

TEST_F(MachineLockAmongProcesses, OfAnotherNameIsFree) {
    const MachineLock held("x", directory.path());
    Child other([&] { EXPECT_TRUE(MachineLock("y", directory.path()).keepsProcessesOut()); });
    EXPECT_EQ(other.wait(), 0);
}

TEST_F(MachineLockAmongProcesses, IsFreeOnceItsHolderIsDead) {
    Signal taken;
    Child holder([&] {
        const MachineLock lock("x", directory.path());
        taken.give();
        pause();
    });
    taken.await();
    holder.send(SIGKILL);
    holder.wait();
    EXPECT_TRUE(MachineLock("x", directory.path()).keepsProcessesOut());
}

TEST_F(MachineLockAmongProcesses, IsNotHandedOnToAChildOfAForkThatOutlivesIt) {
    Signal end;
    std::optional<Child> heir;
    {
        const MachineLock lock("x", directory.path());
        heir.emplace([&] { end.await(); });
    }
    Child other([&] { EXPECT_TRUE(MachineLock("x", directory.path()).keepsProcessesOut()); });
    EXPECT_EQ(other.wait(), 0);
    end.give();
    EXPECT_EQ(heir->wait(), 0);
}

TEST_F(MachineLockAmongProcesses, IsNotTouchedByAForkedChildThatLosesItsCopy) {
    std::optional<MachineLock> held(std::in_place, "x", directory.path());
    Child copy([&] { held.reset(); });
    EXPECT_EQ(copy.wait(), 0);
    expectAnotherProcessToWait(held);
}

TEST_F(MachineLockAmongProcesses, GivesCommandsNothingOfIt) {
    const MachineLock lock("x", directory.path());
    const std::string command = "! ls -l /proc/self/fd | grep -F '" + directory.path() + "'";
    EXPECT_EQ(std::system(command.c_str()), 0);
}

TEST_F(MachineLockAmongProcesses, KeepsItsFileForRootAlone) {
    { const MachineLock lock("x", directory.path()); }
    struct stat status {};
    ASSERT_EQ(stat(directory.path("x").c_str(), &status), 0);
    EXPECT_EQ(status.st_mode & 07777, 0600U);
    EXPECT_EQ(status.st_size, 0);
}

TEST_F(MachineLockAmongProcesses, FollowsNoLink) {
    directory.link(directory.path("elsewhere"), "x");
    EXPECT_FALSE(MachineLock("x", directory.path()).keepsProcessesOut());
    EXPECT_FALSE(fs::exists(directory.path("elsewhere")));
}

} // namespace
