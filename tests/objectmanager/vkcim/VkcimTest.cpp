// The program itself, with a provider that answers what it was asked.
#include "tests/support/Process.h"
#include "tests/support/TemporaryDirectory.h"

#include <gmock/gmock.h>
#include <nlohmann/json.hpp>

#include <filesystem>

namespace {

using nlohmann::json;
using support::Outcome;
using testing::EndsWith;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::MatchesRegex;
using testing::Not;
using Words = std::vector<std::string>;

Outcome vkcim(const Words& words, const std::string& input = "") {
    Words all = {VKCIM, "--library", ECHO_PROVIDER, "--provider", "Echo"};
    all.insert(all.end(), words.begin(), words.end());
    return support::runCommand(all, input);
}

/// The JSON answer of a command that succeeds.
json answer(Words words, const std::string& input = "") {
    words.insert(words.begin(), {"--format", "json"});
    const Outcome outcome = vkcim(words, input);
    EXPECT_EQ(outcome.status, 0) << outcome.error;
    EXPECT_THAT(outcome.error, IsEmpty());
    EXPECT_THAT(outcome.output, EndsWith("\n"));
    EXPECT_EQ(outcome.output.find('\n'), outcome.output.size() - 1) << "one line";
    return json::parse(outcome.output);
}

/// The properties of the only instance answered, each as its value.
json properties(const Words& words, const std::string& input = "") {
    const json results = answer(words, input).at("results");
    EXPECT_EQ(results.size(), 1u);
    json values;
    for (const auto& [name, value] : results.at(0).at("properties").items()) values[name] = value.at("value");
    return values;
}

TEST(Vkcim, NamesListsPathsThatGetTakesBack) {
    const json results = answer({"names", "Echo_Thing"}).at("results");
    ASSERT_EQ(results.size(), 2u);
    EXPECT_EQ(results.at(1).at("path"), R"(Echo_Thing.Name="b\"\\")");
    EXPECT_EQ(results.at(1).at("properties"), nullptr);
    EXPECT_EQ(properties({"get", results.at(1).at("path")}).at("KeyName"), "b\"\\");
}

TEST(Vkcim, ToldWhetherTheProviderClosedTheResult) {
    EXPECT_EQ(answer({"names", "Echo_Thing"}).at("done"), true);
    EXPECT_EQ(answer({"names", "Echo_Open"}).at("done"), false);
}

TEST(Vkcim, InstancesHoldEveryTypeExactly) {
    const std::string output = vkcim({"--format", "json", "instances", "Echo_Everything"}).output;
    for (const char* part :
         {R"("B":{"type":"boolean","value":true})", R"("C16":{"type":"char16","value":65})",
          R"("U8":{"type":"uint8","value":255})", R"("U64":{"type":"uint64","value":18446744073709551615})",
          R"("S64":{"type":"sint64","value":-9223372036854775808})", R"("R32":{"type":"real32","value":0.1})",
          R"("R64":{"type":"real64","value":0.1})", R"("NaN":{"type":"real64","value":"NaN"})",
          "\"Text\":{\"type\":\"string\",\"value\":\"a\xef\xbf\xbd\\\"\\n\"}",
          R"("When":{"type":"datetime","value":"20261121060000.123456+060"})",
          R"("Ref":{"type":"ref","value":"Echo_Everything.Name=\"other\""})",
          R"("Far":{"type":"ref","value":"root/x:Echo_Everything.Name=\"other\""})",
          R"("Embedded":{"type":"instance","value":{"path":"Echo_Inside.Name=\"inside\"")",
          R"("Array":{"type":"uint16[]","value":[null,11]})", R"("Null":{"type":"uint32","value":null})"}) {
        EXPECT_THAT(output, HasSubstr(part));
    }
}

