#include "tests/objectmanager/endpoint/HostileRequests.h"

namespace endpoint {
namespace {

using cimxml::className;
using cimxml::instanceName;
using cimxml::key;
using cimxml::parameter;
using cimxml::text;

const std::string many(10000, 'a');

HttpRequest elsewhere(const std::string& nameSpace) {
    HttpRequest made = with("CIMObject", "root%2F" + nameSpace);
    made.body = cimxml::intrinsic("EnumerateClassNames", "",
                                  "<LOCALNAMESPACEPATH><NAMESPACE NAME=\"root\"/><NAMESPACE NAME=\"" + nameSpace +
                                      "\"/></LOCALNAMESPACEPATH>");
    return made;
}

HttpRequest names(const std::string& parameters) {
    return asking("EnumerateInstanceNames", parameters);
}

HttpRequest aClass(const std::string& parameters) {
    return asking("GetClass", parameter("ClassName", className("CIM_System")) + parameters);
}

/// The instance with these keys.
HttpRequest instance(const std::string& keys, const std::string& name = "VESKA_ComputerSystem") {
    return asking("GetInstance", parameter("InstanceName", instanceName(name, keys)));
}

HttpRequest opening(const std::string& parameters) {
    return asking("OpenEnumerateInstances", parameter("ClassName", className("CIM_System")) + parameters);
}

HttpRequest pulling(const std::string& parameters) {
    return asking("PullInstancesWithPath", parameters);
}

HttpRequest operationInCapitals() {
    HttpRequest made = asking("NoSuchOperation", parameter("ClassName", className("CIM_System")));
    return with("CIMMethod", "NOSUCHOPERATION", made);
}

} // namespace

HostileRequests hostileOperations() {
    const std::string computer = parameter("ClassName", className("CIM_System"));
    const std::string ofComputer = key("CreationClassName", "VESKA_ComputerSystem");
    const std::string context = parameter("EnumerationContext", text("1234"));
    const auto answered = [](const char* what, const HttpRequest& http, const char* code) {
        return HostileRequest{what, http, "200", "none", code};
    };
    return {
        answered("an unknown operation", operationInCapitals(), "7"),
        answered("a query", asking("ExecQuery", ""), "7"),
        answered("an opened query", asking("OpenQueryInstances", ""), "7"),
        answered("an operation with a very long name", asking(many, ""), "7"),
        answered("an unknown namespace", elsewhere("x"), "3"),
        answered("a namespace with a very long name", elsewhere(many), "3"),
        answered("an unknown class", names(parameter("ClassName", className("No_Such"))), "5"),
        answered("a class with a very long name", names(parameter("ClassName", className(many + many))), "5"),
        answered("a class whose name is markup", names(parameter("ClassName", className("&lt;A&gt;&amp;amp;"))), "5"),
        answered("the declaration of an unknown class", asking("GetClass", parameter("ClassName", className("X"))),
                 "6"),
        answered("no parameter", names(""), "4"),
        answered("a parameter twice", names(computer + parameter("CLASSNAME", className("CIM_System"))), "4"),
        answered("an unknown parameter", names(computer + parameter("LocalOnly", text("TRUE"))), "4"),
        answered("a parameter of another kind", names(parameter("ClassName", text("CIM_System"))), "4"),
        answered("a parameter without a value", names("<IPARAMVALUE NAME=\"ClassName\"/>"), "4"),
        answered("a number as a flag", aClass(parameter("LocalOnly", text("1"))), "4"),
        answered("an array as a flag", aClass(parameter("LocalOnly", "<VALUE.ARRAY/>")), "4"),
        answered("a text as an array", aClass(parameter("PropertyList", text("Name"))), "4"),
        answered("an array of nothing", aClass(parameter("PropertyList", "<VALUE.ARRAY><VALUE.NULL/></VALUE.ARRAY>")),
                 "4"),
        answered("an instance of an unknown class", instance("", "No_Such"), "5"),
        answered("an instance without keys", instance(""), "4"),
        answered("an instance with an unknown key", instance(ofComputer + key("Name", "a") + key("Other", "a")), "4"),
        answered("a text as a key that is a reference", instance(key("Antecedent", "a"), "VESKA_ComputerSystemPackage"),
                 "4"),
        answered("an unknown property",
                 asking("GetProperty", parameter("PropertyName", text("No_Such")) +
                                           parameter("InstanceName", instanceName("VESKA_ComputerSystem",
                                                                                  ofComputer + key("Name", "a")))),
                 "12"),
        answered("an unknown qualifier", asking("GetQualifier", parameter("QualifierName", text("No_Such"))), "6"),
        answered("a number that is too large", opening(parameter("MaxObjectCount", text("4294967296"))), "4"),
        answered("a number below zero", opening(parameter("MaxObjectCount", text("-1"))), "4"),
        answered("a number of ten thousand digits", opening(parameter("MaxObjectCount", text(std::string(10000, '9')))),
                 "4"),
        answered("a timeout that is too long", opening(parameter("OperationTimeout", text("4294967295"))), "22"),
        answered("half a filter", opening(parameter("FilterQuery", text("SELECT * FROM CIM_System"))), "4"),
        answered("a filter",
                 opening(parameter("FilterQueryLanguage", text("DMTF:FQL")) +
                         parameter("FilterQuery", text("SELECT * FROM CIM_System"))),
                 "25"),
        answered("errors that are to be ignored", opening(parameter("ContinueOnError", text("TRUE"))), "26"),
        answered("an unknown enumeration", pulling(context + parameter("MaxObjectCount", text("1"))), "21"),
        answered("an enumeration with a very long name",
                 pulling(parameter("EnumerationContext", text(many)) + parameter("MaxObjectCount", text("1"))), "21"),
        answered("no enumeration", pulling(parameter("MaxObjectCount", text("1"))), "4"),
        answered("an enumeration without a number", pulling(context), "4"),
        answered("the end of an unknown enumeration", asking("CloseEnumeration", context), "21"),
    };
}

} // namespace endpoint
