#include "tests/objectmanager/endpoint/HostileRequests.h"

namespace endpoint {
namespace {

constexpr const char* mapping = "http://www.dmtf.org/cim/mapping/http/v1.0";
const std::string many(20000, 'a');

/// A good request with other bytes in the place of its request line.
std::string lineOf(const std::string& line) {
    const std::string good = bytesOf(goodRequest());
    return line + good.substr(good.find("\r\n"));
}

/// A good request with one line more in its head.
std::string lineMore(const std::string& line) {
    const std::string good = bytesOf(goodRequest());
    return good.substr(0, good.find("\r\n") + 2) + line + good.substr(good.find("\r\n"));
}

std::string manyHeaders() {
    std::string lines;
    for (int i = 0; i < 2000; ++i) lines += (i == 0 ? "X" : "\r\nX") + std::to_string(i) + ": a";
    return lineMore(lines);
}

HostileRequests requestLines() {
    return {
        {"a handshake of TLS", std::string("\x16\x03\x01\x02\0\x01\0\x01\xFC\x03\x03\r\n\r\n", 15), "400 or none"},
        {"one word", lineOf("hello"), "400 or none"},
        {"no method", lineOf(" /cimom HTTP/1.1"), "400 or none"},
        {"no version", lineOf("POST /cimom")},
        {"no version of HTTP", lineOf("POST /cimom HTTPS/1.1")},
        {"more than a version", lineOf("POST /cimom HTTP/1.1 x")},
        {"a version of the past", lineOf("POST /cimom HTTP/0.9"), "505"},
        {"a version of the future", lineOf("PRI * HTTP/2.0"), "505"},
        {"GET", like("GET", "/cimom"), "405"},
        {"HEAD", like("HEAD", "/cimom"), "405"},
        {"PUT", like("PUT", "/cimom"), "405"},
        {"DELETE", like("DELETE", "/cimom"), "405"},
        {"TRACE", like("TRACE", "/cimom"), "405"},
        {"OPTIONS", like("OPTIONS", "*"), "405"},
        {"CONNECT", like("CONNECT", "node8:22"), "405"},
        {"a method that HTTP lacks", like("BREW", "/cimom"), "501"},
        {"a method in small letters", like("post", "/cimom"), "501"},
        {"another path", like("POST", "/etc/passwd"), "404"},
        {"another path behind a host", like("POST", "http://node7:5988/etc/passwd"), "404"},
        {"another scheme", like("POST", "file://node7/cimom"), "404"},
        {"a path that goes up", like("POST", "/../cimom"), "404"},
        {"a path that is too long", like("POST", '/' + many), "414"},
    };
}

HostileRequests mandatoryRequests() {
    const std::string declared = std::string(mapping) + " ; ns=";
    HttpRequest old = mandatory(declared + "40");
    old.version = "HTTP/1.0";
    return {
        {"M-POST without Man", like("M-POST", "/cimom"), "510"},
        {"M-POST for something else", mandatory("http://example.org/other ; ns=40"), "510"},
        {"M-POST without digits", mandatory(mapping), "510"},
        {"M-POST with one digit", mandatory(declared + "4"), "510"},
        {"M-POST with other digits", mandatory(declared + "41")},
        {"M-POST of HTTP/1.0", old},
    };
}

HostileRequests headers() {
    return {
        {"no Host", without("Host")},
        {"an empty Host", with("Host", "")},
        {"two Hosts", withMore("Host", "node8:5988")},
        {"a line without a colon", lineMore("JustAWord")},
        {"a header without a name", lineMore(": x"), "400 or 411"},
        {"a blank before the colon", lineMore("X-Other : x")},
        {"a blank that hides CIMBatch", lineMore("CIMBatch : ")},
        {"a first header that goes on", lineMore(" folded")},
        // The library may take the value to end there.
        {"a zero byte in a header", lineMore(std::string("X-Other: a\0b", 12)), "200 or 400"},
        {"a zero byte behind what is expected", with("CIMObject", std::string("root%2Fcimv2\0:x", 15)), "200 or 400"},
        {"a control character in a header", lineMore("X-Other: a\x01")},
        {"a character to be deleted in a header", lineMore("X-Other: a\x7F")},
        {"the end of a line within a header", lineMore("X-Other: a\rCIMBatch:")},
        {"a header that is too long", lineMore("X-Other: " + many), "431"},
        {"too many headers", manyHeaders(), "431"},
        {"no Content-Type", without("Content-Type"), "415"},
        {"another Content-Type", with("Content-Type", "text/plain"), "415"},
        {"another charset", with("Content-Type", "application/xml; charset=iso-8859-1"), "415"},
        {"another parameter", with("Content-Type", "application/xml; version=1"), "415"},
        {"a compressed body", with("Content-Encoding", "gzip"), "415"},
    };
}

HostileRequests cimHeaders() {
    HttpRequest method = with("CIMMethod", "ManageTime");
    method.body =
        cimxml::message("<SIMPLEREQ><METHODCALL NAME=\"ManageTime\"><LOCALCLASSPATH>" + cimxml::localNameSpace +
                        cimxml::className("VESKA_TimeService") + "</LOCALCLASSPATH></METHODCALL></SIMPLEREQ>");
    return {
        {"no CIMOperation", without("CIMOperation")},
        {"another CIMOperation", with("CIMOperation", "Export"), "400", "unsupported-operation"},
        {"CIMOperation twice", withMore("cimoperation", "MethodCall"), "400", "unsupported-operation"},
        {"CIMBatch", with("CIMBatch", ""), "501", "multiple-requests-unsupported"},
        {"no CIMMethod", without("CIMMethod"), "400", "header-mismatch"},
        {"an empty CIMMethod", with("CIMMethod", ""), "400", "header-mismatch"},
        {"another CIMMethod", with("CIMMethod", "GetClass"), "400", "header-mismatch"},
        {"CIMMethod with a bad escape", with("CIMMethod", "EnumerateClassNames%4"), "400", "header-mismatch"},
        {"CIMMethod twice", withMore("CIMMethod", "EnumerateClassNames"), "400", "header-mismatch"},
        {"no CIMObject", without("CIMObject"), "400", "header-mismatch"},
        {"another CIMObject", with("CIMObject", "root%2Finterop"), "400", "header-mismatch"},
        {"CIMObject with a bad escape", with("CIMObject", "root%2xcimv2"), "400", "header-mismatch"},
        {"CIMObject with an escaped zero byte", with("CIMObject", "root%2Fcimv2%00"), "400", "header-mismatch"},
        {"CIMObject of another class", with("CIMObject", "root/cimv2:VESKA_Other.Name=\"x\"", method), "400",
         "header-mismatch"},
        {"CIMObject of a class elsewhere", with("CIMObject", "root/x:VESKA_TimeService", method), "400",
         "header-mismatch"},
        {"another protocol version", with("CIMProtocolVersion", "1.4"), "400", "header-mismatch"},
    };
}

} // namespace

HostileRequests hostileHeads() {
    return together({requestLines(), mandatoryRequests(), headers(), cimHeaders()});
}

} // namespace endpoint
