#include "objectmanager/vkcim/MofOutput.h"
#include "tests/objectmanager/vkcim/TestSchema.h"

#include <gtest/gtest.h>

#include <limits>

namespace vkcim {
namespace {

const std::string nameSpace = "root/cimv2";

std::string mof(const om::Answer& answer) {
    return mofText(answer, nameSpace, testSchema());
}

om::ObjectPath thing(const char* name) {
    return {"", "root/cimv2", "Test_Thing", {{"Name", {CMPI_string, std::string(name)}}}};
}

TEST(MofOutput, PathsStandOneALine) {
    om::Answer answer;
    answer.results.emplace_back(thing("a"));
    om::ObjectPath elsewhere = thing("b");
    elsewhere.nameSpace = "root/x";
    answer.results.emplace_back(elsewhere);
    EXPECT_EQ(mof(answer), "Test_Thing.Name=\"a\"\nroot/x:Test_Thing.Name=\"b\"\n");
}

TEST(MofOutput, AnInstanceIsABlockOfLiterals) {
    const om::Value states{CMPI_uint16A,
                           std::vector<om::Value>{{CMPI_uint16, std::uint64_t{2}}, {CMPI_uint16, std::monostate()}}};
    om::Answer answer;
    answer.results.emplace_back(
        om::Instance{thing("a"),
                     {{"Text",
                       {CMPI_string, std::string("a\"b\\c\n\x01"
                                                 "1")}},
                      {"States", states},
                      {"None", {CMPI_stringA, std::vector<om::Value>{}}},
                      {"On", {CMPI_boolean, true}},
                      {"Missing", {CMPI_uint8, std::monostate()}},
                      {"Whole", {CMPI_real64, 5.0}},
                      {"Large", {CMPI_real64, 1e300}},
                      {"Odd", {CMPI_real32, std::numeric_limits<double>::infinity()}},
                      {"Since", {CMPI_dateTime, std::string("20261121060000.123456+000")}},
                      {"Owner", {CMPI_ref, std::make_shared<const om::ObjectPath>(thing("b"))}}}});
    EXPECT_EQ(mof(answer), "instance of Test_Thing {\n"
                           "    Text = \"a\\\"b\\\\c\\n\\x00011\";\n"
                           "    States = {2, NULL};\n"
                           "    None = {};\n"
                           "    On = TRUE;\n"
                           "    Missing = NULL;\n"
                           "    Whole = 5.0;\n"
                           "    Large = 1.0e+300;\n"
                           "    Odd = NULL /* Infinity */;\n"
                           "    Since = \"20261121060000.123456+000\";\n"
                           "    Owner = \"Test_Thing.Name=\\\"b\\\"\";\n"
                           "};\n");
}

TEST(MofOutput, WhatAMethodReturnsIsCommented) {
    om::Answer answer;
    answer.returnValue = om::Value{CMPI_uint32, std::uint64_t{4}};
    answer.out = {{"Text", {CMPI_string, std::string("a\nb")}}};
    EXPECT_EQ(mof(answer), "// return value uint32:4\n// out Text=string:a\\nb\n");
}

TEST(MofOutput, AReportNamesClassesAndNotesInComments) {
    Report report;
    report.host = "node7";
    report.classes = {{"Test_Thing", {}}};
    report.classes.front().second.results.emplace_back(om::Instance{thing("a"), {}});
    report.associations = {{"Test_Link", {}}};
    report.associations.front().second.code = CMPI_RC_ERR_INVALID_CLASS;
    report.notes = {"no tables"};
    EXPECT_EQ(mofText(report, nameSpace, testSchema()), "// Host node7\n"
                                                        "\n// Test_Thing: CMPI_RC_OK\n"
                                                        "instance of Test_Thing {\n};\n"
                                                        "\n// Test_Link: CMPI_RC_ERR_INVALID_CLASS\n"
                                                        "\n// Notes\n// - no tables\n");
}

} // namespace
} // namespace vkcim
