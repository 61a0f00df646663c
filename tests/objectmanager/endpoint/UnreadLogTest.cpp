#include "objectmanager/endpoint/Log.h"

#include <gtest/gtest.h>

#include <fcntl.h>
#include <unistd.h>

#include <string>

namespace endpoint {
namespace {

/// A pipe in the place of standard error.
class PipedLog {
public:
    PipedLog() {
        EXPECT_EQ(pipe2(ends, O_CLOEXEC), 0);
        dup2(ends[1], STDERR_FILENO);
    }
    ~PipedLog() {
        dup2(usual, STDERR_FILENO);
        for (const int each : {ends[0], ends[1], usual}) close(each);
    }
    PipedLog(const PipedLog&) = delete;
    PipedLog& operator=(const PipedLog&) = delete;

    void fill() const {
        fcntl(ends[1], F_SETFL, O_NONBLOCK);
        const std::string page(4096, 'x');
        while (write(ends[1], page.data(), page.size()) > 0) {
        }
        fcntl(ends[1], F_SETFL, 0);
    }

    std::string read() const {
        fcntl(ends[0], F_SETFL, O_NONBLOCK);
        std::string all;
        char bytes[4096];
        for (ssize_t count = 0; (count = ::read(ends[0], bytes, sizeof bytes)) > 0;)
            all.append(bytes, static_cast<std::size_t>(count));
        return all;
    }

private:
    int usual = fcntl(STDERR_FILENO, F_DUPFD_CLOEXEC, 0);
    int ends[2] = {-1, -1};
};

TEST(UnreadLog, LosesLinesAndStopsNobody) {
    std::string before;
    std::string after;
    {
        const PipedLog piped;
        piped.fill();
        log("lost");
        before = piped.read();
        log("read");
        after = piped.read();
    }
    EXPECT_EQ(before.find("lost"), std::string::npos);
    EXPECT_EQ(after, "vkcimd: read\n");
}

} // namespace
} // namespace endpoint
