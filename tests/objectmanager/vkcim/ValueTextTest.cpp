#include "objectmanager/vkcim/ValueText.h"
#include "objectmanager/vkcim/ParseError.h"
#include "tests/objectmanager/vkcim/TestSchema.h"

#include <gmock/gmock.h>

#include <cmath>

namespace vkcim {
namespace {

using testing::HasSubstr;

const std::string nameSpace = "root/cimv2";

om::Value parse(std::string_view text, std::optional<CMPIType> declared = std::nullopt) {
    return parseValue(text, declared, {nameSpace, testSchema()});
}

std::string again(std::string_view text, std::optional<CMPIType> declared = std::nullopt) {
    return valueText(parse(text, declared), {nameSpace, testSchema()});
}

TEST(ValueText, ReadsEveryTypeAndPrintsItBack) {
    for (const char* text : {"boolean:true",
                             "boolean:false",
                             "char16:65535",
                             "real32:1.5",
                             "real64:-2.5e-10",
                             "uint8:255",
                             "uint16:65535",
                             "uint32:4294967295",
                             "uint64:18446744073709551615",
                             "sint8:-128",
                             "sint16:-32768",
                             "sint32:-2147483648",
                             "sint64:-9223372036854775808",
                             "string:a:b\\n,c",
                             "string:",
                             "string:null:uint8",
                             "string:uint8:7",
                             "datetime:20261121060000.123456+060",
                             "datetime:00000001020304.000000:000",
                             R"(ref:Test_Thing.Name="a")",
                             "ref:root/y:Test_Thing",
                             "null:uint16",
                             "null:string[]",
                             "null:ref",
                             "uint16[]:",
                             "uint16[]:2,11",
                             "string[]:a\\,b,c\\\\d,",
                             "boolean[]:true,false",
                             "real32[]:0.1,NaN,Infinity,-Infinity",
                             R"(ref[]:Test_Thing.Name="a"\,Other="b",Test_Thing)"}) {
        EXPECT_EQ(again(text), text);
    }
}

TEST(ValueText, AnArraysElementsHaveItsElementType) {
    const om::Value value = parse("string[]:a\\,b,c\\\\d,");
    const auto& elements = std::get<std::vector<om::Value>>(value.data);
    ASSERT_EQ(elements.size(), 3u);
    EXPECT_EQ(std::get<std::string>(elements[0].data), "a,b");
    EXPECT_EQ(std::get<std::string>(elements[1].data), "c\\d");
    EXPECT_EQ(std::get<std::string>(elements[2].data), "");
    EXPECT_EQ(elements[0].type, CMPI_string);
}

TEST(ValueText, WithoutTypeItsLookDecides) {
    struct {
        const char* text;
        const char* value;
    } const looks[] = {{"true", "boolean:true"},
                       {"false", "boolean:false"},
                       {"0", "uint32:0"},
                       {"4294967295", "uint32:4294967295"},
                       {"4294967296", "uint64:4294967296"},
                       {"18446744073709551615", "uint64:18446744073709551615"},
                       {"-1", "sint64:-1"},
                       {"1.5", "real64:1.5"},
                       {"-1e3", "real64:-1000"},
                       {".5", "real64:0.5"},
                       {"5.", "real64:5"},
                       {"", "string:"},
                       {".", "string:."},
                       {"-", "string:-"},
                       {"1.2.3", "string:1.2.3"},
                       {"1e", "string:1e"},
                       {"e5", "string:e5"},
                       {"NaN", "string:NaN"},
                       {"note: uint8:7", "string:note: uint8:7"},
                       {"UINT8:7", "string:UINT8:7"},
                       {"1,2", "string:1,2"}};
    for (const auto& each : looks) EXPECT_EQ(again(each.text), each.value) << each.text;
}

TEST(ValueText, TheDeclaredTypeComesBeforeItsLook) {
    EXPECT_EQ(again("7", CMPI_string), "string:7");
    EXPECT_EQ(again("7", CMPI_uint8), "uint8:7");
    EXPECT_EQ(again("2,11", CMPI_uint16A), "uint16[]:2,11");
    EXPECT_EQ(again("TRUE", CMPI_boolean), "boolean:true");
    EXPECT_EQ(again("Test_Thing.Name=\"a\"", CMPI_ref), "ref:Test_Thing.Name=\"a\"");
    EXPECT_EQ(again("7", CMPI_instance), "uint32:7") << "an embedded instance cannot be written";
}

TEST(ValueText, AWrittenTypeComesBeforeTheDeclaredOne) {
    EXPECT_EQ(again("uint8:7", CMPI_string), "uint8:7");
    EXPECT_EQ(again("null:uint16", CMPI_string), "null:uint16");
}

TEST(ValueText, TheEmptyTextIsTheEmptyStringWhateverIsDeclared) {
    EXPECT_EQ(again("", CMPI_uint32), "string:");
    EXPECT_EQ(again("", CMPI_uint16A), "string:");
}

TEST(ValueText, RefusesWhatItCannotReadAndTellsWhere) {
    struct {
        const char* text;
        std::size_t position;
        const char* what;
    } const bad[] = {{"uint8:256", 7, "out of range for uint8 (0 to 255)"},
                     {"uint8:-1", 7, "out of range"},
                     {"sint8:128", 7, "-128 to 127"},
                     {"sint64:9223372036854775808", 8, "out of range"},
                     {"uint64:18446744073709551616", 8, "out of range"},
                     {"18446744073709551616", 1, "out of range"},
                     {"-9223372036854775809", 1, "out of range"},
                     {"char16:65536", 8, "out of range"},
                     {"real32:1e39", 8, "out of range"},
                     {"real64:1e309", 8, "out of range"},
                     {"real64:inf", 8, "is no real64"},
                     {"real64:0x1p3", 8, "is no real64"},
                     {"uint8:", 7, "is no uint8"},
                     {"uint8: 7", 7, "is no uint8"},
                     {"uint8:7x", 7, "is no uint8"},
                     {"uint8:+7", 7, "is no uint8"},
                     {"boolean:yes", 9, "neither true nor false"},
                     {"datetime:20261121", 10, "is no datetime"},
                     {"datetime:20261321060000.000000+000", 10, "is no datetime"},
                     {"ref:", 5, "path is empty"},
                     {"ref:A.K=", 9, "no value"},
                     {"null:", 6, "is no type"},
                     {"null:uint7", 6, "\"uint7\" is no type"},
                     {"uint16[]:1,x", 12, "is no uint16"},
                     {"uint16[]:1,", 12, "is no uint16"},
                     {"string[]:a\\n", 11, "'\\'"},
                     {"string[]:a\\", 11, "'\\'"},
                     {"ref[]:A,B.K=\"x\\\\n\"", 17, "only"}};
    for (const auto& each : bad) {
        try {
            ADD_FAILURE() << each.text << " was read as " << again(each.text);
        } catch (const ParseError& error) {
            EXPECT_EQ(error.position, each.position) << each.text << ": " << error.what();
            EXPECT_THAT(error.what(), HasSubstr(each.what)) << each.text;
        }
    }
}

TEST(ValueText, ARealKeepsTheWidthOfItsType) {
    EXPECT_EQ(std::get<double>(parse("real32:0.1").data), static_cast<double>(0.1f));
    EXPECT_EQ(std::get<double>(parse("real64:0.1").data), 0.1);
    EXPECT_EQ(again("real32:16777217"), "real32:16777216");
    EXPECT_TRUE(std::isnan(std::get<double>(parse("real64:NaN").data)));
}

TEST(ValueText, AnAssignmentIsSplitAtTheFirstEqualsSign) {
    const auto none = [](const std::string&) { return std::optional<CMPIType>(); };
    const om::NamedValue value = parseAssignment("Name=a=b", none, {nameSpace, testSchema()});
    EXPECT_EQ(value.first, "Name");
    EXPECT_EQ(std::get<std::string>(value.second.data), "a=b");
    EXPECT_THROW(parseAssignment("Name", none, {nameSpace, testSchema()}), ParseError);
    EXPECT_THROW(parseAssignment("=x", none, {nameSpace, testSchema()}), ParseError);
}

TEST(ValueText, PlainTextHasNoTypeAndNoEscapes) {
    EXPECT_EQ(plainText(parse("string[]:a\\,b,c"), {nameSpace, testSchema()}), "a,b, c");
    EXPECT_EQ(plainText(parse("null:uint8"), {nameSpace, testSchema()}), "null");
}

} // namespace
} // namespace vkcim
