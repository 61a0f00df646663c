#include "fuzz/RandomRequest.h"

#include "fuzz/RandomHost.h"

namespace fuzz {
namespace {

/// Those that are served, behind others. A class that is new comes last, so that what the seeds choose stays; what a
/// seed is too short to choose is a computer system.
const std::vector<std::string>& classes() {
    static const std::vector<std::string> names = [] {
        std::vector<std::string> all = {
            "veska_computersystem",      "CIM_ElementCapabilities", "CIM_ComputerSystemPackage",
            "CIM_ServiceAffectsElement", "CIM_Dependency",          "CIM_ComputerSystem"};
        for (const auto& served : {om::Schema::builtin().servedAssociations(), om::Schema::builtin().servedClasses()})
            all.insert(all.end(), served.begin(), served.end());
        return all;
    }();
    return names;
}

constexpr std::array<const char*, 12> keyNames = {
    "Name",      "name",           "Tag",          "InstanceID",      "SystemName",       "Antecedent",
    "Dependent", "ManagedElement", "Capabilities", "AffectedElement", "AffectingElement", "CreationClassName"};

constexpr std::array<const char*, 8> argumentNames = {"GetRequest",
                                                      "ManagedElement",
                                                      "TimeData",
                                                      "deliveryRetryIntervalSec",
                                                      "deliveryRetryAttempts",
                                                      "AutomaticDSTAdjustment",
                                                      "Region",
                                                      "Else"};

constexpr std::array<const char*, 6> dateTimes = {"20240101120000.000000+060", "19700101000000.000000-000",
                                                  "20241231235959.999999-999", "99991231235959.******+000",
                                                  "00000001000000.000000:000", "2024**************.******+000"};

constexpr std::array<const char*, 3> methods = {"ManageTime", "SetCIMconfig", "setcimconfig"};

om::ObjectPath randomPath(Choices& choices, const std::string& hostName, int depth);

std::string randomText(Choices& choices, const std::string& hostName) {
    switch (choices.below(4)) {
    case 0:
        return hostName;
    case 1:
        return choices.oneIn(2) ? "/computer/1" : "/computer/0";
    default:
        return choices.text(nodeNames);
    }
}

om::Value randomValue(Choices& choices, const std::string& hostName, int depth) {
    switch (choices.below(8)) {
    case 0:
        return {CMPI_boolean, choices.oneIn(2)};
    case 1:
        return {CMPI_uint32, std::uint64_t{choices.below(256) * 0x01010101U}};
    case 2:
        return {CMPI_sint64, -static_cast<std::int64_t>(choices.below(256))};
    case 3:
        return {CMPI_dateTime, choices.one(dateTimes)};
    case 4:
        return {CMPI_uint16, {}};
    case 5:
        return {CMPI_stringA, std::vector<om::Value>{{CMPI_string, randomText(choices, hostName)}, {CMPI_string, {}}}};
    case 6:
        if (depth > 0)
            return {CMPI_ref, std::make_shared<const om::ObjectPath>(randomPath(choices, hostName, depth - 1))};
        return {CMPI_ref, {}};
    default:
        return {CMPI_string, randomText(choices, hostName)};
    }
}

/// Mostly of a type that keys of that name have.
om::Value randomKey(Choices& choices, const std::string& hostName, int depth) {
    switch (choices.below(4)) {
    case 0:
        return randomValue(choices, hostName, depth);
    case 1:
        if (depth > 0)
            return {CMPI_ref, std::make_shared<const om::ObjectPath>(randomPath(choices, hostName, depth - 1))};
        [[fallthrough]];
    default:
        return {CMPI_string, randomText(choices, hostName)};
    }
}

om::ObjectPath randomPath(Choices& choices, const std::string& hostName, int depth) {
    om::ObjectPath path;
    path.nameSpace = choices.oneIn(8) ? "" : "root/cimv2";
    path.className = choices.text(classes());
    for (std::size_t i = choices.below(4); i > 0; --i) {
        const std::string name = choices.text(keyNames);
        path.keys.emplace_back(name, randomKey(choices, hostName, depth));
    }
    return path;
}

template <class Known>
std::optional<std::string> perhaps(Choices& choices, const Known& known) {
    if (choices.oneIn(2)) return std::nullopt;
    return choices.text(known);
}

om::Fault randomFault(Choices& choices) {
    om::Fault fault;
    fault.kind = static_cast<om::FaultKind>(1 + choices.below(om::faultNames().size()));
    fault.call = 1 + choices.below(64);
    fault.lasting = choices.oneIn(2);
    fault.unstated = choices.oneIn(2);
    return fault;
}

} // namespace

om::Request randomRequest(Choices& choices, const std::string& hostName) {
    constexpr std::size_t operations = 12;
    om::Request request;
    request.operation = static_cast<om::Operation>(choices.below(operations));
    request.path = randomPath(choices, hostName, 2);
    request.assocClass = perhaps(choices, classes());
    request.resultClass = perhaps(choices, classes());
    request.role = perhaps(choices, keyNames);
    request.resultRole = perhaps(choices, keyNames);
    request.method = choices.text(methods);
    request.query = choices.text(nodeNames);
    request.language = "WQL";
    if (choices.oneIn(2)) request.propertyList = {choices.text(keyNames)};
    for (std::size_t i = choices.below(5); i > 0; --i) {
        const std::string name = choices.text(argumentNames);
        request.values.emplace_back(name, randomValue(choices, hostName, 2));
    }
    if (choices.oneIn(4)) request.fault = randomFault(choices);
    return request;
}

} // namespace fuzz
