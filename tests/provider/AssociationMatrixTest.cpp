#include "support/HostName.h"
#include "support/Requests.h"
#include "support/SimulatedHost.h"

#include <gmock/gmock.h>

#include <algorithm>
#include <cstring>
#include <set>

// Every association class × every source × every result class × names and instances, on a host of one computer with one
// chassis. The groups below state what comes back; each value of a dimension has a letter, and a dimension that a group
// leaves empty stands for all of its values.

namespace {

/// C, P and T: one of the three, or what it derives from. A: all three. N: none.
const std::pair<char, std::optional<std::string>> associations[] = {
    {'C', "VESKA_ComputerCapabilities"},
    {'C', "CIM_ElementCapabilities"},
    {'P', "VESKA_ComputerSystemPackage"},
    {'P', "CIM_ComputerSystemPackage"},
    {'P', "CIM_SystemPackaging"},
    {'P', "CIM_Dependency"},
    {'T', "VESKA_TimeServiceAffectsElement"},
    {'T', "CIM_ServiceAffectsElement"},
    {'N', "VESKA_Nothing"},
    {'N', "VESKA_ComputerSystem"},
    {'A', std::nullopt},
    {'A', ""},
};

struct Source {
    char letter;
    const char* className;
    const char* key;
    std::string value;
    std::string path; ///< as it is answered
};

std::vector<Source> sources() {
    const std::string host = test::hostName();
    return {
        {'C', "VESKA_ComputerSystem", "Name", host,
         R"(VESKA_ComputerSystem.CreationClassName="VESKA_ComputerSystem",Name=")" + host + "\""},
        {'P', "VESKA_PhysicalPackage", "Tag", "CZ1234",
         R"(VESKA_PhysicalPackage.CreationClassName="VESKA_PhysicalPackage",Tag="CZ1234")"},
        {'L', "VESKA_EnabledLogicalElementCapabilities", "InstanceID", "/computer/0",
         R"(VESKA_EnabledLogicalElementCapabilities.InstanceID="/computer/0")"},
        {'T', "VESKA_TimeService", "Name", "TimeService@" + host,
         "VESKA_TimeService.Name=\"TimeService@" + host + R"(",CreationClassName="VESKA_TimeService",SystemName=")" +
             host + R"(",SystemCreationClassName="VESKA_ComputerSystem")"},
        {'F', "VESKA_Fan", "DeviceID", "1", ""},
    };
}

/// None, the right one, one of another value, one of another spelling.
constexpr char keyings[] = "-rvs";
/// None, an empty one, the class at the other end, the one that it derives from, in small letters, an unrelated one.
constexpr char resultClasses[] = "-evclu";

constexpr char known[] = "-r";
constexpr char unknown[] = "vs";
constexpr char reachable[] = "-evcl";
constexpr bool closed = true;
constexpr bool open = false; // the operation ended with an exception, or with an error

struct Group {
    const char* name;
    const char* associations;
    const char* sources;
    const char* keys;
    const char* resultClasses;
    const char* results; ///< letters of sources
    bool done;
    CMPIrc code = CMPI_RC_OK;
};

// clang-format off
constexpr Group groups[] = {
    {"no such association", "N", "", "", "", "", open, CMPI_RC_ERR_INVALID_CLASS},

    // No class stands for all three. An end that is not found ends the request.
    {"computer to all",                      "A", "C",   known,   reachable, "LPT", closed},
    {"computer to all but the chassis",      "A", "C",   known,   "u",       "LT",  closed},
    {"unknown computer to all",              "A", "C",   unknown, "",        "",    open},
    {"chassis through all",                  "A", "P",   known,   reachable, "C",   closed},
    {"chassis through all to another class", "A", "P",   known,   "u",       "",    closed},
    {"unknown chassis through all",          "A", "P",   unknown, "",        "",    open},
    {"capabilities through all",             "A", "L",   known,   "",        "C",   closed},
    {"unknown capabilities through all",     "A", "L",   unknown, "",        "",    open},
    {"time service through all",             "A", "T",   "",      "",        "C",   closed},
    {"others through all",                   "A", "F",   "",      "",        "",    closed},

    // The result class is only looked at by the package association.
    {"computer to capabilities",              "C", "C",   known,   "", "L", closed},
    {"unknown computer to capabilities",      "C", "C",   "v",     "", "",  closed},
    {"computer without Name to capabilities", "C", "C",   "s",     "", "",  open},
    {"capabilities to computer",              "C", "L",   known,   "", "C", closed},
    {"unknown capabilities to computer",      "C", "L",   unknown, "", "",  open},
    {"others through capabilities",           "C", "PTF", "",      "", "",  closed},

    {"computer to chassis",     "P", "C",   known,   reachable, "P", closed},
    {"chassis to computer",     "P", "P",   known,   reachable, "C", closed},
    {"either to another class", "P", "CP",  known,   "u",       "",  closed},
    {"either end unknown",      "P", "CP",  unknown, "",        "",  open},
    {"others through package",  "P", "LTF", "",      "",        "",  closed},

    // Both ends are this host, whatever the keys say.
    {"computer to time service",    "T", "C",   "", "", "T", closed},
    {"time service to computer",    "T", "T",   "", "", "C", closed},
    {"others through time service", "T", "PLF", "", "", "",  closed},
};
// clang-format on

