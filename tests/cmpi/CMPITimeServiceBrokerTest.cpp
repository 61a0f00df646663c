// The adapter of the time service itself, with brokers and arguments that fail.

#include "cmpi/CMPITimeService.h"
#include "support/FakeCommands.h"
#include "support/Provider.h"
#include "support/SimulatedHost.h"

#include <cmpimacs.h>
#include <gmock/gmock.h>

namespace {

using testing::ElementsAre;
using testing::IsEmpty;
using VK::BaseServerProvider::CMPITimeService;

CMPIDateTime* noDateTime(const CMPIBroker*, CMPIStatus*) {
    return nullptr;
}
CMPIDateTime* emptyDateTime(const CMPIBroker*, CMPIStatus*) {
    static CMPIDateTime empty = {};
    return &empty;
}
CMPICount countFails(const CMPIArgs*, CMPIStatus* status) {
    status->rc = CMPI_RC_ERR_FAILED;
    return 2;
}
CMPIStatus addFails(const CMPIArgs*, const char*, const CMPIValue*, CMPIType) {
    return {CMPI_RC_ERR_FAILED, nullptr};
}

/// The arguments and the broker of a call that succeeds, to be spoiled in one place.
class CMPITimeServiceBrokerTest : public testing::Test {
protected:
    CMPITimeServiceBrokerTest() {
        test::simulate({test::computer(0, "node7")});
        commands.add("ps");
        commands.add("ntpd", test::printing({"ntpd: time slew +0.000012s"}));
        path = CMNewObjectPath(real, "root/cimv2", CMPITimeService::className, nullptr);
        out = CMNewArgs(real, nullptr);
    }

    CMPIArgs* arguments(bool get) {
        CMPIArgs* const in = CMNewArgs(real, nullptr);
        CMPIValue value = {};
        value.boolean = get ? 1 : 0;
        CMAddArg(in, "GetRequest", &value, CMPI_boolean);
        value.ref = path;
        CMAddArg(in, "ManagedElement", &value, CMPI_ref);
        value.dateTime = CMNewDateTimeFromChars(real, "20240101120000.000000+060", nullptr);
        CMAddArg(in, "TimeData", &value, CMPI_dateTime);
        return in;
    }

    unsigned int invoke(const CMPIArgs* in, const char* method = "ManageTime") {
        return CMPITimeService(broker, nullptr, path).invokeMethod(method, in, out, nullptr);
    }
    CMPICount outCount() { return CMGetArgCount(out, nullptr); }
    void expectUntouchedHost() {
        EXPECT_EQ(test::simulatedProperty("/computer/0", 126), "");
        EXPECT_EQ(test::simulatedProperty("/computer/0", 127), 60);
        EXPECT_THAT(commands.take(), IsEmpty());
    }

