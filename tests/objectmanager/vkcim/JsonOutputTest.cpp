#include "objectmanager/vkcim/JsonOutput.h"
#include "tests/objectmanager/vkcim/TestSchema.h"

#include <gtest/gtest.h>
#include <nlohmann/json.hpp>

#include <limits>

namespace vkcim {
namespace {

const std::string nameSpace = "root/cimv2";

std::string json(const om::Answer& answer) {
    return jsonText(answer, nameSpace, testSchema());
}

om::ObjectPath node7() {
    return {"", "root/cimv2", "Test_Thing", {{"Name", {CMPI_string, std::string("node7")}}}};
}

/// The value's text in an answer that returns it.
std::string bare(const om::Value& value) {
    om::Answer answer;
    answer.returnValue = value;
    const std::string text = json(answer);
    const std::string before = R"("returnValue":{"type":)";
    const std::size_t start = text.find(before) + before.size();
    return text.substr(start, text.find(R"(},"out")") - start);
}

TEST(JsonOutput, EveryKeyIsInEveryAnswer) {
    EXPECT_EQ(json({}), R"({"status":{"code":0,"name":"CMPI_RC_OK","message":null},"done":false,)"
                        R"("results":[],"returnValue":null,"out":{}})");
}

TEST(JsonOutput, AStatusHasItsNumberItsNameAndItsMessage) {
    om::Answer answer;
    answer.code = CMPI_RC_ERR_INVALID_CLASS;
    answer.message = "say \"what\"";
    answer.done = true;
    EXPECT_EQ(json(answer), R"({"status":{"code":5,"name":"CMPI_RC_ERR_INVALID_CLASS","message":"say \"what\""},)"
                            R"("done":true,"results":[],"returnValue":null,"out":{}})");
    answer.code = static_cast<CMPIrc>(77);
    EXPECT_NE(json(answer).find(R"("code":77,"name":"UNKNOWN")"), std::string::npos);
}

TEST(JsonOutput, APathHasNullForItsProperties) {
    om::Answer answer;
    answer.results.emplace_back(node7());
    EXPECT_NE(json(answer).find(
                  R"("results":[{"path":"Test_Thing.Name=\"node7\"","namespace":"root/cimv2","class":"Test_Thing",)"
                  R"("keys":{"Name":{"type":"string","value":"node7"}},"properties":null}])"),
              std::string::npos)
        << json(answer);
}

TEST(JsonOutput, ANumberHasTheWordsOfItsClassBesideIt) {
    const auto numbers = [](std::initializer_list<std::uint64_t> values) {
        std::vector<om::Value> elements;
        for (const std::uint64_t value : values) elements.push_back({CMPI_uint16, value});
        return om::Value{CMPI_uint16A, elements};
    };
    om::Instance computer;
    computer.path.className = "VESKA_ComputerSystem";
    computer.properties = {{"HealthState", {CMPI_uint16, std::uint64_t{5}}},
                           {"OperationalStatus", numbers({2, 77})},
                           {"Dedicated", numbers({77})},
                           {"Status", {CMPI_string, std::string("OK")}}};
    om::Answer answer;
    answer.results.emplace_back(computer);
    EXPECT_NE(jsonText(answer, nameSpace, om::Schema::builtin())
                  .find(R"("properties":{"HealthState":{"type":"uint16","value":5,"words":["OK"]},)"
                        R"("OperationalStatus":{"type":"uint16[]","value":[2,77],"words":["OK",null]},)"
                        R"("Dedicated":{"type":"uint16[]","value":[77]},"Status":{"type":"string","value":"OK"}})"),
              std::string::npos);
}

TEST(JsonOutput, PropertiesKeepTheOrderInWhichTheyWereSet) {
    om::Instance instance{
        node7(),
        {{"Zulu", {CMPI_uint8, std::uint64_t{1}}},
         {"Alpha",
          {CMPI_uint16A, std::vector<om::Value>{{CMPI_uint16, std::uint64_t{2}}, {CMPI_uint16, std::uint64_t{11}}}}}}};
    om::Answer answer;
    answer.results.emplace_back(instance);
    EXPECT_NE(json(answer).find(R"("properties":{"Zulu":{"type":"uint8","value":1},)"
                                R"("Alpha":{"type":"uint16[]","value":[2,11]}}})"),
              std::string::npos)
        << json(answer);
}

TEST(JsonOutput, IntegersHaveAllTheirDigits) {
    EXPECT_EQ(bare({CMPI_uint64, std::numeric_limits<std::uint64_t>::max()}),
              R"("uint64","value":18446744073709551615)");
    EXPECT_EQ(bare({CMPI_sint64, std::numeric_limits<std::int64_t>::min()}),
              R"("sint64","value":-9223372036854775808)");
    EXPECT_EQ(bare({CMPI_uint64, std::uint64_t{9007199254740993}}), R"("uint64","value":9007199254740993)");
    EXPECT_EQ(bare({CMPI_char16, std::uint64_t{65}}), R"("char16","value":65)");
}

