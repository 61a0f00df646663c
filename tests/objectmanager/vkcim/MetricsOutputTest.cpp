#include "objectmanager/vkcim/MetricsOutput.h"
#include "tests/objectmanager/vkcim/TestFacts.h"

#include <gmock/gmock.h>

namespace vkcim {
namespace {

using testing::HasSubstr;
using testing::Not;

std::string metrics(const Facts& facts, bool withSerials = false) {
    return metricsText(facts, om::Schema::builtin(), withSerials);
}

TEST(Metrics, AreATextForBothFormats) {
    Facts facts =
        factsOf({{"HealthState", number(10)}, {"OperationalStatus", list(CMPI_uint16A, {number(3), number(5)})}},
                {{{"Manufacturer", text("Example")}, {"Model", text("RX200")}, {"PackageType", number(2)}}});
    facts.timeServices = {instance("VESKA_TimeService", {{"AutomaticDSTAdjustment", {CMPI_boolean, true}}})};
    facts.time = 1795240800;
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

TEST(Metrics, LeaveOutStatesThatTheSchemaHasNoWordFor) {
    EXPECT_THAT(metrics(factsOf({{"HealthState", number(4711)}})), Not(HasSubstr("vk_computer_health")));
    EXPECT_THAT(metrics(factsOf({{"OperationalStatus", list(CMPI_uint16A, {number(4711), number(4712)})}})),
                Not(HasSubstr("vk_computer_operational_status")));
    EXPECT_THAT(metrics(factsOf({{"OperationalStatus", list(CMPI_uint16A, {number(4711), number(3)})}})),
                HasSubstr("{vk_computer_operational_status=\"Degraded\"} 1"));
}

TEST(Metrics, LeaveOutAnOffsetThatIsNotKnown) {
    Facts facts = factsOf({});
    EXPECT_THAT(metrics(facts), HasSubstr("vk_time_offset_minutes -300\n"));
    facts.clock = {};
    EXPECT_THAT(metrics(facts), Not(HasSubstr("vk_time_offset_minutes")));
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

TEST(Metrics, HaveOneSampleForSourcesThatAreShownAlike) {
    Facts facts = factsOf({});
    facts.notes = {"/a\xff: is broken", "/a\xfe: is broken", "/a\xff: is broken"};
    EXPECT_THAT(metrics(facts), HasSubstr("always 1.\n# TYPE vk_source_missing gauge\n"
                                          "vk_source_missing{source=\"/a\xef\xbf\xbd\"} 1\n# HELP"));
}

TEST(Metrics, TakeWhatIsMissingFromTheNotes) {
    const std::pair<const char*, std::optional<std::string>> notes[] = {
        {"no UUID: the host has none", "UUID"},
        {"no SMBIOS tables: /sys/firmware/dmi/tables/DMI may be read by root alone", "SMBIOS tables"},
        {"/sys/firmware/dmi/tables/DMI: the table ends early", "/sys/firmware/dmi/tables/DMI"},
        {"no VESKA_ComputerSystem: CMPI_RC_ERR_ACCESS_DENIED (2)", "VESKA_ComputerSystem"},
        {"time service: NTP daemon ntpd running", std::nullopt},
        {"no /usr/sbin/cimconfig: the delivery settings of the CIM server read as 0", std::nullopt},
        {"a note", std::nullopt},
        {"", std::nullopt}};
    for (const auto& [note, source] : notes) EXPECT_EQ(missingSource(note), source) << note;
}

} // namespace
} // namespace vkcim
