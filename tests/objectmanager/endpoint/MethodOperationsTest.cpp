#include "tests/objectmanager/endpoint/Endpoint.h"

#include <gmock/gmock.h>

namespace endpoint {
namespace {

using cimxml::className;
using cimxml::instanceName;
using cimxml::key;

class MethodOperations : public testing::Test {
protected:
    MethodOperations() { simulateNode7(); }
};

std::string argument(const std::string& name, const std::string& content, const std::string& type = "") {
    return "<PARAMVALUE NAME=\"" + name + "\"" + (type.empty() ? "" : " PARAMTYPE=\"" + type + "\"") + ">" + content +
           "</PARAMVALUE>";
}

std::string reference(const std::string& name) {
    return "<VALUE.REFERENCE>" + name + "</VALUE.REFERENCE>";
}

TEST_F(MethodOperations, TakesTypesFromTheClassAndReturnsTypedValues) {
    const Reply reply =
        invoke(timeServiceName(), "managetime",
               argument("getrequest", "<VALUE>True</VALUE>") + argument("ManagedElement", reference(computerName())));
    ASSERT_EQ(reply.code, 0) << reply.description;
    EXPECT_STREQ(reply.response.name(), "METHODRESPONSE");
    EXPECT_STREQ(reply.response.attribute("NAME").value(), "managetime");
    const pugi::xml_node returned = reply.response.child("RETURNVALUE");
    EXPECT_STREQ(returned.attribute("PARAMTYPE").value(), "uint32");
    EXPECT_STREQ(returned.child("VALUE").text().get(), "0");
    const pugi::xml_node time = returned.next_sibling();
    EXPECT_STREQ(time.attribute("NAME").value(), "TimeData");
    EXPECT_STREQ(time.attribute("PARAMTYPE").value(), "datetime");
    EXPECT_EQ(reply.out("TimeData").size(), 25U);
}

TEST_F(MethodOperations, ANullParameterIsHandedOn) {
    const Reply reply = invoke(timeServiceName(), "ManageTime",
                               argument("GetRequest", "<VALUE>true</VALUE>", "boolean") +
                                   argument("ManagedElement", "", "reference") + argument("TimeData", ""));
    EXPECT_EQ(reply.code, 0) << reply.description;
}

TEST_F(MethodOperations, ParametersHaveToFitTheClass) {
    const auto code = [](const std::string& arguments) {
        return invoke(timeServiceName(), "ManageTime", arguments).code;
    };
    EXPECT_EQ(code(argument("NoSuch", "<VALUE>1</VALUE>")), 4);
    EXPECT_EQ(code(argument("GetRequest", "<VALUE>TRUE</VALUE>") + argument("GETREQUEST", "<VALUE>TRUE</VALUE>")), 4);
    EXPECT_EQ(code(argument("GetRequest", "<VALUE>1</VALUE>")), 4);
    EXPECT_EQ(code(argument("GetRequest", "<VALUE>TRUE</VALUE>", "string")), 4);
    EXPECT_EQ(code(argument("GetRequest", "<VALUE.ARRAY/>")), 4);
    EXPECT_EQ(code(argument("TimeData", "<VALUE>yesterday</VALUE>")), 4);
    EXPECT_EQ(code(argument("ManagedElement", "<VALUE>text</VALUE>")), 4);
}

TEST_F(MethodOperations, AProvidersStatusAndMessageBecomeTheError) {
    EXPECT_EQ(invoke(timeServiceName(), "ManageTime", "").code, 4);
}

TEST_F(MethodOperations, OnlyAClassesOwnMethodsAreThere) {
    EXPECT_EQ(invoke(timeServiceName(), "NoSuchMethod", "").code, 17);
    EXPECT_EQ(invoke(timeServiceName(), "StartService", "").code, 16);
    EXPECT_EQ(invoke(computerName(), "ManageTime", "").code, 17);
    EXPECT_EQ(invoke(className("CIM_TimeService"), "ManageTime", "").code, 16);
    EXPECT_EQ(invoke(instanceName("No_Such", ""), "ManageTime", "").code, 6);
    EXPECT_EQ(invoke(instanceName("VESKA_TimeService", key("Name", "x")), "ManageTime", "").code, 4);
}

} // namespace
} // namespace endpoint
