#include "objectmanager/endpoint/Contexts.h"
#include "objectmanager/endpoint/Operations.h"
#include "objectmanager/endpoint/Results.h"

#include <algorithm>
#include <iterator>

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
cimxml::Pieces deliver(const Call& call, Enumeration enumeration, std::uint32_t count, std::string name) {
    const std::size_t left = enumeration.elements.size() - enumeration.next;
    const auto first = std::make_move_iterator(enumeration.elements.begin() + static_cast<long>(enumeration.next));
    const std::size_t sent = std::min<std::size_t>({count, mostObjects, left});
    std::vector<om::Result> elements(first, first + static_cast<long>(sent));
    cimxml::Pieces pieces = returned(cimxml::Pieces(cimxml::oneByOne(std::move(elements), enumeration.write)));
    enumeration.next += sent;
    const bool end = enumeration.next == enumeration.elements.size();
    if (end) {
        name.clear();
    } else if (name.empty()) {
        name = call.contexts.keep(std::move(enumeration));
    } else {
        call.contexts.putBack(name, std::move(enumeration));
    }
    cimxml::Writer writer;
    writer.parameter("EndOfSequence", {CMPI_boolean, end});
    writer.parameter("EnumerationContext", {CMPI_string, name});
    pieces.enclose({}, writer.text());
    return pieces;
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

/// The enumeration of these objects, as it begins.
template <class Object>
cimxml::Pieces begin(const Call& call, Opening opened, std::vector<Object> objects, Enumeration::Write write) {
    opened.enumeration.elements.assign(std::make_move_iterator(objects.begin()),
                                       std::make_move_iterator(objects.end()));
    opened.enumeration.write = std::move(write);
    return deliver(call, std::move(opened.enumeration), opened.firstCount, {});
}

cimxml::Pieces openInstances(const Call& call, Opening opened, const Selection& selection,
                             std::vector<om::Instance> instances) {
    return begin(call, std::move(opened), std::move(instances),
                 [selection, &host = call.host](cimxml::Writer& writer, const om::Result& result) {
                     const auto& instance = std::get<om::Instance>(result);
                     writer.open("VALUE.INSTANCEWITHPATH");
                     writer.instancePath(instance.path, host);
                     selection.write(writer, instance);
                     writer.close("VALUE.INSTANCEWITHPATH");
                 });
}

cimxml::Pieces openPaths(const Call& call, Opening opened, std::vector<om::ObjectPath> paths) {
    return begin(call, std::move(opened), std::move(paths),
                 [&host = call.host](cimxml::Writer& writer, const om::Result& result) {
                     writer.instancePath(std::get<om::ObjectPath>(result), host);
                 });
}

Traversal openedTraversal(const Call& call, bool toReferences) {
    return traversalFrom(call, call.parameters.requiredInstanceName("InstanceName"), toReferences);
}

cimxml::Pieces openTraversedInstances(const Call& call, bool toReferences) {
    const Selection selection(call);
    Opening opened = opening(call, false);
    const Traversal traversal = openedTraversal(call, toReferences);
    return openInstances(call, std::move(opened), selection, associatedInstances(call, traversal, selection));
}

cimxml::Pieces openTraversedPaths(const Call& call, bool toReferences) {
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

cimxml::Pieces pull(const Call& call, bool paths) {
    const std::string name = call.parameters.requiredText("EnumerationContext");
    const std::optional<std::uint32_t> count = call.parameters.number("MaxObjectCount");
    if (!count) fail(CMPI_RC_ERR_INVALID_PARAMETER, "parameter MaxObjectCount is missing");
    return deliver(call, takeContext(call, name, paths), *count, name);
}

} // namespace

cimxml::Pieces openEnumerateInstances(const Call& call) {
    Opening opened = opening(call, false);
    Selection selection(call);
    std::vector<om::Instance> instances = instancesOfClass(call, selection);
    return openInstances(call, std::move(opened), selection, std::move(instances));
}

cimxml::Pieces openEnumerateInstancePaths(const Call& call) {
    Opening opened = opening(call, true);
    return openPaths(call, std::move(opened), pathsOfClass(call));
}

cimxml::Pieces openAssociatorInstances(const Call& call) {
    return openTraversedInstances(call, false);
}
cimxml::Pieces openAssociatorInstancePaths(const Call& call) {
    return openTraversedPaths(call, false);
}
cimxml::Pieces openReferenceInstances(const Call& call) {
    return openTraversedInstances(call, true);
}
cimxml::Pieces openReferenceInstancePaths(const Call& call) {
    return openTraversedPaths(call, true);
}
cimxml::Pieces pullInstancesWithPath(const Call& call) {
    return pull(call, false);
}
cimxml::Pieces pullInstancePaths(const Call& call) {
    return pull(call, true);
}

cimxml::Pieces closeEnumeration(const Call& call) {
    takeContext(call, call.parameters.requiredText("EnumerationContext"), std::nullopt);
    return {};
}

} // namespace endpoint
