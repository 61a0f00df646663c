#include "objectmanager/vkcim/Effect.h"

#include "objectmanager/model/TypeNames.h"
#include "objectmanager/vkcim/ValueText.h"

#include <fmt/format.h>

namespace vkcim {
namespace {

/// What cannot be written is left alone without a word: a failure that was logged is another property's.
bool mayBeWritten(const std::string& className, const std::string& property, const om::Schema& schema) {
    if (schema.find(className) == nullptr) return true;
    const om::PropertyDeclaration* declared = schema.findProperty(className, property);
    return declared != nullptr && om::isMarked(declared->qualifiers, "Write");
}

} // namespace

std::vector<std::string> notChanged(const om::Request& modification, const om::Answer& afterwards,
                                    const std::string& reason, const om::Schema& schema) {
    if (afterwards.code != CMPI_RC_OK) // a provider may know no get: what it accepted then counts
        return {};
    const auto* instance =
        afterwards.results.empty() ? nullptr : std::get_if<om::Instance>(&afterwards.results.front());
    if (instance == nullptr) return {"not changed: no such instance"};
    const ValueContext context{modification.path.nameSpace, schema};
    const auto because = [&](const std::string& name) {
        return reason.empty() || !mayBeWritten(modification.path.className, name, schema) ? "" : " (" + reason + ')';
    };
    std::vector<std::string> lines;
    for (const auto& [name, wanted] : modification.values) {
        const om::Value* found = om::findValue(instance->properties, name);
        const std::string has =
            found == nullptr || found->isNull() ? "has no value" : "is " + plainText(*found, context);
        const std::string wants = wanted.isNull() ? "has no value" : "is " + plainText(wanted, context);
        if (has != wants) lines.push_back(fmt::format("not changed: {} {}{}", name, has, because(name)));
    }
    return lines;
}

} // namespace vkcim
