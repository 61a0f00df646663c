#include "objectmanager/vkcim/Arguments.h"
#include "objectmanager/vkcim/Commands.h"

#include <gmock/gmock.h>

namespace vkcim {
namespace {

using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;
using Words = std::vector<std::string>;

Arguments good(const Words& words) {
    const Parsed parsed = parseArguments(words);
    if (!parsed.arguments) throw std::runtime_error(parsed.error + parsed.output);
    return *parsed.arguments;
}

TEST(Arguments, HaveDefaults) {
    const Arguments arguments = good({"names", "A"});
    EXPECT_STREQ(arguments.command->name, "names");
    EXPECT_EQ(arguments.subject, "A");
    EXPECT_EQ(arguments.library, "");
    EXPECT_EQ(arguments.provider, "BaseServerProvider");
    EXPECT_EQ(arguments.nameSpace, "root/cimv2");
    EXPECT_EQ(arguments.format, Format::Text);
    EXPECT_EQ(arguments.repeat, 1u);
    EXPECT_EQ(arguments.threads, 1u);
    EXPECT_FALSE(arguments.timing);
    EXPECT_FALSE(arguments.assocClass || arguments.resultClass || arguments.role || arguments.resultRole);
    EXPECT_FALSE(arguments.properties);
}

TEST(Arguments, OptionsStandBeforeOrAfterTheCommand) {
    for (const Words& words : {Words{"--format", "json", "--namespace=root/x", "--timing", "names", "A"},
                               Words{"names", "--format", "json", "--namespace=root/x", "A", "--timing"},
                               Words{"--format=json", "names", "A", "--timing", "--namespace", "root/x"}}) {
        const Arguments arguments = good(words);
        EXPECT_EQ(arguments.format, Format::Json);
        EXPECT_EQ(arguments.nameSpace, "root/x");
        EXPECT_EQ(arguments.subject, "A");
        EXPECT_TRUE(arguments.timing);
    }
}

TEST(Arguments, AnEmptyPropertyListIsNotAMissingOne) {
    EXPECT_THAT(good({"--properties", "", "names", "A"}).properties.value(), IsEmpty());
    EXPECT_THAT(good({"--properties=", "names", "A"}).properties.value(), IsEmpty());
    EXPECT_THAT(good({"names", "A", "--properties", "X,Y"}).properties.value(), ElementsAre("X", "Y"));
    EXPECT_EQ(good({"names", "A", "--role="}).role, "");
}

TEST(Arguments, EveryCommandIsRead) {
    for (const Command& command : commands) {
        Words words = {command.name};
        if (command.takes == Takes::Command) continue; // answered at once
        if (command.takes != Takes::Nothing) words.push_back("subject");
        if (command.member) words.push_back("member");
        if (command.assignments) words.insert(words.end(), {"a=1", "b="});
        const Arguments arguments = good(words);
        EXPECT_EQ(arguments.command, &command);
        EXPECT_EQ(arguments.subject, command.takes == Takes::Nothing ? "" : "subject");
        EXPECT_EQ(arguments.member, command.member ? "member" : "");
        EXPECT_EQ(arguments.assignments.size(), command.assignments ? 2u : 0u) << command.name;
    }
}

TEST(Arguments, WordsThatLookLikeSomethingElseAreTakenAsTheyAre) {
    EXPECT_EQ(good({"names", "report"}).subject, "report");
    EXPECT_EQ(good({"get", "-"}).subject, "-");
    EXPECT_THAT(good({"modify", "A", "x=-5", "y=[1,2]", "z=--timing"}).assignments,
                ElementsAre("x=-5", "y=[1,2]", "z=--timing"));
}

TEST(Arguments, HelpAndVersionAreAnswersOfTheirOwn) {
    for (const Words& words :
         {Words{"--help"}, Words{"--version"}, Words{"names", "--help"}, Words{"get", "A", "--help"}, Words{"-h"},
          Words{"-V"}, Words{"names", "-h"}, Words{"help"}, Words{"help", "names"}}) {
        const Parsed parsed = parseArguments(words);
        EXPECT_FALSE(parsed.arguments);
        EXPECT_EQ(parsed.exitStatus, 0);
        EXPECT_THAT(parsed.error, IsEmpty());
        EXPECT_THAT(parsed.output, HasSubstr("vkcim"));
    }
}

TEST(Arguments, EveryCommandsHelpHasItsExample) {
    for (const Command& command : commands) {
        EXPECT_THAT(parseArguments({command.name, "--help"}).output, HasSubstr(command.example));
        EXPECT_EQ(parseArguments({"help", command.name}).output, parseArguments({command.name, "--help"}).output);
    }
    EXPECT_EQ(parseArguments({"help"}).output, parseArguments({"--help"}).output);
    EXPECT_THAT(parseArguments({"help", "modify"}).output, HasSubstr("/etc/localtime"));
}

TEST(Arguments, OptionsThatACommandWouldIgnoreAreRefused) {
    EXPECT_TRUE(good({"report", "--verbose"}).verbose);
    EXPECT_TRUE(good({"modify", "A", "x=1", "--dry-run"}).dryRun);
    EXPECT_TRUE(good({"--dry-run", "invoke", "A", "m"}).dryRun);
    EXPECT_TRUE(good({"report", "--format", "openmetrics", "--with-serials"}).withSerials);
    const std::pair<Words, const char*> refused[] = {
        {{"report", "--with-serials"}, "report: --with-serials does not go with it"},
        {{"report", "--format", "facts", "--with-serials"}, "report: --with-serials does not go with it"},
        {{"instances", "A", "--format", "facts"}, "instances: --format facts is a format of report"},
        {{"names", "A", "--format", "openmetrics"}, "names: --format openmetrics is a format of report"},
        {{"names", "A", "--verbose"}, "names: --verbose does not go with it"},
        {{"create", "A", "x=1", "--dry-run"}, "create: --dry-run does not go with it"},
        {{"delete", "A", "--dry-run"}, "delete: --dry-run does not go with it"},
        {{"report", "--dry-run"}, "report: --dry-run does not go with it"},
        {{"value", "A", "x", "--repeat", "2"}, "value: --repeat does not go with it"},
        {{"describe", "A", "--url", "unix:/s"}, "describe: --url does not go with it"},
        {{"classes", "--timing"}, "classes: --timing does not go with it"},
        {{"--format", "json", "classes"}, "classes: its output is text alone"},
        {{"--format", "mof", "describe", "A"}, "describe: its output is text alone"},
        {{"--format", "json", "value", "A", "x"}, "value: its output is text alone"},
        {{"--format", "json", "modify", "A", "x=1", "--dry-run"}, "--dry-run: its output is text alone"}};
    for (const auto& [words, what] : refused) {
        const Parsed parsed = parseArguments(words);
        EXPECT_EQ(parsed.exitStatus, 2) << what;
        EXPECT_EQ(parsed.error, std::string("vkcim: ") + what + "\nTry 'vkcim --help'.\n");
    }
}

TEST(Arguments, AMistypedCommandIsAnsweredWithTheNearestOne) {
    EXPECT_THAT(parseArguments({"nmaes", "A"}).error, HasSubstr("there is no command 'nmaes'; did you mean names?"));
    EXPECT_THAT(parseArguments({"--formt", "json", "names", "A"}).error,
                HasSubstr("there is no option '--formt'; did you mean --format?"));
    EXPECT_THAT(parseArguments({"help", "reprot"}).error, HasSubstr("no command 'reprot'; did you mean report?"));
}

TEST(Arguments, ValuesAreCalledAsTheyAreWritten) {
    EXPECT_THAT(parseArguments({"modify", "--help"}).output, HasSubstr(" PATH NAME=VALUE...\n"));
    EXPECT_THAT(parseArguments({"modify", "--help"}).output, HasSubstr("\n  NAME=VALUE ... "));
    EXPECT_THAT(parseArguments({"invoke", "--help"}).output, HasSubstr(" PATH METHOD [NAME=VALUE...]\n"));
    EXPECT_EQ(parseArguments({"modify", "A"}).error, "vkcim: NAME=VALUE is required\nTry 'vkcim --help'.\n");
}

TEST(Arguments, UnusableOnesAreRefusedWithStatusTwo) {
    for (const Words& words : {Words{"--library", "", "names", "A"},
                               Words{"--provider", "", "names", "A"},
                               Words{},
                               Words{"bogus"},
                               Words{"--bogus", "names", "A"},
                               Words{"names"},
                               Words{"names", "A", "B"},
                               Words{"names", ""},
                               Words{"report", "A"},
                               Words{"modify", "A"},
                               Words{"create", "A"},
                               Words{"invoke", "A"},
                               Words{"--format", "xml", "report"},
                               Words{"--repeat", "0", "names", "A"},
                               Words{"--repeat", "x", "names", "A"},
                               Words{"--threads", "-1", "names", "A"},
                               Words{"--threads", "2", "report"},
                               Words{"report", "--repeat", "1"},
                               Words{"--format", "json", "--format", "mof", "report"},
                               Words{"--namespace"},
                               Words{"--namespace=", "names", "A"},
                               Words{"--repeat", "1000000001", "names", "A"},
                               Words{"--properties", "A,,B", "names", "A"},
                               Words{"--timing=", "names", "A"}}) {
        const Parsed parsed = parseArguments(words);
        EXPECT_FALSE(parsed.arguments) << testing::PrintToString(words);
        EXPECT_EQ(parsed.exitStatus, 2) << testing::PrintToString(words);
        EXPECT_THAT(parsed.error, HasSubstr("vkcim: ")) << testing::PrintToString(words);
        EXPECT_THAT(parsed.output, IsEmpty());
    }
}

TEST(Arguments, ANamespaceThatNoObjectCanLieInIsRefused) {
    struct {
        const char* nameSpace;
        const char* what;
    } const bad[] = {{"", "the namespace is empty"},
                     {"root/", "has an empty part"},
                     {"/root", "has an empty part"},
                     {"root//cimv2", "has an empty part"},
                     {"root/cimv2:VESKA_TimeService", "cannot hold ':'"},
                     {"root cimv2", "cannot hold byte 0x20"},
                     {"root\x1b", "cannot hold byte 0x1b"}};
    for (const auto& each : bad) {
        const Parsed parsed = parseArguments({"--namespace", each.nameSpace, "report"});
        EXPECT_EQ(parsed.exitStatus, 2) << each.nameSpace;
        EXPECT_THAT(parsed.error, HasSubstr(std::string("vkcim: --namespace: "))) << each.nameSpace;
        EXPECT_THAT(parsed.error, HasSubstr(each.what)) << each.nameSpace;
    }
    for (const char* nameSpace : {"interop", "root/PG_InterOp", "root/x-1", "r\xc3\xb6\xc3\xb6t"}) {
        EXPECT_EQ(good({"--namespace", nameSpace, "report"}).nameSpace, nameSpace);
    }
}

TEST(Arguments, NoMoreRunsAreTimedThanTimesCanBeKept) {
    EXPECT_EQ(good({"--timing", "--repeat", "100000000", "names", "A"}).repeat, 100000000u);
    EXPECT_EQ(good({"--repeat", "1000000000", "--threads", "1024", "names", "A"}).repeat, 1000000000u);
    for (const Words& runs : {Words{"--repeat", "100000001"}, Words{"--repeat", "1000000000", "--threads", "1024"},
                              Words{"--repeat", "50000000", "--threads", "3"}}) {
        Words words = {"--timing", "names", "A"};
        words.insert(words.end(), runs.begin(), runs.end());
        const Parsed parsed = parseArguments(words);
        EXPECT_EQ(parsed.exitStatus, 2) << testing::PrintToString(runs);
        EXPECT_THAT(parsed.error, HasSubstr("--timing: at most 100000000 runs"));
    }
}

} // namespace
} // namespace vkcim
