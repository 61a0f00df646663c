#include "objectmanager/endpoint/Exchange.h"

#include "tests/objectmanager/endpoint/Endpoint.h"
#include "tests/objectmanager/endpoint/HttpRequests.h"

#include <gmock/gmock.h>

namespace endpoint {
namespace {

HttpAnswer answer(const HttpRequest& http) {
    if (auto refused = refuseHead(http)) return *refused;
    return exchange(operations(), http, administrator());
}

std::string header(const HttpAnswer& http, const std::string& name) {
    for (const auto& [key, value] : http.headers) {
        if (key == name) return value;
    }
    return "none";
}

TEST(Exchange, AnswersWithTheHeadersOfTheStandard) {
    const HttpAnswer answered = answer(goodRequest());
    EXPECT_EQ(answered.status, 200U);
    EXPECT_EQ(header(answered, "Content-Type"), "application/xml; charset=\"utf-8\"");
    EXPECT_EQ(header(answered, "CIMOperation"), "MethodResponse");
    EXPECT_THAT(answered.body, testing::HasSubstr("CIM_ComputerSystem"));
    EXPECT_EQ(answered.operation, "EnumerateClassNames");
    EXPECT_EQ(answered.className, "CIM_System");
}

TEST(Exchange, AMandatoryRequestHasAPrefixBeforeItsHeaders) {
    for (const char* man :
         {"http://www.dmtf.org/cim/mapping/http/v1.0 ; ns=40", "\"http://www.dmtf.org/cim/mapping/http/v1.0\";NS=40"}) {
        const HttpAnswer answered = answer(mandatory(man));
        EXPECT_EQ(answered.status, 200U) << man;
        EXPECT_EQ(header(answered, "73-CIMOperation"), "MethodResponse");
        EXPECT_EQ(header(answered, "Man"), "http://www.dmtf.org/cim/mapping/http/v1.0 ; ns=73");
        EXPECT_EQ(header(answered, "Ext"), " ");
    }
    HttpRequest unreadable = mandatory("http://www.dmtf.org/cim/mapping/http/v1.0 ; ns=40");
    unreadable.body = "<CIM";
    EXPECT_EQ(header(answer(unreadable), "73-CIMError"), "request-not-well-formed");
}

TEST(Exchange, TakesEveryFormInWhichClientsSendHeaders) {
    const HttpRequest good[] = {with("CIMObject", "root/cimv2"),
                                with("CIMObject", "ROOT%2fCIMV2"),
                                with("CIMMethod", "enumerateclassnames"),
                                with("CIMMethod", "Enumerate%43lassNames"),
                                with("CIMOperation", "methodCALL"),
                                with("CIMProtocolVersion", "1.0"),
                                with("Content-Type", "text/xml"),
                                with("Content-Type", "Application/XML;charset=UTF-8"),
                                with("Content-Encoding", "identity"),
                                with("Accept-Encoding", "gzip"),
                                like("POST", "/"),
                                like("POST", "/cimom/"),
                                like("POST", "http://node7:5988/cimom"),
                                like("POST", "HTTPS://node7"),
                                with("X-Other", "a\tb")};
    for (const HttpRequest& http : good) EXPECT_EQ(answer(http).status, 200U) << answer(http).detail;
    HttpRequest old = without("Host");
    old.version = "HTTP/1.0";
    EXPECT_EQ(answer(old).status, 200U);
}

TEST(Exchange, KeysInCIMObjectAreNotCompared) {
    HttpRequest made = with("CIMMethod", "ManageTime");
    made.body =
        cimxml::message("<SIMPLEREQ><METHODCALL NAME=\"ManageTime\"><LOCALINSTANCEPATH>" + cimxml::localNameSpace +
                        timeServiceName() + "</LOCALINSTANCEPATH></METHODCALL></SIMPLEREQ>");
    EXPECT_EQ(answer(with("CIMObject", "root/cimv2:VESKA_TimeService.Name=\"50%41\"", made)).status, 200U);
    EXPECT_EQ(answer(with("CIMObject", "root%2Fcimv2%3Aveska_timeservice.Name%3D%22x%22", made)).status, 200U);
    EXPECT_EQ(answer(with("CIMObject", "root/cimv2:VESKA_TimeService", made)).status, 200U);
}

TEST(Exchange, ARefusalIsAHeaderAlone) {
    const HttpAnswer unread = answer(withBody("<CIM"));
    EXPECT_EQ(unread.status, 400U);
    EXPECT_EQ(header(unread, "CIMError"), "request-not-well-formed");
    EXPECT_EQ(unread.body, "");
    EXPECT_EQ(unread.detail, "a tag that does not end");
    EXPECT_EQ(header(answer(like("GET", "/cimom")), "Allow"), "POST, M-POST");
}

TEST(Exchange, ACimErrorIsAnAnswerLikeAnyOther) {
    const HttpAnswer answered = answer(asking("EnumerateClassNames", cimxml::parameter("x", "")));
    EXPECT_EQ(answered.status, 200U);
    EXPECT_EQ(answered.cimStatus, 4);
    EXPECT_EQ(header(answered, "CIMError"), "none");
}

} // namespace
} // namespace endpoint
