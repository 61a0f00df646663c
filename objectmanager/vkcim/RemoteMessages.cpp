#include "objectmanager/vkcim/RemoteMessages.h"

#include "objectmanager/cimxml/Document.h"
#include "objectmanager/cimxml/Errors.h"
#include "objectmanager/cimxml/Typing.h"
#include "objectmanager/cimxml/Writer.h"
#include "objectmanager/model/Characters.h"
#include "objectmanager/vkcim/PathText.h"

#include <algorithm>
#include <array>

namespace vkcim {
namespace {

using om::Operation;

/// In the order of om::Operation.
constexpr std::array<const char*, 11> names = {
    "EnumerateInstanceNames", "EnumerateInstances", "GetInstance",   "CreateInstance",
    "ModifyInstance",         "DeleteInstance",     "ExecQuery",     "Associators",
    "AssociatorNames",        "References",         "ReferenceNames"};

bool isMethod(const om::Request& request) {
    return request.operation == Operation::InvokeMethod;
}

bool returnsInstances(Operation operation) {
    return operation == Operation::EnumInstances || operation == Operation::GetInstance ||
           operation == Operation::Associators || operation == Operation::References;
}

std::string encoded(std::string_view text) {
    constexpr const char* digits = "0123456789ABCDEF";
    std::string result;
    for (const char c : text) {
        const auto byte = static_cast<unsigned char>(c);
        if (om::isNameByte(c) && byte < 0x80) {
            result += c;
        } else {
            result += '%';
            result += digits[byte >> 4U];
            result += digits[byte & 0xFU];
        }
    }
    return result;
}

/// The parameters of an intrinsic operation, one after the other.
class Parameters {
public:
    explicit Parameters(const om::Request& given) : request(given) {}

    std::string text() {
        switch (request.operation) {
        case Operation::EnumInstanceNames:
            className("ClassName", request.path.className);
            break;
        case Operation::EnumInstances:
            className("ClassName", request.path.className);
            flag("LocalOnly", false);
            flag("DeepInheritance", true);
            break;
        case Operation::GetInstance:
            instanceName("InstanceName");
            flag("LocalOnly", false);
            break;
        case Operation::DeleteInstance:
            instanceName("InstanceName");
            break;
        case Operation::CreateInstance:
            create();
            break;
        case Operation::ModifyInstance:
            modify();
            break;
        case Operation::ExecQuery:
            writer.intrinsicParameter("QueryLanguage", {CMPI_string, request.language});
            writer.intrinsicParameter("Query", {CMPI_string, request.query});
            break;
        default:
            associate();
        }
        if (returnsInstances(request.operation)) properties(request.propertyList);
        return writer.take();
    }

private:
    void open(std::string_view name) { writer.open("IPARAMVALUE", {{"NAME", name}}); }
    void close() { writer.close("IPARAMVALUE"); }

    void flag(std::string_view name, bool value) { writer.intrinsicParameter(name, {CMPI_boolean, value}); }

    void className(std::string_view name, const std::optional<std::string>& value) {
        if (!value) return;
        open(name);
        writer.className(*value);
        close();
    }

    void role(std::string_view name, const std::optional<std::string>& value) {
        if (value) writer.intrinsicParameter(name, {CMPI_string, *value});
    }

    void instanceName(std::string_view name) {
        open(name);
        writer.instanceName(request.path);
        close();
    }

    void properties(const std::optional<std::vector<std::string>>& list) {
        if (!list) return;
        std::vector<om::Value> elements;
        for (const std::string& name : *list) elements.push_back({CMPI_string, name});
        writer.intrinsicParameter("PropertyList", {CMPI_stringA, std::move(elements)});
    }

    void create() {
        om::Instance instance{request.path, request.path.keys};
        for (const auto& [name, value] : request.values) om::putValue(instance.properties, name, value);
        open("NewInstance");
        writer.instance(instance);
        close();
    }

    /// A null has to be named: servers leave what has no value as it is.
    void modify() {
        std::optional<std::vector<std::string>> list = request.propertyList;
        const auto isNull = [](const om::NamedValue& each) { return each.second.isNull(); };
        if (!list && std::any_of(request.values.begin(), request.values.end(), isNull)) {
            list.emplace();
            for (const om::NamedValue& each : request.values) list->push_back(each.first);
        }
        open("ModifiedInstance");
        writer.open("VALUE.NAMEDINSTANCE");
        writer.instanceName(request.path);
        writer.instance({request.path, request.values});
        writer.close("VALUE.NAMEDINSTANCE");
        close();
        properties(list);
    }

    void associate() {
        const bool references =
            request.operation == Operation::References || request.operation == Operation::ReferenceNames;
        instanceName("ObjectName");
        if (!references) className("AssocClass", request.assocClass);
        className("ResultClass", request.resultClass);
        role("Role", request.role);
        if (!references) role("ResultRole", request.resultRole);
    }

    const om::Request& request;
    cimxml::Writer writer;
};

std::string call(const om::Request& request) {
    cimxml::Writer writer;
    if (!isMethod(request)) {
        const char* const name = names[static_cast<std::size_t>(request.operation)];
        writer.open("IMETHODCALL", {{"NAME", name}});
        writer.localNameSpace(request.path.nameSpace);
        writer.raw(Parameters(request).text());
        writer.close("IMETHODCALL");
        return writer.take();
    }
    writer.open("METHODCALL", {{"NAME", request.method}});
    if (request.path.keys.empty()) {
        writer.open("LOCALCLASSPATH");
        writer.localNameSpace(request.path.nameSpace);
        writer.className(request.path.className);
        writer.close("LOCALCLASSPATH");
    } else {
        writer.localInstancePath(request.path);
    }
    for (const auto& [name, value] : request.values) writer.parameter(name, value);
    writer.close("METHODCALL");
    return writer.take();
}

/// Reads what stands in IMETHODRESPONSE or METHODRESPONSE.
class Response {
public:
    Response(const om::Request& asked, const om::Schema& schema)
        : request(asked), reading{schema, asked.path.nameSpace, cimxml::Trust::Message} {}

