#include "objectmanager/vkcim/FaultText.h"

#include <gmock/gmock.h>

namespace vkcim {
namespace {

using testing::HasSubstr;
using testing::ThrowsMessage;

TEST(FaultText, GoodTextsAreRead) {
    const om::Fault third = parseFault("setProperty:3");
    EXPECT_EQ(third.kind, om::FaultKind::setProperty);
    EXPECT_EQ(third.call, 3u);
    EXPECT_FALSE(third.lasting || third.unstated);
    const om::Fault all = parseFault("newObjectPath:1+");
    EXPECT_EQ(all.kind, om::FaultKind::newObjectPath);
    EXPECT_TRUE(all.lasting);
    EXPECT_TRUE(parseFault("getKey:18446744073709551615:null").unstated);
    const om::Fault both = parseFault("getKey:2+:null");
    EXPECT_EQ(both.call, 2u);
    EXPECT_TRUE(both.lasting && both.unstated);
}

TEST(FaultText, BadTextsAreRefused) {
    for (const char* unknown : {"", "None:1", "setproperty:1", "setProperty :1", ":1"})
        EXPECT_THAT([&] { parseFault(unknown); }, ThrowsMessage<std::runtime_error>(HasSubstr("no broker operation")));
    for (const char* number : {"getKey", "getKey:", "getKey:0", "getKey:-1", "getKey:+1", "getKey:1x", "getKey: 1",
                               "getKey:1:nul", "getKey:1:null+", "getKey:1++", "getKey:18446744073709551616"})
        EXPECT_THAT([&] { parseFault(number); }, ThrowsMessage<std::runtime_error>(HasSubstr("is not KIND:N")))
            << number;
}

TEST(FaultText, TheListHoldsWhatIsRead) {
    const std::string list = faultList();
    EXPECT_EQ(std::count(list.begin(), list.end(), '\n') + 1, static_cast<long>(om::faultNames().size()));
    for (const std::string& name : om::faultNames()) {
        EXPECT_THAT(list, HasSubstr(name));
        EXPECT_NO_THROW(parseFault(name + ":1"));
    }
}

} // namespace
} // namespace vkcim
