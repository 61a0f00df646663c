#include "tests/objectmanager/endpoint/Endpoint.h"

#include <gmock/gmock.h>

#include <stdexcept>

namespace endpoint {
namespace {

using cimxml::className;
using cimxml::intrinsic;
using cimxml::parameter;
using cimxml::text;

const std::string elsewhere =
    R"(<LOCALNAMESPACEPATH><NAMESPACE NAME="root"/><NAMESPACE NAME="x"/></LOCALNAMESPACEPATH>)";

TEST(Operations, WhatIsNotServedIsNotSupported) {
    for (const char* name : {"PullInstances", "EnumerationCount", "CreateClass", "ModifyClass", "DeleteClass",
                             "SetQualifier", "DeleteQualifier", ""}) {
        EXPECT_EQ(ask(name, "").code, 7) << name;
    }
}

TEST(Operations, NamesOfOperationsAndParametersCompareWithoutCase) {
    EXPECT_EQ(ask("enumerateCLASSnames", parameter("DEEPinheritance", text(" true "))).code, 0);
}

TEST(Operations, NamespacesCompareWithoutCase) {
    const std::string upper =
        R"(<LOCALNAMESPACEPATH><NAMESPACE NAME="ROOT"/><NAMESPACE NAME="CimV2"/></LOCALNAMESPACEPATH>)";
    EXPECT_EQ(ask(intrinsic("EnumerateClassNames", "", upper)).code, 0);
    EXPECT_EQ(ask(intrinsic("EnumerateClassNames", "", elsewhere)).code, 3);
}

TEST(Operations, ReadingAndChangingAreTwoRights) {
    const Caller reader{"monitor", "", true, false};
    const Caller nobody{"nobody", "", false, false};
    EXPECT_EQ(ask(intrinsic("EnumerateClassNames", ""), reader).code, 0);
    EXPECT_EQ(ask(intrinsic("EnumerateClassNames", ""), nobody).code, 2);
    for (const char* name : {"ModifyInstance", "SetProperty", "CreateInstance", "DeleteInstance"}) {
        EXPECT_EQ(ask(intrinsic(name, ""), reader).code, 2) << name;
        EXPECT_EQ(ask(intrinsic(name, ""), administrator()).code, 4) << name;
    }
    const std::string method =
        cimxml::message("<SIMPLEREQ><METHODCALL NAME=\"ManageTime\"><LOCALINSTANCEPATH>" + cimxml::localNameSpace +
                        timeServiceName() + "</LOCALINSTANCEPATH></METHODCALL></SIMPLEREQ>");
    EXPECT_EQ(ask(method, reader).code, 2);
}

TEST(Operations, AccessGoesBeforeSupportAndSupportBeforeNamespaceAndParameters) {
    const Caller nobody{"nobody", "", false, false};
    EXPECT_EQ(ask(intrinsic("NoSuch", "", elsewhere), nobody).code, 2);
    EXPECT_EQ(ask(intrinsic("NoSuch", "", elsewhere)).code, 7);
    EXPECT_EQ(ask(intrinsic("GetClass", parameter("NoSuch", text("")), elsewhere)).code, 3);
    EXPECT_EQ(
        ask(intrinsic("GetClass", parameter("NoSuch", text("")) + parameter("ClassName", className("No_Such")))).code,
        4);
}

/// Operations over a provider that answers what a test says.
int codeOf(const Ask& provider, std::string* seen = nullptr) {
    Operations made({{"root/cimv2", {}, &om::Schema::builtin(), provider}}, "host1");
    const cimxml::Request request =
        cimxml::readRequest(intrinsic("EnumerateInstances", parameter("ClassName", className("VESKA_ComputerSystem"))));
    const Outcome outcome = made.answer(request, administrator());
    if (seen != nullptr) *seen = outcome.message;
    return outcome.code;
}

TEST(Operations, AStatusOfTheProviderIsPassedOnWithItsMessage) {
    std::string message;
    const int code = codeOf(
        [](const om::Request&) {
            om::Answer answer;
            answer.code = CMPI_RC_ERR_INVALID_QUERY;
            answer.message = "not <today>";
            return answer;
        },
        &message);
    EXPECT_EQ(code, 15);
    EXPECT_THAT(message, testing::HasSubstr("CODE=\"15\" DESCRIPTION=\"not &lt;today&gt;\""));
}

TEST(Operations, WhatTheProviderLacksIsNotSupportedAndWhatItThrowsIsAFailure) {
    EXPECT_EQ(codeOf([](const om::Request&) -> om::Answer { throw om::LoadError("no such factory"); }), 7);
    EXPECT_EQ(codeOf([](const om::Request&) -> om::Answer { throw std::runtime_error("broken"); }), 1);
}

TEST(Operations, TheProviderLearnsWhoAsks) {
    std::string principal;
    codeOf([&](const om::Request& request) {
        principal = request.principal;
        return om::Answer();
    });
    EXPECT_EQ(principal, "root");
}

} // namespace
} // namespace endpoint
