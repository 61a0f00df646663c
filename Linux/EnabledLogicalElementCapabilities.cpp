#include "Linux/EnabledLogicalElementCapabilities.h"

namespace VK::BaseServerProvider {

static const std::string& loggerEnabledLogicalElementCapabilities = lastingString("Norvane.BaseServerProvider");
static const TraceSource source{loggerEnabledLogicalElementCapabilities, "EnabledLogicalElementCapabilities"};

const TraceSource& EnabledLogicalElementCapabilities::traceSource() {
    return source;
}

EnabledLogicalElementCapabilities::EnabledLogicalElementCapabilities() {
    const TraceScope scope(VK_SCOPE(source));
    selectFirst();
}

EnabledLogicalElementCapabilities::~EnabledLogicalElementCapabilities() noexcept(false) {
    const DestructorTraceScope scope(VK_SCOPE(source));
}

bool EnabledLogicalElementCapabilities::passes(const Filter& filter) const {
    return filter.type != FilterType::InstanceID ||
           Instrumentation::convertPathToString(node().getPathToNode()) == filter.reference;
}

bool EnabledLogicalElementCapabilities::getInstanceID(std::string& instanceID) const {
    const TraceScope scope(VK_SCOPE(source));
    instanceID = Instrumentation::convertPathToString(node().getPathToNode());
    traceVariable(source, "instanceID", instanceID.c_str());
    return true;
}

bool EnabledLogicalElementCapabilities::getElementName(std::string& name) const {
    const TraceScope scope(VK_SCOPE(source));
    return node().getProperty(NodeLexicon::NameProperty, name);
}

bool EnabledLogicalElementCapabilities::getElementNameEditSupported(bool& supported) const {
    const TraceScope scope(VK_SCOPE(source));
    bool readOnly{};
    if (!node().isPropertyReadOnly(NodeLexicon::NameProperty, readOnly)) return false;
    supported = !readOnly;
    return true;
}

} // namespace VK::BaseServerProvider
