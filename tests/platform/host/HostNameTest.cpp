#include "host/State.h"

#include <gtest/gtest.h>

#include <cerrno>
#include <cstring>
#include <unistd.h>

namespace {

enum Behaviour { Works, Fails, LeavesNoEnd, SaysNothing } behaviour = Works;

} // namespace

/// Takes the place of the system's.
extern "C" __attribute__((visibility("default"))) int gethostname(char* name, std::size_t length) noexcept {
    switch (behaviour) {
    case Works:
        std::strncpy(name, "node7", length);
        return 0;
    case Fails:
        errno = ENAMETOOLONG;
        return -1;
    case LeavesNoEnd:
        std::memset(name, 'n', length);
        return 0;
    default:
        return 0;
    }
}

namespace VK::Host {

namespace {

TEST(HostName, IsTheKernels) {
    behaviour = Works;
    EXPECT_EQ(hostName(Root("/")), "node7");
}

TEST(HostName, IsAbsentWhenItCannotBeTold) {
    behaviour = Fails;
    EXPECT_EQ(hostName(Root("/")), std::nullopt);
    behaviour = SaysNothing;
    EXPECT_EQ(hostName(Root("/")), std::nullopt);
}

TEST(HostName, WithoutEndIsCutAtTheBuffersSize) {
    behaviour = LeavesNoEnd;
    EXPECT_EQ(hostName(Root("/")), std::string(128, 'n'));
}

} // namespace

} // namespace VK::Host
