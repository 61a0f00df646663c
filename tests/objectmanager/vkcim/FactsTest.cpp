#include "objectmanager/vkcim/FactsOutput.h"
#include "tests/objectmanager/vkcim/TestFacts.h"

#include <gmock/gmock.h>
#include <nlohmann/json.hpp>

namespace vkcim {
namespace {

using nlohmann::json;

json jsonOf(const Facts& facts) {
    return json::parse(factsText(facts, testNameSpace, om::Schema::builtin()));
}

TEST(Facts, HoldWordsBesideNumbers) {
    const json facts = jsonOf(
        factsOf({{"HealthState", number(5)}, {"OperationalStatus", list(CMPI_uint16A, {number(2), number(4711)})}}));
    EXPECT_EQ(facts.at("host"), "node7");
    EXPECT_EQ(facts.at("health"), "OK");
    EXPECT_EQ(facts.at("computer_HealthState"), 5);
    EXPECT_EQ(facts.at("computer_HealthState_word"), "OK");
    EXPECT_EQ(facts.at("computer_OperationalStatus"), json({2, 4711}));
    EXPECT_EQ(facts.at("computer_OperationalStatus_words"), json({"OK", "4711"})) << "a number without a word";
}

TEST(Facts, LeaveOutWhatIsNotKnown) {
    const json facts = jsonOf(factsOf({{"CreationClassName", text("VESKA_ComputerSystem")},
                                       {"UUID", text("")},
                                       {"Status", text("Unknown")},
                                       {"Description", {CMPI_string, {}}},
                                       {"HealthState", number(0)},
                                       {"Dedicated", list(CMPI_uint16A, {})},
                                       {"OperationalStatus", list(CMPI_uint16A, {number(0)})},
                                       {"ElementName", text("node7")}}));
    std::vector<std::string> known;
    for (const auto& [key, value] : facts.items())
        if (key.rfind("computer", 0) == 0) known.push_back(key);
    EXPECT_THAT(known, testing::ElementsAre("computer_ElementName"));
    EXPECT_FALSE(facts.contains("health"));
}

TEST(Facts, HaveNoHostWhoseNameIsNotKnown) {
    for (const char* name : {"", "Unknown"}) EXPECT_FALSE(jsonOf(factsOf({}, {}, name)).contains("host")) << name;
    EXPECT_FALSE(jsonOf(factsFrom([](const om::Request&) { return om::Answer(); })).contains("host"));
}

TEST(Facts, NoteEachClassThatIsAnsweredWithAnError) {
    const json facts = jsonOf(factsFrom([](const om::Request& request) {
        om::Answer answer;
        if (request.path.className != "VESKA_TimeService") answer.code = CMPI_RC_ERR_ACCESS_DENIED;
        return answer;
    }));
    EXPECT_EQ(facts.at("notes"), json({"no VESKA_ComputerSystem: CMPI_RC_ERR_ACCESS_DENIED (2)",
                                       "no VESKA_PhysicalPackage: CMPI_RC_ERR_ACCESS_DENIED (2)",
                                       "no UUID: the host has none", "time service: NTP daemon ntpd running"}));
}

TEST(Facts, KeepIdentifiersAndTheirDescriptionsTogether) {
    const json facts = jsonOf(
        factsOf({{"OtherIdentifyingInfo", list(CMPI_stringA, {text("a"), text(""), text("c")})},
                 {"IdentifyingDescriptions", list(CMPI_stringA, {text("CIM:A"), text("CIM:B"), text("CIM:C")})}}));
    EXPECT_EQ(facts.at("computer_OtherIdentifyingInfo"), json({"a", "c"}));
    EXPECT_EQ(facts.at("computer_IdentifyingDescriptions"), json({"CIM:A", "CIM:C"}));
}

TEST(Facts, NumberAllButTheFirst) {
    const json facts = jsonOf(factsOf({}, {{{"Model", text("RX200")}}, {{"Model", text("RX300")}}}));
    EXPECT_EQ(facts.at("chassis_Model"), "RX200");
    EXPECT_EQ(facts.at("chassis2_Model"), "RX300");
}

TEST(Facts, HoldTheClockWhereItIsKnown) {
    Facts facts = factsOf({});
    EXPECT_EQ(jsonOf(facts).at("time_service_time"), "20261121060000.123456-300");
    EXPECT_EQ(jsonOf(facts).at("time_service_offset_minutes"), -300);
    facts.clock = {};
    EXPECT_FALSE(jsonOf(facts).contains("time_service_time"));
    EXPECT_FALSE(jsonOf(facts).contains("time_service_offset_minutes"));
}

TEST(Facts, HaveNoTimeThatIsNoDateTime) {
    const auto nothing = [](const om::Request&) { return om::Answer(); };
    for (const char* time : {"soon", "Unknown", "20261121******.******+000", "00000001000000.000000:000"}) {
        const json facts = jsonOf(factsFrom(nothing, time));
        EXPECT_FALSE(facts.contains("time_service_time")) << time;
        EXPECT_EQ(facts.at("time_service_offset_minutes"), -300);
    }
}

} // namespace
} // namespace vkcim
