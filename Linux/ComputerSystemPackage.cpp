#include "Linux/ComputerSystemPackage.h"

#include "Linux/ComputerNode.h"
#include "Linux/MonikerKey.h"
#include "include/Exceptions.h"
#include "include/Trace.h"

namespace VK::BaseServerProvider {

static const std::string& loggerComputerSystemPackage = lastingString("Norvane.BaseServerProvider");
static const TraceSource source{loggerComputerSystemPackage, "ComputerSystemPackage"};

namespace {

/// Selects the first chassis of that serial number, or nothing.
void selectChassis(Instrumentation& cursor, const std::string& tag) {
    for (cursor.selectNode(NodeLexicon::SystemChassisNode); cursor; ++cursor) {
        std::string serial;
        if (!cursor.getProperty(NodeLexicon::SerialNumberProperty, serial))
            throw InstrumentationException("Serial Property on Chassis not available.");
        if (serial == tag) return;
    }
}

} // namespace

ComputerSystemPackage::ComputerSystemPackage() {
    traceMethod(VK_METHOD(source));
}

ComputerSystemPackage::~ComputerSystemPackage() noexcept(false) {
    traceDestructor(VK_METHOD(source));
}

void ComputerSystemPackage::getComputerSystemMoniker(Moniker& monikerPackage) {
    const ParameterTraceScope scope(VK_SCOPE(source), " monikerPackage=", &monikerPackage);
    const std::string tag = requiredKey(monikerPackage, "Tag");
    traceVariable(source, "tag", tag.c_str());
    selectChassis(instrumentation, tag);
    // On purpose: a missing chassis has an empty parent, which shows as a missing name.
    const std::string parent = instrumentation.getPathToParentNode();
    instrumentation.selectNode(parent);
    const std::string name = requiredComputerName(instrumentation, "Name Property on Computer not available.");
    traceVariable(source, "name", name.c_str());
    replaceMoniker(monikerPackage, "Name", name);
}

void ComputerSystemPackage::getPhysicalPackageMoniker(Moniker& monikerComputer) {
    const ParameterTraceScope scope(VK_SCOPE(source), " monikerComputer=", &monikerComputer);
    Instrumentation computer;
    const std::string name = requiredKey(monikerComputer, "Name");
    traceVariable(source, "name", name.c_str());
    selectComputer(computer, name);
    if (!computer) throw InstrumentationException("Concerned Computer Could Not Be Found.");
    replaceMoniker(monikerComputer, "SystemName", computer.getPathToNode());
}

bool ComputerSystemPackage::getPlatformGUID(std::string& guid) {
    const TraceScope scope(VK_SCOPE(source));
    instrumentation.selectNode(NodeLexicon::ComputerSystemNode);
    return instrumentation && instrumentation.getProperty(NodeLexicon::UUIDProperty, guid);
}

} // namespace VK::BaseServerProvider
