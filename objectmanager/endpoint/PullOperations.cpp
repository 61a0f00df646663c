#include "objectmanager/endpoint/Contexts.h"
#include "objectmanager/endpoint/Operations.h"
#include "objectmanager/endpoint/Results.h"

#include <algorithm>

namespace endpoint {
namespace {

constexpr int invalidContext = 21;
constexpr int invalidTimeout = 22;
constexpr int filtersUnsupported = 25;
constexpr int continuationUnsupported = 26;
constexpr std::uint32_t usualTimeout = 60;
constexpr std::uint32_t longestTimeout = 300;
/// A client may ask for more at once, and gets that many.
constexpr std::uint32_t mostObjects = 10000;

/// Throws for what an opening operation asks and is not offered.
void checkFilters(const Call& call) {
    const auto query = call.parameters.text("FilterQuery");
    const auto language = call.parameters.text("FilterQueryLanguage");
    if (query && language) fail(filtersUnsupported, "");
    if (query || language) fail(CMPI_RC_ERR_INVALID_PARAMETER, "a filter has a query and a language");
    if (call.parameters.flag("ContinueOnError", false)) fail(continuationUnsupported, "");
}

std::chrono::seconds timeoutOf(const Call& call) {
    const std::uint32_t asked = call.parameters.number("OperationTimeout").value_or(usualTimeout);
    if (asked == 0 || asked > longestTimeout) {
        fail(invalidTimeout, "between 1 and " + std::to_string(longestTimeout) + " seconds");
    }
    return std::chrono::seconds(asked);
}

/// The next elements, and where the enumeration stands after them. `name` is empty while it is not kept yet.
std::string deliver(const Call& call, Enumeration enumeration, std::uint32_t count, std::string name) {
    const std::size_t most = std::min(count, mostObjects);
    std::string elements;
    for (std::size_t sent = 0; sent < most && enumeration.next < enumeration.elements.size(); ++sent) {
        elements += enumeration.elements[enumeration.next];
        enumeration.elements[enumeration.next++] = std::string(); // its memory goes at once
    }
    const bool end = enumeration.next == enumeration.elements.size();
    if (end) {
        name.clear();
    } else if (name.empty()) {
        name = call.contexts.keep(std::move(enumeration));
    } else {
        call.contexts.putBack(name, std::move(enumeration));
    }
    cimxml::Writer writer;
    writer.raw(returned(std::move(elements)));
    writer.parameter("EndOfSequence", {CMPI_boolean, end});
    writer.parameter("EnumerationContext", {CMPI_string, name});
    return writer.take();
}

/// What an opening operation asks of its enumeration, made and checked before a provider is asked.
struct Opening {
    Enumeration enumeration;
    std::uint32_t firstCount;
};

Opening opening(const Call& call, bool paths) {
    checkFilters(call);
    Enumeration enumeration;
    enumeration.nameSpace = call.space.name;
    enumeration.user = call.caller.user;
    enumeration.paths = paths;
    enumeration.timeout = timeoutOf(call);
    return {std::move(enumeration), call.parameters.number("MaxObjectCount").value_or(0)};
}

std::string openInstances(const Call& call, Opening opened, const Selection& selection,
                          const std::vector<om::Instance>& instances) {
    for (const om::Instance& instance : instances) {
        cimxml::Writer writer;
        writer.open("VALUE.INSTANCEWITHPATH");
        writer.instancePath(instance.path, call.host);
        selection.write(writer, instance);
        writer.close("VALUE.INSTANCEWITHPATH");
        opened.enumeration.elements.push_back(writer.take());
    }
    return deliver(call, std::move(opened.enumeration), opened.firstCount, {});
}

std::string openPaths(const Call& call, Opening opened, const std::vector<om::ObjectPath>& paths) {
    for (const om::ObjectPath& path : paths) {
        cimxml::Writer writer;
        writer.instancePath(path, call.host);
        opened.enumeration.elements.push_back(writer.take());
    }
    return deliver(call, std::move(opened.enumeration), opened.firstCount, {});
}

Traversal openedTraversal(const Call& call, bool toReferences) {
    return traversalFrom(call, call.parameters.requiredInstanceName("InstanceName"), toReferences);
}

std::string openTraversedInstances(const Call& call, bool toReferences) {
    const Selection selection(call);
    Opening opened = opening(call, false);
    const Traversal traversal = openedTraversal(call, toReferences);
    return openInstances(call, std::move(opened), selection, associatedInstances(call, traversal, selection));
}

std::string openTraversedPaths(const Call& call, bool toReferences) {
    Opening opened = opening(call, true);
    return openPaths(call, std::move(opened), associatedPaths(call, openedTraversal(call, toReferences)));
}

/// The enumeration of the caller's context. One of another kind, namespace or user stays as it is.
Enumeration takeContext(const Call& call, const std::string& name, std::optional<bool> paths) {
    std::optional<Enumeration> found = call.contexts.take(name);
    if (!found) fail(invalidContext, "");
    const bool ours = found->nameSpace == call.space.name && found->user == call.caller.user;
    if (ours && (!paths || *paths == found->paths)) return std::move(*found);
    call.contexts.putBack(name, std::move(*found));
    fail(invalidContext, "");
}

std::string pull(const Call& call, bool paths) {
    const std::string name = call.parameters.requiredText("EnumerationContext");
    const std::optional<std::uint32_t> count = call.parameters.number("MaxObjectCount");
    if (!count) fail(CMPI_RC_ERR_INVALID_PARAMETER, "parameter MaxObjectCount is missing");
    return deliver(call, takeContext(call, name, paths), *count, name);
}

} // namespace

std::string openEnumerateInstances(const Call& call) {
    Opening opened = opening(call, false);
    Selection selection(call);
    const std::vector<om::Instance> instances = instancesOfClass(call, selection);
    return openInstances(call, std::move(opened), selection, instances);
}

std::string openEnumerateInstancePaths(const Call& call) {
    Opening opened = opening(call, true);
    return openPaths(call, std::move(opened), pathsOfClass(call));
}

std::string openAssociatorInstances(const Call& call) {
    return openTraversedInstances(call, false);
}
std::string openAssociatorInstancePaths(const Call& call) {
    return openTraversedPaths(call, false);
}
std::string openReferenceInstances(const Call& call) {
    return openTraversedInstances(call, true);
}
std::string openReferenceInstancePaths(const Call& call) {
    return openTraversedPaths(call, true);
}
std::string pullInstancesWithPath(const Call& call) {
    return pull(call, false);
}
std::string pullInstancePaths(const Call& call) {
    return pull(call, true);
}

std::string closeEnumeration(const Call& call) {
    takeContext(call, call.parameters.requiredText("EnumerationContext"), std::nullopt);
    return {};
}

} // namespace endpoint
