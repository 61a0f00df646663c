// What the program hands to a provider, and prints of its answers.
#include "tests/objectmanager/vkcim/AskedEcho.h"

#include <gmock/gmock.h>

namespace {

using echo::answer;
using echo::properties;
using echo::vkcim;
using echo::Words;
using nlohmann::json;
using testing::HasSubstr;

TEST(VkcimOperations, NamesListsPathsThatGetTakesBack) {
    const json results = answer({"names", "Echo_Thing"}).at("results");
    ASSERT_EQ(results.size(), 2u);
    EXPECT_EQ(results.at(1).at("path"), R"(Echo_Thing.Name="b\"\\")");
    EXPECT_EQ(results.at(1).at("properties"), nullptr);
    EXPECT_EQ(properties({"get", results.at(1).at("path")}).at("KeyName"), "b\"\\");
}

TEST(VkcimOperations, ToldWhetherTheProviderClosedTheResult) {
    EXPECT_EQ(answer({"names", "Echo_Thing"}).at("done"), true);
    EXPECT_EQ(answer({"names", "Echo_Open"}).at("done"), false);
}

TEST(VkcimOperations, InstancesHoldEveryTypeExactly) {
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

TEST(VkcimOperations, ThePathsKeysReachTheProvider) {
    const json values = properties({"get", R"(root/x:Echo_Thing.A="x\"",b=-7,C=TRUE)"});
    EXPECT_EQ(values.at("KeyA"), "x\"");
    EXPECT_EQ(values.at("Keyb"), -7);
    EXPECT_EQ(values.at("KeyC"), true);
    EXPECT_EQ(answer({"get", "root/x:Echo_Thing"}).at("results").at(0).at("namespace"), "root/x");
    EXPECT_EQ(answer({"get", "Echo_Thing", "--namespace", "root/y"}).at("results").at(0).at("namespace"), "root/y");
}

TEST(VkcimOperations, GetOfAnUnknownInstanceFindsNothing) {
    const support::Outcome outcome = vkcim({"get", R"(Echo_Missing.Name="x")"});
    EXPECT_EQ(outcome.status, 4);
    EXPECT_EQ(outcome.output, "");
    EXPECT_EQ(outcome.error, "vkcim: no such instance: Echo_Missing.Name=\"x\"\n");
    const json nothing = json::parse(vkcim({"--format", "json", "get", R"(Echo_Missing.Name="x")"}).output);
    EXPECT_EQ(nothing.at("results"), json::array());
    EXPECT_EQ(nothing.at("done"), true);
    EXPECT_EQ(nothing.at("status").at("name"), "CMPI_RC_OK");
}

TEST(VkcimOperations, APathIsReadFromStandardInput) {
    EXPECT_EQ(properties({"get", "-"}, "Echo_Thing.Name=\"piped\"\n").at("KeyName"), "piped");
    EXPECT_EQ(vkcim({"get", "-"}).status, 2);
}

TEST(VkcimOperations, ThePropertyListIsHandedOnAndNotApplied) {
    EXPECT_FALSE(properties({"instances", "Echo_Thing"}).contains("PropertyList"));
    EXPECT_EQ(properties({"instances", "Echo_Thing", "--properties", ""}).at("PropertyList"), "");
    const json two = properties({"get", "Echo_Thing", "--properties", "A,B"});
    EXPECT_EQ(two.at("PropertyList"), "A;B;");
    EXPECT_EQ(two.at("Operation"), "GetInstance");
}

TEST(VkcimOperations, ModifySendsTypedValues) {
    EXPECT_EQ(
        vkcim({"modify", "Echo_Thing", "A=uint16[]:2,11", "B=text", "C=null:uint8", "D=", "E=7"}).error,
        "vkcim: CMPI_RC_ERR_FAILED (1): A 8336 [2][11]; B 5632 \"text\"; C 128 null; D 5632 \"\"; E 160 7; no list\n");
    EXPECT_EQ(vkcim({"modify", "Echo_Thing", "A=1", "--properties", "X"}).error,
              "vkcim: CMPI_RC_ERR_FAILED (1): A 160 1; X\n");
    EXPECT_EQ(json::parse(vkcim({"--format", "json", "modify", "Echo_Quiet", "A=1"}).output).at("results"),
              json::array());
}

TEST(VkcimOperations, ModifySaysWhatDidNotTakeEffect) {
    const support::Outcome lost = vkcim({"modify", "Echo_Quiet", "A=1", "Operation=GetInstance"});
    EXPECT_EQ(lost.status, 4);
    EXPECT_EQ(lost.error, "vkcim: not changed: A has no value\n");
    EXPECT_EQ(vkcim({"modify", "Echo_Quiet", "Operation=GetInstance"}).status, 0);
}

TEST(VkcimOperations, ValueIsBareAndOneALine) {
    const support::Outcome value = vkcim({"value", "Echo_Everything", "U64"});
    EXPECT_EQ(value.status, 0);
    EXPECT_EQ(value.output, "18446744073709551615\n");
    EXPECT_EQ(vkcim({"value", R"(Echo_Thing.Name="x")", "keyname"}).output, "x\n");
    EXPECT_EQ(vkcim({"value", "Echo_Everything", "Array"}).output, "11\n") << "an element that is null is no value";
    const support::Outcome none = vkcim({"value", "Echo_Everything", "Null"});
    EXPECT_EQ(none.status, 4);
    EXPECT_EQ(none.error, "vkcim: Null of Echo_Everything has no value\n");
    EXPECT_EQ(vkcim({"value", "Echo_Fail", "Null"}).status, 1);
}

TEST(VkcimOperations, ADryRunSaysWhatWouldBeAskedAndAsksNothing) {
    const support::Outcome dry = vkcim({"modify", "Echo_Fail.Name=\"a\"", "A=1", "--dry-run"});
    EXPECT_EQ(dry.status, 0) << "Echo_Fail answers an error when it is asked";
    EXPECT_THAT(dry.output, testing::MatchesRegex("host      this host, .*\n"
                                                  "provider  Echo in .*\n"
                                                  "path      Echo_Fail.Name=\"a\"\n"
                                                  "modify\n"
                                                  "  A=uint32:1\n"
                                                  "Nothing was asked.\n"));
    EXPECT_THAT(vkcim({"invoke", "Echo_Fail", "Run", "--dry-run"}).output, HasSubstr("\ninvoke    Run\n"));
    EXPECT_EQ(support::runCommand({VKCIM, "--library", "/nowhere", "invoke", "A", "m", "--dry-run"}).status, 3);
}

TEST(VkcimOperations, CreateAnswersThePath) {
    EXPECT_EQ(answer({"create", "Echo_Thing.Name=\"new\"", "A=1"}).at("results").at(0).at("path"),
              "Echo_Thing.Name=\"new\"");
}

TEST(VkcimOperations, DeleteAnswersAStatusAlone) {
    EXPECT_EQ(answer({"delete", "Echo_Thing"}).at("results"), json::array());
    EXPECT_EQ(vkcim({"delete", "Echo_Missing"}).status, 1);
}

TEST(VkcimOperations, AQueryIsWql) {
    const json values = properties({"query", "SELECT * FROM Echo_Thing"});
    EXPECT_EQ(values.at("Query"), "SELECT * FROM Echo_Thing");
    EXPECT_EQ(values.at("Language"), "WQL");
}

TEST(VkcimOperations, AssociationOperationsGetTheirFilters) {
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

TEST(VkcimOperations, AnInvalidClassMayBeAMissingAssociationClass) {
    EXPECT_THAT(vkcim({"associators", "VESKA_ComputerSystem"}).error, testing::HasSubstr("--assoc-class"));
    EXPECT_THAT(vkcim({"names", "VESKA_ComputerSystem"}).error, testing::Not(testing::HasSubstr("--assoc-class")));
}

TEST(VkcimOperations, InvokeAnswersReturnValueAndOutArguments) {
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

TEST(VkcimOperations, ThreadsCallConcurrently) {
    EXPECT_EQ(properties({"--threads", "4", "instances", "Echo_Crowd"}).at("Crowd"), 4);
}

TEST(VkcimOperations, MofHasBlocksAndPathsAndComments) {
    EXPECT_EQ(vkcim({"--format", "mof", "names", "Echo_Thing"}).output,
              "Echo_Thing.Name=\"a\"\nEcho_Thing.Name=\"b\\\"\\\\\"\n");
    EXPECT_THAT(vkcim({"--format", "mof", "instances", "Echo_Everything"}).output,
                HasSubstr("instance of Echo_Everything {\n    B = TRUE;\n"));
    EXPECT_EQ(vkcim({"--format", "mof", "invoke", "Echo_Thing", "Run"}).output,
              "// return value uint32:0\n// out Method=string:Run\n");
}

} // namespace
