#include "objectmanager/vkcim/FactsOutput.h"
#include "objectmanager/vkcim/MetricsOutput.h"

#include <gmock/gmock.h>
#include <nlohmann/json.hpp>

namespace vkcim {
namespace {

using nlohmann::json;
using testing::Eq;
using testing::HasSubstr;
using testing::Not;

const std::string nameSpace = "root/cimv2";

om::Value text(const char* value) {
    return {CMPI_string, std::string(value)};
}

om::Value number(std::uint64_t value) {
    return {CMPI_uint16, value};
}

om::Value list(CMPIType type, std::vector<om::Value> elements) {
    return {type, std::move(elements)};
}

om::Instance instance(const char* className, std::vector<om::NamedValue> properties) {
    return {{"", nameSpace, className, {{"Name", text("node7")}}}, std::move(properties)};
}

/// The facts of a host whose computer and chassis have these properties.
Facts factsOf(const std::vector<om::NamedValue>& computer,
              const std::vector<std::vector<om::NamedValue>>& chassis = {}) {
    const auto run = [&](const om::Request& request) {
        om::Answer answer;
        if (request.path.className == "VESKA_ComputerSystem")
            answer.results.emplace_back(instance("VESKA_ComputerSystem", computer));
        if (request.path.className == "VESKA_PhysicalPackage")
            for (const auto& each : chassis) answer.results.emplace_back(instance("VESKA_PhysicalPackage", each));
        EXPECT_EQ(request.operation, om::Operation::EnumInstances) << "facts change nothing";
        return answer;
    };
    return gatherFacts(
        om::Schema::builtin(), nameSpace, {}, run,
        [] {
            return HostClock{"20261121060000.123456-300", "-300"};
        },
        [] {
            return std::vector<std::string>{"no UUID: the host has none", "time service: NTP daemon running"};
        });
}

json jsonOf(const Facts& facts) {
    return json::parse(factsText(facts, nameSpace, om::Schema::builtin()));
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
    EXPECT_THAT(metricsText(facts, om::Schema::builtin(), false), Not(HasSubstr("vk_time_offset_minutes")));
}

std::string metrics(const Facts& facts, bool withSerials = false) {
    return metricsText(facts, om::Schema::builtin(), withSerials);
}

TEST(Metrics, AreATextForBothFormats) {
    Facts facts =
        factsOf({{"HealthState", number(10)}, {"OperationalStatus", list(CMPI_uint16A, {number(3), number(5)})}},
                {{{"Manufacturer", text("Example")}, {"Model", text("RX200")}, {"PackageType", number(2)}}});
    facts.timeServices = {instance("VESKA_TimeService", {{"AutomaticDSTAdjustment", {CMPI_boolean, true}}})};
    facts.time = "2026-11-21T06:00:00Z";
    EXPECT_EQ(metrics(facts), R"(# HELP vk_computer_health Health of the computer: 1 for the state that it is in.
# TYPE vk_computer_health gauge
vk_computer_health{vk_computer_health="OK"} 0
vk_computer_health{vk_computer_health="Degraded/Warning"} 1
# HELP vk_computer_operational_status Operational states of the computer: 1 for each that it is in.
# TYPE vk_computer_operational_status gauge
vk_computer_operational_status{vk_computer_operational_status="OK"} 0
vk_computer_operational_status{vk_computer_operational_status="Degraded"} 1
vk_computer_operational_status{vk_computer_operational_status="Predictive Failure"} 1
vk_computer_operational_status{vk_computer_operational_status="In Service"} 0
# HELP vk_chassis_info What each chassis is, always 1.
# TYPE vk_chassis_info gauge
vk_chassis_info{chassis="1",manufacturer="Example",model="RX200",type="Rack"} 1
# HELP vk_time_offset_minutes Minutes that local time is ahead of UTC.
# TYPE vk_time_offset_minutes gauge
vk_time_offset_minutes -300
# HELP vk_dst_adjustment Whether local time follows daylight saving.
# TYPE vk_dst_adjustment gauge
vk_dst_adjustment 1
# HELP vk_source_missing What the host does not say of itself, or says with a fault, always 1.
# TYPE vk_source_missing gauge
vk_source_missing{source="UUID"} 1
# HELP vk_report_timestamp_seconds When this was made, in seconds since 1970.
# TYPE vk_report_timestamp_seconds gauge
vk_report_timestamp_seconds 1795240800
# EOF
)");
}

TEST(Metrics, EscapeLabels) {
    EXPECT_THAT(metrics(factsOf({}, {{{"Model", text("a\"b\\c\nd\xff")}}})), HasSubstr(R"(model="a\"b\\c\nd)"
                                                                                       "\xef\xbf\xbd\"} 1\n"));
}

TEST(Metrics, HoldSerialNumbersOnlyWhereAsked) {
    const Facts facts =
        factsOf({{"UUID", text("4c4c4544")}}, {{{"SerialNumber", text("CZ1234")}, {"Tag", text("CZ1234")}}});
    EXPECT_THAT(metrics(facts), Not(HasSubstr("CZ1234")));
    EXPECT_THAT(metrics(facts, true), HasSubstr(R"(vk_chassis_info{chassis="1",serial="CZ1234"} 1)"));
    EXPECT_THAT(metrics(facts, true), Not(HasSubstr("4c4c4544")));
}

TEST(Metrics, TakeWhatIsMissingFromTheNotes) {
    const std::pair<const char*, std::optional<std::string>> notes[] = {
        {"no UUID: the host has none", "UUID"},
        {"no SMBIOS tables: /sys/firmware/dmi/tables/DMI may be read by root alone", "SMBIOS tables"},
        {"/sys/firmware/dmi/tables/DMI: the table ends early", "/sys/firmware/dmi/tables/DMI"},
        {"time service: NTP daemon running", std::nullopt},
        {"a note", std::nullopt},
        {"", std::nullopt}};
    for (const auto& [note, source] : notes) EXPECT_EQ(missingSource(note), source) << note;
}

} // namespace
} // namespace vkcim
