#pragma once

#include "objectmanager/endpoint/Call.h"
#include "objectmanager/endpoint/Selection.h"

#include <vector>

namespace endpoint {

inline const om::ObjectPath& pathOf(const om::ObjectPath& path) {
    return path;
}
inline const om::ObjectPath& pathOf(const om::Instance& instance) {
    return instance.path;
}

/// What the providers return to several requests (askEach) and is wanted: `isWanted` is given the request's place and
/// the result's path.
template <class Result, class Wanted>
std::vector<Result> wantedResults(const Call& call, const std::vector<om::Request>& requests, Wanted isWanted) {
    std::vector<Result> found;
    askEach(call, requests, [&](std::size_t which, om::Answer answer) {
        for (auto& result : answer.results) {
            auto* one = std::get_if<Result>(&result);
            if (one != nullptr && isWanted(which, pathOf(*one))) found.push_back(std::move(*one));
        }
    });
    return found;
}

/// The instances or paths that an enumeration or association returns, as the plain and the pulled operations share
/// them. All throw CimError.
std::vector<om::Instance> instancesOfClass(const Call& call, Selection& selection);
std::vector<om::ObjectPath> pathsOfClass(const Call& call);

/// What an association operation is asked: from where, and through what.
struct Traversal {
    bool toReferences = false; ///< to the association's instances, not through them
    om::ObjectPath source;
    std::optional<std::string> assocClass; ///< of References: ResultClass
    std::optional<std::string> resultClass;
    std::optional<std::string> role;
    std::optional<std::string> resultRole;
};

/// The traversal that the parameters describe, from the instance or class that `source` names.
Traversal traversalFrom(const Call& call, const cimxml::PathElement& source, bool toReferences);
std::vector<om::Instance> associatedInstances(const Call& call, const Traversal& traversal, const Selection& selection);
std::vector<om::ObjectPath> associatedPaths(const Call& call, const Traversal& traversal);
/// What the schema allows for a class: classes at the other end, or association classes.
std::vector<std::string> associatedClasses(const Call& call, const Traversal& traversal);

} // namespace endpoint
