#pragma once

#include <array>
#include <cerrno>
#include <cstdio>
#include <cstdlib>
#include <functional>
#include <gtest/gtest.h>
#include <string>
#include <sys/wait.h>
#include <unistd.h>

namespace support {

/// Runs something in a child process of its own, for what is chosen once per process: the text that it answers, or why
/// the child ended otherwise (98: one of its expectations failed).
inline std::string inChild(const std::function<std::string()>& run) {
    std::array<int, 2> ends{};
    std::fflush(nullptr);
    if (pipe2(ends.data(), 0) != 0) return "no pipe";
    const pid_t child = fork();
    if (child < 0) return "no child";
    if (child == 0) {
        close(ends[0]);
        const std::string text = run();
        const bool whole = write(ends[1], text.data(), text.size()) == static_cast<ssize_t>(text.size());
        close(ends[1]);
        std::exit(testing::Test::HasFailure() ? 98 : whole ? 0 : 99);
    }
    close(ends[1]);
    std::string text;
    std::array<char, 4096> chunk{};
    for (ssize_t count = 0; (count = read(ends[0], chunk.data(), chunk.size())) > 0 || (count < 0 && errno == EINTR);)
        if (count > 0) text.append(chunk.data(), static_cast<std::size_t>(count));
    close(ends[0]);
    int status = 0;
    while (waitpid(child, &status, 0) < 0 && errno == EINTR) {
    }
    if (WIFSIGNALED(status)) return "the child was killed by signal " + std::to_string(WTERMSIG(status));
    if (WEXITSTATUS(status) != 0) return "the child exited with " + std::to_string(WEXITSTATUS(status));
    return text;
}

/// The same for what answers nothing; fails where one of its expectations did.
inline void inOwnProcess(const std::function<void()>& run) {
    EXPECT_EQ(inChild([&] {
                  run();
                  return std::string();
              }),
              "");
}

} // namespace support
