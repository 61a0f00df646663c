#include "Linux/HostName.h"

#include <gtest/gtest.h>
#include <string>
#include <sys/utsname.h>
#include <unistd.h>

namespace {

/// What the kernel's answer is to be: bytes to leave in the field, and the result.
struct Answer {
    std::string bytes;
    int result = 0;
};
const Answer* answer = nullptr;
size_t lengthAsked = 0;

} // namespace

/// Stands before the C library's function.
extern "C" int gethostname(char* name, size_t length) noexcept {
    lengthAsked = length;
    if (answer != nullptr) {
        answer->bytes.copy(name, length);
        return answer->result;
    }
    utsname names{};
    const int result = uname(&names);
    std::string(names.nodename).copy(name, length);
    return result;
}

namespace {

using VK::BaseServerProvider::HostName;

std::string textFor(const Answer& given) {
    answer = &given;
    const std::string text = HostName().text();
    answer = nullptr;
    return text;
}

TEST(HostName, IsTheKernelsNodeName) {
    utsname names{};
    ASSERT_EQ(uname(&names), 0);
    EXPECT_EQ(HostName().text(), names.nodename);
    EXPECT_EQ(lengthAsked, 128U);
}

TEST(HostName, OfTheWholeFieldWithoutATerminatorEndsWithTheField) {
    EXPECT_EQ(textFor({std::string(128, 'h')}), std::string(128, 'h'));
}

TEST(HostName, OfMoreThanTheFieldIsCut) {
    EXPECT_EQ(textFor({std::string(200, 'h'), -1}), std::string(128, 'h'));
}

TEST(HostName, EndsAtItsTerminator) {
    using namespace std::string_literals;
    EXPECT_EQ(textFor({"node7\0rest"s}), "node7");
}

TEST(HostName, IsEmptyWhenTheKernelTellsNothing) {
    EXPECT_EQ(textFor({"", -1}), "");
}

} // namespace
