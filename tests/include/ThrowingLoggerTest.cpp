// This program's own logger, which stands before the product's.
#pragma GCC visibility push(default)
#include "nvlog/NVLogger.h"
#pragma GCC visibility pop

#include "include/Trace.h"

#include <gtest/gtest.h>

#include <functional>
#include <new>
#include <pthread.h>
#include <stdexcept>
#include <vector>

namespace {

std::function<void()> logging;
std::vector<const char*> logged; ///< the texts' own characters
std::vector<const char*> traced;

void expectNothing(const char* reserved, int reserved1, int reserved2) {
    EXPECT_EQ(reserved, nullptr);
    EXPECT_EQ(reserved1, 0);
    EXPECT_EQ(reserved2, 0);
}

} // namespace

namespace NVLog {

void NVLogger::logLevelMessage(const char*, const char*, int, const std::string&, int, char* reserved, int reserved1,
                               int reserved2, const std::string& text) {
    expectNothing(reserved, reserved1, reserved2);
    logged.push_back(text.data());
    logging();
}

void NVLogger::traceLevelMessage(const char*, const char*, int, const std::string&, int, char* reserved, int reserved1,
                                 int reserved2, const std::string& text) {
    expectNothing(reserved, reserved1, reserved2);
    traced.push_back(text.data());
}

} // namespace NVLog

namespace {

const std::string category("Norvane.BaseServerProvider");
const VK::TraceSource source{category, "Sample"};

TEST(ThrowingLogger, IsHeardWhereItThrowsAStandardException) {
    logging = [] { throw std::bad_alloc(); };
    EXPECT_THROW(VK::traceMethod(VK_METHOD(source)), std::bad_alloc);
    EXPECT_THROW(VK::ParameterTraceScope(VK_SCOPE(source), " count=", 7U), std::bad_alloc);
}

TEST(ThrowingLogger, IsHeardAsAStandardExceptionWhateverElseItThrows) {
    logging = [] { throw 42; };
    const auto expectFailure = [](const std::function<void()>& trace) {
        try {
            trace();
            ADD_FAILURE() << "nothing was thrown";
        } catch (const std::runtime_error& failure) {
            EXPECT_STREQ(failure.what(), "The logger failed");
        }
    };
    expectFailure([] { VK::traceMethod(VK_METHOD(source)); });
    expectFailure([] { const VK::ParameterTraceScope scope(VK_SCOPE(source), " count=", 7U); });
}

TEST(ThrowingLogger, IsNotHeardAtTheEndOfAScope) {
    for (const bool standard : {false, true}) {
        logging = [] {};
        EXPECT_NO_THROW({
            const VK::TraceScope scope(VK_SCOPE(source));
            const VK::ParameterTraceScope parameters(VK_SCOPE(source), " count=", 7U);
            logging = [standard] {
                if (standard) throw std::bad_alloc();
                throw 42;
            };
            const VK::DestructorTraceScope destructor(VK_SCOPE(source));
            VK::traceDestructor(VK_METHOD(source));
        });
    }
}

/// Ends its thread, in either way. A cancellation that is put off stays pending.
void leaveByExit() {
    static int answer = 0;
    pthread_exit(&answer);
}
void leaveByCancellation() {
    pthread_cancel(pthread_self());
    pthread_testcancel();
}

/// Whether a thread that runs `lines` ends before it comes to their end, and what it owns is destroyed on the way.
bool endsThread(const std::function<void()>& lines) {
    struct Run {
        const std::function<void()>& lines;
        bool unwound = false;
        bool wentOn = false;
    } run{lines};
    const auto start = [](void* argument) -> void* {
        Run& all = *static_cast<Run*>(argument);
        struct Owned {
            bool& gone;
            ~Owned() { gone = true; }
        };
        const Owned owned{all.unwound};
        all.lines();
        all.wentOn = true;
        return nullptr;
    };
    logging = [] {};
    pthread_t thread{};
    EXPECT_EQ(pthread_create(&thread, nullptr, start, &run), 0);
    EXPECT_EQ(pthread_join(thread, nullptr), 0);
    EXPECT_TRUE(run.unwound);
    return !run.wentOn;
}

// A line is formatted once, and the same bytes are handed over twice.
TEST(Logger, IsHandedTheSameTextTwice) {
    logging = [] {};
    logged.clear();
    traced.clear();
    {
        const VK::ParameterTraceScope scope(VK_SCOPE(source), " count=", 7U);
        VK::traceVariable(source, "name", "a value that is longer than a short string is inside");
        VK::traceMessage(source, "text", VK::FailureLevel);
    }
    EXPECT_EQ(logged.size(), 4U);
    EXPECT_EQ(logged, traced);
}

class EndedThread : public testing::TestWithParam<void (*)()> {};

TEST_P(EndedThread, IsUnwoundFromALine) {
    EXPECT_TRUE(endsThread([] {
        logging = GetParam();
        VK::traceMethod(VK_METHOD(source));
    }));
}

TEST_P(EndedThread, IsUnwoundFromTheEntryOfAScope) {
    EXPECT_TRUE(endsThread([] {
        logging = GetParam();
        const VK::ParameterTraceScope scope(VK_SCOPE(source), " count=", 7U);
    }));
    EXPECT_TRUE(endsThread([] {
        logging = GetParam();
        const VK::DestructorTraceScope scope(VK_SCOPE(source));
    }));
}

template <class Scope, class... Parameters>
void leaveAtTheEnd(const Parameters&... parameters) {
    const Scope scope(VK_SCOPE(source), parameters...);
    logging = [] {
        const auto leave = EndedThread::GetParam();
        logging = [] {};
        leave();
    };
}

TEST_P(EndedThread, IsUnwoundFromTheEndOfAScope) {
    EXPECT_TRUE(endsThread([] { leaveAtTheEnd<VK::TraceScope>(); }));
    EXPECT_TRUE(endsThread([] { leaveAtTheEnd<VK::ParameterTraceScope>(" count=", 7U); }));
    EXPECT_TRUE(endsThread([] { leaveAtTheEnd<VK::DestructorTraceScope>(); }));
}

TEST_P(EndedThread, IsUnwoundFromADestructorsLine) {
    EXPECT_TRUE(endsThread([] {
        logging = GetParam();
        VK::traceDestructor(VK_METHOD(source));
    }));
}

INSTANTIATE_TEST_SUITE_P(, EndedThread, testing::Values(leaveByExit, leaveByCancellation),
                         [](const auto& each) { return each.index == 0 ? "ByExit" : "ByCancellation"; });

// Nothing but the exception can leave a destructor while it unwinds.
TEST(CancelledThread, EndsAfterTheScopesThatAnExceptionLeaves) {
    static bool caught = false;
    EXPECT_TRUE(endsThread([] {
        try {
            const VK::TraceScope outer(VK_SCOPE(source));
            const VK::ParameterTraceScope inner(VK_SCOPE(source), " count=", 7U);
            logging = leaveByCancellation;
            throw std::runtime_error("out");
        } catch (const std::runtime_error&) {
            caught = true;
        }
        pthread_testcancel();
    }));
    EXPECT_TRUE(caught);
}

} // namespace
