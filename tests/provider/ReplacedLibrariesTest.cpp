#include "support/Command.h"
#include "support/SimulatedHost.h"

#include <gmock/gmock.h>

#include <filesystem>
#include <fstream>
#include <regex>

namespace {

using testing::Each;
using testing::ElementsAreArray;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::Not;
using testing::SizeIs;
using Environment = std::map<std::string, std::string>;
using Arguments = std::vector<std::string>;

const Arguments getOne = {"get", R"(VESKA_ComputerSystem.CreationClassName="VESKA_ComputerSystem",Name="node7")"};

/// A process of its own, in which the sanitizers accept libraries that are loaded before theirs. The library is named
/// as seen from its directory, since the list of those to preload is cut at blanks.
Environment preloading(const std::string& library) {
    return {{"LD_PRELOAD", "./" + library}, {"ASAN_OPTIONS", "verify_asan_link_order=0"}};
}

Environment operator+(Environment environment, const Environment& more) {
    for (const auto& [name, value] : more) environment[name] = value;
    return environment;
}

test::CommandResult askChild(const Arguments& command, const Environment& environment, const Arguments& options = {}) {
    // The variables are for vkcim alone: what starts it must not be made to preload anything.
    std::string line = "cd " + test::quoted(REPLACEMENTS) + " && timeout -k 5 60 env";
    for (const auto& [name, value] : environment) line += " " + name + "=" + test::quoted(value);
    for (const char* word : {VKCIM, "--library", VK_PROVIDER_LIBRARY, "--format", "json"})
        line += " " + test::quoted(word);
    for (const Arguments& words : {options, command})
        for (const std::string& word : words) line += " " + test::quoted(word);
    return test::run(line);
}

/// The answer of a child that must have given one.
nlohmann::json answerOf(const test::CommandResult& finished) {
    const nlohmann::json answer = nlohmann::json::parse(finished.output, nullptr, false);
    if (answer.is_discarded())
        throw std::runtime_error("exit status " + std::to_string(finished.exitStatus) + ", " + finished.output);
    return answer;
}

nlohmann::json ask(const Arguments& command, const Environment& environment) {
    return answerOf(askChild(command, environment));
}

std::string namesOf(const nlohmann::json& answer) {
    std::string names;
    for (const nlohmann::json& result : answer["results"]) names += result["keys"]["Name"]["value"].get<std::string>();
    return names;
}

class ReplacedLibraries : public testing::Test {
protected:
    ReplacedLibraries() {
        test::simulate({test::computer(0, "node7"), test::chassis(0, 0, "CZ1")});
        intact = ask(getOne, {});
    }

    void expectIntact(const nlohmann::json& answer, const std::string& replacement) {
        EXPECT_EQ(answer, intact) << replacement;
        EXPECT_THAT(intact["results"], SizeIs(1));
    }

    /// Nothing returned, nothing closed, no error.
    static void expectNothing(const nlohmann::json& answer, const std::string& replacement) {
        EXPECT_EQ(answer["status"], nlohmann::json({{"code", 0}, {"name", "CMPI_RC_OK"}, {"message", nullptr}}))
            << replacement;
        EXPECT_EQ(answer["results"], nlohmann::json::array()) << replacement;
        EXPECT_EQ(answer["done"], false) << replacement;
    }