TEST(Vkcim, ThePathsKeysReachTheProvider) {
    const json values = properties({"get", R"(root/x:Echo_Thing.A="x\"",b=-7,C=TRUE)"});
    EXPECT_EQ(values.at("KeyA"), "x\"");
    EXPECT_EQ(values.at("Keyb"), -7);
    EXPECT_EQ(values.at("KeyC"), true);
    EXPECT_EQ(answer({"get", "root/x:Echo_Thing"}).at("results").at(0).at("namespace"), "root/x");
    EXPECT_EQ(answer({"get", "Echo_Thing", "--namespace", "root/y"}).at("results").at(0).at("namespace"), "root/y");
}

TEST(Vkcim, GetOfAnUnknownInstanceAnswersNothing) {
    const json nothing = answer({"get", R"(Echo_Missing.Name="x")"});
    EXPECT_EQ(nothing.at("results"), json::array());
    EXPECT_EQ(nothing.at("done"), true);
    EXPECT_EQ(nothing.at("status").at("name"), "CMPI_RC_OK");
}

TEST(Vkcim, APathIsReadFromStandardInput) {
    EXPECT_EQ(properties({"get", "-"}, "Echo_Thing.Name=\"piped\"\n").at("KeyName"), "piped");
    EXPECT_EQ(vkcim({"get", "-"}).status, 2);
}

TEST(Vkcim, ThePropertyListIsHandedOnAndNotApplied) {
    EXPECT_FALSE(properties({"instances", "Echo_Thing"}).contains("PropertyList"));
    EXPECT_EQ(properties({"instances", "Echo_Thing", "--properties", ""}).at("PropertyList"), "");
    const json two = properties({"get", "Echo_Thing", "--properties", "A,B"});
    EXPECT_EQ(two.at("PropertyList"), "A;B;");
    EXPECT_EQ(two.at("Operation"), "GetInstance");
}

TEST(Vkcim, ModifySendsTypedValues) {
    EXPECT_EQ(
        vkcim({"modify", "Echo_Thing", "A=uint16[]:2,11", "B=text", "C=null:uint8", "D=", "E=7"}).error,
        "vkcim: CMPI_RC_ERR_FAILED (1): A 8336 [2][11]; B 5632 \"text\"; C 128 null; D 5632 \"\"; E 160 7; no list\n");
    EXPECT_EQ(vkcim({"modify", "Echo_Thing", "A=1", "--properties", "X"}).error,
              "vkcim: CMPI_RC_ERR_FAILED (1): A 160 1; X\n");
    EXPECT_EQ(answer({"modify", "Echo_Quiet", "A=1"}).at("results"), json::array());
}

TEST(Vkcim, CreateAnswersThePath) {
    EXPECT_EQ(answer({"create", "Echo_Thing.Name=\"new\"", "A=1"}).at("results").at(0).at("path"),
              "Echo_Thing.Name=\"new\"");
}

TEST(Vkcim, DeleteAnswersAStatusAlone) {
    EXPECT_EQ(answer({"delete", "Echo_Thing"}).at("results"), json::array());
    EXPECT_EQ(vkcim({"delete", "Echo_Missing"}).status, 1);
}

TEST(Vkcim, AQueryIsWql) {
    const json values = properties({"query", "SELECT * FROM Echo_Thing"});
    EXPECT_EQ(values.at("Query"), "SELECT * FROM Echo_Thing");
    EXPECT_EQ(values.at("Language"), "WQL");
}

TEST(Vkcim, AssociationOperationsGetTheirFilters) {
    const Words filters = {"--assoc-class", "A", "--result-class", "B", "--role", "C", "--result-role", "D"};
    const auto with = [&](Words words) {
        words.insert(words.end(), filters.begin(), filters.end());
        return words;
    };
    const json all = properties(with({"associators", "Echo_Thing"}));
    EXPECT_EQ(all, json::parse(R"({"Operation":"Associators","AssocClass":"A","ResultClass":"B","Role":"C",)"
                               R"("ResultRole":"D"})"));
    EXPECT_EQ(properties(with({"references", "Echo_Thing"})),
              json::parse(R"({"Operation":"References","ResultClass":"B","Role":"C"})"));
    EXPECT_EQ(properties({"associators", "Echo_Thing"}), json::parse(R"({"Operation":"Associators"})"));
    EXPECT_EQ(answer(with({"associator-names", "Echo_Thing"})).at("results").at(0).at("path"), "Echo_Thing.Name=\"A\"");
    EXPECT_EQ(answer({"reference-names", "Echo_Thing"}).at("results").at(0).at("path"), "Echo_Thing.Name=\"none\"");
}

TEST(Vkcim, InvokeAnswersReturnValueAndOutArguments) {
    const json all = answer({"invoke", "Echo_Thing", "Run", "When=datetime:20261121060000.123456+000", "X=null:uint32",
                             "Ref=ref:root/x:Echo_Thing.Name=\"a\"", "List=string[]:a\\,b,c"});
    EXPECT_EQ(all.at("returnValue"), json::parse(R"({"type":"uint32","value":4})"));
    EXPECT_EQ(all.at("out").at("When"), json::parse(R"({"type":"datetime","value":"20261121060000.123456+000"})"));
    EXPECT_EQ(all.at("out").at("X"), json::parse(R"({"type":"uint32","value":null})"));
    EXPECT_EQ(all.at("out").at("Ref").at("value"), "root/x:Echo_Thing.Name=\"a\"");
    EXPECT_EQ(all.at("out").at("List").at("value"), json::parse(R"(["a,b","c"])"));
    EXPECT_EQ(all.at("out").at("Method").at("value"), "Run");
    EXPECT_EQ(answer({"invoke", "Echo_Thing", "Run"}).at("returnValue").at("value"), 0);
}

TEST(Vkcim, TheExampleOfInvokesHelpSucceeds) {
    const std::string help = support::runCommand({VKCIM, "invoke", "--help"}).output;
    const std::string heading = "Example:\n";
    const std::size_t begin = help.find(heading);
    ASSERT_NE(begin, std::string::npos);
    const std::size_t line = begin + heading.size();
    const std::string example = help.substr(line, help.find('\n', line) - line);
    const std::string folder = std::filesystem::path(VKCIM).parent_path();
    const Outcome outcome = support::runCommand({"/bin/sh", "-c", "PATH=" + folder + ":$PATH; " + example});
    EXPECT_EQ(outcome.status, 0) << example << ": " << outcome.error;
    EXPECT_THAT(outcome.output, HasSubstr("TimeData"));
}

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
}

