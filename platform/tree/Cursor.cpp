#include "tree/Cursor.h"

#include "vk/NodeLexicon.h"

namespace VK::Tree {

Cursor::Cursor() : Cursor(NodeSource::current()) {}

void Cursor::standOn(const Node* node) {
    current = node;
    knownStatus.reset();
    knownName.reset();
}

void Cursor::selectType(unsigned int type) {
    tree = host.tree();
    sameType = &tree->ofType(type);
    rank = 0;
    filtered = false;
    standOn(sameType->empty() ? nullptr : sameType->front());
}

void Cursor::selectPath(const std::string& path) {
    tree = host.tree();
    sameType = nullptr;
    filtered = false;
    standOn(tree->find(path).node);
}

void Cursor::advance() {
    if (current == nullptr) return;
    // Paths are unique: behind the one node that a filter lets pass, or that was selected by its path, there is none.
    standOn(filtered || sameType == nullptr || ++rank >= sameType->size() ? nullptr : (*sameType)[rank]);
}

void Cursor::filterByPath(const std::string& path) {
    if (current == nullptr) return;
    const NodeTree::Place place = tree->find(path);
    const bool reached = place.node == current || (!filtered && sameType != nullptr && place.node != nullptr &&
                                                   place.node->type == current->type && place.rank >= rank);
    standOn(reached ? place.node : nullptr);
    rank = place.rank;
    filtered = true;
}

const Value* Cursor::find(unsigned int property, std::optional<Value>& changing) const {
    if (current == nullptr) return nullptr;
    if (const auto fixed = current->properties.find(property); fixed != current->properties.end())
        return &fixed->second;
    if (property != NodeLexicon::NameProperty) {
        changing = host.read(*current, property);
        return changing ? &*changing : nullptr;
    }
    if (!knownName) knownName = host.read(*current, property);
    return *knownName ? &**knownName : nullptr;
}

std::optional<Value> Cursor::read(unsigned int property) const {
    std::optional<Value> changing;
    const Value* const found = find(property, changing);
    return found != nullptr ? std::optional<Value>(*found) : std::nullopt;
}

bool Cursor::write(unsigned int property, const Value& value) {
    if (current == nullptr || !host.write(*current, property, value)) return false;
    // The cursor that wrote sees what it wrote.
    std::shared_ptr<const NodeTree> now = host.tree();
    const NodeTree::Place place = now->find(current->path);
    if (place.node == nullptr || place.node->type != current->type) return true; // taken away since: the old one stays
    if (sameType != nullptr) sameType = &now->ofType(place.node->type);
    standOn(place.node);
    rank = place.rank;
    tree = std::move(now);
    return true;
}

std::optional<bool> Cursor::isReadOnly(unsigned int property) const {
    return current != nullptr ? host.isReadOnly(*current, property) : std::nullopt;
}

unsigned int Cursor::status() const {
    if (current == nullptr) return 0;
    if (!knownStatus) knownStatus = host.status(*current);
    return *knownStatus;
}

} // namespace VK::Tree
