#include "system/Namespaces.h"

#include <gmock/gmock.h>

#include <cerrno>
#include <csignal>
#include <cstring>
#include <fstream>
#include <sched.h>
#include <stdexcept>
#include <sys/mount.h>
#include <sys/prctl.h>
#include <sys/wait.h>
#include <unistd.h>

namespace test {
namespace {

/// Why the tests cannot run; empty where they can.
std::string reason = "the test program was started without namespaces";

std::string failure(const std::string& what) {
    return what + ": " + std::strerror(errno);
}

void checked(int result, const std::string& what) {
    if (result != 0) throw std::runtime_error(failure(what));
}

bool write(const std::string& path, const std::string& text) {
    std::ofstream file(path);
    file << text << std::flush;
    return file.good();
}

/// New namespaces for what this process starts: as root by right, else within a user namespace in which it is root.
bool leaveHost() {
    constexpr int wanted = CLONE_NEWNS | CLONE_NEWUTS | CLONE_NEWPID;
    if (unshare(wanted) == 0) return true;
    const std::string user = std::to_string(geteuid());
    const std::string group = std::to_string(getegid());
    return unshare(wanted | CLONE_NEWUSER) == 0 && write("/proc/self/setgroups", "deny") &&
           write("/proc/self/uid_map", "0 " + user + " 1") && write("/proc/self/gid_map", "0 " + group + " 1");
}

/// Runs `work` in a child, and answers what it exits with; 128 and the signal where one ended it.
template <class Work>
int inChild(Work work) {
    std::fflush(nullptr);
    const pid_t child = fork();
    if (child == 0) {
        prctl(PR_SET_PDEATHSIG, SIGKILL);
        work();
    }
    int status = 0;
    while (waitpid(child, &status, 0) < 0)
        if (errno != EINTR) return 1;
    return WIFEXITED(status) ? WEXITSTATUS(status) : 128 + WTERMSIG(status);
}

/// What the first process of the new namespaces does.
[[noreturn]] void runInside() {
    if (mount(nullptr, "/", nullptr, MS_REC | MS_PRIVATE, nullptr) != 0)
        reason = failure("mounts cannot be made private");
    else if (mount("proc", "/proc", "proc", MS_NOSUID | MS_NOEXEC | MS_NODEV, nullptr) != 0)
        reason = failure("/proc cannot be mounted");
    else
        reason.clear();
    std::exit(RUN_ALL_TESTS());
}

/// What the process between does, which can start nothing more once the namespaces' first process is gone; a sanitizer
/// would want to, at a usual exit.
[[noreturn]] void leaveAndRun() {
    if (leaveHost()) _exit(inChild(runInside));
    reason = failure("this machine allows no namespaces");
    std::exit(RUN_ALL_TESTS());
}

} // namespace

void NamespaceTest::SetUp() {
    if (!reason.empty()) GTEST_SKIP() << reason;
}

CoveredDirectory::CoveredDirectory(const std::filesystem::path& theDirectory) : directory(theDirectory) {
    // A chroot may have no /sys: then all of it is covered, with the directory that was asked for.
    if (!exists(directory)) {
        below.emplace_back(directory.parent_path());
        create_directory(directory);
    }
    checked(mount("tmpfs", directory.c_str(), "tmpfs", MS_NOSUID | MS_NODEV, "mode=755"),
            "covering " + directory.string());
}

CoveredDirectory::~CoveredDirectory() {
    umount2(directory.c_str(), MNT_DETACH);
}

void nameHost(const std::string& name) {
    checked(sethostname(name.data(), name.size()), "naming the host");
}

} // namespace test

/// Asked by the leak sanitizer, where one is built in. That of gcc 12 fails by itself, in some layouts of memory, when
/// it looks at what a forked process that loaded the provider keeps for its threads.
extern "C" __attribute__((visibility("default"))) const char* __lsan_default_options();
const char* __lsan_default_options() {
    return "use_tls=0";
}

int main(int count, char** arguments) {
    testing::InitGoogleMock(&count, arguments);
    return testing::GTEST_FLAG(list_tests) ? RUN_ALL_TESTS() : test::inChild(test::leaveAndRun);
}
