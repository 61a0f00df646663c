#include "objectmanager/endpoint/Interop.h"

#include <algorithm>

namespace endpoint {
namespace {

constexpr const char* interopName = "interop";
constexpr const char* managerClass = "VESKA_ObjectManager";
constexpr const char* managerName = "vkcimd";
constexpr const char* nameSpaceClass = "VESKA_Namespace";

om::Qualifiers described(const char* text) {
    return {{"Description", om::qualifierValue(text)}};
}

om::PropertyDeclaration property(const char* propertyName, int type, const char* text) {
    return {propertyName, static_cast<CMPIType>(type), false, {}, described(text)};
}

om::PropertyDeclaration key(const char* keyName, const char* text) {
    om::PropertyDeclaration declared = property(keyName, CMPI_string, text);
    declared.key = true;
    declared.qualifiers.insert(declared.qualifiers.begin(), {"Key", om::qualifierValue(true)});
    return declared;
}

om::ClassDeclaration declaration(const char* className, const char* superclass, const char* text,
                                 std::vector<om::PropertyDeclaration> properties = {}) {
    return {className, superclass, false, std::move(properties), {}, described(text)};
}

om::PropertyDeclaration organization() {
    om::PropertyDeclaration declared =
        property("RegisteredOrganization", CMPI_uint16, "The organization that defines the profile.");
    declared.qualifiers.emplace_back("ValueMap", om::qualifierValue({"1", "2"}));
    declared.qualifiers.emplace_back("Values", om::qualifierValue({"Other", "DMTF"}));
    return declared;
}

std::vector<om::ClassDeclaration> declarations() {
    std::vector<om::ClassDeclaration> classes;
    for (const char* above : {"CIM_ManagedElement", "CIM_ManagedSystemElement", "CIM_LogicalElement",
                              "CIM_EnabledLogicalElement", "CIM_Service"}) {
        classes.push_back(*om::Schema::builtin().find(above));
    }
    classes.push_back(declaration("CIM_WBEMService", "CIM_Service", "A service of web-based management."));
    classes.push_back(
        declaration("CIM_ObjectManager", "CIM_WBEMService", "A service that answers CIM operations.",
                    {property("GatherStatisticalData", CMPI_boolean, "Whether it counts its operations.")}));
    classes.push_back(declaration(managerClass, "CIM_ObjectManager", "The endpoint that answers this request."));
    classes.push_back(declaration(
        "CIM_Namespace", "CIM_ManagedElement", "A namespace of an object manager.",
        {key("SystemCreationClassName", "The class of the system."), key("SystemName", "The system's name."),
         key("ObjectManagerCreationClassName", "The class of the object manager."),
         key("ObjectManagerName", "The object manager's name."), key("CreationClassName", "The namespace's own class."),
         key("Name", "The namespace's full name, such as root/cimv2."),
         property("ClassType", CMPI_uint16, "What kind of classes the namespace holds.")}));
    classes.push_back(declaration(nameSpaceClass, "CIM_Namespace", "A namespace of this endpoint."));
    classes.push_back(declaration("CIM_RegisteredProfile", "CIM_ManagedElement",
                                  "A profile that is implemented. This endpoint registers none.",
                                  {key("InstanceID", "Its identifier."), organization(),
                                   property("RegisteredName", CMPI_string, "The profile's name."),
                                   property("RegisteredVersion", CMPI_string, "Its version.")}));
    return classes;
}

const om::Schema& schema() {
    static const om::Schema made(declarations());
    return made;
}

om::Value text(std::string value) {
    return {CMPI_string, std::move(value)};
}

/// An instance whose keys are its first properties.
om::Instance instance(const char* className, std::vector<om::NamedValue> keys, std::vector<om::NamedValue> more) {
    om::Instance made;
    made.path.nameSpace = interopName;
    made.path.className = className;
    made.path.keys = keys;
    made.properties = std::move(keys);
    std::move(more.begin(), more.end(), std::back_inserter(made.properties));
    return made;
}

om::Instance manager(const std::string& host) {
    const om::Value healthy{CMPI_uint16A, std::vector<om::Value>{{CMPI_uint16, std::uint64_t{2}}}};
    return instance(
        managerClass,
        {{"SystemCreationClassName", text("CIM_ComputerSystem")},
         {"SystemName", text(host)},
         {"CreationClassName", text(managerClass)},
         {"Name", text(managerName)}},
        {{"ElementName", text(managerName)},
         {"Description", text(std::string("Endpoint of the embedded object manager, version ") + VKCIMD_VERSION)},
         {"OperationalStatus", healthy},
         {"EnabledState", {CMPI_uint16, std::uint64_t{2}}},
         {"Started", {CMPI_boolean, true}},
         {"GatherStatisticalData", {CMPI_boolean, false}}});
}

om::Instance nameSpace(const std::string& host, const std::string& which) {
    return instance(nameSpaceClass,
                    {{"SystemCreationClassName", text("CIM_ComputerSystem")},
                     {"SystemName", text(host)},
                     {"ObjectManagerCreationClassName", text(managerClass)},
                     {"ObjectManagerName", text(managerName)},
                     {"CreationClassName", text(nameSpaceClass)},
                     {"Name", text(which)}},
                    {});
}

bool isNamedBy(const om::Instance& instance, const om::ObjectPath& path) {
    return std::all_of(instance.path.keys.begin(), instance.path.keys.end(), [&](const om::NamedValue& each) {
        const om::Value* given = om::findValue(path.keys, each.first);
        return given != nullptr && *given == each.second;
    });
}

om::Answer answer(const std::vector<om::Instance>& instances, const om::Request& request) {
    om::Answer made;
    if (request.operation != om::Operation::EnumInstances && request.operation != om::Operation::EnumInstanceNames &&
        request.operation != om::Operation::GetInstance) {
        made.code = CMPI_RC_ERR_NOT_SUPPORTED;
        return made;
    }
    for (const om::Instance& each : instances) {
        if (!om::sameName(each.path.className, request.path.className)) continue;
        if (request.operation == om::Operation::EnumInstanceNames) {
            made.results.emplace_back(each.path);
        } else if (request.operation == om::Operation::EnumInstances || isNamedBy(each, request.path)) {
            made.results.emplace_back(each);
        }
    }
    return made;
}

} // namespace

NameSpace interopNameSpace(std::vector<std::string> others, const std::string& host) {
    others.emplace_back(interopName);
    std::vector<om::Instance> instances = {manager(host)};
    for (const std::string& each : others) instances.push_back(nameSpace(host, each));
    return {interopName, {"root/interop"}, &schema(), [made = std::move(instances)](const om::Request& request) {
                return answer(made, request);
            }};
}

} // namespace endpoint
