#include "objectmanager/endpoint/Results.h"

#include <algorithm>

namespace endpoint {
namespace {

bool matches(const std::optional<std::string>& wanted, std::string_view name) {
    return !wanted || om::sameName(*wanted, name);
}

/// An association class with those of its references that the source may be held by, and those to results.
struct Candidate {
    std::string className;
    std::vector<const om::PropertyDeclaration*> far;
};

/// The references of an association class, nearest class first.
std::vector<const om::PropertyDeclaration*> referencesOf(const om::Schema& schema, const std::string& className) {
    std::vector<const om::PropertyDeclaration*> found;
    for (const om::ClassDeclaration* c : schema.line(className)) {
        for (const om::PropertyDeclaration& property : c->properties) {
            const bool again = std::any_of(found.begin(), found.end(),
                                           [&](const auto* each) { return om::sameName(each->name, property.name); });
            if (property.type == CMPI_ref && !again) found.push_back(&property);
        }
    }
    return found;
}

/// Whether a result may be of both classes.
bool related(const om::Schema& schema, std::string_view a, std::string_view b) {
    return schema.isA(a, b) || schema.isA(b, a);
}

std::optional<Candidate> candidate(const Call& call, const Traversal& traversal, const std::string& className) {
    const om::Schema& schema = call.schema();
    if (traversal.assocClass && !schema.isA(className, *traversal.assocClass)) return std::nullopt;
    Candidate found{className, {}};
    bool held = false;
    const auto ends = referencesOf(schema, className);
    for (const om::PropertyDeclaration* near : ends) {
        if (!matches(traversal.role, near->name) || !schema.isA(traversal.source.className, near->referenceClass)) {
            continue;
        }
        held = true;
        for (const om::PropertyDeclaration* far : ends) {
            if (far == near || !matches(traversal.resultRole, far->name)) continue;
            if (traversal.resultClass && !related(schema, far->referenceClass, *traversal.resultClass)) continue;
            if (std::find(found.far.begin(), found.far.end(), far) == found.far.end()) found.far.push_back(far);
        }
    }
    if (!held || (!traversal.toReferences && found.far.empty())) return std::nullopt;
    return found;
}

std::vector<Candidate> candidates(const Call& call, const Traversal& traversal,
                                  const std::vector<std::string>& classNames) {
    std::vector<Candidate> found;
    for (const std::string& className : classNames) {
        if (auto one = candidate(call, traversal, className)) found.push_back(std::move(*one));
    }
    return found;
}

/// Whether a result is what the filters ask for, whatever the provider made of them.
bool isWanted(const Call& call, const Traversal& traversal, const Candidate& through, std::string_view resultClass) {
    const om::Schema& schema = call.schema();
    if (traversal.toReferences) return schema.isA(resultClass, through.className);
    if (traversal.resultClass && !schema.isA(resultClass, *traversal.resultClass)) return false;
    return std::any_of(through.far.begin(), through.far.end(), [&](const om::PropertyDeclaration* far) {
        return schema.isA(resultClass, far->referenceClass);
    });
}

om::Request requestThrough(const Call& call, const Traversal& traversal, const Candidate& through, bool names) {
    using om::Operation;
    const Operation operation = traversal.toReferences ? (names ? Operation::ReferenceNames : Operation::References)
                                                       : (names ? Operation::AssociatorNames : Operation::Associators);
    om::Request request = requestFor(call, operation, traversal.source);
    request.role = traversal.role;
    if (traversal.toReferences) {
        request.resultClass = through.className;
    } else {
        request.assocClass = through.className;
        request.resultClass = traversal.resultClass;
        request.resultRole = traversal.resultRole;
    }
    return request;
}

template <class Result>
std::vector<Result> results(const Call& call, const Traversal& traversal, bool names, const Selection* selection) {
    const auto through = candidates(call, traversal, call.schema().servedAssociations());
    std::vector<om::Request> requests;
    for (const Candidate& each : through) {
        requests.push_back(requestThrough(call, traversal, each, names));
        if (selection != nullptr) requests.back().propertyList = selection->properties();
    }
    return wantedResults<Result>(call, requests, [&](std::size_t which, const om::ObjectPath& path) {
        return isWanted(call, traversal, through[which], path.className);
    });
}

void expectClass(const Call& call, const std::optional<std::string>& name) {
    if (name) knownClass(call, *name, CMPI_RC_ERR_INVALID_PARAMETER);
}

} // namespace

Traversal traversalFrom(const Call& call, const cimxml::PathElement& source, bool toReferences) {
    Traversal traversal;
    traversal.toReferences = toReferences;
    traversal.source = typedPath(call, source, CMPI_RC_ERR_INVALID_PARAMETER);
    traversal.resultClass = call.parameters.className("ResultClass");
    traversal.role = call.parameters.text("Role");
    if (toReferences) {
        traversal.assocClass.swap(traversal.resultClass);
    } else {
        traversal.assocClass = call.parameters.className("AssocClass");
        traversal.resultRole = call.parameters.text("ResultRole");
    }
    expectClass(call, traversal.assocClass);
    expectClass(call, traversal.resultClass);
    return traversal;
}

std::vector<om::Instance> associatedInstances(const Call& call, const Traversal& traversal,
                                              const Selection& selection) {
    auto found = results<om::Instance>(call, traversal, false, &selection);
    for (om::Instance& instance : found) instance = selection.of(std::move(instance));
    return found;
}

std::vector<om::ObjectPath> associatedPaths(const Call& call, const Traversal& traversal) {
    return results<om::ObjectPath>(call, traversal, true, nullptr);
}

std::vector<std::string> associatedClasses(const Call& call, const Traversal& traversal) {
    std::vector<std::string> associations;
    for (const om::ClassDeclaration& declared : call.schema().classes()) {
        if (declared.association) associations.push_back(declared.name);
    }
    std::vector<std::string> found;
    const auto add = [&found](const std::string& name) {
        if (std::find(found.begin(), found.end(), name) == found.end()) found.push_back(name);
    };
    for (const Candidate& each : candidates(call, traversal, associations)) {
        if (traversal.toReferences) add(each.className);
        for (const om::PropertyDeclaration* far : each.far) {
            if (!traversal.toReferences) add(far->referenceClass);
        }
    }
    return found;
}

} // namespace endpoint
