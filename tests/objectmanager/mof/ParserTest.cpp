#include "objectmanager/mof/Parser.h"

#include "objectmanager/mof/Complaint.h"

#include <gmock/gmock.h>

namespace mof {
namespace {

using testing::ElementsAre;

std::string complaint(const std::string& text) {
    return complaintOf([&] { parse(text, "f"); });
}

TEST(Parser, ReadsClassesWithTheirPlaces) {
    const std::string text = R"([Association,
  Version("1.0.0")]
class A_B : C_D
{
    [Key] C_D REF One; uint8 Two[4] = {1, 0x2};
    [Static]
    boolean Three([In(false), Out] STRING Four[], [Out] C_D ref Five);
};
class E_F {};)";
    const std::vector<om::ClassDeclaration> classes = parse(text, "f");
    ASSERT_EQ(classes.size(), 2U);
    const om::ClassDeclaration& first = classes[0];
    EXPECT_EQ(first.name, "A_B");
    EXPECT_EQ(first.superclass, "C_D");
    EXPECT_TRUE(first.association);
    EXPECT_EQ(first.place.file, "f");
    EXPECT_EQ(first.place.line, 3U);
    EXPECT_THAT(first.place.qualifierLines, ElementsAre(1U, 2U));
    ASSERT_EQ(first.properties.size(), 2U);
    const om::PropertyDeclaration &one = first.properties[0], &two = first.properties[1];
    EXPECT_EQ(one.type, CMPI_ref);
    EXPECT_EQ(one.referenceClass, "C_D");
    EXPECT_TRUE(one.key);
    EXPECT_EQ(two.type, CMPI_uint8A);
    EXPECT_EQ(two.place.line, 5U);
    EXPECT_EQ(std::get<std::vector<om::Value>>(two.defaultValue.data).size(), 2U);
    ASSERT_EQ(first.methods.size(), 1U);
    const om::MethodDeclaration& three = first.methods[0];
    EXPECT_EQ(three.returnType, CMPI_boolean);
    EXPECT_EQ(three.place.line, 7U);
    EXPECT_THAT(three.place.qualifierLines, ElementsAre(6U));
    ASSERT_EQ(three.parameters.size(), 2U);
    EXPECT_EQ(three.parameters[0].type, CMPI_stringA);
    EXPECT_FALSE(three.parameters[0].in);
    EXPECT_TRUE(three.parameters[0].out);
    EXPECT_TRUE(three.parameters[1].in) << "what is not said to be none";
    EXPECT_EQ(classes[1].place.line, 9U);
}

TEST(Parser, ReadsValues) {
    const auto declared = parse("class A_B { string S = \"a\" /**/ \"b\"; boolean B = TRUE; uint8 N = Null; "
                                "[Q, R(false), V{\"x\"}, W({})] sint8 I = -128; };",
                                "f")[0];
    const std::vector<om::PropertyDeclaration>& properties = declared.properties;
    EXPECT_EQ(properties[0].defaultValue, (om::Value{CMPI_string, std::string("ab")}));
    EXPECT_EQ(properties[1].defaultValue, (om::Value{CMPI_boolean, true}));
    EXPECT_TRUE(properties[2].defaultValue.isNull());
    EXPECT_EQ(properties[3].defaultValue, (om::Value{CMPI_sint64, std::int64_t{-128}}));
    const om::Qualifiers expected = {{"Q", om::qualifierValue(true)},
                                     {"R", om::qualifierValue(false)},
                                     {"V", om::qualifierValue({"x"})},
                                     {"W", {CMPI_stringA, std::vector<om::Value>()}}};
    EXPECT_EQ(properties[3].qualifiers, expected);
}

TEST(Parser, ReadsAnEmptyFile) {
    EXPECT_TRUE(parse("", "f").empty());
    EXPECT_TRUE(parse("// nothing\n", "f").empty());
}

TEST(Parser, RefusesWithTheLine) {
    const std::pair<const char*, const char*> bad[] = {
        {"class", "f:1: expected a class name, found the file's end"},
        {"class A_B : {};", "f:1: expected a superclass, found '{'"},
        {"class A_B\n{", "f:2: expected a type, found the file's end"},
        {"class A_B { uint8 C[D]; };", "f:1: expected ']', found 'D'"},
        {"class A_B { uint8 C[4 };", "f:1: expected ']', found '}'"},
        {"class A_B { ref C; };", "f:1: 'ref' is no type"},
        {"class A_B { A_B ref C(); };", "f:1: method C returns a reference"},
        {"class A_B { uint8 C(uint8); };", "f:1: expected a parameter's name, found ')'"},
        {"class A_B { uint8 C(uint8 D,); };", "f:1: expected a type, found ')'"},
        {"class A_B { uint8 C = {1,}; };", "f:1: expected a value, found '}'"},
        {"class A_B { uint8 C = {{1}}; };", "f:1: expected a value, found '{'"},
        {"class A_B { uint8 C = never; };", "f:1: expected a value, found 'never'"},
        {"[] class A_B {};", "f:1: expected a qualifier, found ']'"},
        {"[Q(1 2)] class A_B {};", "f:1: expected ')', found '2'"},
        {"#pragma locale (\"en_US\")", "f:1: #pragma is refused: compilers may ignore it"},
        {"class A_B {} #pragma", "f:1: expected ';', found '#pragma'"},
        {"Qualifier Q : boolean = false;", "f:1: expected a class, found 'Qualifier'"},
    };
    for (const auto& [text, expected] : bad) EXPECT_EQ(complaint(text), expected) << text;
}

TEST(Parser, ReadsHugeFiles) {
    std::string text;
    for (int i = 0; i < 20000; ++i) text += "class A_B { uint8 C = 1; };\n";
    EXPECT_EQ(parse(text, "f").back().place.line, 20000U);
    EXPECT_EQ(complaint("class A_B { uint8 C = " + std::string(100000, '{')), "f:1: expected a value, found '{'");
}

} // namespace
} // namespace mof
