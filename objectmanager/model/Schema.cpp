#include "objectmanager/model/Schema.h"

namespace om {

namespace {

template <class T>
const T* lookUp(const ResolvedClass::Table<T>& table, std::string_view name) {
    const auto found = table.find(name);
    return found == table.end() ? nullptr : found->second;
}

} // namespace

const PropertyDeclaration* ResolvedClass::findProperty(std::string_view name) const {
    return lookUp(properties, name);
}

const MethodDeclaration* ResolvedClass::findMethod(std::string_view name) const {
    return lookUp(methods, name);
}

Schema::Schema(const std::vector<ClassDeclaration>& classes) : classes_(classes.begin(), classes.end()) {
    for (const ClassDeclaration& declared : classes_) index_[declared.name].declaration = &declared;
    for (auto& [name, resolved] : index_) inherit(resolved);
    for (const ClassDeclaration& declared : classes_) serve(declared);
}

const ClassDeclaration& Schema::add(ClassDeclaration declared) {
    const ClassDeclaration& added = classes_.emplace_back(std::move(declared));
    ResolvedClass& resolved = index_[added.name];
    resolved.declaration = &added;
    inherit(resolved);
    serve(added);
    return added;
}

void Schema::inherit(ResolvedClass& resolved) const {
    for (const ClassDeclaration* c : line(resolved.declaration->name)) {
        for (const PropertyDeclaration& property : c->properties) {
            const bool nearest = resolved.properties.emplace(property.name, &property).second;
            if (nearest && property.key) resolved.keys.push_back(&property);
        }
        for (const MethodDeclaration& method : c->methods) resolved.methods.emplace(method.name, &method);
    }
}

const ResolvedClass* Schema::resolve(std::string_view className) const {
    const auto found = index_.find(className);
    return found == index_.end() ? nullptr : &found->second;
}

const ClassDeclaration* Schema::find(std::string_view className) const {
    const ResolvedClass* resolved = resolve(className);
    return resolved == nullptr ? nullptr : resolved->declaration;
}

void ServedNames::add(const ClassDeclaration& declared) {
    if (containsName(all, declared.name)) return; // of a class that is its own ancestor
    if (declared.association) {
        associations.push_back(declared.name);
        all.push_back(declared.name);
    } else {
        all.insert(all.begin() + static_cast<long>(classes.size()), declared.name);
        classes.push_back(declared.name);
    }
}

/// Once, so that requests need not look at every class.
void Schema::serve(const ClassDeclaration& declared) {
    static constexpr std::string_view standard = "CIM_";
    if (sameName(std::string_view(declared.name).substr(0, standard.size()), standard)) return;
    served_.add(declared);
    for (const ClassDeclaration* c : line(declared.name)) index_.find(c->name)->second.below.add(declared);
}

const PropertyDeclaration* Schema::findProperty(std::string_view className, std::string_view property) const {
    const ResolvedClass* resolved = resolve(className);
    return resolved == nullptr ? nullptr : resolved->findProperty(property);
}

const MethodDeclaration* Schema::findMethod(std::string_view className, std::string_view method) const {
    const ResolvedClass* resolved = resolve(className);
    return resolved == nullptr ? nullptr : resolved->findMethod(method);
}

std::vector<std::string_view> Schema::wordsFor(std::string_view className, const NamedValue& property) const {
    const PropertyDeclaration* declared = findProperty(className, property.first);
    return declared == nullptr ? std::vector<std::string_view>() : om::wordsFor(declared->qualifiers, property.second);
}

const std::vector<std::string>& Schema::servedBelow(std::string_view className) const {
    static const std::vector<std::string> none;
    const ResolvedClass* resolved = resolve(className);
    return resolved == nullptr ? none : resolved->below.all;
}

std::vector<const ClassDeclaration*> Schema::line(std::string_view className) const {
    std::vector<const ClassDeclaration*> found;
    // The count bounds the walk, should a class be its own ancestor.
    for (const ClassDeclaration* c = find(className); c != nullptr && found.size() < classes_.size();
         c = find(c->superclass))
        found.push_back(c);
    return found;
}

bool Schema::isA(std::string_view className, std::string_view ancestor) const {
    std::size_t left = classes_.size(); // without a list: providers ask this in every request
    for (const ClassDeclaration* c = find(className); c != nullptr && left > 0; c = find(c->superclass), --left) {
        if (sameName(c->name, ancestor)) return true;
    }
    return false;
}

} // namespace om
