// The real syslog of the C library and a daemon's socket at /dev/log, in processes that are forked while threads log.

#include "nvlog/NVLogger.h"
#include "support/Isolated.h"
#include "support/TemporaryDirectory.h"
#include "system/Namespaces.h"

#include <gmock/gmock.h>

#include <array>
#include <atomic>
#include <cerrno>
#include <csignal>
#include <cstring>
#include <filesystem>
#include <optional>
#include <poll.h>
#include <stdexcept>
#include <sys/mount.h>
#include <sys/socket.h>
#include <sys/un.h>
#include <thread>

namespace {

namespace fs = std::filesystem;

void log(const std::string& text) {
    NVLog::NVLogger::logLevelMessage("run", "ForkedSyslogTest", 7, "Norvane.Test", 6000, nullptr, 0, 0, text);
}

/// A /dev of the test's own: everything that the host's has, but for its syslog.
class OwnDevices {
public:
    OwnDevices() {
        fs::create_directory(kept);
        if (mount("/dev", kept.c_str(), nullptr, MS_BIND | MS_REC, nullptr) != 0)
            throw std::runtime_error(std::string("binding /dev: ") + std::strerror(errno));
        covered.emplace("/dev");
        for (const fs::directory_entry& entry : fs::directory_iterator(kept))
            if (entry.path().filename() != "log") fs::create_symlink(entry.path(), "/dev" / entry.path().filename());
    }
    ~OwnDevices() {
        covered.reset();
        umount2(kept.c_str(), MNT_DETACH);
    }
    OwnDevices(const OwnDevices&) = delete;
    OwnDevices& operator=(const OwnDevices&) = delete;

private:
    const support::TemporaryDirectory directory;
    const fs::path kept = directory.path("dev");
    std::optional<test::CoveredDirectory> covered;
};

/// A syslog daemon's socket at /dev/log.
class Daemon {
public:
    explicit Daemon(int type) : descriptor(socket(AF_UNIX, type | SOCK_CLOEXEC, 0)) {
        sockaddr_un address{};
        address.sun_family = AF_UNIX;
        std::strcpy(address.sun_path, "/dev/log");
        const bool bound = bind(descriptor, reinterpret_cast<const sockaddr*>(&address), sizeof address) == 0;
        if (!bound || (type == SOCK_STREAM && listen(descriptor, 8) != 0))
            throw std::runtime_error(std::string("a socket at /dev/log: ") + std::strerror(errno));
    }
    ~Daemon() {
        close(descriptor);
        fs::remove("/dev/log");
    }
    Daemon(const Daemon&) = delete;
    Daemon& operator=(const Daemon&) = delete;

    /// The next message that somebody sent; empty when none comes for a while.
    std::string next(int milliseconds) const { return receive(descriptor, milliseconds); }
    /// The same from the next sender that connects.
    std::string nextOfStream() const {
        const int sender = accept(descriptor, nullptr, nullptr);
        const std::string text = receive(sender, 10000);
        close(sender);
        return text;
    }

private:
    static std::string receive(int from, int milliseconds) {
        pollfd readable{from, POLLIN, 0};
        std::array<char, 4096> text{};
        if (poll(&readable, 1, milliseconds) != 1) return {};
        const ssize_t size = recv(from, text.data(), text.size(), 0);
        return {text.data(), static_cast<std::size_t>(size > 0 ? size : 0)};
    }

    const int descriptor;
};

class ForkedSyslog : public test::NamespaceTest {
protected:
    void SetUp() override {
        NamespaceTest::SetUp();
        for (const char* name : {"NVLOG_SINK", "NVLOG_LEVELS", "NVLOG_CHANNELS"}) unsetenv(name);
        if (!IsSkipped()) devices.emplace();
    }

    /// Forks a child that logs a line, killed by SIGALRM if it hangs: its process.
    static pid_t logInChild() {
        const pid_t child = fork();
        if (child != 0) return child;
        alarm(30);
        log("from a child");
        _exit(0);
    }
    static int statusOf(pid_t child) {
        int status = -1;
        while (waitpid(child, &status, 0) < 0 && errno == EINTR) {
        }
        return status;
    }

    std::optional<OwnDevices> devices;
};

TEST_F(ForkedSyslog, NeverMakesAChildHangWhileOtherThreadsLog) {
    test::isolated([] {
        const Daemon daemon(SOCK_DGRAM);
        std::atomic<bool> stop{false};
        std::atomic<bool> allSent{false};
        std::thread reader([&] {
            while (!allSent) daemon.next(10);
        });
        std::array<std::thread, 4> loggers;
        for (std::thread& logger : loggers)
            logger = std::thread([&] {
                while (!stop) log("from a thread");
            });
        int hung = 0;
        for (int i = 0; i < 200 && hung == 0; ++i) hung += statusOf(logInChild()) == 0 ? 0 : 1;
        stop = true;
        for (std::thread& logger : loggers) logger.join(); // one may wait until its line is read
        allSent = true;
        reader.join();
        EXPECT_EQ(hung, 0);
    });
}

TEST_F(ForkedSyslog, GetsTheChildsLineThroughTheDaemonsSocketOfEitherType) {
    test::isolated([] {
        std::thread([] {}).join();
        for (const int type : {SOCK_DGRAM, SOCK_STREAM}) {
            const Daemon daemon(type);
            const pid_t child = logInChild();
            const std::string end(type == SOCK_STREAM ? 1 : 0, '\0');
            EXPECT_EQ(type == SOCK_STREAM ? daemon.nextOfStream() : daemon.next(10000),
                      "<11>" + std::string(program_invocation_short_name) + "[" + std::to_string(child) +
                          "]: LOG 6000 Norvane.Test ForkedSyslogTest:7 run: from a child" + end);
            EXPECT_EQ(statusOf(child), 0);
        }
    });
}

TEST_F(ForkedSyslog, LosesAChildsLineWhereNoDaemonListens) {
    test::isolated([] {
        std::thread([] {}).join();
        EXPECT_EQ(statusOf(logInChild()), 0);
    });
}

} // namespace