    test::FakeCommands commands;
    const CMPIBroker* const real = test::provider().broker();
    const CMPIBroker* broker = real;
    CMPIObjectPath* path = nullptr;
    CMPIArgs* out = nullptr;
};

TEST_F(CMPITimeServiceBrokerTest, TakesTheMethodNameInAnyCase) {
    for (const char* name : {"ManageTime", "managetime", "MANAGETIME"}) EXPECT_EQ(invoke(arguments(true), name), 0U);
}

TEST_F(CMPITimeServiceBrokerTest, KnowsNoOtherMethod) {
    for (const char* name : {"ManageTimes", "Manage", "", "SetCIMconfig", static_cast<const char*>(nullptr)})
        EXPECT_EQ(invoke(arguments(false), name), 17U);
    expectUntouchedHost();
}

TEST_F(CMPITimeServiceBrokerTest, RefusesMissingArgumentsAndACountThatFails) {
    EXPECT_EQ(invoke(nullptr), 4U);
    CMPIArgsFT table = *out->ft;
    table.getArgCount = countFails;
    CMPIArgs failing = {out->hdl, &table};
    EXPECT_EQ(invoke(&failing), 4U);
}

TEST_F(CMPITimeServiceBrokerTest, RefusesAWrongCountBeforeAnyArgumentIsLookedAt) {
    static CMPICount count;
    static unsigned int looks;
    looks = 0;
    CMPIArgsFT table = *out->ft;
    table.getArgCount = [](const CMPIArgs*, CMPIStatus*) { return count; };
    table.getArg = [](const CMPIArgs*, const char*, CMPIStatus*) {
        ++looks;
        return CMPIData{};
    };
    const CMPIArgs in = {out->hdl, &table};
    for (const CMPICount wrong : {0U, 1U, 4U, 5U, 4294967295U}) {
        count = wrong;
        EXPECT_EQ(invoke(&in), 4U) << wrong;
    }
    EXPECT_EQ(looks, 0U);
    count = 2;
    EXPECT_EQ(invoke(&in), 4U);
    EXPECT_GT(looks, 0U);
}

TEST_F(CMPITimeServiceBrokerTest, FailsWithoutOutArgumentsAndTouchesNothing) {
    out = nullptr;
    EXPECT_EQ(invoke(arguments(true)), 1U);
    EXPECT_EQ(invoke(arguments(false)), 1U);
    expectUntouchedHost();
}

TEST_F(CMPITimeServiceBrokerTest, SaysToTheBrokerAloneWhichArgumentHasAWrongType) {
    static std::vector<std::string> said;
    said.clear();
    CMPIBrokerEncFT table = *real->eft;
    table.newString = [](const CMPIBroker*, const char* text, CMPIStatus*) -> CMPIString* {
        said.emplace_back(text);
        return nullptr;
    };
    CMPIBroker listening = *real;
    listening.eft = &table;
    broker = &listening;
    for (const char* name : {"ManagedElement", "TimeData"}) {
        CMPIArgs* const in = arguments(false);
        CMPIValue value = {};
        CMAddArg(in, name, &value, CMPI_boolean);
        EXPECT_EQ(invoke(in), 1U) << name;
    }
    EXPECT_THAT(said, ElementsAre("ManagedElement Parameter is having Invalid type or is NULL",
                                  "TimeData Parameter is having Invalid type or is NULL"));
    expectUntouchedHost();
}

TEST_F(CMPITimeServiceBrokerTest, FailsWhenTheBrokerMakesNoDateTime) {
    for (const auto newDateTime : {noDateTime, emptyDateTime}) {
        CMPIBrokerEncFT table = *real->eft;
        table.newDateTime = newDateTime;
        CMPIBroker spoiled = *real;
        spoiled.eft = &table;
        broker = &spoiled;
        EXPECT_EQ(invoke(arguments(true)), 1U);
        EXPECT_EQ(outCount(), 0U);
        EXPECT_EQ(invoke(arguments(false)), 1U);
        EXPECT_EQ(outCount(), 0U);
    }
    EXPECT_EQ(test::simulatedProperty("/computer/0", 126), "20240101110000.000000+000") << "the host was set before";
}

TEST_F(CMPITimeServiceBrokerTest, FailsWhenTheAnswerCannotBeAdded) {
    CMPIArgsFT table = *out->ft;
    table.addArg = addFails;
    CMPIArgs failing = {out->hdl, &table};
    out = &failing;
    EXPECT_EQ(invoke(arguments(true)), 1U);
}

TEST_F(CMPITimeServiceBrokerTest, FailsWithoutABroker) {
    broker = nullptr;
    EXPECT_EQ(invoke(arguments(true)), 1U);
    CMPIArgs* const withoutElement = CMNewArgs(real, nullptr);
    CMPIValue value = {};
    CMAddArg(withoutElement, "GetRequest", &value, CMPI_boolean);
    CMAddArg(withoutElement, "TimeData", &value, CMPI_boolean);
    EXPECT_EQ(invoke(withoutElement), 1U) << "refused without a message, there being nobody to make one";
}

TEST_F(CMPITimeServiceBrokerTest, FailsForADateTimeThatTellsNoText) {
    CMPIDateTimeFT table = {};
    CMPIDateTime* const good = CMNewDateTimeFromChars(real, "20240101120000.000000+060", nullptr);
    table = *good->ft;
    table.getStringFormat = [](const CMPIDateTime*, CMPIStatus*) -> CMPIString* { return nullptr; };
    static CMPIDateTime mute = {};
    mute = {good->hdl, &table};
    CMPIArgsFT argumentTable = *out->ft;
    argumentTable.getArgCount = [](const CMPIArgs*, CMPIStatus*) -> CMPICount { return 3; };
    argumentTable.getArg = [](const CMPIArgs*, const char* name, CMPIStatus*) {
        CMPIData data = {};
        if (std::string("GetRequest") == name) data.type = CMPI_boolean;
        if (std::string("ManagedElement") == name) data.type = CMPI_ref;
        if (std::string("TimeData") == name) {
            data.type = CMPI_dateTime;
            data.value.dateTime = &mute;
        }
        return data;
    };
    const CMPIArgs in = {out->hdl, &argumentTable};
    EXPECT_EQ(invoke(&in), 1U);
    expectUntouchedHost();
}

TEST_F(CMPITimeServiceBrokerTest, IgnoresANullInstance) {
    CMPITimeService(broker, nullptr, path).modifyInstance(nullptr, nullptr);
    EXPECT_EQ(test::simulatedProperty("/computer/0", 200), 0);
}

TEST_F(CMPITimeServiceBrokerTest, LooksAtTheRegionOnlyWhereDaylightSavingIsNotGiven) {
    static std::vector<std::string> asked;
    static CMPIType type;
    CMPIInstanceFT table = {};
    table.getProperty = [](const CMPIInstance*, const char* name, CMPIStatus*) {
        asked.emplace_back(name);
        return CMPIData{type, CMPI_goodValue, {}};
    };
    const CMPIInstance instance = {&table, &table};
    asked.clear();
    type = CMPI_boolean;
    CMPITimeService(broker, nullptr, path).modifyInstance(&instance, nullptr);
    EXPECT_THAT(asked, ElementsAre("AutomaticDSTAdjustment"));
    asked.clear();
    type = CMPI_uint16;
    CMPITimeService(broker, nullptr, path).modifyInstance(&instance, nullptr);
    EXPECT_THAT(asked, ElementsAre("AutomaticDSTAdjustment", "Region"));
}

/// Arguments and a date-time whose slots can be taken away; those that are there ask the real ones.
class WithoutSlots {
public:
    WithoutSlots(const CMPIBroker* broker, const CMPIArgs* arguments) {
        realArguments = arguments;
        realTime = CMNewDateTimeFromChars(broker, "20240101120000.000000+060", nullptr);
        poorTime = &time;
        argumentTable.getArgCount = [](const CMPIArgs*, CMPIStatus* status) {
            return realArguments->ft->getArgCount(realArguments, status);
        };
        argumentTable.getArg = [](const CMPIArgs*, const char* name, CMPIStatus* status) {
            CMPIData data = realArguments->ft->getArg(realArguments, name, status);
            if (data.type == CMPI_dateTime) data.value.dateTime = poorTime;
            return data;
        };
        timeTable.getStringFormat = [](const CMPIDateTime*, CMPIStatus* status) {
            return realTime->ft->getStringFormat(realTime, status);
        };
        timeTable.getBinaryFormat = [](const CMPIDateTime*, CMPIStatus* status) {
            return realTime->ft->getBinaryFormat(realTime, status);
        };
    }

