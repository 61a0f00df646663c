#include "vk/Instrumentation.h"

#include "tree/Cursor.h"

namespace VK {

class Instrumentation::Cursor : public Tree::Cursor {};

Instrumentation::Instrumentation() : cursor(std::make_unique<Cursor>()) {}

Instrumentation::~Instrumentation() = default;

void Instrumentation::selectNode(NodeLexicon::NodeType type) {
    cursor->selectType(type);
}

void Instrumentation::selectNode(const std::string& path) {
    cursor->selectPath(path);
}

Instrumentation::operator bool() const {
    return cursor->node() != nullptr;
}

Instrumentation& Instrumentation::operator++() {
    cursor->advance();
    return *this;
}

void Instrumentation::setFilter(NodeLexicon::PathType type, const std::string& reference) {
    if (type == NodeLexicon::NamePath)
        cursor->filterByPath(reference);
    else
        cursor->finish();
}

bool Instrumentation::getProperty(NodeLexicon::Properties property, std::string& value) const {
    return cursor->read(property, value);
}

bool Instrumentation::getProperty(NodeLexicon::Properties property, unsigned int& value) const {
    return cursor->read(property, value);
}

bool Instrumentation::setProperty(NodeLexicon::Properties property, std::string& value) {
    return cursor->write(property, value);
}

bool Instrumentation::setProperty(NodeLexicon::Properties property, unsigned int& value) {
    return cursor->write(property, value);
}

bool Instrumentation::isPropertyReadOnly(NodeLexicon::Properties property, bool& readOnly) const {
    const std::optional<bool> answer = cursor->isReadOnly(property);
    if (answer) readOnly = *answer;
    return answer.has_value();
}

unsigned int Instrumentation::getNodeStatus() const {
    return cursor->status();
}

std::string Instrumentation::getNodeDescription() const {
    return cursor->node() != nullptr ? cursor->node()->description : std::string();
}

NodePath Instrumentation::getPathToNode() const {
    return cursor->node() != nullptr ? NodePath(cursor->node()->path) : NodePath();
}

NodePath Instrumentation::getPathToParentNode() const {
    return cursor->node() != nullptr ? NodePath(cursor->node()->parent) : NodePath();
}

std::string Instrumentation::convertPathToString(const NodePath& path) {
    return path;
}

NodePath Instrumentation::convertStringToPath(const std::string& text) {
    return NodePath(text);
}

} // namespace VK
