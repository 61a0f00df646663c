#include "bench/Rows.h"

#include <stdexcept>

namespace bench {
namespace {

const char* nameOf(om::Operation operation) {
    switch (operation) {
    case om::Operation::EnumInstanceNames:
        return "EnumInstanceNames";
    case om::Operation::EnumInstances:
        return "EnumInstances";
    case om::Operation::GetInstance:
        return "GetInstance";
    case om::Operation::Associators:
        return "Associators";
    case om::Operation::AssociatorNames:
        return "AssociatorNames";
    default:
        throw std::logic_error("an operation that is not measured");
    }
}

bool isEnumeration(om::Operation operation) {
    return operation == om::Operation::EnumInstanceNames || operation == om::Operation::EnumInstances;
}

const std::vector<int> series = {1, 10, 100, 1000};
const std::vector<int> shortSeries = {1, 10, 100}; ///< for associations: some grow with the square

/// A host has one element of these, however many computers.
bool isSingle(const std::string& className) {
    return className == "VESKA_TimeService" || className == "VESKA_TimeServiceAffectsElement";
}

/// Reading its instance takes as long as the object manager's own command.
bool runsCommands(const std::string& className) {
    return className == "VESKA_CIMServiceConfig";
}

} // namespace

std::vector<Row> rows() {
    using om::Operation;
    const om::Schema& schema = om::Schema::builtin();
    std::vector<Row> all;
    for (const std::string& name : schema.servedClasses()) {
        if (runsCommands(name)) continue;
        for (const Operation operation :
             {Operation::EnumInstanceNames, Operation::EnumInstances, Operation::GetInstance})
            all.push_back({operation, name, {}, isSingle(name) ? one : series});
    }
    for (const std::string& name : schema.servedAssociations()) {
        const std::vector<int>& computers = isSingle(name) ? one : shortSeries;
        for (const Operation operation : {Operation::EnumInstanceNames, Operation::EnumInstances})
            all.push_back({operation, name, {}, computers});
        for (const om::PropertyDeclaration* end : schema.resolve(name)->keys)
            for (const Operation operation : {Operation::Associators, Operation::AssociatorNames})
                all.push_back({operation, end->referenceClass, name, computers});
    }
    return all;
}

std::string nameOf(const Row& row) {
    const std::string name = nameOf(row.operation) + ("/" + row.className);
    return row.assocClass.empty() ? name : name + "/" + row.assocClass;
}

std::string nameOf(const Row& row, bool live, int computers) {
    return nameOf(row) + (live ? "/live" : "/computers:" + std::to_string(computers));
}

om::Request requestOf(const Row& row, om::ObjectManager& provider) {
    om::Request request;
    request.operation = om::Operation::EnumInstanceNames;
    request.path.nameSpace = "root/cimv2";
    request.path.className = row.className;
    if (!isEnumeration(row.operation)) {
        const om::Answer names = provider.run(request);
        if (names.results.empty()) throw std::runtime_error("the host has no " + row.className);
        request.path = std::get<om::ObjectPath>(names.results.back());
    }
    request.operation = row.operation;
    if (!row.assocClass.empty()) request.assocClass = row.assocClass;
    return request;
}

} // namespace bench
