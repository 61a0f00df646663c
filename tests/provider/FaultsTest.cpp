// Every request, with every call that it makes to the object manager failing in turn.
#include "support/Provider.h"
#include "support/SimulatedHost.h"

#include <gmock/gmock.h>

#include <algorithm>
#include <set>

namespace {

using om::Operation;

struct Case {
    std::string name;
    om::Request request;
};

std::string hostName() {
    return test::text(*test::find(test::paths(test::names("VESKA_TimeService")).at(0).keys, "SystemName"));
}

/// Two computers, one with two chassis; the first is named like this host, so that it has the time service.
void simulateHost() {
    test::simulate({});
    test::simulate({test::computer(0, hostName()), test::computer(1, "node8"), test::chassis(0, 0, "CZ1"),
                    test::chassis(0, 1, "CZ2"), test::chassis(1, 0, "CZ3")});
}

const char* const classes[] = {"VESKA_ComputerSystem",
                               "VESKA_PhysicalPackage",
                               "VESKA_EnabledLogicalElementCapabilities",
                               "VESKA_ComputerSystemPackage",
                               "VESKA_ComputerCapabilities",
                               "VESKA_TimeService",
                               "VESKA_TimeServiceAffectsElement",
                               "VESKA_CIMServiceConfig"};

om::Request asking(Operation operation, const om::ObjectPath& path) {
    om::Request request;
    request.operation = operation;
    request.path = path;
    return request;
}

std::vector<Case> instanceCases() {
    std::vector<Case> cases;
    for (const std::string className : classes) {
        const om::ObjectPath keyless = test::path(className);
        cases.push_back({"names of " + className, asking(Operation::EnumInstanceNames, keyless)});
        cases.push_back({"instances of " + className, asking(Operation::EnumInstances, keyless)});
        cases.push_back({"keyless get of " + className, asking(Operation::GetInstance, keyless)});
        for (const om::ObjectPath& path : test::paths(test::names(className)))
            cases.push_back({"get of " + test::print(path), asking(Operation::GetInstance, path)});
    }
    Case modify = {"modify", asking(Operation::ModifyInstance, test::paths(test::names("VESKA_TimeService")).at(0))};
    modify.request.values = {{"AutomaticDSTAdjustment", {CMPI_boolean, true}}};
    cases.push_back(modify);
    return cases;
}

std::vector<Case> associationCases() {
    const std::pair<const char*, std::vector<const char*>> associations[] = {
        {"VESKA_ComputerCapabilities", {"VESKA_ComputerSystem", "VESKA_EnabledLogicalElementCapabilities"}},
        {"CIM_ElementCapabilities", {"VESKA_ComputerSystem"}},
        {"VESKA_ComputerSystemPackage", {"VESKA_ComputerSystem", "VESKA_PhysicalPackage"}},
        {"VESKA_TimeServiceAffectsElement", {"VESKA_ComputerSystem", "VESKA_TimeService"}},
        {"CIM_Dependency", {"VESKA_ComputerSystem"}}, // above two of the three
    };
    std::vector<Case> cases;
    for (const auto& [association, sources] : associations) {
        for (const char* className : sources) {
            std::vector<om::ObjectPath> paths = test::paths(test::names(className));
            paths.push_back(test::path(className));
            for (const om::ObjectPath& source : paths) {
                for (const Operation operation : {Operation::AssociatorNames, Operation::Associators}) {
                    om::Request request = asking(operation, source);
                    request.assocClass = association;
                    const char* const what =
                        operation == Operation::Associators ? "associators of " : "associator names of ";
                    cases.push_back({what + test::print(source) + " through " + association, request});
                }
            }
        }
    }
    return cases;
}

om::Request calling(const char* className, const char* method, std::vector<om::NamedValue> in) {
    om::Request request = asking(Operation::InvokeMethod, test::paths(test::names(className)).at(0));
    request.method = method;
    request.values = std::move(in);
    return request;
}

std::vector<Case> methodCases() {
    const om::Value element = {CMPI_ref, std::make_shared<const om::ObjectPath>(test::path("VESKA_ComputerSystem"))};
    return {{"ManageTime, reading", calling("VESKA_TimeService", "ManageTime",
                                            {{"GetRequest", {CMPI_boolean, true}}, {"ManagedElement", element}})},
            {"ManageTime, setting", calling("VESKA_TimeService", "ManageTime",
                                            {{"GetRequest", {CMPI_boolean, false}},
                                             {"ManagedElement", element},
                                             {"TimeData", {CMPI_dateTime, std::string("20240101120000.000000+060")}}})},
            {"SetCIMconfig", calling("VESKA_CIMServiceConfig", "SetCIMconfig",
                                     {{"deliveryRetryIntervalSec", {CMPI_uint32, std::uint64_t{30}}},
                                      {"deliveryRetryAttempts", {CMPI_uint32, std::uint64_t{3}}}})}};
}

/// The lines about failures, each once: those of the log channel.
std::vector<std::string> failureLines() {
    std::vector<std::string> lines;
    for (const std::string& line : test::takeLog())
        if (line.find(" LOG 6000 ") != std::string::npos) lines.push_back(line);
    return lines;
}

using Result = std::variant<om::ObjectPath, om::Instance>;

const om::ObjectPath& pathOf(const Result& result) {
    const auto* instance = std::get_if<om::Instance>(&result);
    return instance != nullptr ? instance->path : std::get<om::ObjectPath>(result);
}

/// The properties that a whole instance has and this one lacks; nothing when it is not a part of it, in its order.
std::optional<std::size_t> missing(const Result& part, const Result& whole) {
    const auto* some = std::get_if<om::Instance>(&part);
    const auto* all = std::get_if<om::Instance>(&whole);
    if (some == nullptr || all == nullptr) return std::nullopt;
    auto at = all->properties.begin();
    for (const om::NamedValue& property : some->properties) {
        at = std::find(at, all->properties.end(), property);
        if (at == all->properties.end()) return std::nullopt;
        ++at;
    }
    return all->properties.size() - some->properties.size();
}

/// How an answer with a fault differs from the one without.
struct Loss {
    std::size_t elements = 0;
    std::size_t properties = 0;
};

/// Every element must be one of the whole answer's, its path exactly so and its properties as far as they are there.
Loss compare(const om::Answer& part, const om::Answer& whole) {
    Loss loss;
    auto at = whole.results.begin();
    for (const Result& result : part.results) {
        at = std::find_if(at, whole.results.end(), [&](const Result& each) {
            return pathOf(each) == pathOf(result) && each.index() == result.index();
        });
        if (at == whole.results.end()) {
            ADD_FAILURE() << "answered something else, or half of it: " << test::print(pathOf(result));
            return loss;
        }
        if (std::holds_alternative<om::Instance>(result)) {
            const auto lost = missing(result, *at);
            EXPECT_TRUE(lost) << "a property that the whole instance does not have";
            loss.properties += lost.value_or(0);
        }
        ++at;
    }
    loss.elements = whole.results.size() - part.results.size();
    return loss;
}

bool isOneOf(const std::string& kind, std::initializer_list<const char*> kinds) {
    return std::any_of(kinds.begin(), kinds.end(), [&](const char* each) { return kind == each; });
}

/// Those that tell the class of a request: without them it is one that is not known.
bool mayHideTheClass(const std::string& kind) {
    return isOneOf(kind, {"getClassName", "getCharPtr", "classPathIsA", "newObjectPath"});
}

/// What is answered for a class that is not known.
CMPIrc refusal(Operation operation) {
    return operation == Operation::ModifyInstance ? CMPI_RC_ERR_NOT_SUPPORTED : CMPI_RC_ERR_INVALID_CLASS;
}

void checkReading(Operation operation, const std::string& kind, const om::Answer& answer, const om::Answer& whole) {
    const std::vector<std::string> failures = failureLines();
    const Loss loss = compare(answer, whole);
    if (whole.code == CMPI_RC_OK && answer.code == refusal(operation) && mayHideTheClass(kind)) {
        EXPECT_FALSE(answer.done);
    } else {
        EXPECT_EQ(answer.code, whole.code);
        EXPECT_FALSE(answer.message);
    }
    EXPECT_LE(failures.size(), 1u) << testing::PrintToString(failures);
    if (isOneOf(kind, {"addKey", "newObjectPath", "newInstance", "returnObjectPath", "returnInstance"})) {
        EXPECT_EQ(loss.properties, 0u) << "elements are dropped whole";
        const bool lost = loss.elements > 0 || answer.code != whole.code;
        EXPECT_GE(failures.size(), lost ? 1u : 0u);
    }
    if (isOneOf(kind, {"setProperty", "newArray", "setElementAt", "newString", "newDateTimeFromChars"})) {
        EXPECT_EQ(loss.elements, 0u);
        EXPECT_EQ(loss.properties, 1u);
        EXPECT_EQ(failures.size(), 1u);
        EXPECT_EQ(answer.done, whole.done);
    }
}

/// Runs the request with every call of a kind failing: nothing must come back that is not in the whole answer.
void failAllCalls(const Case& each, const om::Answer& whole) {
    for (const std::string& kind : om::faultNames()) {
        SCOPED_TRACE(each.name + " with " + kind + ":1+");
        om::Request request = each.request;
        request.fault = om::Fault{*om::faultKind(kind), 1, true, false};
        compare(test::provider().run(request), whole);
    }
}

/// Runs the request with one call after the other failing; `check` looks at each answer.
template <class Check>
std::size_t failEachCall(const Case& each, Check check) {
    std::size_t runs = 0;
    for (const std::string& kind : om::faultNames()) {
        for (const bool unstated : {false, true}) {
            for (std::size_t call = 1;; ++call) {
                SCOPED_TRACE(each.name + " with " + kind + ":" + std::to_string(call) + (unstated ? ":null" : ""));
                om::Request request = each.request;
                request.fault = om::Fault{*om::faultKind(kind), call, false, unstated};
                test::takeLog();
                const om::Answer answer = test::provider().run(request);
                if (!answer.faulted) break;
                if (call > 5000) {
                    ADD_FAILURE() << "there is no end to the calls";
                    break;
                }
                check(kind, unstated, answer);
                ++runs;
            }
        }
        if (testing::Test::HasFailure()) break; // one fault's lines are enough
    }
    return runs;
}

class FaultsTest : public testing::Test {
protected:
    FaultsTest() { simulateHost(); }
};

/// How many faults there were.
std::size_t readWithFaults(const std::vector<Case>& cases) {
    std::size_t faults = 0;
    for (const Case& each : cases) {
        const om::Answer whole = test::provider().run(each.request);
        const std::size_t runs =
            failEachCall(each, [&](const std::string& kind, bool unstated, const om::Answer& answer) {
                // A namespace or key that the object manager says is not there, and a text that it says is null, is not
                // there: the request is another one then.
                if (unstated && isOneOf(kind, {"getNameSpace", "getKeyCount", "getKeyAt", "getCharPtr"})) return;
                if (isOneOf(kind, {"getKeyCount", "getKeyAt", "getCharPtr"}) && unstated) return;
                checkReading(each.request.operation, kind, answer, whole);
            });
        EXPECT_GT(runs, 0u) << each.name;
        failAllCalls(each, whole);
        faults += runs;
        if (testing::Test::HasFailure()) break;
    }
    return faults;
}

TEST_F(FaultsTest, NoInstanceOperationAnswersHalfOfAnythingOrCrashes) {
    EXPECT_GT(readWithFaults(instanceCases()), 1000u);
}

TEST_F(FaultsTest, NoAssociationOperationAnswersHalfOfAnythingOrCrashes) {
    EXPECT_GT(readWithFaults(associationCases()), 1000u);
}

TEST_F(FaultsTest, AMethodAnswersACodeOfItsOwnOrFailedWithTheText) {
    for (const Case& each : methodCases()) {
        const om::Answer whole = test::provider().run(each.request);
        EXPECT_EQ(whole.code, CMPI_RC_OK) << each.name;
        const std::size_t runs = failEachCall(each, [&](const std::string& kind, bool, const om::Answer& answer) {
            const om::Value code = answer.returnValue.value_or(om::Value{CMPI_uint32, {}});
            EXPECT_EQ(code.type, CMPI_uint32);
            EXPECT_EQ(code.isNull(), kind == "returnData") << "nothing but that keeps the code from being returned";
            if (answer.message) {
                EXPECT_EQ(answer.code, CMPI_RC_ERR_FAILED);
                EXPECT_THAT(*answer.message, testing::StartsWith("The broker could not tell "));
                EXPECT_EQ(code.data, om::Value({CMPI_uint32, std::uint64_t{0}}).data);
            } else if (!code.isNull()) {
                EXPECT_EQ(std::get<std::uint64_t>(code.data), static_cast<std::uint64_t>(answer.code));
            }
            EXPECT_THAT(answer.code, testing::AnyOf(CMPI_RC_OK, CMPI_RC_ERR_FAILED, CMPI_RC_ERR_INVALID_PARAMETER,
                                                    CMPI_RC_ERR_INVALID_CLASS));
            EXPECT_EQ(answer.done, kind != "returnDone");
            if (answer.code == CMPI_RC_OK) {
                EXPECT_EQ(test::namesOf(answer.out), test::namesOf(whole.out));
            }
        });
        EXPECT_GT(runs, 0u) << each.name;
    }
}

} // namespace
