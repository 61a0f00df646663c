// Stands in for the product's instrumentation: the operations of vk/Instrumentation.h and nothing else, over one
// computer.

#include "vk/Instrumentation.h"

namespace VK {

class Instrumentation::Cursor {
public:
    bool onComputer = false;
};

Instrumentation::Instrumentation() : cursor(new Cursor) {}
Instrumentation::~Instrumentation() = default;

void Instrumentation::selectNode(NodeLexicon::NodeType type) {
    cursor->onComputer = type == NodeLexicon::ComputerSystemNode;
}
void Instrumentation::selectNode(const std::string& path) {
    cursor->onComputer = path == "/replaced";
}
Instrumentation::operator bool() const {
    return cursor->onComputer;
}
Instrumentation& Instrumentation::operator++() {
    cursor->onComputer = false;
    return *this;
}
void Instrumentation::setFilter(NodeLexicon::PathType type, const std::string& reference) {
    cursor->onComputer = cursor->onComputer && type == NodeLexicon::NamePath && reference == "/replaced";
}
bool Instrumentation::getProperty(NodeLexicon::Properties property, std::string& value) const {
    if (!cursor->onComputer || property != NodeLexicon::NameProperty) return false;
    value = "replaced";
    return true;
}
bool Instrumentation::getProperty(NodeLexicon::Properties, unsigned int&) const {
    return false;
}
bool Instrumentation::setProperty(NodeLexicon::Properties, std::string&) {
    return false;
}
bool Instrumentation::setProperty(NodeLexicon::Properties, unsigned int&) {
    return false;
}
bool Instrumentation::isPropertyReadOnly(NodeLexicon::Properties, bool&) const {
    return false;
}
unsigned int Instrumentation::getNodeStatus() const {
    return cursor->onComputer ? 1 : 0;
}
std::string Instrumentation::getNodeDescription() const {
    return cursor->onComputer ? "Replaced" : "";
}
NodePath Instrumentation::getPathToNode() const {
    return cursor->onComputer ? NodePath("/replaced") : NodePath();
}
NodePath Instrumentation::getPathToParentNode() const {
    return {};
}
std::string Instrumentation::convertPathToString(const NodePath& path) {
    return path;
}
NodePath Instrumentation::convertStringToPath(const std::string& text) {
    return text;
}

} // namespace VK
