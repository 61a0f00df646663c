#include "support/Provider.h"
#include "support/SimulatedHost.h"

#include <gmock/gmock.h>

#include <set>

#include <unistd.h>

// Every association class × every source × every result class × names and instances, on a host of one computer with one
// chassis. The groups below state what comes back; a dimension that a group leaves empty stands for all of its values.

namespace {

enum Association {
    CapVeska,
    CapCim,
    PkgVeska,
    PkgCim,
    PkgBase,
    PkgBaseBase,
    TimeVeska,
    TimeCim,
    Unknown,
    NotOne,
    Null,
    Empty
};
enum Source { Computer, Chassis, Capabilities, TimeService, Foreign };
enum Keys { Keyless, Right, WrongValue, WrongName };
enum ResultClass { None, Blank, Veska, Cim, OtherCase, Unrelated };
enum Outcome { Nothing, TheComputer, TheChassis, TheCapabilities, TheTimeService, Everything, AllButTheChassis };

constexpr Association associations[] = {CapVeska,  CapCim,  PkgVeska, PkgCim, PkgBase, PkgBaseBase,
                                        TimeVeska, TimeCim, Unknown,  NotOne, Null,    Empty};
constexpr Source sources[] = {Computer, Chassis, Capabilities, TimeService, Foreign};
constexpr Keys keyings[] = {Keyless, Right, WrongValue, WrongName};
constexpr ResultClass resultClasses[] = {None, Blank, Veska, Cim, OtherCase, Unrelated};

const std::set<Association> capabilitiesFamily = {CapVeska, CapCim};
const std::set<Association> packageFamily = {PkgVeska, PkgCim, PkgBase, PkgBaseBase};
const std::set<Association> timeFamily = {TimeVeska, TimeCim};
const std::set<ResultClass> reachable = {None, Blank, Veska, Cim, OtherCase};
constexpr bool closed = true;
constexpr bool open = false; // the operation ended with an exception, or with an error

struct Group {
    const char* name;
    std::set<Association> associations;
    std::set<Source> sources;
    std::set<Keys> keys;
    std::set<ResultClass> resultClasses;
    Outcome outcome;
    CMPIrc code;
    bool done;
};

const std::vector<Group> groups = {
    {"no such association", {Unknown, NotOne}, {}, {}, {}, Nothing, CMPI_RC_ERR_INVALID_CLASS, open},

    // No class stands for all three. An end that is not found ends the request.
    {"computer to all", {Null, Empty}, {Computer}, {Keyless, Right}, reachable, Everything, CMPI_RC_OK, closed},
    {"computer to all but the chassis",
     {Null, Empty},
     {Computer},
     {Keyless, Right},
     {Unrelated},
     AllButTheChassis,
     CMPI_RC_OK,
     closed},
    {"unknown computer to all", {Null, Empty}, {Computer}, {WrongValue, WrongName}, {}, Nothing, CMPI_RC_OK, open},
    {"chassis through all", {Null, Empty}, {Chassis}, {Keyless, Right}, reachable, TheComputer, CMPI_RC_OK, closed},
    {"chassis through all to another class",
     {Null, Empty},
     {Chassis},
     {Keyless, Right},
     {Unrelated},
     Nothing,
     CMPI_RC_OK,
     closed},
    {"unknown chassis through all", {Null, Empty}, {Chassis}, {WrongValue, WrongName}, {}, Nothing, CMPI_RC_OK, open},
    {"capabilities through all", {Null, Empty}, {Capabilities}, {Keyless, Right}, {}, TheComputer, CMPI_RC_OK, closed},
    {"unknown capabilities through all",
     {Null, Empty},
     {Capabilities},
     {WrongValue, WrongName},
     {},
     Nothing,
     CMPI_RC_OK,
     open},
    {"time service through all", {Null, Empty}, {TimeService}, {}, {}, TheComputer, CMPI_RC_OK, closed},
    {"others through all", {Null, Empty}, {Foreign}, {}, {}, Nothing, CMPI_RC_OK, closed},

    // The result class is only looked at by the package association.
    {"computer to capabilities",
     capabilitiesFamily,
     {Computer},
     {Keyless, Right},
     {},
     TheCapabilities,
     CMPI_RC_OK,
     closed},
    {"unknown computer to capabilities", capabilitiesFamily, {Computer}, {WrongValue}, {}, Nothing, CMPI_RC_OK, closed},
    {"computer without Name to capabilities",
     capabilitiesFamily,
     {Computer},
     {WrongName},
     {},
     Nothing,
     CMPI_RC_OK,
     open},
    {"capabilities to computer",
     capabilitiesFamily,
     {Capabilities},
     {Keyless, Right},
     {},
     TheComputer,
     CMPI_RC_OK,
     closed},
    {"unknown capabilities to computer",
     capabilitiesFamily,
     {Capabilities},
     {WrongValue, WrongName},
     {},
     Nothing,
     CMPI_RC_OK,
     open},
    {"others through capabilities",
     capabilitiesFamily,
     {Chassis, TimeService, Foreign},
     {},
     {},
     Nothing,
     CMPI_RC_OK,
     closed},

    {"computer to chassis", packageFamily, {Computer}, {Keyless, Right}, reachable, TheChassis, CMPI_RC_OK, closed},
    {"chassis to computer", packageFamily, {Chassis}, {Keyless, Right}, reachable, TheComputer, CMPI_RC_OK, closed},
    {"either to another class",
     packageFamily,
     {Computer, Chassis},
     {Keyless, Right},
     {Unrelated},
     Nothing,
     CMPI_RC_OK,
     closed},
    {"either end unknown", packageFamily, {Computer, Chassis}, {WrongValue, WrongName}, {}, Nothing, CMPI_RC_OK, open},
    {"others through package",
     packageFamily,
     {Capabilities, TimeService, Foreign},
     {},
     {},
     Nothing,
     CMPI_RC_OK,
     closed},

    // Both ends are this host, whatever the keys say.
    {"computer to time service", timeFamily, {Computer}, {}, {}, TheTimeService, CMPI_RC_OK, closed},
    {"time service to computer", timeFamily, {TimeService}, {}, {}, TheComputer, CMPI_RC_OK, closed},
    {"others through time service", timeFamily, {Chassis, Capabilities, Foreign}, {}, {}, Nothing, CMPI_RC_OK, closed},
};

std::string hostName() {
    char name[128] = {};
    gethostname(name, sizeof name - 1);
    return name;
}

std::optional<std::string> nameOf(Association association) {
    switch (association) {
    case CapVeska:
        return "VESKA_ComputerCapabilities";
    case CapCim:
        return "CIM_ElementCapabilities";
    case PkgVeska:
        return "VESKA_ComputerSystemPackage";
    case PkgCim:
        return "CIM_ComputerSystemPackage";
    case PkgBase:
        return "CIM_SystemPackaging";
    case PkgBaseBase:
        return "CIM_Dependency";
    case TimeVeska:
        return "VESKA_TimeServiceAffectsElement";
    case TimeCim:
        return "CIM_ServiceAffectsElement";
    case Unknown:
        return "VESKA_Nothing";
    case NotOne:
        return "VESKA_ComputerSystem";
    case Null:
        return {};
    case Empty:
        return "";
    }
    throw std::logic_error("association");
}

struct SourceText {
    const char* className;
    const char* key;
    std::string value;
};

SourceText textOf(Source source) {
    switch (source) {
    case Computer:
        return {"VESKA_ComputerSystem", "Name", hostName()};
    case Chassis:
        return {"VESKA_PhysicalPackage", "Tag", "CZ1234"};
    case Capabilities:
        return {"VESKA_EnabledLogicalElementCapabilities", "InstanceID", "/computer/0"};
    case TimeService:
        return {"VESKA_TimeService", "Name", "TimeService@" + hostName()};
    case Foreign:
        return {"VESKA_Fan", "DeviceID", "1"};
    }
    throw std::logic_error("source");
}

om::ObjectPath pathOf(Source source, Keys keys) {
    const SourceText text = textOf(source);
    std::string lowerKey = text.key;
    lowerKey[0] = static_cast<char>(std::tolower(lowerKey[0]));
    switch (keys) {
    case Keyless:
        return test::path(text.className);
    case Right:
        return test::path(text.className, {{text.key, text.value}});
    case WrongValue:
        return test::path(text.className, {{text.key, text.value + "x"}});
    case WrongName:
        return test::path(text.className, {{lowerKey, text.value}});
    }
    throw std::logic_error("keys");
}

/// The class at the other end, without its prefix.
std::string otherEnd(Association association, Source source) {
    if (source != Computer) return "ComputerSystem";
    if (capabilitiesFamily.count(association) != 0) return "EnabledLogicalElementCapabilities";
    return timeFamily.count(association) != 0 ? "TimeService" : "PhysicalPackage";
}

std::optional<std::string> nameOf(ResultClass resultClass, const std::string& otherEnd) {
    switch (resultClass) {
    case None:
        return {};
    case Blank:
        return "";
    case Veska:
        return "VESKA_" + otherEnd;
    case Cim:
        return "CIM_" + otherEnd;
    case OtherCase: {
        std::string name = "cim_" + otherEnd;
        for (char& c : name) c = static_cast<char>(std::tolower(c));
        return name;
    }
    case Unrelated:
        return "CIM_Fan";
    }
    throw std::logic_error("result class");
}

std::vector<std::string> expectedPaths(Outcome outcome);

std::vector<std::string> expectedPaths(const std::vector<Outcome>& outcomes) {
    std::vector<std::string> all;
    for (const Outcome each : outcomes)
        for (const std::string& path : expectedPaths(each)) all.push_back(path);
    return all;
}

std::vector<std::string> expectedPaths(Outcome outcome) {
    const std::string host = hostName();
    switch (outcome) {
    case Nothing:
        return {};
    case TheComputer:
        return {"VESKA_ComputerSystem.CreationClassName=\"VESKA_ComputerSystem\",Name=\"" + host + "\""};
    case TheChassis:
        return {"VESKA_PhysicalPackage.CreationClassName=\"VESKA_PhysicalPackage\",Tag=\"CZ1234\""};
    case TheCapabilities:
        return {"VESKA_EnabledLogicalElementCapabilities.InstanceID=\"/computer/0\""};
    case TheTimeService:
        return {"VESKA_TimeService.Name=\"TimeService@" + host +
                "\",CreationClassName=\"VESKA_TimeService\",SystemName=\"" + host +
                "\",SystemCreationClassName=\"VESKA_ComputerSystem\""};
    case Everything:
        return expectedPaths(std::vector{TheCapabilities, TheChassis, TheTimeService});
    case AllButTheChassis:
        return expectedPaths(std::vector{TheCapabilities, TheTimeService});
    }
    throw std::logic_error("outcome");
}

template <class Value>
bool matches(const std::set<Value>& values, Value value) {
    return values.empty() || values.count(value) != 0;
}

TEST(AssociationMatrix, EveryCombinationAnswersAsItsOneGroupSays) {
    test::simulate({test::computer(0, hostName()), test::chassis(0, 0, "CZ1234")});
    std::set<const Group*> used;
    int combinations = 0;
    for (const Association association : associations)
        for (const Source source : sources)
            for (const Keys keys : keyings)
                for (const ResultClass resultClass : resultClasses) {
                    const std::optional<std::string> assocName = nameOf(association);
                    const std::optional<std::string> resultName = nameOf(resultClass, otherEnd(association, source));
                    const om::ObjectPath from = pathOf(source, keys);
                    SCOPED_TRACE("from " + test::print(from) + " through " + assocName.value_or("(null)") + " to " +
                                 resultName.value_or("(null)"));
                    const Group* found = nullptr;
                    for (const Group& group : groups) {
                        if (!matches(group.associations, association) || !matches(group.sources, source) ||
                            !matches(group.keys, keys) || !matches(group.resultClasses, resultClass))
                            continue;
                        ASSERT_EQ(found, nullptr) << "both in '" << found->name << "' and '" << group.name << "'";
                        found = &group;
                    }
                    ASSERT_NE(found, nullptr) << "in no group";
                    used.insert(found);
                    SCOPED_TRACE(found->name);

                    const om::Answer names = test::associatorNames(from, assocName, resultName);
                    const om::Answer instances = test::associators(from, assocName, resultName);
                    std::vector<std::string> namedPaths;
                    for (const om::ObjectPath& path : test::paths(names)) namedPaths.push_back(test::print(path));
                    std::vector<std::string> instancePaths;
                    for (const om::Instance& instance : test::instancesOf(instances))
                        instancePaths.push_back(test::print(instance.path));
                    EXPECT_EQ(namedPaths, expectedPaths(found->outcome));
                    EXPECT_EQ(instancePaths, expectedPaths(found->outcome));
                    for (const om::Answer* answer : {&names, &instances}) {
                        EXPECT_EQ(answer->code, found->code);
                        EXPECT_EQ(answer->message, std::nullopt);
                        EXPECT_EQ(answer->done, found->done);
                    }
                    ++combinations;
                }
    EXPECT_EQ(combinations, 12 * 5 * 4 * 6);
    EXPECT_EQ(used.size(), groups.size()) << "a group that no combination falls into";
}

} // namespace
