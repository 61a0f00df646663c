#pragma once

#include <cerrno>
#include <cstdio>
#include <exception>
#include <functional>
#include <gtest/gtest.h>
#include <sys/wait.h>
#include <unistd.h>
#ifdef VK_COVERAGE
extern "C" void __gcov_dump();
#endif

namespace test {

/// Writes what a process has counted for coverage, which _exit would lose.
inline void keepCoverage() {
#ifdef VK_COVERAGE
    __gcov_dump();
#endif
}

/// Runs a part of a test in a process of its own, for what the libraries read once per process and for what changes the
/// process. Its failures are printed there and fail the calling test.
inline void isolated(const std::function<void()>& body) {
    std::fflush(nullptr);
    const pid_t child = fork();
    ASSERT_GE(child, 0);
    if (child == 0) {
        try {
            body();
        } catch (const std::exception& exception) {
            ADD_FAILURE() << "an exception came out: " << exception.what();
        }
        std::fflush(nullptr);
        keepCoverage();
        _exit(testing::Test::HasFailure() ? 1 : 0); // the parent's objects are not the child's to destroy
    }
    int status = 0;
    while (waitpid(child, &status, 0) < 0) ASSERT_EQ(errno, EINTR);
    EXPECT_TRUE(WIFEXITED(status)) << "killed by signal " << WTERMSIG(status);
    EXPECT_EQ(WEXITSTATUS(status), 0) << "the part that ran in a process of its own failed, as printed above";
}

} // namespace test
