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

namespace {

std::function<void()> logging;

} // namespace

namespace NVLog {

void NVLogger::logLevelMessage(const char*, const char*, int, const std::string&, int, char*, int, int,
                               const std::string&) {
    logging();
}

void NVLogger::traceLevelMessage(const char*, const char*, int, const std::string&, int, char*, int, int,
                                 const std::string&) {}

} // namespace NVLog

namespace {

const std::string category("Norvane.BaseServerProvider");
const VK::TraceSource source{category, "Sample"};

TEST(ThrowingLogger, IsHeardWhereItThrowsAStandardException) {
    logging = [] { throw std::bad_alloc(); };
    EXPECT_THROW(VK::traceMethod(source), std::bad_alloc);
    EXPECT_THROW(VK::ParameterTraceScope(source, " count=", 7U), std::bad_alloc);
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
    expectFailure([] { VK::traceMethod(source); });
    expectFailure([] { const VK::ParameterTraceScope scope(source, " count=", 7U); });
}

TEST(ThrowingLogger, IsNotHeardAtTheEndOfAScope) {
    for (const bool standard : {false, true}) {
        logging = [] {};
        EXPECT_NO_THROW({
            const VK::TraceScope scope(source);
            const VK::ParameterTraceScope parameters(source, " count=", 7U);
            logging = [standard] {
                if (standard) throw std::bad_alloc();
                throw 42;
            };
            const VK::DestructorTraceScope destructor(source);
            VK::traceDestructor(source);
        });
    }
}

void* leaveThread(void*) {
    static int answer = 0;
    logging = [] { pthread_exit(&answer); };
    VK::traceMethod(source);
    return nullptr;
}

TEST(ThrowingLogger, MayEndItsThread) {
#ifdef __SANITIZE_ADDRESS__
    GTEST_SKIP() << "what ends a thread is caught as a reference to nothing, which the sanitizers report";
#endif
    pthread_t thread{};
    ASSERT_EQ(pthread_create(&thread, nullptr, leaveThread, nullptr), 0);
    void* answer = nullptr;
    ASSERT_EQ(pthread_join(thread, &answer), 0);
    EXPECT_NE(answer, nullptr) << "the thread went on";
}

} // namespace
