#include "objectmanager/endpoint/Log.h"

#include "objectmanager/endpoint/Work.h"

#include <gmock/gmock.h>

namespace endpoint {
namespace {

std::string written(const std::string& line) {
    testing::internal::CaptureStderr();
    log(line);
    return testing::internal::GetCapturedStderr();
}

TEST(Log, EscapesWhatCouldEndALine) {
    EXPECT_EQ(written("a\nvkcimd: b\x1b"), "vkcimd: a\\x0avkcimd: b\\x1b\n");
}

TEST(Log, CutsALineThatIsTooLongForTheJournal) {
    EXPECT_EQ(written(std::string(100000, 'x')), "vkcimd: " + std::string(1024, 'x') + '\n');
    const std::string escaped = written("abc" + std::string(1000, '\n'));
    EXPECT_EQ(escaped.substr(escaped.size() - 9), "\\x0a\\x0a\n"); // no half of an escape
}

TEST(Log, QuotesATextOfAClientSoThatItStaysOneWord) {
    EXPECT_EQ(logged(""), "-");
    EXPECT_EQ(logged("VESKA_TimeService"), "VESKA_TimeService");
    EXPECT_EQ(logged("a b"), "\"a b\"");
    EXPECT_EQ(logged("a\" http=200 \""), "\"a\\x22 http=200 \\x22\"");
    EXPECT_EQ(logged("a\\x0a"), "a\\x5cx0a");
}

TEST(Log, NamesNeverPushTheStatusOutOfALine) {
    Work work;
    work.connection = std::make_shared<Connection>();
    work.connection->address = "192.0.2.7";
    const std::string longName(100000, '\n');
    work.caller.user = longName;
    HttpAnswer answer = plainAnswer(400, std::string(100000, '\x01'));
    answer.operation = answer.nameSpace = answer.className = longName;
    work.finish(answer);
    const std::string line = written(work.logLine());
    EXPECT_LT(line.size(), 1100U);
    EXPECT_THAT(line, testing::HasSubstr(" http=400 cim=0 us="));
}

TEST(Log, ADetailOfAClientIsCut) {
    Work work;
    work.connection = std::make_shared<Connection>();
    work.finish(plainAnswer(400, "path /" + std::string(48000, 'x')));
    EXPECT_THAT(work.logLine(), testing::EndsWith(": path /" + std::string(250, 'x')));
}

} // namespace
} // namespace endpoint