    CMPIArgsFT argumentTable = {};
    CMPIDateTimeFT timeTable = {};
    const CMPIArgs in = {this, &argumentTable};

private:
    inline static const CMPIArgs* realArguments = nullptr;
    inline static CMPIDateTime* realTime = nullptr;
    inline static CMPIDateTime* poorTime = nullptr;

    CMPIDateTime time = {this, &timeTable};
};

TEST_F(CMPITimeServiceBrokerTest, FailsWhereTheBrokerLacksASlot) {
    const CMPIArgs* const given = arguments(false);
    WithoutSlots counting(real, given);
    counting.argumentTable.getArgCount = nullptr;
    EXPECT_EQ(invoke(&counting.in), 4U);
    WithoutSlots reading(real, given);
    reading.argumentTable.getArg = nullptr;
    EXPECT_EQ(invoke(&reading.in), 4U);
    WithoutSlots text(real, given);
    text.timeTable.getStringFormat = nullptr;
    EXPECT_EQ(invoke(&text.in), 1U);
    WithoutSlots seconds(real, given);
    seconds.timeTable.getBinaryFormat = nullptr;
    EXPECT_EQ(invoke(&seconds.in), 1U);
    expectUntouchedHost();
    const WithoutSlots whole(real, given);
    EXPECT_EQ(invoke(&whole.in), 0U) << "with all of them";
}

TEST_F(CMPITimeServiceBrokerTest, AnswersNoTimeWhereTheBrokerLacksASlot) {
    const CMPIArgs* const in = arguments(true);
    CMPIArgs* const usual = out;
    CMPIArgsFT outTable = *usual->ft;
    CMPIArgs poorOut = {usual->hdl, &outTable};
    outTable.addArg = nullptr;
    out = &poorOut;
    EXPECT_EQ(invoke(in), 1U);
    out = usual;

    CMPIBrokerEncFT factories = *real->eft;
    CMPIBroker poor = *real;
    poor.eft = &factories;
    broker = &poor;
    factories.newDateTime = nullptr;
    EXPECT_EQ(invoke(in), 1U);
    factories.newString = nullptr; // of a text that stays in the provider
    CMPIArgs* const withoutElement = CMNewArgs(real, nullptr);
    CMPIValue get = {};
    get.boolean = 1;
    CMAddArg(withoutElement, "GetRequest", &get, CMPI_boolean);
    CMAddArg(withoutElement, "ManagedElement", &get, CMPI_boolean);
    EXPECT_EQ(invoke(withoutElement), 1U);
    EXPECT_EQ(outCount(), 0U);
}

} // namespace
