#include "Linux/ComputerNode.h"

#include "include/Exceptions.h"

namespace VK::BaseServerProvider {

std::string requiredComputerName(const Instrumentation& node, const char* failure) {
    std::string name;
    if (!node.getProperty(NodeLexicon::NameProperty, name)) throw InstrumentationException(failure);
    return name;
}

void selectComputer(Instrumentation& cursor, const std::string& name) {
    cursor.selectNode(NodeLexicon::ComputerSystemNode);
    while (cursor && requiredComputerName(cursor, "Name Property on Computer Node not available.") != name) ++cursor;
}

} // namespace VK::BaseServerProvider
