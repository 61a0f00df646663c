#include "objectmanager/endpoint/Exchange.h"

#include "tests/objectmanager/endpoint/Endpoint.h"

#include <gmock/gmock.h>

#include <algorithm>

namespace endpoint {
namespace {

using cimxml::className;
using cimxml::parameter;

HttpRequest request() {
    HttpRequest made;
    made.method = "POST";
    made.headers = {{"Host", "node7:5988"},
                    {"Content-Type", "application/xml; charset=\"utf-8\""},
                    {"CIMOperation", "MethodCall"},
                    {"CIMMethod", "EnumerateClassNames"},
                    {"CIMObject", "root%2Fcimv2"}};
    made.body = cimxml::intrinsic("EnumerateClassNames", parameter("ClassName", className("CIM_System")));
    return made;
}

HttpRequest with(const std::string& name, const std::string& value, HttpRequest made = request()) {
    for (auto& [key, old] : made.headers) {
        if (key != name) continue;
        old = value;
        return made;
    }
    made.headers.emplace_back(name, value);
    return made;
}

HttpRequest without(const std::string& name) {
    HttpRequest made = request();
    made.headers.erase(
        std::remove_if(made.headers.begin(), made.headers.end(), [&](const auto& each) { return each.first == name; }),
        made.headers.end());
    return made;
}

HttpRequest withBody(const std::string& body) {
    HttpRequest made = request();
    made.body = body;
    return made;
}

HttpRequest like(const std::string& method, const std::string& path, const std::string& version = "HTTP/1.1") {
    HttpRequest made = request();
    made.method = method;
    made.path = path;
    made.version = version;
    return made;
}

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
    const HttpAnswer answered = answer(request());
    EXPECT_EQ(answered.status, 200U);
    EXPECT_EQ(header(answered, "Content-Type"), "application/xml; charset=\"utf-8\"");
    EXPECT_EQ(header(answered, "CIMOperation"), "MethodResponse");
    EXPECT_THAT(answered.body, testing::HasSubstr("CIM_ComputerSystem"));
    EXPECT_EQ(answered.operation, "EnumerateClassNames");
    EXPECT_EQ(answered.className, "CIM_System");
}

HttpRequest mandatory(const std::string& man) {
    HttpRequest made = request();
    made.method = "M-POST";
    for (auto& [name, value] : made.headers) {
        if (name.rfind("CIM", 0) == 0) name.insert(0, "40-");
    }
    made.headers.emplace_back("Man", man);
    return made;
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
                                like("POST", "/cimom/")};
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
    EXPECT_EQ(header(answer(with("CIMObject", "root/cimv2:VESKA_Other.Name=\"x\"", made)), "CIMError"),
              "header-mismatch");
    EXPECT_EQ(header(answer(with("CIMObject", "root/x:VESKA_TimeService.Name=\"x\"", made)), "CIMError"),
              "header-mismatch");
}

