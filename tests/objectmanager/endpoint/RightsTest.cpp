#include "objectmanager/endpoint/Rights.h"

#include <gmock/gmock.h>

#include <nss.h>
#include <sys/resource.h>
#include <unistd.h>

#include <cstdlib>
#include <system_error>

namespace endpoint {
namespace {

TEST(Rights, OfRootAreAllAndOfNobodyInParticularNone) {
    EXPECT_TRUE(rightsOf(std::string("root")).mayChange);
    EXPECT_TRUE(rightsOf(uid_t{0}).mayChange);
    EXPECT_FALSE(rightsOf(std::string("nobody-of-this-name")).mayRead);
    EXPECT_FALSE(rightsOf(uid_t{4000000000U}).mayRead);
}

/// 0 where it is said that the rights cannot be known, in a process that can open no file any more.
[[noreturn]] void askWithoutDescriptors() {
    __nss_configure_lookup("passwd", "files"); // whatever else this host asks
    const rlimit none = {0, 0};
    setrlimit(RLIMIT_NOFILE, &none);
    try {
        rightsOf(std::string("root"));
    } catch (const std::system_error& error) {
        _exit(error.code().value() == EMFILE ? 0 : 2);
    }
    _exit(1);
}

TEST(Rights, AreNotThoseOfNobodyWhereTheyCannotBeLookedUp) {
#ifdef __SANITIZE_ADDRESS__
    GTEST_SKIP() << "the undefined-behaviour sanitizer looks at an object's type through a pipe";
#endif
    EXPECT_EXIT(askWithoutDescriptors(), testing::ExitedWithCode(0), "");
}

} // namespace
} // namespace endpoint