TEST(JsonOutput, RealsAreTheShortestTextThatReadsBackInTheirWidth) {
    EXPECT_EQ(bare({CMPI_real32, static_cast<double>(0.1f)}), R"("real32","value":0.1)");
    EXPECT_EQ(bare({CMPI_real64, static_cast<double>(0.1f)}), R"("real64","value":0.10000000149011612)");
    EXPECT_EQ(bare({CMPI_real64, 5.0}), R"("real64","value":5)");
    EXPECT_EQ(bare({CMPI_real64, 1e300}), R"("real64","value":1e+300)");
    EXPECT_EQ(bare({CMPI_real64, std::numeric_limits<double>::quiet_NaN()}), R"("real64","value":"NaN")");
    EXPECT_EQ(bare({CMPI_real32, std::numeric_limits<double>::infinity()}), R"("real32","value":"Infinity")");
    EXPECT_EQ(bare({CMPI_real64, -std::numeric_limits<double>::infinity()}), R"("real64","value":"-Infinity")");
}

TEST(JsonOutput, NullsKeepTheirType) {
    EXPECT_EQ(bare({CMPI_uint16A, std::monostate()}), R"("uint16[]","value":null)");
    EXPECT_EQ(
        bare({CMPI_stringA, std::vector<om::Value>{{CMPI_string, std::monostate()}, {CMPI_string, std::string("x")}}}),
        R"("string[]","value":[null,"x"])");
    EXPECT_EQ(bare({CMPI_booleanA, std::vector<om::Value>{}}), R"("boolean[]","value":[])");
}

TEST(JsonOutput, BytesThatAreNotUtf8AreReplacedEverywhere) {
    EXPECT_EQ(bare({CMPI_string, std::string("a\xff\n")}), "\"string\",\"value\":\"a\xef\xbf\xbd\\n\"");
    om::Answer answer;
    answer.message = "\xfe";
    answer.results.emplace_back(
        om::ObjectPath{"", "root\xff", "C\xff", {{"K\xff", {CMPI_string, std::string("\xff")}}}});
    const nlohmann::json read = nlohmann::json::parse(json(answer)).at("results").at(0);
    EXPECT_EQ(read.at("namespace"), "root\xef\xbf\xbd");
    EXPECT_EQ(read.at("path"), "C\xef\xbf\xbd.K\xef\xbf\xbd=\"\xef\xbf\xbd\"");
}

TEST(JsonOutput, AReferenceIsAPathWithItsNamespaceWhereThatDiffers) {
    om::ObjectPath path = node7();
    EXPECT_EQ(bare({CMPI_ref, std::make_shared<const om::ObjectPath>(path)}),
              R"("ref","value":"Test_Thing.Name=\"node7\"")");
    path.nameSpace = "root/x";
    EXPECT_EQ(bare({CMPI_ref, std::make_shared<const om::ObjectPath>(path)}),
              R"("ref","value":"root/x:Test_Thing.Name=\"node7\"")");
}

TEST(JsonOutput, AnEmbeddedInstanceIsAnObjectLikeAResult) {
    const om::Instance inside{node7(), {{"Speed", {CMPI_uint16, std::uint64_t{3}}}}};
    EXPECT_EQ(bare({CMPI_instance, std::make_shared<const om::Instance>(inside)}),
              R"("instance","value":{"path":"Test_Thing.Name=\"node7\"","namespace":"root/cimv2",)"
              R"("class":"Test_Thing","keys":{"Name":{"type":"string","value":"node7"}},)"
              R"("properties":{"Speed":{"type":"uint16","value":3}}})");
}

TEST(JsonOutput, OutArgumentsAreNamed) {
    om::Answer answer;
    answer.returnValue = om::Value{CMPI_uint32, std::uint64_t{0}};
    answer.out = {{"TimeData", {CMPI_dateTime, std::string("20261121060000.123456+000")}}};
    EXPECT_NE(json(answer).find(R"("returnValue":{"type":"uint32","value":0},"out":{"TimeData":)"
                                R"({"type":"datetime","value":"20261121060000.123456+000"}}})"),
              std::string::npos)
        << json(answer);
}

TEST(JsonOutput, AReportHoldsTheAnswersByClassInOrder) {
    Report report;
    report.host = "node\"7";
    report.version = "2.1.0";
    report.time = 1795240800;
    report.classes = {{"B", {}}, {"A", {}}};
    report.associations = {{"L", {}}};
    report.notes = {"no tables"};
    const std::string empty = json({});
    EXPECT_EQ(jsonText(report, nameSpace, testSchema()),
              R"({"host":"node\"7","version":"2.1.0","time":"2026-11-21T06:00:00Z","classes":{"B":)" + empty +
                  R"(,"A":)" + empty + R"(},"associations":{"L":)" + empty + R"(},"notes":["no tables"]})");
}

} // namespace
} // namespace vkcim
