#include "provider/BaseServerProvider.h"
#include "support/Provider.h"
#include "support/SimulatedHost.h"

#include <gmock/gmock.h>

#include <stdexcept>

namespace {

using testing::Contains;
using testing::ContainsRegex;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::Not;

const std::vector<om::NamedValue> getTime = {{"GetRequest", {CMPI_boolean, true}}, {"ManagedElement", {CMPI_ref, {}}}};

om::Answer invoke(const std::string& className, const std::string& method, const std::vector<om::NamedValue>& in) {
    return test::invoke(test::path(className), method, in);
}

/// Code, return value and whether there was a message and an end: all that the frame adds.
void expectCode(const om::Answer& answer, unsigned int code) {
    EXPECT_EQ(answer.code, static_cast<CMPIrc>(code));
    EXPECT_EQ(answer.message, std::nullopt);
    EXPECT_TRUE(answer.done);
    ASSERT_TRUE(answer.returnValue.has_value());
    EXPECT_EQ(answer.returnValue->type, CMPI_uint32);
    EXPECT_EQ(std::get<std::uint64_t>(answer.returnValue->data), code);
}

TEST(InvokeMethod, AnswersZeroAndClosesTheResult) {
    test::simulate({test::computer(0, "node7")});
    const om::Answer answer = invoke("VESKA_TimeService", "ManageTime", getTime);
    expectCode(answer, 0);
    EXPECT_THAT(test::namesOf(answer.out), ElementsAre("TimeData"));
}

TEST(InvokeMethod, RunsManageTimeUnderAnyNameOnATimeService) {
    test::simulate({test::computer(0, "node7")});
    for (const char* name : {"ManageTime", "StartService", "SetCIMconfig", "x", ""}) {
        const om::Answer answer = invoke("VESKA_TimeService", name, getTime);
        expectCode(answer, 0);
        EXPECT_THAT(test::namesOf(answer.out), ElementsAre("TimeData")) << name;
        expectCode(invoke("veska_TIMEservice", name, {}), 4);
    }
}

TEST(InvokeMethod, HandsTheNameOnToTheConfiguration) {
    test::simulate({});
    expectCode(invoke("VESKA_CIMServiceConfig", "ManageTime", getTime), 17);
    expectCode(invoke("VESKA_CIMServiceConfig", "SetCIMconfig", {}), 4);
}

TEST(InvokeMethod, AnswersTheAdaptersCodeAsStatusAndReturnValue) {
    test::simulate({test::computer(0, "node7")});
    expectCode(invoke("VESKA_TimeService", "ManageTime", {}), 4);
    const std::vector<om::NamedValue> wrongElement = {{"GetRequest", {CMPI_boolean, true}},
                                                      {"ManagedElement", {CMPI_string, std::string("x")}}};
    expectCode(invoke("VESKA_TimeService", "ManageTime", wrongElement), 1);
}

TEST(InvokeMethod, AnswersInvalidClassForClassesWithoutMethods) {
    test::simulate({test::computer(0, "node7")});
    for (const char* className : {"VESKA_ComputerSystem", "VESKA_PhysicalPackage", "VESKA_TimeServiceAffectsElement",
                                  "CIM_TimeService", "VESKA_Unknown"}) {
        SCOPED_TRACE(className);
        const om::Answer answer = invoke(className, "ManageTime", getTime);
        expectCode(answer, 5);
        EXPECT_THAT(answer.out, IsEmpty());
    }
}

/// The operation itself, asked with arguments whose count throws, as an adapter might.
class InvokeMethodException : public testing::Test {
protected:
    ~InvokeMethodException() override { VK::BaseServerProvider::broker = nullptr; }

    CMPIStatus run(const CMPIBroker* broker) {
        VK::BaseServerProvider::broker = broker;
        const CMPIBroker* const maker = test::provider().broker();
        const CMPIObjectPath* const path = CMNewObjectPath(maker, "root/cimv2", "VESKA_TimeService", nullptr);
        CMPIArgs* const arguments = CMNewArgs(maker, nullptr);
        CMPIArgsFT argumentTable = *arguments->ft;
        argumentTable.getArgCount = [](const CMPIArgs*, CMPIStatus*) -> CMPICount {
            throw std::runtime_error("Could not find instance");
        };
        const CMPIArgs throwing = {arguments->hdl, &argumentTable};
        CMPIResultFT table = {};
        table.returnData = [](const CMPIResult* result, const CMPIValue* value, CMPIType type) -> CMPIStatus {
            seen(result).push_back("data " + std::to_string(value->uint32) + " of type " + std::to_string(type));
            return {CMPI_RC_OK, nullptr};
        };
        table.returnDone = [](const CMPIResult* result) -> CMPIStatus {
            seen(result).push_back("done");
            return {CMPI_RC_OK, nullptr};
        };
        const CMPIResult result = {&returned, &table};
        return VK::BaseServerProvider::BaseServer_InvokeMethod(nullptr, nullptr, &result, path, "ManageTime", &throwing,
                                                               nullptr);
    }

    static std::vector<std::string>& seen(const CMPIResult* result) {
        return *static_cast<std::vector<std::string>*>(result->hdl);
    }

    std::vector<std::string> returned;
};

TEST_F(InvokeMethodException, BecomesFailedWithItsText) {
    test::takeLog();
    const CMPIStatus status = run(test::provider().broker());
    EXPECT_EQ(status.rc, CMPI_RC_ERR_FAILED);
    ASSERT_NE(status.msg, nullptr);
    EXPECT_STREQ(CMGetCharsPtr(status.msg, nullptr), "Could not find instance");
    EXPECT_THAT(returned, ElementsAre("data 0 of type " + std::to_string(CMPI_uint32), "done"));
    const std::vector<std::string> log = test::takeLog();
    EXPECT_THAT(log,
                Contains(ContainsRegex(" LOG 3000 .* BaseServer_InvokeMethod: MESSAGE .*Could not find instance$")));
    EXPECT_THAT(log, Contains(HasSubstr("Could not find instance")).Times(2)) << "one in each channel";
    EXPECT_THAT(log, Not(Contains(HasSubstr("markProviderExit"))));
}

TEST_F(InvokeMethodException, HasNoMessageWhereTheBrokerMakesNoTexts) {
    CMPIBroker poor = *test::provider().broker();
    CMPIBrokerEncFT factories = *poor.eft;
    factories.newString = nullptr;
    poor.eft = &factories;
    const CMPIStatus status = run(&poor);
    EXPECT_EQ(status.rc, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(status.msg, nullptr);
}

TEST_F(InvokeMethodException, HasNoMessageWithoutABroker) {
    const CMPIStatus status = run(nullptr);
    EXPECT_EQ(status.rc, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(status.msg, nullptr);
    EXPECT_THAT(returned, ElementsAre("data 0 of type " + std::to_string(CMPI_uint32), "done"));
}

} // namespace
