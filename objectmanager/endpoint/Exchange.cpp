#include "objectmanager/endpoint/Exchange.h"

#include "objectmanager/cimxml/Errors.h"
#include "objectmanager/model/Characters.h"
#include "objectmanager/model/Names.h"

#include <algorithm>
#include <array>

namespace endpoint {
namespace {

using cimxml::Refusal;

constexpr std::string_view mapping = "http://www.dmtf.org/cim/mapping/http/v1.0";

std::string_view trimmed(std::string_view text) {
    return om::trimmed(text, " \t"); // the blanks of HTTP's headers
}

/// The two digits that an M-POST puts before its headers: `Man: "URI" ; ns=NN`.
std::optional<std::string> prefixOf(std::string_view man) {
    const std::size_t semicolon = man.find(';');
    std::string_view uri = trimmed(man.substr(0, semicolon));
    if (uri.size() >= 2 && uri.front() == '"' && uri.back() == '"') uri = uri.substr(1, uri.size() - 2);
    if (uri != mapping || semicolon == std::string_view::npos) return std::nullopt;
    std::string_view digits = trimmed(man.substr(semicolon + 1));
    const std::size_t equals = digits.find('=');
    if (equals == std::string_view::npos || !om::sameName(trimmed(digits.substr(0, equals)), "ns")) return std::nullopt;
    digits = trimmed(digits.substr(equals + 1));
    if (digits.size() != 2 || !om::isDigit(digits[0]) || !om::isDigit(digits[1])) return std::nullopt;
    return std::string(digits) + '-';
}

/// What stands before the names of the CIM headers: nothing for POST. Throws Refusal.
std::string prefixOf(const HttpRequest& request) {
    if (request.method == "POST") return {};
    if (request.version == "HTTP/1.0") throw Refusal(400, "", "M-POST takes HTTP/1.1");
    const std::optional<std::string> prefix = prefixOf(headerOf(request, "Man").value_or(""));
    if (!prefix) throw Refusal(510, "", "no CIM extension is declared");
    return *prefix;
}

int hexDigit(char c) {
    if (om::isDigit(c)) return c - '0';
    const char letter = om::lower(c);
    return letter >= 'a' && letter <= 'f' ? letter - 'a' + 10 : -1;
}

/// With `%41` as `A`; nothing for a bad escape.
std::optional<std::string> decoded(std::string_view text) {
    std::string result;
    for (std::size_t i = 0; i < text.size(); ++i) {
        if (text[i] != '%') {
            result += text[i];
            continue;
        }
        const int high = i + 2 < text.size() ? hexDigit(text[i + 1]) : -1;
        const int low = high >= 0 ? hexDigit(text[i + 2]) : -1;
        if (low < 0) return std::nullopt;
        result += static_cast<char>(high * 16 + low);
        i += 2;
    }
    return result;
}

bool isOneOf(std::string_view word, std::initializer_list<std::string_view> words) {
    return std::any_of(words.begin(), words.end(), [&](std::string_view each) { return om::sameName(each, word); });
}

/// `application/xml; charset="utf-8"` and its variants.
bool isCimContent(std::string_view type) {
    const std::size_t semicolon = type.find(';');
    if (!isOneOf(trimmed(type.substr(0, semicolon)), {"application/xml", "text/xml"})) return false;
    if (semicolon == std::string_view::npos) return true;
    const std::string_view parameter = trimmed(type.substr(semicolon + 1));
    const std::size_t equals = parameter.find('=');
    if (equals == std::string_view::npos) return parameter.empty();
    if (!om::sameName(trimmed(parameter.substr(0, equals)), "charset")) return false;
    return isOneOf(trimmed(parameter.substr(equals + 1)), {"utf-8", "\"utf-8\""});
}

/// Without the scheme and host that stand before the path in a request for a proxy: every server takes those, too.
std::string_view pathWithin(std::string_view target) {
    for (const std::string_view scheme : {"http://", "https://"}) {
        if (!om::sameName(target.substr(0, scheme.size()), scheme)) continue;
        const std::size_t slash = target.find('/', scheme.size());
        return slash == std::string_view::npos ? "/" : target.substr(slash);
    }
    return target;
}

void checkMethod(const HttpRequest& request) {
    static constexpr std::array<std::string_view, 8> known = {"GET",     "HEAD",  "PUT",   "DELETE",
                                                              "OPTIONS", "PATCH", "TRACE", "CONNECT"};
    if (request.method == "POST" || request.method == "M-POST") return;
    const bool isKnown = std::find(known.begin(), known.end(), request.method) != known.end();
    throw Refusal(isKnown ? 405 : 501, "", "method " + request.method);
}

/// A name ends at its colon and a value with its line, for us and for whoever else reads the head.
void checkHeaders(const Headers& headers) {
    const auto isControl = [](char c) { return (static_cast<unsigned char>(c) < 0x20 && c != '\t') || c == 0x7F; };
    const auto isHost = [](const auto& header) { return om::sameName(header.first, "Host"); };
    for (const auto& [name, value] : headers) {
        const bool isToken = !name.empty() && name.find_first_of(" \t") == std::string::npos;
        if (!isToken || std::any_of(value.begin(), value.end(), isControl)) throw Refusal(400, "", "header " + name);
    }
    if (std::count_if(headers.begin(), headers.end(), isHost) > 1) throw Refusal(400, "", "more than one Host");
}

std::string requiredHeader(const HttpRequest& request, const std::string& name, const char* cimError) {
    const std::optional<std::string> value = headerOf(request, name);
    if (!value || value->empty()) throw Refusal(400, cimError, "header " + name + " is missing");
    return *value;
}

void checkHead(const HttpRequest& request) {
    checkMethod(request);
    if (!isOneOf(pathWithin(request.path), {"/cimom", "/cimom/", "/"})) throw Refusal(404, "", "path " + request.path);
    checkHeaders(request.headers);
    const std::string prefix = prefixOf(request);
    const std::string operation = requiredHeader(request, prefix + "CIMOperation", "");
    if (!om::sameName(operation, "MethodCall")) throw Refusal(400, "unsupported-operation", operation);
    if (request.version != "HTTP/1.0") requiredHeader(request, "Host", "");
    if (headerOf(request, prefix + "CIMBatch")) {
        throw Refusal(501, "multiple-requests-unsupported", "several requests in one message");
    }
    requiredHeader(request, prefix + "CIMMethod", "header-mismatch");
    requiredHeader(request, prefix + "CIMObject", "header-mismatch");
    if (!isCimContent(headerOf(request, "Content-Type").value_or("")))
        throw Refusal(415, "", "the type of the content");
    const std::string encoding = headerOf(request, "Content-Encoding").value_or("identity");
    if (!om::sameName(encoding, "identity")) throw Refusal(415, "", "the content is encoded");
}

/// Namespace, and class for a method, without keys.
std::string objectOf(const cimxml::Request& request) {
    return request.intrinsic ? request.nameSpace : request.nameSpace + ':' + request.target.className;
}

bool isSameObject(std::string_view header, const cimxml::Request& request) {
    if (!request.intrinsic) header = header.substr(0, header.find('.', header.find(':')));
    return om::sameName(header, objectOf(request));
}

void compareHeaders(const HttpRequest& http, const std::string& prefix, const cimxml::Request& request) {
    const auto differs = [](const char* name) {
        return Refusal(400, "header-mismatch", std::string("header ") + name + " differs from the message");
    };
    if (headerOf(http, prefix + "CIMProtocolVersion").value_or("1.0") != request.protocolVersion) {
        throw differs("CIMProtocolVersion");
    }
    const std::string method = requiredHeader(http, prefix + "CIMMethod", "header-mismatch");
    if (!om::sameName(decoded(method).value_or(""), request.name)) throw differs("CIMMethod");
    const std::string object = requiredHeader(http, prefix + "CIMObject", "header-mismatch");
    if (!isSameObject(object, request) && !isSameObject(decoded(object).value_or(""), request)) {
        throw differs("CIMObject");
    }
}

/// What the headers of an answer to M-POST begin with, and those that it has more.
void declareExtension(Headers& headers, bool mandatory) {
    if (!mandatory) return;
    constexpr const char* prefix = "73-";
    for (auto& [name, value] : headers) {
        if (name.rfind("CIM", 0) == 0) name.insert(0, prefix);
    }
    headers.emplace_back("Ext", " "); // a blank, since libmicrohttpd sends no header without a value
    headers.emplace_back("Man", std::string(mapping) + " ; ns=73");
}

HttpAnswer refusalOf(const Refusal& refusal, bool mandatory) {
    HttpAnswer answer;
    answer.status = refusal.status;
    answer.detail = refusal.what();
    if (refusal.status == 405) answer.headers.emplace_back("Allow", "POST, M-POST");
    if (!refusal.cimError.empty()) answer.headers.emplace_back("CIMError", refusal.cimError);
    declareExtension(answer.headers, mandatory && !refusal.cimError.empty());
    return answer;
}

bool isMandatory(const HttpRequest& request) {
    return request.method == "M-POST";
}

/// The class that an operation works on, for the log.
std::string subjectOf(const cimxml::Request& request) {
    if (!request.intrinsic) return request.target.className;
    for (const cimxml::ParameterElement& parameter : request.parameters) {
        const cimxml::ValueElement& value = parameter.value;
        if (value.path && !isOneOf(parameter.name, {"AssocClass", "ResultClass"})) return value.path->className;
        if (value.instance) return value.instance->className;
    }
    return {};
}

} // namespace

std::optional<std::string> headerOf(const HttpRequest& request, std::string_view name) {
    std::optional<std::string> found;
    for (const auto& [key, value] : request.headers) {
        if (om::sameName(key, name)) found = found ? *found + ", " + value : value;
    }
    return found;
}

std::optional<HttpAnswer> refuseHead(const HttpRequest& request) {
    try {
        checkHead(request);
        return std::nullopt;
    } catch (const Refusal& refusal) {
        return refusalOf(refusal, isMandatory(request));
    }
}

HttpAnswer exchange(Operations& operations, const HttpRequest& request, Caller caller, const Permit& permit,
                    std::size_t enough) {
    try {
        const cimxml::Request read = cimxml::readRequest(request.body);
        compareHeaders(request, prefixOf(request), read);
        HttpAnswer answer;
        answer.operation = read.name;
        answer.nameSpace = read.nameSpace;
        answer.className = subjectOf(read);
        if (permit) permit(answer, changesSomething(read), caller);
        Outcome outcome = operations.answer(read, caller, enough);
        answer.body = std::move(outcome.message);
        answer.rest = std::move(outcome.rest);
        answer.cimStatus = outcome.code;
        answer.headers = {{"Content-Type", "application/xml; charset=\"utf-8\""},
                          {"CIMOperation", "MethodResponse"},
                          {"Cache-Control", "no-cache"}};
        declareExtension(answer.headers, isMandatory(request));
        return answer;
    } catch (const Refusal& refusal) {
        return refusalOf(refusal, isMandatory(request));
    }
}

} // namespace endpoint
