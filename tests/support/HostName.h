#pragma once

#include <string>

#include <sys/utsname.h>

namespace test {

/// The name of the host that runs the tests.
inline std::string hostName() {
    utsname names{};
    uname(&names);
    return names.nodename;
}

} // namespace test
