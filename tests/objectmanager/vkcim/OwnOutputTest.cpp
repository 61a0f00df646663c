// Who prints where: the program on its standard output, everybody else on standard error.
#include "tests/objectmanager/vkcim/AskedEcho.h"
#include "tests/support/TemporaryDirectory.h"

#include <gmock/gmock.h>

#include <filesystem>

namespace {

using nlohmann::json;
using support::Outcome;
using testing::HasSubstr;
using testing::Not;

const std::string program = "'" VKCIM "' --library '" ECHO_PROVIDER "' --provider Echo ";

/// Runs the program by the shell, with a provider that prints on standard output.
Outcome loudly(const std::string& command) {
    return support::runCommand({"/bin/sh", "-c", command}, "", {{"ECHO_LOUD", "1"}});
}

std::size_t countOf(const std::string& word, const std::string& text) {
    std::size_t count = 0;
    for (std::size_t at = text.find(word); at != std::string::npos; at = text.find(word, at + 1)) ++count;
    return count;
}

TEST(OwnOutput, HoldsTheAnswerAloneWhateverTheProviderPrints) {
    const Outcome outcome = loudly(program + "--format json instances Echo_Thing");
    EXPECT_EQ(outcome.status, 0);
    EXPECT_EQ(json::parse(outcome.output).at("results").size(), 1u) << outcome.output;
    for (const char* way : {"loud write\n", "loud command\n", "loud buffer 1\n"})
        EXPECT_EQ(countOf(way, outcome.error), 3u) << "loading, answering and unloading: " << way << outcome.error;
}

TEST(OwnOutput, HoldsTheAnswerAloneInManyThreadsAndInAReport) {
    const Outcome threads = loudly(program + "--format json --threads 4 --repeat 3 instances Echo_Thing");
    EXPECT_EQ(json::parse(threads.output).at("results").size(), 1u) << threads.output;
    EXPECT_EQ(countOf("loud write\n", threads.error), 14u);
    const Outcome report = loudly(program + "--format json report");
    EXPECT_TRUE(json::parse(report.output).contains("classes")) << report.output;
    EXPECT_THAT(report.error, HasSubstr("loud command\n"));
}

TEST(OwnOutput, HoldsTheAnswerAloneOfAMethodThatRunsACommand) {
    const support::TemporaryDirectory host;
    host.write("vcm/bin/cimconfig",
               "#!/bin/sh\necho 'Planned value is set.'\nls -l /proc/self/fd >'" + host.path("descriptors") + "'\n");
    std::filesystem::permissions(host.path("vcm/bin/cimconfig"), std::filesystem::perms::owner_all);
    const json product = {{"rootDirectory", host.path("platform/")}, {"kvm", false}};
    host.write("tree.json", json::object({{"product", product}, {"nodes", json::array()}}).dump());
    const std::string output = host.path("output");
    const Outcome outcome =
        support::runCommand({"/bin/sh", "-c",
                             "exec '" VKCIM "' --format json invoke VESKA_CIMServiceConfig SetCIMconfig "
                             "deliveryRetryIntervalSec=30 >'" +
                                 output + "'"},
                            "", {{"VK_INSTRUMENTATION_TREE", host.path("tree.json")}, {"NVLOG_SINK", "none"}});
    EXPECT_EQ(outcome.status, 0);
    EXPECT_EQ(json::parse(host.read("output")).at("returnValue").at("value"), 0) << host.read("output");
    EXPECT_EQ(outcome.error, "Planned value is set.\n");
    EXPECT_THAT(host.read("descriptors"), HasSubstr(host.path("descriptors")));
    EXPECT_THAT(host.read("descriptors"), Not(HasSubstr(output))) << "a command could keep a pipeline open";
}

TEST(OwnOutput, ThatCannotBeWrittenIsSaidAndExitsWithOne) {
    for (const char* where : {">/dev/full", ">&-"}) {
        for (const char* words : {"names Echo_Thing", "--format json report", "--help"}) {
            const Outcome outcome = loudly(program + words + " " + where);
            EXPECT_EQ(outcome.status, 1) << words << where;
            EXPECT_THAT(outcome.error, HasSubstr(" cannot be written\n")) << words << where;
        }
    }
}

TEST(OwnOutput, IsTheAnswersAlsoWhereNoOtherStreamIsOpen) {
    for (const char* closed : {"2>&-", "<&-", "<&- 2>&-"}) {
        const Outcome outcome = loudly(program + "--format json instances Echo_Thing " + closed);
        EXPECT_EQ(outcome.status, 0) << closed;
        EXPECT_EQ(json::parse(outcome.output).at("results").size(), 1u) << closed << outcome.output;
        EXPECT_EQ(countOf("loud", outcome.output), 0u) << closed;
    }
    EXPECT_EQ(loudly(program + "names Echo_Thing <&- >&- 2>&-").status, 1);
}

} // namespace
