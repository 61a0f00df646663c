#include "objectmanager/vkcim/Effect.h"

#include "objectmanager/model/TypeNames.h"
#include "objectmanager/vkcim/ValueText.h"

#include <fmt/format.h>

namespace vkcim {

std::vector<std::string> notChanged(const om::Request& modification, const om::Answer& afterwards,
                                    const std::string& reason, const om::Schema& schema) {
    if (afterwards.code != CMPI_RC_OK) // a provider may know no get: what it accepted then counts
        return {};
    const auto* instance =
        afterwards.results.empty() ? nullptr : std::get_if<om::Instance>(&afterwards.results.front());
    if (instance == nullptr) return {"not changed: no such instance"};
    const ValueContext context{modification.path.nameSpace, schema};
    const std::string because = reason.empty() ? "" : " (" + reason + ')';
    std::vector<std::string> lines;
    for (const auto& [name, wanted] : modification.values) {
        const om::Value* found = om::findValue(instance->properties, name);
        const std::string has =
            found == nullptr || found->isNull() ? "has no value" : "is " + plainText(*found, context);
        const std::string wants = wanted.isNull() ? "has no value" : "is " + plainText(wanted, context);
        if (has != wants) lines.push_back(fmt::format("not changed: {} {}{}", name, has, because));
    }
    return lines;
}

} // namespace vkcim
