#include "objectmanager/endpoint/ClassElements.h"
#include "objectmanager/endpoint/Operations.h"
#include "objectmanager/endpoint/Results.h"

namespace endpoint {
namespace {

/// Whether the schema is asked, and no provider: for the name of a class, which some clients write as that of an
/// instance without keys.
bool isClassRequest(const Call& call, const cimxml::PathElement& source) {
    if (!source.instance) return true;
    const om::ResolvedClass* known = call.schema().resolve(source.className);
    return source.keys.empty() && known != nullptr && !known->keys.empty();
}

cimxml::Pieces classObjects(const Call& call, std::vector<std::string> names) {
    ClassSelection parts = ClassSelection::of(call, false);
    parts.localOnly = false;
    const auto write = [parts, &host = call.host, &space = call.space](cimxml::Writer& writer,
                                                                       const std::string& name) {
        writer.open("VALUE.OBJECTWITHPATH");
        writer.classPath(host, space.name, name);
        writeClass(writer, *space.schema, *space.schema->find(name), parts);
        writer.close("VALUE.OBJECTWITHPATH");
    };
    return returned(cimxml::Pieces(cimxml::oneByOne(std::move(names), write)));
}

/// VALUE.OBJECTWITHPATH for each instance or class.
cimxml::Pieces objects(const Call& call, bool toReferences) {
    const Selection selection(call);
    const cimxml::PathElement& source = call.parameters.requiredObjectName("ObjectName");
    const Traversal traversal = traversalFrom(call, source, toReferences);
    if (isClassRequest(call, source)) return classObjects(call, associatedClasses(call, traversal));
    const auto write = [selection, &host = call.host](cimxml::Writer& writer, const om::Instance& instance) {
        writer.open("VALUE.OBJECTWITHPATH");
        writer.instancePath(instance.path, host);
        selection.write(writer, instance);
        writer.close("VALUE.OBJECTWITHPATH");
    };
    return returned(cimxml::Pieces(cimxml::oneByOne(associatedInstances(call, traversal, selection), write)));
}

/// OBJECTPATH for each instance or class.
cimxml::Pieces names(const Call& call, bool toReferences) {
    const cimxml::PathElement& source = call.parameters.requiredObjectName("ObjectName");
    const Traversal traversal = traversalFrom(call, source, toReferences);
    if (isClassRequest(call, source)) {
        cimxml::Writer writer; // there are only so many classes
        for (const std::string& name : associatedClasses(call, traversal)) {
            writer.open("OBJECTPATH");
            writer.classPath(call.host, call.space.name, name);
            writer.close("OBJECTPATH");
        }
        return returned(writer.take());
    }
    const auto write = [&host = call.host](cimxml::Writer& writer, const om::ObjectPath& path) {
        writer.open("OBJECTPATH");
        writer.instancePath(path, host);
        writer.close("OBJECTPATH");
    };
    return returned(cimxml::Pieces(cimxml::oneByOne(associatedPaths(call, traversal), write)));
}

} // namespace

cimxml::Pieces associators(const Call& call) {
    return objects(call, false);
}
cimxml::Pieces associatorNames(const Call& call) {
    return names(call, false);
}
cimxml::Pieces references(const Call& call) {
    return objects(call, true);
}
cimxml::Pieces referenceNames(const Call& call) {
    return names(call, true);
}

} // namespace endpoint