    nlohmann::json intact;
};

using ThrowingLogger = ReplacedLibraries;

TEST_F(ThrowingLogger, EndsTheWorkButNeitherTheProcessNorTheStatus) {
    for (const char* thrown : {"exception", "text", "number"}) {
        for (const char* operation : {"log", "trace"}) {
            const nlohmann::json answer =
                ask(getOne, preloading(REPLACED_LOGGER) +
                                Environment{{"REPLACEMENT_THROWS", thrown}, {"REPLACEMENT_IN", operation}});
            expectNothing(answer, std::string(thrown) + " in " + operation);
        }
    }
}

TEST_F(ThrowingLogger, LosesNothingWhereOnlyItsBufferFails) {
    for (const char* operation : {"make", "insert", "convert", "str"})
        expectIntact(ask(getOne, preloading(REPLACED_LOGGER) + Environment{{"REPLACEMENT_IN", operation}}), operation);
}

TEST_F(ThrowingLogger, DoesNotReachTheObjectManagerFromAnyOperation) {
    const Arguments commands[] = {
        {"names", "VESKA_ComputerSystem"},
        {"instances", "VESKA_ComputerSystem"},
        {"instances", "VESKA_TimeService"},
        {"modify", "VESKA_TimeService", "AutomaticDSTAdjustment=true"},
        {"associators", R"(VESKA_ComputerSystem.Name="node7")", "--assoc-class", "CIM_ElementCapabilities"},
        {"associator-names", R"(VESKA_ComputerSystem.Name="node7")", "--assoc-class", "CIM_ElementCapabilities"},
    };
    for (const Arguments& command : commands)
        expectNothing(ask(command, preloading(REPLACED_LOGGER) +
                                       Environment{{"REPLACEMENT_THROWS", "number"}, {"REPLACEMENT_IN", "log"}}),
                      command[0]);
}

TEST_F(ThrowingLogger, DoesNotChangeTheAnswerOfOperationsThatAreNotOffered) {
    const Arguments commands[] = {{"create", "VESKA_ComputerSystem", "Name=node9"},
                                  {"delete", "VESKA_ComputerSystem"},
                                  {"query", "SELECT * FROM VESKA_ComputerSystem"},
                                  {"references", "VESKA_ComputerSystem"},
                                  {"reference-names", "VESKA_ComputerSystem"}};
    for (const Arguments& command : commands) {
        const nlohmann::json answer =
            ask(command,
                preloading(REPLACED_LOGGER) + Environment{{"REPLACEMENT_THROWS", "number"}, {"REPLACEMENT_IN", "log"}});
        EXPECT_EQ(answer["status"]["name"], "CMPI_RC_ERR_NOT_SUPPORTED") << command[0];
        EXPECT_EQ(answer["status"]["message"], nullptr) << command[0];
    }
}

TEST_F(ThrowingLogger, GivesTheExceptionsTextToTheCallerOfAMethod) {
    const nlohmann::json answer = ask({"invoke", "VESKA_TimeService", "ManageTime"},
                                      preloading(REPLACED_LOGGER) + Environment{{"REPLACEMENT_IN", "log"}});
    EXPECT_EQ(answer["status"]["name"], "CMPI_RC_ERR_FAILED");
    EXPECT_EQ(answer["status"]["message"], "the replaced library failed");
    EXPECT_EQ(answer["done"], true);
}

TEST_F(ThrowingLogger, LosesNothingOfTheAnswerWhereOnlyExitLinesOrDestructorsFail) {
    for (const char* thrown : {"exception", "text", "number"})
        for (const auto& [operation, line] : {std::pair("log", "EXITING"), std::pair("trace", "~")})
            expectIntact(ask(getOne, preloading(REPLACED_LOGGER) + Environment{{"REPLACEMENT_THROWS", thrown},
                                                                               {"REPLACEMENT_IN", operation},
                                                                               {"REPLACEMENT_MATCH", line}}),
                         std::string(thrown) + " at " + line);
}

TEST_F(ThrowingLogger, MayFailAtAnyCall) {
    for (const char* thrown : {"exception", "text", "number"}) {
        for (const char* operation : {"log", "trace"}) {
            const test::CommandResult finished =
                askChild(getOne,
                         preloading(REPLACED_LOGGER) + Environment{{"REPLACEMENT_THROWS", thrown},
                                                                   {"REPLACEMENT_IN", operation},
                                                                   {"REPLACEMENT_SELDOM", "1"}},
                         {"--repeat", "500"});
            // 4 where the last answer lost its instance.
            EXPECT_THAT(finished.exitStatus, testing::AnyOf(0, 4)) << thrown << " in " << operation;
            EXPECT_EQ(answerOf(finished)["status"]["name"], "CMPI_RC_OK") << thrown << " in " << operation;
        }
    }
}

Arguments linesOf(const std::filesystem::path& path) {
    static const std::regex address("0x[0-9a-f]+");
    std::ifstream file(path);
    Arguments lines;
    for (std::string line; std::getline(file, line);) lines.push_back(std::regex_replace(line, address, "ADDRESS"));
    return lines;
}

TEST_F(ReplacedLibraries, HandEachEventOverAloneAlsoWhereTheBufferNeverStartsAnew) {
    const std::filesystem::path starting = test::processDirectory() / "starting";
    const std::filesystem::path keeping = test::processDirectory() / "keeping";
    expectIntact(ask(getOne, preloading(REPLACED_LOGGER) + Environment{{"REPLACEMENT_LOG", starting.string()}}),
                 "a buffer that starts anew");
    expectIntact(ask(getOne, preloading(REPLACED_LOGGER) +
                                 Environment{{"REPLACEMENT_LOG", keeping.string()}, {"REPLACEMENT_KEEPS", "1"}}),
                 "a buffer that keeps all");
    const Arguments lines = linesOf(keeping);
    EXPECT_THAT(lines, SizeIs(testing::Ge(100U)));
    EXPECT_THAT(lines, ElementsAreArray(linesOf(starting)));
}

TEST_F(ReplacedLibraries, EndTheWorkWithAMessageWhenAnOperationThrows) {
    for (const char* operation : {"getKeyCount", "createInstance", "getNodeStatus"}) {
        test::takeLog();
        const nlohmann::json answer =
            ask(getOne, preloading(REPLACED_OPERATIONS) + Environment{{"REPLACEMENT_IN", operation}});
        expectNothing(answer, operation);
        std::vector<std::string> messages;
        for (const std::string& line : test::takeLog())
            if (line.find("MESSAGE [") != std::string::npos) messages.push_back(line);
        ASSERT_THAT(messages, SizeIs(2)) << operation;
        EXPECT_THAT(messages, Each(HasSubstr(" 3000 Norvane.BaseServerProvider BaseServerProvider:"))) << operation;
        EXPECT_THAT(messages, Each(HasSubstr(" BaseServer_GetInstance: MESSAGE [File: BaseServerProvider, Line: ")));
        EXPECT_THAT(messages, Each(testing::EndsWith("]: the replaced library failed"))) << operation;
    }
}

TEST_F(ReplacedLibraries, LeaveAModificationOkWhenTheHostThrows) {
    const nlohmann::json answer = ask({"modify", "VESKA_TimeService", "AutomaticDSTAdjustment=true"},
                                      preloading(REPLACED_OPERATIONS) + Environment{{"REPLACEMENT_IN", "setProperty"}});
    expectNothing(answer, "setProperty");
    EXPECT_EQ(test::simulatedProperty("/computer/0", 200), 0);
}

TEST_F(ReplacedLibraries, AnswerAsEverWhereTheyOnlyPassOn) {
    expectIntact(ask(getOne, preloading(REPLACED_OPERATIONS)), "operations that pass on");
}

TEST_F(ReplacedLibraries, NeedOfTheInstrumentationNoMoreThanItsOperations) {
    const nlohmann::json answer = ask({"instances", "VESKA_ComputerSystem"}, preloading(REPLACED_INSTRUMENTATION));
    ASSERT_THAT(answer["results"], SizeIs(1));
    const nlohmann::json& properties = answer["results"][0]["properties"];
    EXPECT_EQ(properties["Name"]["value"], "replaced");
    EXPECT_EQ(properties["Description"]["value"], "Replaced");
    EXPECT_EQ(ask({"names", "VESKA_CIMServiceConfig"}, preloading(REPLACED_INSTRUMENTATION))["status"]["code"], 0);
}

TEST_F(ReplacedLibraries, NameTheTimeServiceWithoutAHostNameThatCannotBeRead) {
    const nlohmann::json answer = ask({"names", "VESKA_TimeService"},
                                      preloading(REPLACED_HOSTNAME) + Environment{{"REPLACEMENT_HOSTNAME", "fails"}});
    EXPECT_EQ(namesOf(answer), "TimeService@");
    EXPECT_EQ(answer["results"][0]["keys"]["SystemName"]["value"], "");
}

TEST_F(ReplacedLibraries, ReadNoFurtherThanTheRoomForAHostNameWithoutTerminator) {
    const nlohmann::json answer = ask({"names", "VESKA_TimeService"},
                                      preloading(REPLACED_HOSTNAME) + Environment{{"REPLACEMENT_HOSTNAME", "fills"}});
    EXPECT_EQ(namesOf(answer), "TimeService@" + std::string(128, 'h'));
}

} // namespace
