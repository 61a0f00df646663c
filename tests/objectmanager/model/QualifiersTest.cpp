#include "objectmanager/model/Qualifiers.h"

#include "objectmanager/model/Schema.h"

#include <gmock/gmock.h>

namespace om {
namespace {

using testing::ElementsAre;
using testing::IsEmpty;
using testing::StartsWith;

const Qualifiers health = {{"Write", qualifierValue(true)},
                           {"Read", qualifierValue(false)},
                           {"Description", qualifierValue("How it is.")},
                           {"ValueMap", qualifierValue({"0", "5", "6..9", "100..", "..-1"})},
                           {"Values", qualifierValue({"Unknown", "OK", "Bad", "Vendor", "Below"})}};

Value number(std::uint64_t value) {
    return {CMPI_uint16, value};
}

TEST(Qualifiers, AreFoundWithoutRegardToCase) {
    EXPECT_TRUE(isMarked(health, "write"));
    EXPECT_FALSE(isMarked(health, "Read"));
    EXPECT_FALSE(isMarked(health, "Key"));
    EXPECT_FALSE(isMarked(health, "Description")) << "it is no boolean";
    EXPECT_EQ(textOf(health, "DESCRIPTION"), "How it is.");
    EXPECT_EQ(textOf(health, "Override"), "");
    EXPECT_THAT(textsOf({{"ValueMap", qualifierValue({"2"})}}, "valuemap"), ElementsAre("2"));
    EXPECT_THAT(textsOf(health, "BitMap"), IsEmpty());
}

TEST(Qualifiers, HaveAWordForANumberOrARangeOfThem) {
    EXPECT_THAT(wordsFor(health, number(5)), ElementsAre("OK"));
    EXPECT_THAT(wordsFor(health, number(6)), ElementsAre("Bad"));
    EXPECT_THAT(wordsFor(health, number(9)), ElementsAre("Bad"));
    EXPECT_THAT(wordsFor(health, number(65535)), ElementsAre("Vendor"));
    EXPECT_THAT(wordsFor(health, {CMPI_sint16, std::int64_t{-3}}), ElementsAre("Below"));
    EXPECT_THAT(wordsFor(health, number(10)), IsEmpty());
}

TEST(Qualifiers, HaveAWordForEachElementOfAnArray) {
    EXPECT_THAT(wordsFor(health, {CMPI_uint16A, std::vector<Value>{number(0), number(10), number(5)}}),
                ElementsAre("Unknown", "", "OK"));
    EXPECT_THAT(wordsFor(health, {CMPI_uint16A, std::vector<Value>{number(10), {CMPI_uint16, {}}}}), IsEmpty());
    EXPECT_THAT(wordsFor(health, {CMPI_uint16A, std::vector<Value>{}}), IsEmpty());
}

TEST(Qualifiers, HaveNoWordsForAnythingElse) {
    EXPECT_THAT(wordsFor(health, {CMPI_string, std::string("5")}), IsEmpty());
    EXPECT_THAT(wordsFor(health, {CMPI_uint16, {}}), IsEmpty());
    EXPECT_THAT(wordsFor({}, number(5)), IsEmpty());
    const Qualifiers unpaired = {{"ValueMap", qualifierValue({"1", "2"})}, {"Values", qualifierValue({"One"})}};
    EXPECT_THAT(wordsFor(unpaired, number(1)), ElementsAre("One"));
    EXPECT_THAT(wordsFor(unpaired, number(2)), IsEmpty());
}

TEST(Qualifiers, OfTheClassesBuiltInAreThoseOfTheMofFiles) {
    const Schema& schema = Schema::builtin();
    const PropertyDeclaration* automatic = schema.findProperty("VESKA_TimeService", "AutomaticDSTAdjustment");
    EXPECT_TRUE(isMarked(automatic->qualifiers, "Write"));
    EXPECT_FALSE(isMarked(schema.findProperty("VESKA_TimeService", "Region")->qualifiers, "Write"));
    EXPECT_THAT(textOf(automatic->qualifiers, "Description"), StartsWith("Whether the time zone in force"));
    EXPECT_THAT(wordsFor(schema.findProperty("VESKA_ComputerSystem", "HealthState")->qualifiers, number(5)),
                ElementsAre("OK"));
    const ClassDeclaration* package = schema.find("VESKA_ComputerSystemPackage");
    EXPECT_TRUE(isMarked(package->qualifiers, "Association"));
    EXPECT_EQ(textOf(package->qualifiers, "Version"), "1.0.0");
    const MethodDeclaration* manage = schema.findMethod("VESKA_TimeService", "ManageTime");
    EXPECT_EQ(textOf(manage->qualifiers, "Override"), "ManageTime");
    EXPECT_TRUE(isMarked(manage->parameters[1].qualifiers, "Out"));
}

} // namespace
} // namespace om
