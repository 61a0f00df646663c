// The program itself, with a provider that answers what it was asked.
#include "tests/objectmanager/vkcim/AskedEcho.h"
#include "tests/support/TemporaryDirectory.h"

#include <gmock/gmock.h>

#include <filesystem>

namespace {

using echo::answer;
using echo::vkcim;
using echo::Words;
using nlohmann::json;
using support::Outcome;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::MatchesRegex;
using testing::Not;

TEST(Vkcim, AnotherStatusThanOkExitsWithOneAndIsNamed) {
    const Outcome failed = vkcim({"--format", "json", "instances", "Echo_Fail"});
    EXPECT_EQ(failed.status, 1);
    EXPECT_EQ(failed.error, "vkcim: CMPI_RC_ERR_FAILED (1): asked to\\x1b fail\n");
    EXPECT_EQ(json::parse(failed.output).at("status"),
              json::parse(R"({"code":1,"name":"CMPI_RC_ERR_FAILED","message":"asked to\u001b fail"})"));
    const Outcome odd = vkcim({"names", "Echo_Odd"});
    EXPECT_EQ(odd.status, 1);
    EXPECT_EQ(odd.error, "vkcim: UNKNOWN (77)\n");
    EXPECT_THAT(odd.output, IsEmpty());
}

TEST(Vkcim, AMistypedClassNameIsAnsweredWithTheNearestOne) {
    const Outcome outcome = vkcim({"names", "VESKA_ComputerSytsem"});
    EXPECT_EQ(outcome.status, 1);
    EXPECT_EQ(outcome.error, "vkcim: CMPI_RC_ERR_INVALID_CLASS (5)\n"
                             "vkcim: there is no class VESKA_ComputerSytsem; did you mean VESKA_ComputerSystem?\n");
    EXPECT_EQ(vkcim({"names", "Something_Else"}).error, "vkcim: CMPI_RC_ERR_INVALID_CLASS (5)\n"
                                                        "vkcim: there is no class Something_Else in the schema\n");
}

TEST(Vkcim, OneBadRunAmongManyExitsWithOne) {
    const Outcome outcome = vkcim({"--format", "json", "--repeat", "3", "names", "Echo_Flaky"});
    EXPECT_EQ(outcome.status, 1);
    EXPECT_THAT(outcome.error, HasSubstr("CMPI_RC_ERR_FAILED (1)"));
    EXPECT_EQ(json::parse(outcome.output).at("status").at("code"), 0) << "that of the last run";
}

TEST(Vkcim, TimingCountsEveryRun) {
    const Outcome outcome = vkcim({"--timing", "--repeat", "50", "--threads", "3", "names", "Echo_Thing"});
    EXPECT_EQ(outcome.status, 0);
    EXPECT_THAT(outcome.error, MatchesRegex("\\{.*\\}\n"));
    const json timing = json::parse(outcome.error);
    EXPECT_EQ(timing.at("runs"), 150);
    EXPECT_GT(timing.at("min_ns"), 0);
    EXPECT_LE(timing.at("min_ns"), timing.at("median_ns"));
    EXPECT_LE(timing.at("median_ns"), timing.at("p99_ns"));
    EXPECT_LE(timing.at("p99_ns"), timing.at("max_ns"));
    EXPECT_LE(timing.at("max_ns"), timing.at("wall_ns"));
    EXPECT_THAT(vkcim({"names", "Echo_Thing"}).error, IsEmpty());
}

TEST(Vkcim, UnusableArgumentsExitWithTwo) {
    for (const Words& words : {Words{}, Words{"bogus"}, Words{"names"}, Words{"get", "A.K"}, Words{"names", "A.K=1"},
                               Words{"modify", "Echo_Thing", "A=uint8:256"}, Words{"--format", "yaml", "report"}}) {
        const Outcome outcome = vkcim(words);
        EXPECT_EQ(outcome.status, 2) << testing::PrintToString(words);
        EXPECT_THAT(outcome.output, IsEmpty());
        EXPECT_THAT(outcome.error, HasSubstr("vkcim: "));
    }
}

TEST(Vkcim, ALibraryThatCannotBeUsedExitsWithThree) {
    const auto with = [](const char* library, const char* provider, const Words& words) {
        Words all = {VKCIM, "--library", library, "--provider", provider};
        all.insert(all.end(), words.begin(), words.end());
        return support::runCommand(all);
    };
    EXPECT_EQ(with("/nowhere/lib.so", "Echo", {"names", "Echo_Thing"}).status, 3);
    EXPECT_EQ(with("/etc/passwd", "Echo", {"names", "Echo_Thing"}).status, 3);
    EXPECT_EQ(with(ECHO_PROVIDER, "Absent", {"names", "Echo_Thing"}).status, 3);
    EXPECT_EQ(with(ECHO_PROVIDER, "Null", {"names", "Echo_Thing"}).status, 3);
    EXPECT_EQ(with(ECHO_PROVIDER, "Failing", {"names", "Echo_Thing"}).status, 3);
    EXPECT_EQ(with(ECHO_PROVIDER, "Null", {"invoke", "Echo_Thing", "Run"}).status, 3);
    EXPECT_EQ(with(ECHO_PROVIDER, "Null", {"--threads", "4", "--repeat", "9", "names", "Echo_Thing"}).status, 3);
    EXPECT_EQ(with(ECHO_PROVIDER, "Absent", {"report"}).status, 3);
    EXPECT_THAT(with("/nowhere/lib.so", "Echo", {"report"}).error, HasSubstr("/nowhere/lib.so"));
}

TEST(Vkcim, HelpAndVersionExitWithZero) {
    for (const Words& words : {Words{"--help"}, Words{"--version"}, Words{"invoke", "--help"}}) {
        const Outcome outcome = support::runCommand([&] {
            Words all = {VKCIM};
            all.insert(all.end(), words.begin(), words.end());
            return all;
        }());
        EXPECT_EQ(outcome.status, 0);
        EXPECT_THAT(outcome.output, HasSubstr("vkcim"));
        EXPECT_THAT(outcome.error, IsEmpty());
    }
}

TEST(Vkcim, AReportIsFineWhateverTheClassesAnswer) {
    const Outcome text = vkcim({"report"});
    EXPECT_EQ(text.status, 0);
    EXPECT_THAT(text.output, HasSubstr("VESKA_ComputerSystem  not served: CMPI_RC_ERR_INVALID_CLASS\n"));
    EXPECT_THAT(text.output, Not(HasSubstr("\x1b")));
    EXPECT_THAT(text.output, Not(HasSubstr("Notes"))) << "the notes are our own provider's";
    const json report = answer({"report"});
    EXPECT_EQ(report.at("classes").size(), 5u);
    EXPECT_EQ(report.at("associations").at("VESKA_ComputerCapabilities").at("status").at("code"), 5);
    EXPECT_EQ(report.at("notes"), json::array());
}

TEST(Vkcim, OurOwnProvidersReportNotesWhatTheHostCouldNotTell) {
    const support::TemporaryDirectory bare;
    const Outcome outcome = support::runCommand({VKCIM, "--format", "json", "report"}, "",
                                                {{"VK_INSTRUMENTATION_ROOT", bare.path()}, {"NVLOG_SINK", "none"}});
    EXPECT_EQ(outcome.status, 0);
    const json notes = json::parse(outcome.output).at("notes");
    ASSERT_FALSE(notes.empty());
    EXPECT_THAT(std::string(notes.at(0)), HasSubstr("SMBIOS"));
}

TEST(Vkcim, TheDefaultLibraryIsTheOneBesideTheProgram) {
    const support::TemporaryDirectory copy;
    std::filesystem::create_directories(copy.path("bin"));
    std::filesystem::copy_file(VKCIM, copy.path("bin/vkcim"));
    const Outcome missing = support::runCommand({copy.path("bin/vkcim"), "names", "Echo_Thing"});
    EXPECT_EQ(missing.status, 3);
    EXPECT_THAT(missing.error, HasSubstr(copy.path("lib/libvknabaseserverprofileprovider.so.1")));
    copy.link(ECHO_PROVIDER, "lib/libvknabaseserverprofileprovider.so.1");
    EXPECT_EQ(support::runCommand({copy.path("bin/vkcim"), "--provider", "Echo", "names", "Echo_Thing"}).status, 0);
}

TEST(Vkcim, ALibraryOfTheWorkingDirectoryNeedsNoSlash) {
    const support::TemporaryDirectory directory;
    directory.link(ECHO_PROVIDER, "libecho.so");
    const std::string command =
        "cd '" + directory.path() + "' && exec '" VKCIM "' --library libecho.so --provider Echo";
    const Outcome outcome = support::runCommand({"/bin/sh", "-c", command + " names Echo_Thing"});
    EXPECT_EQ(outcome.status, 0) << outcome.error;
}

TEST(Vkcim, FaultsOfTheBrokerAreListedAndHitEveryRun) {
    const Outcome list = support::runCommand({VKCIM, "--list-faults"});
    EXPECT_EQ(list.status, 0);
    EXPECT_THAT(list.output, HasSubstr("\nnewObjectPath\n"));
    const Words all = {"--fault", "returnObjectPath:1", "--repeat", "3", "names", "Echo_Thing"};
    EXPECT_EQ(answer(all).at("results").size(), 1u) << "one of two is lost, in the last run as in the first";
    const Outcome never = vkcim({"--fault", "returnObjectPath:9", "names", "Echo_Thing"});
    EXPECT_EQ(never.status, 0);
    EXPECT_THAT(never.error, HasSubstr("the fault did not happen"));
    for (const char* bad : {"nothing:1", "newInstance", "newInstance:0"}) {
        const Outcome refused = vkcim({"--fault", bad, "names", "Echo_Thing"});
        EXPECT_EQ(refused.status, 2) << bad;
        EXPECT_THAT(refused.error, HasSubstr("--list-faults"));
    }
    EXPECT_EQ(vkcim({"--fault", "newInstance:1", "report"}).status, 2);
}

} // namespace
