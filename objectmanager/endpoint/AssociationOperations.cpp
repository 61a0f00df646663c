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

/// VALUE.OBJECTWITHPATH for each instance or class.
std::string objects(const Call& call, bool toReferences) {
    const Selection selection(call);
    const cimxml::PathElement& source = call.parameters.requiredObjectName("ObjectName");
    const Traversal traversal = traversalFrom(call, source, toReferences);
    cimxml::Writer writer;
    if (isClassRequest(call, source)) {
        ClassSelection parts = ClassSelection::of(call, false);
        parts.localOnly = false;
        for (const std::string& name : associatedClasses(call, traversal)) {
            writer.open("VALUE.OBJECTWITHPATH");
            writer.classPath(call.host, call.space.name, name);
            writeClass(writer, call.schema(), *call.schema().find(name), parts);
            writer.close("VALUE.OBJECTWITHPATH");
        }
        return returned(writer.take());
    }
    for (const om::Instance& instance : associatedInstances(call, traversal, selection)) {
        writer.open("VALUE.OBJECTWITHPATH");
        writer.instancePath(instance.path, call.host);
        selection.write(writer, instance);
        writer.close("VALUE.OBJECTWITHPATH");
    }
    return returned(writer.take());
}

/// OBJECTPATH for each instance or class.
std::string names(const Call& call, bool toReferences) {
    const cimxml::PathElement& source = call.parameters.requiredObjectName("ObjectName");
    const Traversal traversal = traversalFrom(call, source, toReferences);
    cimxml::Writer writer;
    if (isClassRequest(call, source)) {
        for (const std::string& name : associatedClasses(call, traversal)) {
            writer.open("OBJECTPATH");
            writer.classPath(call.host, call.space.name, name);
            writer.close("OBJECTPATH");
        }
        return returned(writer.take());
    }
    for (const om::ObjectPath& path : associatedPaths(call, traversal)) {
        writer.open("OBJECTPATH");
        writer.instancePath(path, call.host);
        writer.close("OBJECTPATH");
    }
    return returned(writer.take());
}

} // namespace

std::string associators(const Call& call) {
    return objects(call, false);
}
std::string associatorNames(const Call& call) {
    return names(call, false);
}
std::string references(const Call& call) {
    return objects(call, true);
}
std::string referenceNames(const Call& call) {
    return names(call, true);
}

} // namespace endpoint