om::ObjectPath pathOf(const Source& source, char keys) {
    std::string key = source.key;
    if (keys == 's') key[0] = static_cast<char>(std::tolower(key[0]));
    if (keys == '-') return test::path(source.className);
    return test::path(source.className, {{key, source.value + (keys == 'v' ? "x" : "")}});
}

/// The class at the other end, without its prefix.
std::string otherEnd(char association, char source) {
    if (source != 'C') return "ComputerSystem";
    if (association == 'C') return "EnabledLogicalElementCapabilities";
    return association == 'T' ? "TimeService" : "PhysicalPackage";
}

std::optional<std::string> nameOf(char resultClass, const std::string& otherEnd) {
    if (resultClass == '-') return {};
    if (resultClass == 'e') return "";
    if (resultClass == 'u') return "CIM_Fan";
    std::string name = (resultClass == 'v' ? "VESKA_" : "CIM_") + otherEnd;
    if (resultClass == 'l')
        for (char& c : name) c = static_cast<char>(std::tolower(c));
    return name;
}

bool holds(const char* letters, char letter) {
    return *letters == '\0' || std::strchr(letters, letter) != nullptr;
}

/// The groups that a combination falls into.
std::vector<const Group*> groupsOf(char association, char source, char keys, char resultClass) {
    std::vector<const Group*> found;
    for (const Group& group : groups)
        if (holds(group.associations, association) && holds(group.sources, source) && holds(group.keys, keys) &&
            holds(group.resultClasses, resultClass))
            found.push_back(&group);
    return found;
}

void expectOutcome(const Group& group, const om::Answer& names, const om::Answer& instances) {
    std::vector<std::string> expected;
    for (const char* letter = group.results; *letter != '\0'; ++letter)
        for (const Source& source : sources())
            if (source.letter == *letter) expected.push_back(source.path);
    std::vector<std::string> ofInstances;
    for (const om::Instance& instance : test::instancesOf(instances)) ofInstances.push_back(test::print(instance.path));
    EXPECT_EQ(test::printed(names), expected);
    EXPECT_EQ(ofInstances, expected);
    for (const om::Answer* answer : {&names, &instances}) {
        EXPECT_EQ(answer->code, group.code);
        EXPECT_EQ(answer->message, std::nullopt);
        EXPECT_EQ(answer->done, group.done);
    }
}

TEST(AssociationMatrix, EveryCombinationAnswersAsItsOneGroupSays) {
    test::simulate({test::computer(0, test::hostName()), test::chassis(0, 0, "CZ1234")});
    std::set<const Group*> used;
    int combinations = 0;
    for (const auto& [association, name] : associations)
        for (const Source& source : sources())
            for (const char keys : std::string(keyings))
                for (const char resultClass : std::string(resultClasses)) {
                    const om::ObjectPath from = pathOf(source, keys);
                    const auto result = nameOf(resultClass, otherEnd(association, source.letter));
                    SCOPED_TRACE("from " + test::print(from) + " through " + name.value_or("(null)") + " to " +
                                 result.value_or("(null)"));
                    const auto found = groupsOf(association, source.letter, keys, resultClass);
                    ASSERT_EQ(found.size(), 1U) << "groups";
                    SCOPED_TRACE(found[0]->name);
                    expectOutcome(*found[0], test::associatorNames(from, name, result),
                                  test::associators(from, name, result));
                    used.insert(found[0]);
                    ++combinations;
                }
    EXPECT_EQ(combinations, 12 * 5 * 4 * 6);
    EXPECT_EQ(used.size(), std::size(groups)) << "a group that no combination falls into";
}

} // namespace
