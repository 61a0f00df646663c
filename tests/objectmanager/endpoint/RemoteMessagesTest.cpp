#include "objectmanager/vkcim/RemoteMessages.h"

#include "objectmanager/endpoint/Exchange.h"
#include "support/Requests.h"
#include "support/SimulatedHost.h"
#include "tests/objectmanager/endpoint/Endpoint.h"

#include <gmock/gmock.h>

namespace endpoint {
namespace {

using om::Operation;

/// What a request is answered by way of two messages.
om::Answer remotely(const om::Request& request) {
    const vkcim::RemoteQuestion question = vkcim::remoteQuestion(request, om::Schema::builtin());
    HttpRequest http;
    http.method = "POST";
    http.headers = {{"Host", "x"},
                    {"Content-Type", "application/xml; charset=\"utf-8\""},
                    {"CIMOperation", "MethodCall"},
                    {"CIMMethod", question.method},
                    {"CIMObject", question.object}};
    http.body = question.body;
    EXPECT_FALSE(refuseHead(http));
    const HttpAnswer answer = exchange(operations(), http, administrator());
    EXPECT_EQ(answer.status, 200U) << answer.detail;
    return vkcim::remoteAnswer(answer.body, request, om::Schema::builtin());
}

class RemoteMessages : public testing::Test {
protected:
    RemoteMessages() { simulateNode7(); }

    om::ObjectPath computer =
        test::path("VESKA_ComputerSystem", {{"CreationClassName", "VESKA_ComputerSystem"}, {"Name", "node7"}});
};

void expectSame(const om::Request& request) {
    const om::Answer here = test::provider().run(request);
    const om::Answer there = remotely(request);
    EXPECT_EQ(there.code, here.code);
    ASSERT_EQ(there.results.size(), here.results.size());
    for (std::size_t i = 0; i < here.results.size(); ++i) EXPECT_TRUE(there.results[i] == here.results[i]) << i;
    EXPECT_EQ(there.returnValue.has_value(), here.returnValue.has_value());
}

TEST_F(RemoteMessages, AnAnswerComesBackWithTheSameTypes) {
    for (const std::string& className : om::Schema::builtin().served()) {
        SCOPED_TRACE(className);
        expectSame(test::asking(Operation::EnumInstances, test::path(className)));
        expectSame(test::asking(Operation::EnumInstanceNames, test::path(className)));
    }
    expectSame(test::asking(Operation::GetInstance, computer));
    expectSame(test::asking(Operation::Associators, computer, "VESKA_ComputerSystemPackage"));
    expectSame(test::asking(Operation::AssociatorNames, computer, "VESKA_ComputerCapabilities"));
}

TEST_F(RemoteMessages, AnErrorComesBackAsItsStatus) {
    EXPECT_EQ(remotely(test::asking(Operation::EnumInstances, test::path("No_Such"))).code, CMPI_RC_ERR_INVALID_CLASS);
    EXPECT_EQ(remotely(test::asking(Operation::References, computer)).code, CMPI_RC_ERR_NOT_SUPPORTED);
    EXPECT_EQ(remotely(test::asking(Operation::DeleteInstance, computer)).code, CMPI_RC_ERR_NOT_SUPPORTED);
    om::Request query = test::asking(Operation::ExecQuery, test::path("VESKA_ComputerSystem"));
    query.query = "SELECT * FROM VESKA_ComputerSystem";
    query.language = "WQL";
    EXPECT_EQ(remotely(query).code, CMPI_RC_ERR_NOT_SUPPORTED);
}

TEST_F(RemoteMessages, AMethodsResultsComeBack) {
    const om::ObjectPath service = test::paths(test::names("VESKA_TimeService")).at(0);
    const om::Request request =
        test::calling(service, "ManageTime",
                      {{"GetRequest", {CMPI_boolean, true}},
                       {"ManagedElement", {CMPI_ref, std::make_shared<const om::ObjectPath>(computer)}}});
    const om::Answer answer = remotely(request);
    EXPECT_EQ(answer.code, CMPI_RC_OK) << answer.message.value_or("");
    EXPECT_EQ(answer.returnValue, (om::Value{CMPI_uint32, std::uint64_t{0}}));
    EXPECT_EQ(test::namesOf(answer.out), std::vector<std::string>{"TimeData"});
}

TEST_F(RemoteMessages, AModificationReachesTheHost) {
    om::Request request = test::asking(Operation::ModifyInstance, test::paths(test::names("VESKA_TimeService")).at(0));
    request.values = {{"AutomaticDSTAdjustment", {CMPI_boolean, true}}};
    EXPECT_EQ(remotely(request).code, CMPI_RC_OK);
    EXPECT_EQ(test::simulatedProperty("/computer/0", 200), 1);
}

TEST_F(RemoteMessages, WhatIsNoAnswerIsSaid) {
    const om::Request request = test::asking(Operation::EnumInstanceNames, computer);
    const char* const begin = "<CIM CIMVERSION='2.0' DTDVERSION='2.0'><MESSAGE ID='1' PROTOCOLVERSION='1.0'><SIMPLERSP>"
                              "<IMETHODRESPONSE NAME='x'><IRETURNVALUE>";
    const char* const end = "</IRETURNVALUE></IMETHODRESPONSE></SIMPLERSP></MESSAGE></CIM>";
    EXPECT_NO_THROW(vkcim::remoteAnswer(std::string(begin) + end, request, om::Schema::builtin()));
    for (const std::string& body :
         {std::string(), std::string("<html/>"), std::string(begin), begin + std::string("<CLASS NAME='x'/>") + end,
          begin + std::string("<INSTANCENAME CLASSNAME='A'><KEYVALUE VALUETYPE='boolean'>5</KEYVALUE></INSTANCENAME>") +
              end}) {
        EXPECT_THROW(vkcim::remoteAnswer(body, request, om::Schema::builtin()), std::runtime_error) << body;
    }
}

} // namespace
} // namespace endpoint
