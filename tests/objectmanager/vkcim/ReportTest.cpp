#include "objectmanager/vkcim/Report.h"
#include "objectmanager/vkcim/TextOutput.h"
#include "tests/objectmanager/vkcim/TestSchema.h"

#include <gmock/gmock.h>
#include <sys/utsname.h>

namespace vkcim {
namespace {

using testing::ElementsAre;
using testing::Eq;

const std::string nameSpace = "root/cimv2";

om::ObjectPath path(const char* className, const char* key, const char* value) {
    return {"", "root/cimv2", className, {{key, {CMPI_string, std::string(value)}}}};
}

om::NamedValue reference(const char* name, const om::ObjectPath& to) {
    return {name, {CMPI_ref, std::make_shared<const om::ObjectPath>(to)}};
}

const om::ObjectPath computer = path("VESKA_ComputerSystem", "Name", "node7");

Report::Answers servedAssociations() {
    om::Answer packages, capabilities, affects;
    packages.results.emplace_back(om::Instance{
        path("VESKA_ComputerSystemPackage", "x", "y"),
        {reference("Antecedent", path("VESKA_PhysicalPackage", "Tag", "CZ1")), reference("Dependent", computer)}});
    capabilities.results.emplace_back(om::Instance{
        path("VESKA_ComputerCapabilities", "x", "y"),
        {reference("ManagedElement", computer),
         reference("Capabilities", path("VESKA_EnabledLogicalElementCapabilities", "InstanceID", "node7"))}});
    affects.code = CMPI_RC_ERR_INVALID_CLASS;
    return {{"VESKA_ComputerSystemPackage", packages},
            {"VESKA_ComputerCapabilities", capabilities},
            {"VESKA_TimeServiceAffectsElement", affects}};
}

TEST(Report, AsksEveryClassAndThenEveryAssociationOfTheSchema) {
    std::vector<std::string> asked;
    const Report report = makeReport(
        everythingServed(testSchema()), nameSpace, std::vector<std::string>{"Name"},
        [&](const om::Request& request) {
            asked.push_back(request.path.className);
            EXPECT_EQ(request.operation, om::Operation::EnumInstances);
            EXPECT_EQ(request.path.nameSpace, nameSpace);
            EXPECT_EQ(request.propertyList, std::vector<std::string>{"Name"});
            return om::Answer();
        },
        [] { return std::vector<std::string>{"a note"}; });
    EXPECT_THAT(asked, ElementsAre("Test_Thing", "Test_SpecialThing", "Test_Link"));
    EXPECT_EQ(report.classes.size(), 2u);
    EXPECT_EQ(report.associations.size(), 1u);
    EXPECT_THAT(report.notes, ElementsAre("a note"));
}

std::string hostOf(const om::Answer& computers) {
    const auto run = [&](const om::Request& request) {
        return request.path.className == "VESKA_ComputerSystem" ? computers : om::Answer();
    };
    return makeReport(everythingServed(om::Schema::builtin()), nameSpace, {}, run,
                      [] { return std::vector<std::string>(); })
        .host;
}

TEST(Report, IsHeadedByTheNameOfTheHostThatIsDescribed) {
    om::Answer computers;
    EXPECT_EQ(hostOf(computers), "without a name");
    computers.results.emplace_back(om::Instance{computer, {}});
    EXPECT_EQ(hostOf(computers), "node7");
}

TEST(Report, IsHeadedByThisHostsNameWhereNoComputerIsServed) {
    utsname names{};
    ASSERT_EQ(uname(&names), 0);
    om::Answer unserved;
    unserved.code = CMPI_RC_ERR_INVALID_CLASS;
    EXPECT_EQ(hostOf(unserved), names.nodename);
}

TEST(Report, DrawsEveryAssociationOfTheSchema) {
    const om::Schema& schema = om::Schema::builtin();
    for (const std::string& name : schema.servedAssociations()) {
        om::Instance instance;
        for (const om::PropertyDeclaration* key : schema.resolve(name)->keys)
            instance.properties.push_back(reference(key->name.c_str(), path("VESKA_ComputerSystem", "Name", "node7")));
        om::Answer answer;
        answer.results.emplace_back(instance);
        const std::vector<Link> drawn = links({{name, answer}}, nameSpace, schema);
        ASSERT_EQ(drawn.size(), 1u) << name << ": its references stand in no row of Report.cpp";
        EXPECT_EQ(drawn[0].above, drawn[0].below);
        EXPECT_EQ(drawn[0].association, name);
    }
}

TEST(Report, IsReadableForPeople) {
    om::Answer computers, unserved, failed;
    computers.results.emplace_back(om::Instance{
        computer,
        {{"Name", {CMPI_string, std::string("node7")}},
         {"OperationalStatus",
          {CMPI_uint16A, std::vector<om::Value>{{CMPI_uint16, std::uint64_t{2}}, {CMPI_uint16, std::uint64_t{11}}}}},
         {"UUID", {CMPI_string, std::string()}}}});
    unserved.code = CMPI_RC_ERR_INVALID_CLASS;
    failed.code = CMPI_RC_ERR_FAILED;
    failed.message = "no";
    Report report;
    report.host = "node7";
    report.classes = {{"VESKA_ComputerSystem", computers},
                      {"VESKA_PhysicalPackage", {}},
                      {"VESKA_TimeService", unserved},
                      {"VESKA_CIMServiceConfig", failed}};
    report.associations = servedAssociations();
    report.notes = {"no SMBIOS tables"};
    EXPECT_THAT(plainReport(report, {nameSpace, testSchema()}), Eq(R"(Host node7  root/cimv2

VESKA_ComputerSystem.Name="node7"
  Name               node7
  OperationalStatus  2, 11
  UUID               (empty)

VESKA_PhysicalPackage  no instance

VESKA_TimeService  not served: CMPI_RC_ERR_INVALID_CLASS

VESKA_CIMServiceConfig  answered CMPI_RC_ERR_FAILED (1), no

Associations
  VESKA_PhysicalPackage.Tag="CZ1"
  └─ VESKA_ComputerSystem.Name="node7"  (VESKA_ComputerSystemPackage)
     └─ VESKA_EnabledLogicalElementCapabilities.InstanceID="node7"  (VESKA_ComputerCapabilities)
  VESKA_TimeServiceAffectsElement  not served: CMPI_RC_ERR_INVALID_CLASS

Notes
  - no SMBIOS tables
)"));
}

TEST(TextOutput, ColoursHeadingsOnlyWhenAsked) {
    om::Answer answer;
    answer.results.emplace_back(om::Instance{computer, {}});
    EXPECT_EQ(plainAnswer(answer, {nameSpace, testSchema(), {}}), "VESKA_ComputerSystem.Name=\"node7\"\n");
    EXPECT_EQ(plainAnswer(answer, {nameSpace, testSchema(), {true}}),
              "\x1b[1mVESKA_ComputerSystem.Name=\"node7\"\x1b[0m\n");
}

TEST(TextOutput, HandsNoControlCharactersToTheTerminal) {
    om::Answer answer;
    const om::ObjectPath bad = path("VESKA_ComputerSystem", "Name", "a\x1b[2J\nb\x7f\xc2\x9b");
    answer.results.emplace_back(bad);
    answer.results.emplace_back(om::Instance{bad, {reference("\x1b", bad)}});
    const std::string shown = R"(VESKA_ComputerSystem.Name="a\x1b[2J\nb\x7f\x9b")";
    EXPECT_EQ(plainAnswer(answer, {nameSpace, testSchema()}), shown + "\n\n" + shown + "\n  \\x1b  " + shown + "\n");
}

TEST(TextOutput, SaysSoWhenNothingWasReturned) {
    EXPECT_EQ(plainAnswer({}, {nameSpace, testSchema()}), "(nothing returned)\n");
    om::Answer failed;
    failed.code = CMPI_RC_ERR_FAILED;
    EXPECT_EQ(plainAnswer(failed, {nameSpace, testSchema()}), "");
}

TEST(TextOutput, AMethodsReturnValueAndOutArgumentsAreATable) {
    om::Answer answer;
    answer.returnValue = om::Value{CMPI_uint32, std::uint64_t{0}};
    answer.out = {{"TimeData", {CMPI_dateTime, std::string("20261121060000.123456+000")}}};
    EXPECT_EQ(plainAnswer(answer, {nameSpace, testSchema()}), "  return value  0\n"
                                                              "  TimeData      20261121060000.123456+000\n");
}

} // namespace
} // namespace vkcim
