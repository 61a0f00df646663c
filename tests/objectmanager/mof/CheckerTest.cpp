// What the compiler's own tests do not see: the schema that a run of the object manager would have.
#include "objectmanager/mof/Checker.h"

#include "objectmanager/mof/ClassCheck.h"
#include "objectmanager/mof/Parser.h"

#include <gmock/gmock.h>

namespace mof {
namespace {

using testing::ElementsAre;
using testing::IsEmpty;

constexpr const char* text = R"(
[Abstract] class A_Top { [Key] string Name; uint8 Size = 3; };
[Version("1.0.0")] class A_Low : A_Top {
    [Override("Name"), MaxLen(64)] string Name;
    [MinValue(-3)] sint16 Level = 3;
};)";

TEST(Checker, GivesValuesTheirTypesAndKeysTheirMark) {
    Checker checker;
    checker.add(parse(text, "f"), false);
    ASSERT_THAT(checker.complaints(), IsEmpty());
    const om::PropertyDeclaration& name = *checker.schema().findProperty("a_low", "name");
    EXPECT_TRUE(name.key);
    EXPECT_EQ(*om::findValue(name.qualifiers, "MaxLen"), (om::Value{CMPI_uint32, std::uint64_t{64}}));
    const om::PropertyDeclaration& level = *checker.schema().findProperty("A_Low", "Level");
    EXPECT_EQ(*om::findValue(level.qualifiers, "MinValue"), (om::Value{CMPI_sint64, std::int64_t{-3}}));
    EXPECT_EQ(level.defaultValue, (om::Value{CMPI_sint16, std::int64_t{3}}));
    EXPECT_EQ(checker.schema().resolve("A_Low")->keys, std::vector{&name});
}

TEST(Checker, AsksOnlyOurOwnForDescriptions) {
    Checker checker;
    checker.add(parse(text, "f"));
    EXPECT_THAT(checker.complaints(),
                ElementsAre("f:2: class A_Top has no version of three numbers", "f:2: A_Top has no description",
                            "f:2: A_Top.Name has no description", "f:2: A_Top.Size has no description",
                            "f:3: A_Low has no description", "f:4: A_Low.Name has no description",
                            "f:5: A_Low.Level has no description"));
}

TEST(Checker, LeavesOutWhatCannotBeThereTwiceOrWithoutItsSuperclass) {
    Checker checker;
    checker.add(parse("class A_B {};\nclass a_b { string C; };\nclass A_C : A_Gone {};", "f"), false);
    EXPECT_THAT(checker.complaints(), ElementsAre("f:2: class a_b is declared already at f:1",
                                                  "f:3: superclass A_Gone of A_C is not declared"));
    EXPECT_EQ(checker.schema().classes().size(), 1U);
}

TEST(Checker, SurvivesQualifiersOfWrongTypes) {
    Checker checker;
    checker.add(
        parse("[ValueMap(1), Values({2}), Version({}), Override(null), Description(false)] class A_B { [ValueMap "
              "{1}, Values {null}, In({1, \"a\"})] uint8 C; };",
              "f"));
    EXPECT_GE(checker.complaints().size(), 8U);
}

TEST(Checker, NamesTypesAsMofDoes) {
    EXPECT_EQ(typeText(CMPI_uint16A), "uint16[]");
    EXPECT_EQ(typeText(CMPI_ref, "A_B"), "A_B ref");
    EXPECT_EQ(typeText(CMPI_refA, "A_B"), "A_B ref[]");
}

} // namespace
} // namespace mof