    om::Answer read(const pugi::xml_node& response) {
        om::Answer answer;
        answer.done = true;
        for (const pugi::xml_node& child : cimxml::childElements(response)) {
            const std::string_view name = child.name();
            if (name == "ERROR") {
                answer.code = static_cast<CMPIrc>(child.attribute("CODE").as_int(CMPI_RC_ERR_FAILED));
                answer.message = child.attribute("DESCRIPTION").as_string();
                answer.done = false;
            } else if (name == "IRETURNVALUE") {
                for (const pugi::xml_node& each : cimxml::childElements(child)) result(each, answer);
            } else if (name == "RETURNVALUE") {
                answer.returnValue = parameter(child);
            } else if (name == "PARAMVALUE") {
                answer.out.emplace_back(cimxml::required(child, "NAME"), parameter(child));
            }
        }
        return answer;
    }

private:
    om::Value parameter(const pugi::xml_node& node) const {
        const std::vector<pugi::xml_node> children = cimxml::childElements(node);
        const cimxml::ValueElement element =
            children.empty() ? cimxml::ValueElement() : cimxml::readValue(children.front());
        CMPIType type = cimxml::typeNamed(node.attribute("PARAMTYPE").as_string("string")).value_or(CMPI_string);
        if (type == CMPI_string && (node.attribute("EmbeddedObject") || node.attribute("EMBEDDEDOBJECT"))) {
            type = CMPI_instance;
        }
        const bool array =
            element.kind == cimxml::ValueElement::Kind::Array || element.kind == cimxml::ValueElement::Kind::References;
        if (array) type = static_cast<CMPIType>(type | CMPI_ARRAY);
        return cimxml::typedValue(element, type, reading);
    }

    om::ObjectPath path(const pugi::xml_node& node) const {
        om::ObjectPath found = cimxml::typedPath(cimxml::readPath(node), reading);
        found.host.clear();
        return found;
    }

    /// An instance with its path; of one that comes without, the path is the one that was asked for.
    om::Instance instance(const pugi::xml_node& node, om::ObjectPath where) const {
        om::Instance found = cimxml::typedInstance(cimxml::readInstance(node), reading);
        found.path = std::move(where);
        return found;
    }

    void result(const pugi::xml_node& node, om::Answer& answer) const {
        const std::string_view name = node.name();
        const std::vector<pugi::xml_node> children = cimxml::childElements(node);
        if (name == "INSTANCE") {
            answer.results.emplace_back(instance(node, request.path));
        } else if (name == "OBJECTPATH" && children.size() == 1) {
            answer.results.emplace_back(path(children.front()));
        } else if (name == "INSTANCENAME") {
            answer.results.emplace_back(path(node));
        } else if ((name == "VALUE.NAMEDINSTANCE" || name == "VALUE.OBJECTWITHPATH" || name == "VALUE.OBJECT") &&
                   !children.empty() && children.back().name() == std::string_view("INSTANCE")) {
            om::ObjectPath where = request.path;
            if (children.size() > 1) where = path(children.front());
            answer.results.emplace_back(instance(children.back(), std::move(where)));
        } else {
            throw std::runtime_error("the answer holds an element " + std::string(name));
        }
    }

    const om::Request& request;
    cimxml::Reading reading;
};

} // namespace

RemoteQuestion remoteQuestion(const om::Request& request, const om::Schema& schema) {
    RemoteQuestion question;
    question.method = isMethod(request) ? request.method : names[static_cast<std::size_t>(request.operation)];
    std::string object = request.path.nameSpace;
    if (isMethod(request)) object += ':' + pathText(request.path, request.path.nameSpace, schema);
    question.object = encoded(object);
    cimxml::Writer writer;
    writer.raw("<?xml version=\"1.0\" encoding=\"utf-8\"?>\n");
    writer.open("CIM", {{"CIMVERSION", "2.0"}, {"DTDVERSION", "2.0"}});
    writer.open("MESSAGE", {{"ID", "1"}, {"PROTOCOLVERSION", "1.0"}});
    writer.open("SIMPLEREQ");
    writer.raw(call(request));
    writer.close("SIMPLEREQ");
    writer.close("MESSAGE");
    writer.close("CIM");
    question.body = writer.take();
    return question;
}

om::Answer remoteAnswer(std::string_view body, const om::Request& request, const om::Schema& schema) {
    try {
        pugi::xml_document document;
        cimxml::load(document, body);
        const pugi::xml_node response = document.child("CIM")
                                            .child("MESSAGE")
                                            .child("SIMPLERSP")
                                            .child(isMethod(request) ? "METHODRESPONSE" : "IMETHODRESPONSE");
        if (!response) throw std::runtime_error("the server's answer is no CIM answer");
        return Response(request, schema).read(response);
    } catch (const cimxml::Refusal& refusal) {
        throw std::runtime_error(std::string("the server's answer cannot be read: ") + refusal.what());
    } catch (const cimxml::CimError& error) {
        throw std::runtime_error(std::string("the server's answer cannot be read: ") + error.what());
    }
}

} // namespace vkcim
