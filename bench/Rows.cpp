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

} // namespace

std::string nameOf(const Row& row, bool live, int computers) {
    std::string name = nameOf(row.operation);
    name += std::string("/") + row.className;
    if (row.assocClass != nullptr) name += std::string("/") + row.assocClass;
    return name + (live ? "/live" : "/computers:" + std::to_string(computers));
}

om::Request requestOf(const Row& row, om::ObjectManager& provider) {
    om::Request request;
    request.operation = om::Operation::EnumInstanceNames;
    request.path.nameSpace = "root/cimv2";
    request.path.className = row.className;
    if (!isEnumeration(row.operation)) {
        const om::Answer names = provider.run(request);
        if (names.results.empty()) throw std::runtime_error(std::string("the host has no ") + row.className);
        request.path = std::get<om::ObjectPath>(names.results.back());
    }
    request.operation = row.operation;
    if (row.assocClass != nullptr) request.assocClass = row.assocClass;
    return request;
}

} // namespace bench
