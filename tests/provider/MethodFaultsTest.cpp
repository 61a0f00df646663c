// Every request that changes something, with every call that it makes to the object manager failing in turn.
#include "provider/FaultRuns.h"
#include "support/SimulatedHost.h"

#include <gmock/gmock.h>

#include <dlfcn.h>

namespace {

using om::Operation;
using test::asking;
using test::calling;
using test::FaultCase;
using test::Outcome;

om::ObjectPath first(const std::string& className) {
    return test::paths(test::names(className)).at(0);
}

om::Request settingTime() {
    const om::Value element = {CMPI_ref, std::make_shared<const om::ObjectPath>(test::path("VESKA_ComputerSystem"))};
    return calling(first("VESKA_TimeService"), "ManageTime",
                   {{"GetRequest", {CMPI_boolean, false}},
                    {"ManagedElement", element},
                    {"TimeData", {CMPI_dateTime, std::string("20240101120000.000000+060")}}});
}

std::vector<FaultCase> methodCases() {
    om::Request readingTime = settingTime();
    readingTime.values[0].second = {CMPI_boolean, true};
    readingTime.values.pop_back();
    om::Request withoutElement = readingTime; // refused with a text that stays in the provider
    withoutElement.values[1].second = {CMPI_boolean, true};
    const std::vector<om::NamedValue> settings = {{"deliveryRetryIntervalSec", {CMPI_uint32, std::uint64_t{30}}},
                                                  {"deliveryRetryAttempts", {CMPI_uint32, std::uint64_t{3}}}};
    return {{"ManageTime, reading", readingTime},
            {"ManageTime, setting", settingTime()},
            {"ManageTime, refused", withoutElement},
            {"SetCIMconfig", calling(first("VESKA_CIMServiceConfig"), "SetCIMconfig", settings)},
            {"a method that the class lacks", calling(first("VESKA_CIMServiceConfig"), "Reset", settings)},
            {"a class without methods", calling(first("VESKA_ComputerSystem"), "RequestStateChange", {})},
            {"an association without methods", calling(first("VESKA_ComputerSystemPackage"), "Reset", {})}};
}

/// What a method answered: one number twice, or FAILED with an exception's text.
void checkCode(const std::string& kind, const om::Answer& answer, const std::vector<std::string>& lines) {
    const om::Value code = answer.returnValue.value_or(om::Value{CMPI_uint32, {}});
    EXPECT_EQ(code.type, CMPI_uint32);
    EXPECT_EQ(code.isNull(), kind == "returnData") << "nothing but that keeps the code from being returned";
    EXPECT_EQ(answer.done, kind != "returnDone");
    if (answer.message) {
        EXPECT_EQ(answer.code, CMPI_RC_ERR_FAILED);
        EXPECT_THAT(*answer.message, testing::StartsWith("The broker could not tell "));
        EXPECT_EQ(code.data, om::Value({CMPI_uint32, std::uint64_t{0}}).data);
        EXPECT_EQ(lines.size(), 1u);
    } else if (!code.isNull()) {
        EXPECT_EQ(std::get<std::uint64_t>(code.data), static_cast<std::uint64_t>(answer.code));
    }
    EXPECT_EQ(std::count_if(lines.begin(), lines.end(), test::tellsException), answer.message ? 1 : 0);
    EXPECT_THAT(answer.code, testing::AnyOf(CMPI_RC_OK, CMPI_RC_ERR_FAILED, CMPI_RC_ERR_INVALID_PARAMETER,
                                            CMPI_RC_ERR_INVALID_CLASS, CMPI_RC_ERR_METHOD_NOT_FOUND));
}

/// `mostLines` is how many arguments can be read in vain.
void checkMethod(const std::string& kind, const Outcome& outcome, const Outcome& whole, std::size_t mostLines) {
    const std::vector<std::string> lines = test::added(outcome.lines, whole.lines);
    EXPECT_LE(lines.size(), mostLines) << testing::PrintToString(lines);
    checkCode(kind, outcome.answer, lines);
    const bool same = outcome.answer.code == whole.answer.code;
    if (same) {
        EXPECT_EQ(test::namesOf(outcome.answer.out), test::namesOf(whole.answer.out));
        EXPECT_EQ(outcome.host, whole.host);
    }
    // The time is answered when it has been set, so that it stays set where that fails.
    if (!test::isOneOf(kind, {"newDateTime", "addArg"}) && !same) {
        EXPECT_EQ(outcome.host, test::untouchedHost()) << "time and offset are set together, or neither is";
    } else {
        EXPECT_EQ(outcome.host, whole.host);
    }
}

class MethodFaultsTest : public testing::Test {
protected:
    MethodFaultsTest() { test::simulateHostForFaults(); }
};

TEST_F(MethodFaultsTest, AMethodAnswersACodeOfItsOwnOrFailedWithTheText) {
    test::Tally tally;
    for (const FaultCase& each : methodCases()) {
        const Outcome whole = test::runOnce(each.request);
        const std::size_t before = tally.runs;
        test::failEachCall(each, tally, [&](const std::string& kind, bool unstated, const Outcome& outcome) {
            if (unstated && kind == "getBinaryFormat") { // its 0 is a time like any other
                EXPECT_EQ(outcome.answer.code, CMPI_RC_OK);
                EXPECT_EQ(test::simulatedProperty("/computer/0", 126), "19700101000000.000000+000");
                return;
            }
            checkMethod(kind, outcome, whole, 1);
            // An argument that the object manager calls missing is left out; one that cannot be read is logged too.
            const bool skipped = outcome.answer.code == whole.answer.code && outcome.commands != whole.commands;
            if (skipped) {
                EXPECT_EQ(test::added(outcome.lines, whole.lines).size(), unstated ? 0u : 1u);
            }
        });
        test::failAllCalls(each, tally, [&](const std::string& kind, bool, const Outcome& outcome) {
            checkMethod(kind, outcome, whole, 2);
        });
        EXPECT_GT(tally.runs, before) << each.name;
        if (HasFailure()) return;
    }
    const std::set<std::string> kinds = {
        "newString", "newDateTime", "getNameSpace", "getClassName",    "getKey",          "getKeyCount", "addArg",
        "getArg",    "getArgCount", "getCharPtr",   "getBinaryFormat", "getStringFormat", "returnData",  "returnDone"};
    EXPECT_EQ(tally.kinds, kinds);
}

TEST_F(MethodFaultsTest, WithoutAFaultTheTimeIsSet) {
    EXPECT_EQ(test::runOnce(settingTime()).answer.code, CMPI_RC_OK);
    EXPECT_EQ(test::simulatedProperty("/computer/0", 127), 60);
    EXPECT_EQ(test::simulatedProperty("/computer/0", 126), "20240101110000.000000+000");
    EXPECT_NE(test::simulatedFile(), test::untouchedHost());
}

TEST_F(MethodFaultsTest, AnExceptionWhoseTextTheBrokerDoesNotMakeAnswersFailedWithoutIt) {
    const om::Request request = methodCases().at(0).request;
    test::runOnce(request); // so that the provider has been made
    void* const library = dlopen(VK_PROVIDER_LIBRARY, RTLD_NOW | RTLD_NOLOAD);
    ASSERT_NE(library, nullptr);
    using Factory = CMPIMethodMI* (*)(const CMPIBroker*, const CMPIContext*, CMPIStatus*);
    const auto create = reinterpret_cast<Factory>(dlsym(library, "BaseServerProvider_Create_MethodMI"));
    ASSERT_NE(create, nullptr);

    const CMPIBroker* const usual = test::provider().broker();
    CMPIBrokerEncFT factories = *usual->eft;
    factories.newString = [](const CMPIBroker*, const char*, CMPIStatus* status) -> CMPIString* {
        if (status != nullptr) *status = {CMPI_RC_ERR_FAILED, nullptr};
        return nullptr;
    };
    CMPIBroker poor = *usual;
    poor.eft = &factories;
    create(&poor, nullptr, nullptr);
    om::Request failing = request;
    failing.fault = om::Fault{om::FaultKind::getNameSpace};
    const Outcome outcome = test::runOnce(failing);
    create(usual, nullptr, nullptr);
    dlclose(library);

    EXPECT_EQ(outcome.answer.code, CMPI_RC_ERR_FAILED);
    EXPECT_FALSE(outcome.answer.message);
    ASSERT_TRUE(outcome.answer.returnValue);
    EXPECT_EQ(*outcome.answer.returnValue, (om::Value{CMPI_uint32, std::uint64_t{0}}));
    EXPECT_TRUE(outcome.answer.done);
    EXPECT_EQ(std::count_if(outcome.lines.begin(), outcome.lines.end(), test::tellsException), 1);
}

/// A change of the time service, or of a class that takes none, either happens, or does not and is logged.
/// `mostLines` is how many properties can be read in vain.
void checkModify(const std::string& kind, bool unstated, const Outcome& outcome, const Outcome& whole,
                 std::size_t mostLines) {
    const std::vector<std::string> lines = test::added(outcome.lines, whole.lines);
    EXPECT_FALSE(outcome.answer.message);
    EXPECT_FALSE(outcome.answer.done);
    if (outcome.answer.code != whole.answer.code) {
        EXPECT_EQ(outcome.answer.code, CMPI_RC_ERR_NOT_SUPPORTED);
        EXPECT_TRUE(test::isOneOf(kind, {"getClassName", "getCharPtr"}));
    }
    const bool changed = outcome.host != whole.host || outcome.answer.code != whole.answer.code;
    if (outcome.host != whole.host) {
        EXPECT_EQ(outcome.host, test::untouchedHost());
    }
    EXPECT_LE(lines.size(), mostLines) << testing::PrintToString(lines);
    const bool absent = unstated && kind == "getProperty"; // what the client does not name stays
    if (changed) {
        EXPECT_EQ(lines.size(), absent ? 0u : mostLines);
    }
}

TEST_F(MethodFaultsTest, AChangeHappensOrIsToldToHaveFailed) {
    const om::ObjectPath service = test::paths(test::names("VESKA_TimeService")).at(0);
    std::vector<FaultCase> cases;
    for (const om::ObjectPath& path : {service, test::path("VESKA_TimeService"), test::path("VESKA_ComputerSystem"),
                                       test::path("VESKA_ComputerSystemPackage"), test::path("VESKA_CIMServiceConfig")})
        cases.push_back({"change of " + test::print(path), asking(Operation::ModifyInstance, path)});
    test::Tally tally;
    for (FaultCase& each : cases) {
        each.request.values = {{"AutomaticDSTAdjustment", {CMPI_boolean, true}}};
        const Outcome whole = test::runOnce(each.request);
        EXPECT_EQ(test::simulatedProperty("/computer/0", 200),
                  each.request.path.className == "VESKA_TimeService" ? 1 : 0);
        const std::size_t before = tally.runs;
        test::failEachCall(each, tally, [&](const std::string& kind, bool unstated, const Outcome& outcome) {
            checkModify(kind, unstated, outcome, whole, 1);
        });
        test::failAllCalls(each, tally, [&](const std::string& kind, bool, const Outcome& outcome) {
            checkModify(kind, false, outcome, whole, kind == "getProperty" ? 2 : 1);
        });
        EXPECT_GT(tally.runs, before) << each.name;
        if (HasFailure()) return;
    }
    const std::set<std::string> kinds = {"getNameSpace", "getClassName", "getKey",
                                         "getKeyCount",  "getProperty",  "getCharPtr"};
    EXPECT_EQ(tally.kinds, kinds);
}

} // namespace
