// What standard error is spared of, in the program itself.
#include "tests/objectmanager/vkcim/AskedEcho.h"
#include "tests/support/TemporaryDirectory.h"

#include <gmock/gmock.h>

namespace {

using nlohmann::json;
using support::Outcome;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::Not;

/// A report on a host that lacks everything, the CIM server's command too, whatever this machine has.
Outcome report(std::vector<std::string> options, const char* sink) {
    const support::TemporaryDirectory host;
    const json product = {{"rootDirectory", host.path("platform/")}, {"kvm", false}};
    host.write("tree.json", json::object({{"product", product}, {"nodes", json::array()}}).dump());
    options.insert(options.begin(), {VKCIM, "report"});
    return support::runCommand(options, "",
                               {{"VK_INSTRUMENTATION_TREE", host.path("tree.json")}, {"NVLOG_SINK", sink}});
}

TEST(QuietErrors, KeepWhatCommandsPrintFromAReport) {
    const Outcome quiet = report({}, "none");
    EXPECT_EQ(quiet.status, 0);
    EXPECT_THAT(quiet.error, IsEmpty());
    EXPECT_THAT(quiet.output, HasSubstr("cimconfig: the delivery settings")) << "the note says it";
    EXPECT_THAT(report({"--verbose"}, "none").error, HasSubstr("cimconfig: not found\n"));
}

TEST(QuietErrors, LetLogLinesThatWereAskedForThrough) {
    const Outcome logged = report({}, "stderr");
    EXPECT_THAT(logged.error, HasSubstr(" LOG 3000 "));
    EXPECT_THAT(logged.error, Not(HasSubstr("not found\n")));
}

TEST(QuietErrors, LetTheMessagesOfTheProgramThrough) {
    const Outcome unreadable =
        support::runCommand({VKCIM, "report"}, "", {{"VK_INSTRUMENTATION_ROOT", "/nowhere"}, {"NVLOG_SINK", "none"}});
    EXPECT_EQ(unreadable.error, "vkcim: the host cannot be read: /nowhere: No such file or directory\n");
    EXPECT_EQ(unreadable.status, 4);
}

} // namespace
