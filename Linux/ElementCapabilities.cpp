#include "Linux/ElementCapabilities.h"

#include "Linux/ComputerNode.h"
#include "Linux/MonikerKey.h"
#include "include/Exceptions.h"
#include "include/Trace.h"

namespace VK::BaseServerProvider {

static const std::string& loggerElementCapabilities = lastingString("Norvane.BaseServerProvider");
static const TraceSource source{loggerElementCapabilities, "ElementCapabilities"};

ElementCapabilities::ElementCapabilities() {
    traceMethod(VK_METHOD(source));
}

ElementCapabilities::~ElementCapabilities() noexcept(false) {
    traceDestructor(VK_METHOD(source));
}

void ElementCapabilities::getCapabilitiesMoniker(Moniker& monikerComputer) {
    const ParameterTraceScope scope(VK_SCOPE(source), " monikerComputer=", &monikerComputer);
    selectComputer(instrumentation, requiredKey(monikerComputer, "Name"));
    // On purpose: off the end the path is empty, and so is the InstanceID.
    const std::string instanceID = Instrumentation::convertPathToString(instrumentation.getPathToNode());
    traceVariable(source, "instanceID", instanceID.c_str());
    replaceMoniker(monikerComputer, "InstanceID", instanceID);
}

void ElementCapabilities::getComputerMoniker(Moniker& monikerCapabilities) {
    const ParameterTraceScope scope(VK_SCOPE(source), " monikerCapabilities=", &monikerCapabilities);
    const NodePath path = Instrumentation::convertStringToPath(requiredKey(monikerCapabilities, "InstanceID"));
    instrumentation.selectNode(NodeLexicon::ComputerSystemNode);
    instrumentation.setFilter(NodeLexicon::NamePath, path);
    if (!instrumentation) throw InstrumentationException("Concerned Computer Could Not Be Found.");
    const std::string name = requiredComputerName(instrumentation, "Name Property on Computer Node not available.");
    traceVariable(source, "name", name.c_str());
    replaceMoniker(monikerCapabilities, "Name", name);
}

} // namespace VK::BaseServerProvider
