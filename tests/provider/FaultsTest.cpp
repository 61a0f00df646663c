// Every request that reads, and every one that is not served, with every call that it makes to the object manager
// failing in turn.
#include "provider/FaultRuns.h"

#include <gmock/gmock.h>

namespace {

using om::Operation;
using test::asking;
using test::FaultCase;
using test::isOneOf;
using test::Outcome;

std::vector<FaultCase> instanceCases() {
    std::vector<FaultCase> cases;
    for (const std::string& className : om::Schema::builtin().served()) {
        const om::ObjectPath keyless = test::path(className);
        cases.push_back({"names of " + className, asking(Operation::EnumInstanceNames, keyless)});
        cases.push_back({"instances of " + className, asking(Operation::EnumInstances, keyless)});
        cases.push_back({"keyless get of " + className, asking(Operation::GetInstance, keyless)});
        for (const om::ObjectPath& path : test::paths(test::names(className)))
            cases.push_back({"get of " + test::print(path), asking(Operation::GetInstance, path)});
    }
    return cases;
}

struct Association {
    const char* name;
    std::vector<const char*> sources;
    std::optional<std::string> resultClass = {};
};

const Association associations[] = {
    {"VESKA_ComputerCapabilities", {"VESKA_ComputerSystem", "VESKA_EnabledLogicalElementCapabilities"}},
    {"CIM_ElementCapabilities", {"VESKA_ComputerSystem"}},
    {"VESKA_ComputerSystemPackage", {"VESKA_ComputerSystem", "VESKA_PhysicalPackage"}},
    {"VESKA_ComputerSystemPackage", {"VESKA_ComputerSystem"}, "CIM_PhysicalPackage"},
    {"VESKA_ComputerSystemPackage", {"VESKA_ComputerSystem"}, "CIM_ComputerSystem"}, // of which there is none there
    {"CIM_ComputerSystemPackage", {"VESKA_PhysicalPackage"}},
    {"VESKA_TimeServiceAffectsElement", {"VESKA_ComputerSystem", "VESKA_TimeService"}},
    {"CIM_ServiceAffectsElement", {"VESKA_TimeService"}},
    {"CIM_Dependency", {"VESKA_ComputerSystem"}},        // above two of the three
    {"", {"VESKA_ComputerSystem", "VESKA_TimeService"}}, // all three
};

std::vector<FaultCase> associationCases() {
    std::vector<FaultCase> cases;
    for (const Association& association : associations) {
        for (const char* className : association.sources) {
            std::vector<om::ObjectPath> sources = test::paths(test::names(className));
            sources.push_back(test::path(className));
            for (const om::ObjectPath& source : sources) {
                for (const Operation operation : {Operation::AssociatorNames, Operation::Associators}) {
                    om::Request request = asking(operation, source);
                    request.assocClass = association.name;
                    request.resultClass = association.resultClass;
                    const char* const what =
                        operation == Operation::Associators ? "associators of " : "associator names of ";
                    cases.push_back({what + test::print(source) + " through " + association.name + " to " +
                                         association.resultClass.value_or("any"),
                                     request});
                }
            }
        }
    }
    return cases;
}

/// Without them the provider does not know what is asked for: the class, the namespace, the keys.
const std::set<std::string> telling = {"getClassName", "getCharPtr",  "classPathIsA", "getNameSpace",
                                       "getKey",       "getKeyCount", "getKeyAt"};

/// Without its name a class may count as one that is not known. Paths are made to ask about relations of classes.
bool mayHideTheClass(const std::string& kind) {
    return isOneOf(kind, {"getClassName", "getCharPtr", "classPathIsA", "newObjectPath"});
}

bool isAssociated(const om::Request& request) {
    return request.operation == Operation::Associators || request.operation == Operation::AssociatorNames;
}

/// The elements that one refused call may cost: one, but
/// - all of the request's where the provider does not know what is asked for;
/// - all at the other end of an association where the one path is refused that chooses them;
/// - a computer's chassis in a walk of their associations, which are found by the computer's path.
std::size_t mostLost(const om::Request& request, const std::string& kind, const Outcome& whole) {
    const bool choosing = isOneOf(kind, {"newObjectPath", "addKey"});
    if (isOneOf(kind, telling) || (choosing && isAssociated(request))) return whole.answer.results.size();
    return choosing && request.path.className == "VESKA_ComputerSystemPackage" ? test::mostChassis : 1;
}

/// The status is that of the answer without a fault, unless the provider could not read the class.
void checkStatus(const std::string& kind, const om::Answer& answer, const om::Answer& whole) {
    EXPECT_FALSE(answer.message);
    if (answer.code == whole.code) return;
    EXPECT_EQ(whole.code, CMPI_RC_OK);
    EXPECT_EQ(answer.code, CMPI_RC_ERR_INVALID_CLASS);
    EXPECT_TRUE(mayHideTheClass(kind));
    EXPECT_TRUE(answer.results.empty());
}

/// Whether it is closed as it is without a fault, or is not for a reason that the log says.
void checkDone(const std::string& kind, const Outcome& outcome, const Outcome& whole, bool thrown) {
    const bool cut = thrown || outcome.answer.code != whole.answer.code || kind == "returnDone";
    EXPECT_EQ(outcome.answer.done, whole.answer.done && !cut);
}

void checkOneFault(const FaultCase& each, const std::string& kind, const Outcome& outcome, const Outcome& whole) {
    checkStatus(kind, outcome.answer, whole.answer);
    const test::Loss loss = test::compare(outcome.answer, whole.answer);
    const std::vector<std::string> lines = test::added(outcome.lines, whole.lines);
    const bool changed = loss.elements + loss.properties > 0 || outcome.answer.code != whole.answer.code ||
                         outcome.answer.done != whole.answer.done;
    EXPECT_LE(lines.size(), 1u) << testing::PrintToString(lines);
    const bool miss = kind == "returnDone" && whole.answer.results.empty(); // which is no failure
    EXPECT_EQ(changed && lines.empty(), miss && whole.answer.done) << "nothing tells of it";
    const bool thrown = !lines.empty() && test::tellsException(lines[0]);
    EXPECT_TRUE(!thrown || isOneOf(kind, telling)) << lines[0];
    checkDone(kind, outcome, whole, thrown);
    EXPECT_LE(loss.elements, mostLost(each.request, kind, whole));
    if (isAssociated(each.request) && !thrown) {
        EXPECT_LE(loss.besideOthers, 1u) << "all of an association's, or one of them";
    }
    EXPECT_LE(loss.properties, loss.elements == 0 ? 1u : 0u);
    if (isOneOf(kind, {"setProperty", "newArray", "setElementAt", "newString"})) {
        EXPECT_EQ(loss.properties, 1u);
    }
    EXPECT_EQ(outcome.host, whole.host);
}

/// For a namespace, key, text or relation that the object manager says is not there: the request is another one then.
void checkOtherRequest(const std::string& kind, const Outcome& outcome, const Outcome& whole) {
    if (outcome.answer.code != whole.answer.code) checkStatus(kind, outcome.answer, whole.answer);
    EXPECT_LE(test::added(outcome.lines, whole.lines).size(), 1u);
    EXPECT_EQ(outcome.host, whole.host);
}

/// Where every call of a kind fails, each loss has its line.
void checkLastingFault(const FaultCase& each, const std::string& kind, const Outcome& outcome, const Outcome& whole) {
    checkStatus(kind, outcome.answer, whole.answer);
    const test::Loss loss = test::compare(outcome.answer, whole.answer);
    const std::vector<std::string> lines = test::added(outcome.lines, whole.lines);
    const bool thrown = !lines.empty() && test::tellsException(lines.back());
    EXPECT_TRUE(!thrown || isOneOf(kind, telling)) << lines.back();
    checkDone(kind, outcome, whole, thrown);
    const std::size_t lost = loss.elements + loss.properties;
    if (lost > 0) {
        EXPECT_GE(lines.size(), 1u);
    }
    const bool oneByOne =
        !isOneOf(kind, telling) && !isAssociated(each.request) && mostLost(each.request, kind, whole) == 1;
    if (oneByOne && kind != "returnDone") {
        EXPECT_EQ(lines.size(), lost) << testing::PrintToString(lines);
    }
}

test::Tally readWithFaults(const std::vector<FaultCase>& cases) {
    test::Tally tally;
    for (const FaultCase& each : cases) {
        const Outcome whole = test::runOnce(each.request);
        const std::size_t before = tally.runs;
        test::failEachCall(each, tally, [&](const std::string& kind, bool unstated, const Outcome& outcome) {
            if (unstated && isOneOf(kind, {"getNameSpace", "getKeyCount", "getKeyAt", "getCharPtr", "classPathIsA"}))
                checkOtherRequest(kind, outcome, whole);
            else
                checkOneFault(each, kind, outcome, whole);
        });
        test::failAllCalls(each, tally, [&](const std::string& kind, bool, const Outcome& outcome) {
            checkLastingFault(each, kind, outcome, whole);
        });
        EXPECT_GT(tally.runs, before) << each.name;
        if (testing::Test::HasFailure()) break;
    }
    return tally;
}

class FaultsTest : public testing::Test {
protected:
    FaultsTest() { test::simulateHostForFaults(); }
};

/// The calls that reading makes, so that one that a test no longer reaches shows. No getter of a date-time supplies
/// one, so that none is ever made: newDateTimeFromChars is not among them.
const std::set<std::string> kindsOfReading = {"newInstance",  "newObjectPath",  "newString",        "newArray",
                                              "getNameSpace", "getClassName",   "addKey",           "getKey",
                                              "getKeyAt",     "getKeyCount",    "setProperty",      "setElementAt",
                                              "getCharPtr",   "returnInstance", "returnObjectPath", "returnDone"};

TEST_F(FaultsTest, NoInstanceOperationAnswersHalfOfAnythingOrCrashes) {
    const test::Tally tally = readWithFaults(instanceCases());
    EXPECT_GT(tally.runs, 1000u);
    EXPECT_EQ(tally.kinds, kindsOfReading);
}

TEST_F(FaultsTest, NoAssociationOperationAnswersHalfOfAnythingOrCrashes) {
    const test::Tally tally = readWithFaults(associationCases());
    EXPECT_GT(tally.runs, 1000u);
    std::set<std::string> kinds = kindsOfReading;
    kinds.insert("classPathIsA");
    EXPECT_EQ(tally.kinds, kinds);
}

TEST_F(FaultsTest, AnOperationThatIsNotServedAsksTheObjectManagerForNothing) {
    test::Tally tally;
    for (const Operation operation : {Operation::CreateInstance, Operation::DeleteInstance, Operation::ExecQuery,
                                      Operation::References, Operation::ReferenceNames}) {
        for (const std::string& className : om::Schema::builtin().served()) {
            const FaultCase each = {className, asking(operation, test::path(className))};
            EXPECT_EQ(test::runOnce(each.request).answer.code, CMPI_RC_ERR_NOT_SUPPORTED);
            test::failEachCall(each, tally, [](const std::string&, bool, const Outcome&) {});
        }
    }
    EXPECT_EQ(tally.runs, 0u) << testing::PrintToString(tally.kinds);
}

} // namespace
