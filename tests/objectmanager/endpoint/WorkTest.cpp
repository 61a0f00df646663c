#include "objectmanager/endpoint/Work.h"

#include <gmock/gmock.h>

namespace endpoint {
namespace {

TEST(Work, TheFirstReasonForAnAnswerThatEndsTooEarlyIsLogged) {
    Work work;
    work.connection = std::make_shared<Connection>();
    work.breakOff("the answer cannot be written: no memory");
    work.breakOff("the client did not take the answer");
    EXPECT_THAT(work.logLine(), testing::ContainsRegex("us=[0-9]+: the answer cannot be written: no memory$"));
}

} // namespace
} // namespace endpoint
