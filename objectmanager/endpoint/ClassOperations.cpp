#include "objectmanager/endpoint/ClassElements.h"
#include "objectmanager/endpoint/Operations.h"
#include "objectmanager/endpoint/Qualifiers.h"

namespace endpoint {
namespace {

/// The subclasses that the parameters ask for; all classes below, or those directly below, or at the top.
std::vector<const om::ClassDeclaration*> subclasses(const Call& call) {
    const std::optional<std::string> above = call.parameters.className("ClassName");
    const bool deep = call.parameters.flag("DeepInheritance", false);
    if (above) knownClass(call, *above);
    std::vector<const om::ClassDeclaration*> found;
    for (const om::ClassDeclaration& declared : call.schema().classes()) {
        const bool direct = om::sameName(declared.superclass, above.value_or(""));
        const bool below = !above || call.schema().isA(declared.superclass, *above);
        if (deep ? below : direct) found.push_back(&declared);
    }
    return found;
}

} // namespace

cimxml::Pieces getClass(const Call& call) {
    const ClassSelection selection = ClassSelection::of(call, true);
    const std::string name = call.parameters.requiredClassName("ClassName");
    const om::ResolvedClass& known = knownClass(call, name, CMPI_RC_ERR_NOT_FOUND);
    cimxml::Writer writer;
    writeClass(writer, call.schema(), *known.declaration, selection);
    return returned(writer.take());
}

cimxml::Pieces enumerateClasses(const Call& call) {
    const ClassSelection selection = ClassSelection::of(call, true);
    const auto write = [selection, &schema = call.schema()](cimxml::Writer& writer,
                                                            const om::ClassDeclaration* declared) {
        writeClass(writer, schema, *declared, selection);
    };
    return returned(cimxml::Pieces(cimxml::oneByOne(subclasses(call), write)));
}

cimxml::Pieces enumerateClassNames(const Call& call) {
    cimxml::Writer writer;
    for (const om::ClassDeclaration* declared : subclasses(call)) writer.className(declared->name);
    return returned(writer.take());
}

cimxml::Pieces getQualifier(const Call& call) {
    const std::string name = call.parameters.requiredText("QualifierName");
    const om::QualifierType* type = om::findQualifierType(name);
    if (type == nullptr) fail(CMPI_RC_ERR_NOT_FOUND, "there is no qualifier " + name);
    cimxml::Writer writer;
    writeQualifierType(writer, *type);
    return returned(writer.take());
}

cimxml::Pieces enumerateQualifiers(const Call&) {
    cimxml::Writer writer;
    for (const om::QualifierType& type : om::qualifierTypes()) writeQualifierType(writer, type);
    return returned(writer.take());
}

} // namespace endpoint