TEST(Vkcim, OneBadRunAmongManyExitsWithOne) {
    const Outcome outcome = vkcim({"--format", "json", "--repeat", "3", "names", "Echo_Flaky"});
    EXPECT_EQ(outcome.status, 1);
    EXPECT_THAT(outcome.error, HasSubstr("CMPI_RC_ERR_FAILED (1)"));
    EXPECT_EQ(json::parse(outcome.output).at("status").at("code"), 0) << "that of the last run";
}

TEST(Vkcim, ThreadsCallConcurrently) {
    EXPECT_EQ(properties({"--threads", "4", "instances", "Echo_Crowd"}).at("Crowd"), 4);
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
    const support::TemporaryDirectory folder;
    folder.link(ECHO_PROVIDER, "libecho.so");
    const std::string command = "cd '" + folder.path() + "' && exec " VKCIM " --library libecho.so --provider Echo";
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

TEST(Vkcim, TheLastOutputIsOnTheDiskOrItSaysSo) {
    const Outcome outcome = support::runCommand(
        {"/bin/sh", "-c",
         std::string(VKCIM) + " --library " ECHO_PROVIDER " --provider Echo names Echo_Thing >/dev/full"});
    EXPECT_EQ(outcome.status, 1);
    EXPECT_THAT(outcome.error, HasSubstr("cannot be written"));
}

TEST(Vkcim, MofHasBlocksAndPathsAndComments) {
    EXPECT_EQ(vkcim({"--format", "mof", "names", "Echo_Thing"}).output,
              "Echo_Thing.Name=\"a\"\nEcho_Thing.Name=\"b\\\"\\\\\"\n");
    EXPECT_THAT(vkcim({"--format", "mof", "instances", "Echo_Everything"}).output,
                HasSubstr("instance of Echo_Everything {\n    B = TRUE;\n"));
    EXPECT_EQ(vkcim({"--format", "mof", "invoke", "Echo_Thing", "Run"}).output,
              "// return value uint32:0\n// out Method=string:Run\n");
}

} // namespace
