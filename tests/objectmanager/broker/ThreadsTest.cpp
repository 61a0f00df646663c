#include "tests/objectmanager/broker/BrokerFixture.h"

#include <atomic>
#include <cerrno>
#include <chrono>
#include <cstdlib>
#include <ctime>

namespace om {
namespace {

class Threads : public BrokerFixture {
protected:
    const CMPIBrokerExtFT* xft = broker->xft;

    void* join(void* thread) {
        void* result = nullptr;
        EXPECT_EQ(xft->joinThread(thread, &result), 0);
        return result;
    }
};

TEST_F(Threads, AThreadRunsAndGivesItsResult) {
    int value = 0;
    void* thread = xft->newThread([](void* argument) -> void* { return argument; }, &value, 0);
    ASSERT_NE(thread, nullptr);
    EXPECT_EQ(join(thread), &value);
}

TEST_F(Threads, AThreadMayEndItself) {
    static const CMPIBrokerExtFT* table = nullptr;
    table = xft;
    int value = 0;
    void* thread = xft->newThread(
        [](void* argument) -> void* {
            table->exitThread(argument);
            return nullptr;
        },
        &value, 0);
    EXPECT_EQ(join(thread), &value);
}

TEST_F(Threads, ASleepingThreadCanBeCancelled) {
#ifdef __SANITIZE_ADDRESS__
    GTEST_SKIP() << "the address sanitizer takes the frames that a cancelled thread leaves for an overflow";
#endif
    static const CMPIBrokerExtFT* table = nullptr;
    table = xft;
    void* thread = xft->newThread(
        [](void*) -> void* {
            table->threadSleep(60'000);
            return nullptr;
        },
        nullptr, 0);
    EXPECT_EQ(xft->cancelThread(thread), 0);
    EXPECT_EQ(join(thread), PTHREAD_CANCELED);
}

TEST_F(Threads, SleepIsInMilliseconds) {
    const auto start = std::chrono::steady_clock::now();
    EXPECT_EQ(xft->threadSleep(20), 0);
    EXPECT_GE(std::chrono::steady_clock::now() - start, std::chrono::milliseconds(20));
}

struct Once {
    const CMPIBrokerExtFT* table;
    int variable = 0;
};
std::atomic<int> initialised{0};

TEST_F(Threads, AFunctionRunsOnceHoweverManyAsk) {
    initialised = 0;
    Once once{xft};
    void* threads[4];
    for (void*& thread : threads) {
        thread = xft->newThread(
            [](void* argument) -> void* {
                auto* given = static_cast<Once*>(argument);
                given->table->threadOnce(&given->variable, [] { ++initialised; });
                return reinterpret_cast<void*>(static_cast<std::intptr_t>(initialised.load()));
            },
            &once, 0);
    }
    for (void* thread : threads) EXPECT_EQ(join(thread), reinterpret_cast<void*>(1));
    EXPECT_EQ(initialised, 1);
}

TEST_F(Threads, AFunctionThatThrowsRunsAgain) {
    initialised = 0;
    int variable = 0;
    const auto throwFirst = [] {
        if (++initialised == 1) throw 1;
    };
    EXPECT_NE(xft->threadOnce(&variable, throwFirst), 0);
    EXPECT_EQ(xft->threadOnce(&variable, throwFirst), 0);
    EXPECT_EQ(xft->threadOnce(&variable, throwFirst), 0);
    EXPECT_EQ(initialised, 2);
}

TEST_F(Threads, KeysHaveFourBytesAndValuesForEachThread) {
    struct {
        CMPIUint32 key = 0;
        CMPIUint32 beside = 0xABCDEF01;
    } place;
    ASSERT_EQ(xft->createThreadKey(reinterpret_cast<CMPI_THREAD_KEY_TYPE*>(&place.key), nullptr), 0);
    EXPECT_EQ(place.beside, 0xABCDEF01U);
    int value = 0;
    EXPECT_EQ(xft->getThreadSpecific(place.key), nullptr);
    EXPECT_EQ(xft->setThreadSpecific(place.key, &value), 0);
    EXPECT_EQ(xft->getThreadSpecific(place.key), &value);
    EXPECT_EQ(xft->destroyThreadKey(place.key), 0);
}

TEST_F(Threads, MutexesAreRecursive) {
    void* mutex = xft->newMutex(0);
    ASSERT_NE(mutex, nullptr);
    xft->lockMutex(mutex);
    xft->lockMutex(mutex);
    xft->unlockMutex(mutex);
    xft->unlockMutex(mutex);
    xft->destroyMutex(mutex);
}

struct Meeting {
    const CMPIBrokerExtFT* table;
    void* mutex;
    void* condition;
    bool arrived = false;
};

TEST_F(Threads, ASignalWakesAWaiter) {
    Meeting meeting{xft, xft->newMutex(0), xft->newCondition(0)};
    void* thread = xft->newThread(
        [](void* argument) -> void* {
            auto* given = static_cast<Meeting*>(argument);
            given->table->lockMutex(given->mutex);
            given->arrived = true;
            given->table->signalCondition(given->condition);
            given->table->unlockMutex(given->mutex);
            return nullptr;
        },
        &meeting, 0);
    xft->lockMutex(meeting.mutex);
    while (!meeting.arrived) EXPECT_EQ(xft->condWait(meeting.condition, meeting.mutex), 0);
    xft->unlockMutex(meeting.mutex);
    join(thread);
    xft->destroyCondition(meeting.condition);
    xft->destroyMutex(meeting.mutex);
}

TEST_F(Threads, ATimedWaitEndsAtAnAbsoluteTime) {
    void* mutex = xft->newMutex(0);
    void* condition = xft->newCondition(0);
    xft->lockMutex(mutex);
    timespec until{};
    clock_gettime(CLOCK_REALTIME, &until);
    EXPECT_EQ(xft->timedCondWait(condition, mutex, &until), ETIMEDOUT);
    xft->unlockMutex(mutex);
    xft->destroyCondition(condition);
    xft->destroyMutex(mutex);
}

TEST_F(Threads, LibraryNamesAreResolved) {
    char* name = xft->resolveFileName("thing");
    EXPECT_STREQ(name, "libthing.so");
    std::free(name);
}

} // namespace
} // namespace om
