#include "objectmanager/vkcim/PathText.h"
#include "objectmanager/vkcim/ParseError.h"
#include "objectmanager/vkcim/ValueText.h"
#include "tests/objectmanager/vkcim/TestSchema.h"

#include <gmock/gmock.h>

namespace vkcim {
namespace {

using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;

om::ObjectPath parse(std::string_view text) {
    return parsePath(text, "root/cimv2", testSchema());
}

std::string key(const om::ObjectPath& path, std::size_t index) {
    const std::string nameSpace = "root/cimv2";
    return path.keys.at(index).first + '=' + valueText(path.keys.at(index).second, {nameSpace, testSchema()});
}

TEST(PathText, ABareClassNameIsAKeylessPath) {
    const om::ObjectPath path = parse("VESKA_ComputerSystem");
    EXPECT_EQ(path.className, "VESKA_ComputerSystem");
    EXPECT_EQ(path.nameSpace, "root/cimv2");
    EXPECT_TRUE(path.keys.empty());
}

TEST(PathText, KeysKeepTheirOrderAndSpelling) {
    const om::ObjectPath path = parse(R"(veska_computersystem.NAME="node7",CreationClassName="VESKA_ComputerSystem")");
    EXPECT_EQ(path.className, "veska_computersystem");
    EXPECT_EQ(key(path, 0), "NAME=string:node7");
    EXPECT_EQ(key(path, 1), "CreationClassName=string:VESKA_ComputerSystem");
}

TEST(PathText, ALeadingNamespaceReplacesTheGivenOne) {
    EXPECT_EQ(parse("root/other:A").nameSpace, "root/other");
    EXPECT_EQ(parse("interop:A").nameSpace, "interop");
    EXPECT_EQ(parse(R"(A.K="root/x:y")").nameSpace, "root/cimv2");
}

TEST(PathText, ReadsEveryKindOfKey) {
    struct {
        const char* text;
        const char* value;
    } const good[] = {{R"("plain")", "string:plain"},
                      {R"("")", "string:"},
                      {R"("a\"b\\c")", R"(string:a"b\c)"},
                      {R"("a,b=c.d")", "string:a,b=c.d"},
                      {"7", "sint64:7"},
                      {"007", "sint64:7"},
                      {"-9223372036854775808", "sint64:-9223372036854775808"},
                      {"9223372036854775807", "sint64:9223372036854775807"},
                      {"9223372036854775808", "uint64:9223372036854775808"},
                      {"18446744073709551615", "uint64:18446744073709551615"},
                      {"TRUE", "boolean:true"},
                      {"fAlSe", "boolean:false"},
                      {R"("7")", "string:7"},
                      {R"(ref:"B.N=\"x\"")", R"(ref:B.N="x")"}};
    for (const auto& each : good) {
        EXPECT_EQ(key(parse(std::string("A.K=") + each.text + ",Last=1"), 0), std::string("K=") + each.value);
    }
}

TEST(PathText, RefusesWhatItCannotReadAndTellsWhere) {
    struct {
        const char* text;
        std::size_t position;
        const char* what;
    } const bad[] = {{"", 1, "empty"},
                     {".K=1", 1, "class name"},
                     {"1A", 1, "cannot start"},
                     {":A", 1, "namespace"},
                     {"root/:A", 1, "empty part"},
                     {"root//x:A", 1, "empty part"},
                     {"//host/root/x:A", 1, "no host"},
                     {"root/x:", 8, "class name is missing"},
                     {"root/x", 5, "unexpected '/'"},
                     {"A B", 2, "byte 0x20"},
                     {"A.", 3, "key name is missing"},
                     {"A.K", 4, "'=' is missing"},
                     {"A.=1", 3, "key name"},
                     {"A.K=", 5, "no value"},
                     {"A.K=,L=1", 5, "no value"},
                     {"A.K=1,", 7, "key name is missing"},
                     {"A.K=1;L=2", 5, "no quoted text"},
                     {"A.K=\"x\"L=2", 8, "unexpected 'L'"},
                     {"A.K=\"x", 5, "not closed"},
                     {"A.K=\"x\\", 5, "not closed"},
                     {"A.K=\"x\\n\"", 8, "only \\\" and \\\\"},
                     {"A.K=yes", 5, "no quoted text"},
                     {"A.K=1.5", 5, "no quoted text"},
                     {"A.K=+1", 5, "no quoted text"},
                     {"A.K=-", 5, "no quoted text"},
                     {"A.K=18446744073709551616", 5, "out of range"},
                     {"A.K=-9223372036854775809", 5, "out of range"},
                     {"A.K=1,k=2", 7, "given twice"},
                     {"A.K=ref:B", 5, "no quoted text"},
                     {R"(Test_Link.From="B.N=\"x")", 21, "not closed"},
                     {R"(Test_Link.From="B.N=\"x\",N=\"y\"")", 27, "given twice"}};
    for (const auto& each : bad) {
        try {
            parse(each.text);
            ADD_FAILURE() << each.text << " was read";
        } catch (const ParseError& error) {
            EXPECT_EQ(error.position, each.position) << each.text << ": " << error.what();
            EXPECT_THAT(error.what(), HasSubstr(each.what)) << each.text;
        }
    }
}

TEST(PathText, TheSchemaTellsWhichQuotedKeysAreReferences) {
    const om::ObjectPath path = parse(R"(test_link.FROM="Test_Thing.Name=\"a\"",Other="Test_Thing.Name=\"b\"")");
    EXPECT_EQ(key(path, 0), R"(FROM=ref:Test_Thing.Name="a")");
    EXPECT_EQ(key(path, 1), R"(Other=string:Test_Thing.Name="b")");
    EXPECT_EQ(key(parse(R"(Unknown.From="Test_Thing.Name=\"a\"")"), 0), R"(From=string:Test_Thing.Name="a")");
}

TEST(PathText, EachNestingIsEscapedOnceMore) {
    const char* text = R"(Test_Link.From="Test_Link.To=\"Test_Thing.Name=\\\"a\\\\\\\"b\\\"\"")";
    const om::ObjectPath path = parse(text);
    const auto inner = std::get<std::shared_ptr<const om::ObjectPath>>(path.keys.at(0).second.data);
    const auto innermost = std::get<std::shared_ptr<const om::ObjectPath>>(inner->keys.at(0).second.data);
    EXPECT_EQ(std::get<std::string>(innermost->keys.at(0).second.data), "a\"b");
    EXPECT_EQ(pathText(path, "root/cimv2", testSchema()), text);
}

TEST(PathText, AReferenceTakesTheNamespaceOfThePathAroundIt) {
    const om::ObjectPath path = parse(R"(root/x:Test_Link.From="Test_Thing",To="root/y:Test_Thing")");
    EXPECT_EQ(std::get<std::shared_ptr<const om::ObjectPath>>(path.keys.at(0).second.data)->nameSpace, "root/x");
    EXPECT_EQ(std::get<std::shared_ptr<const om::ObjectPath>>(path.keys.at(1).second.data)->nameSpace, "root/y");
}

std::vector<std::string> remarksOn(std::string_view text) {
    std::vector<std::string> remarks;
    parsePath(text, "root/cimv2", om::Schema::builtin(), &remarks);
    return remarks;
}

TEST(PathText, RemarksOnKeysThatTheClassLacks) {
    EXPECT_THAT(remarksOn(R"(VESKA_ComputerSystem.Nmae="a")"),
                ElementsAre("position 22: VESKA_ComputerSystem has no key Nmae; did you mean Name?"));
    EXPECT_THAT(remarksOn(R"(veska_physicalpackage.Tag="a",Model="b")"),
                ElementsAre("position 31: VESKA_PhysicalPackage has no key Model; its keys: CreationClassName, Tag"));
    EXPECT_THAT(remarksOn(R"(Other_Class.Nmae="a")"), IsEmpty());
    EXPECT_THAT(remarksOn(R"(CIM_ManagedElement.Nmae="a")"), IsEmpty()) << "the classes below it have keys";
}

TEST(PathText, RemarksOnKeysOfAnotherKind) {
    EXPECT_THAT(remarksOn("VESKA_ComputerSystem.Name=7"),
                ElementsAre("position 27: key Name of VESKA_ComputerSystem is text in quotes"));
    EXPECT_THAT(remarksOn(R"(VESKA_ComputerSystem.name="a",CreationClassName=TRUE)"),
                ElementsAre("position 49: key CreationClassName of VESKA_ComputerSystem is text in quotes"));
    EXPECT_THAT(remarksOn("VESKA_ComputerSystemPackage.Antecedent=7"),
                ElementsAre("position 40: key Antecedent of VESKA_ComputerSystemPackage is a path in quotes"));
}

TEST(PathText, RemarksOnKeysOfReferencesAtTheirPlaceInTheWhole) {
    EXPECT_THAT(remarksOn(R"(VESKA_ComputerSystemPackage.Antecedent="VESKA_PhysicalPackage.Tg=\"a\"")"),
                ElementsAre("position 63: VESKA_PhysicalPackage has no key Tg; did you mean Tag?"));
}

TEST(PathText, PrintsWhatItReads) {
    for (const char* text :
         {"A", R"(A.K="x")", R"(A.K="a\"b\\c",L=-7,M=TRUE,N=18446744073709551615)", R"(A.K=ref:"B.N=\"x\"")",
          R"(Test_Link.From="Test_Thing.Name=\"a\"",To="root/y:Test_Thing.Name=\"b\"")", "A.K=\"\xff\x01\""}) {
        EXPECT_EQ(pathText(parse(text), "root/cimv2", testSchema()), text);
    }
}

TEST(PathText, PrintsANamespaceOnlyWhereItDiffers) {
    const om::ObjectPath path = parse("root/x:A");
    EXPECT_EQ(pathText(path, "root/cimv2", testSchema()), "A");
    EXPECT_EQ(qualifiedPathText(path, "root/cimv2", testSchema()), "root/x:A");
    EXPECT_EQ(qualifiedPathText(path, "root/x", testSchema()), "A");
}

TEST(PathText, WhatIsPrintedWithItsNamespaceReadsBackTheSame) {
    const char* text = R"(root/x:Test_Link.From="Test_Thing",To="root/cimv2:Test_Thing")";
    EXPECT_EQ(qualifiedPathText(parse(text), "root/cimv2", testSchema()), text);
}

TEST(PathText, RealAndDateTimeKeysArePrintedQuoted) {
    om::ObjectPath path;
    path.className = "A";
    path.keys = {{"R", {CMPI_real32, 1.5}},
                 {"D", {CMPI_dateTime, std::string("20261121060000.000000+000")}},
                 {"C", {CMPI_char16, std::uint64_t{65}}}};
    EXPECT_EQ(pathText(path, "root/cimv2", testSchema()), R"(A.R="1.5",D="20261121060000.000000+000",C=65)");
}

} // namespace
} // namespace vkcim