TEST(Exchange, RefusesWhatIsNoCimRequest) {
    const std::string versioned =
        "<?xml version='1.0'?><CIM CIMVERSION='2.0' DTDVERSION='2.0'><MESSAGE ID='1' PROTOCOLVERSION='1.4'>"
        "<SIMPLEREQ><IMETHODCALL NAME='EnumerateClassNames'>" +
        cimxml::localNameSpace + "</IMETHODCALL></SIMPLEREQ></MESSAGE></CIM>";
    struct {
        const char* what;
        HttpRequest http;
        unsigned status;
        const char* cimError;
    } const bad[] = {
        {"GET", like("GET", "/cimom"), 405, "none"},
        {"PUT", like("PUT", "/cimom"), 405, "none"},
        {"OPTIONS", like("OPTIONS", "/cimom"), 405, "none"},
        {"a method that HTTP lacks", like("BREW", "/cimom"), 501, "none"},
        {"another path", like("POST", "/etc/passwd"), 404, "none"},
        {"M-POST without Man", like("M-POST", "/cimom"), 510, "none"},
        {"M-POST for something else", mandatory("http://example.org/other ; ns=40"), 510, "none"},
        {"M-POST without digits", mandatory("http://www.dmtf.org/cim/mapping/http/v1.0"), 510, "none"},
        {"M-POST with one digit", mandatory("http://www.dmtf.org/cim/mapping/http/v1.0 ; ns=4"), 510, "none"},
        {"M-POST with other digits", mandatory("http://www.dmtf.org/cim/mapping/http/v1.0 ; ns=41"), 400, "none"},
        {"M-POST of HTTP/1.0", like("M-POST", "/cimom", "HTTP/1.0"), 400, "none"},
        {"no CIMOperation", without("CIMOperation"), 400, "none"},
        {"another CIMOperation", with("CIMOperation", "Export"), 400, "unsupported-operation"},
        {"no Host", without("Host"), 400, "none"},
        {"CIMBatch", with("CIMBatch", ""), 501, "multiple-requests-unsupported"},
        {"no CIMMethod", without("CIMMethod"), 400, "header-mismatch"},
        {"an empty CIMMethod", with("CIMMethod", ""), 400, "header-mismatch"},
        {"another CIMMethod", with("CIMMethod", "GetClass"), 400, "header-mismatch"},
        {"CIMMethod with a bad escape", with("CIMMethod", "EnumerateClassNames%4"), 400, "header-mismatch"},
        {"no CIMObject", without("CIMObject"), 400, "header-mismatch"},
        {"another CIMObject", with("CIMObject", "root%2Finterop"), 400, "header-mismatch"},
        {"CIMObject with a bad escape", with("CIMObject", "root%2xcimv2"), 400, "header-mismatch"},
        {"no Content-Type", without("Content-Type"), 415, "none"},
        {"another Content-Type", with("Content-Type", "text/plain"), 415, "none"},
        {"another charset", with("Content-Type", "application/xml; charset=iso-8859-1"), 415, "none"},
        {"another parameter", with("Content-Type", "application/xml; version=1"), 415, "none"},
        {"a compressed body", with("Content-Encoding", "gzip"), 415, "none"},
        {"another protocol version", with("CIMProtocolVersion", "1.4"), 400, "header-mismatch"},
        {"a protocol version that no header says", withBody(versioned), 400, "header-mismatch"},
        {"no body", withBody(""), 400, "request-not-well-formed"},
        {"a body that is no XML", withBody("{\"a\": 1}"), 400, "request-not-well-formed"},
        {"half a body", withBody(request().body.substr(0, 150)), 400, "request-not-well-formed"},
        {"a body twice", withBody(request().body + request().body), 400, "request-not-well-formed"},
        {"Latin-1", withBody(cimxml::intrinsic("EnumerateClassNames", parameter("ClassName", className("\xE9")))), 400,
         "request-not-well-formed"},
        {"a zero byte", withBody(request().body + std::string(1, '\0')), 400, "request-not-well-formed"},
        {"a document type", withBody("<!DOCTYPE CIM>" + request().body), 400, "request-not-valid"},
        {"an entity bomb", withBody("<!DOCTYPE a [<!ENTITY a 'aaaa'><!ENTITY b '&a;&a;&a;'>]><CIM>&b;</CIM>"), 400,
         "request-not-valid"},
        {"an answer", withBody(cimxml::message("<SIMPLERSP/>")), 400, "request-not-valid"},
    };
    for (const auto& each : bad) {
        const HttpAnswer answered = answer(each.http);
        EXPECT_EQ(answered.status, each.status) << each.what << ": " << answered.detail;
        EXPECT_EQ(header(answered, "CIMError"), each.cimError) << each.what << ": " << answered.detail;
        EXPECT_EQ(answered.body, "") << each.what;
    }
    EXPECT_EQ(header(answer(like("GET", "/cimom")), "Allow"), "POST, M-POST");
}

TEST(Exchange, AHeaderThatStandsTwiceIsRefused) {
    HttpRequest twice = request();
    twice.headers.emplace_back("cimoperation", "MethodCall");
    EXPECT_EQ(header(answer(twice), "CIMError"), "unsupported-operation");
}

TEST(Exchange, ACimErrorIsAnAnswerLikeAnyOther) {
    const HttpAnswer answered = answer(withBody(cimxml::intrinsic("EnumerateClassNames", parameter("x", ""))));
    EXPECT_EQ(answered.status, 200U);
    EXPECT_EQ(answered.cimStatus, 4);
    EXPECT_EQ(header(answered, "CIMError"), "none");
}

} // namespace
} // namespace endpoint
