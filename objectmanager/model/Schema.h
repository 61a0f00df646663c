#pragma once

#include "objectmanager/model/Names.h"
#include "objectmanager/model/Qualifiers.h"

#include <cmpidt.h>

#include <deque>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

namespace om {

/// Where a declaration stands in a MOF file; nowhere for those of tables.
struct Place {
    std::string file = {};
    std::size_t line = 0;
    std::vector<std::size_t> qualifierLines = {}; ///< one for each qualifier
};

/// A declared property or parameter.
struct PropertyDeclaration {
    std::string name;
    CMPIType type = CMPI_null; ///< with CMPI_ARRAY for arrays
    bool key = false;
    std::string referenceClass = {}; ///< for CMPI_ref only
    Qualifiers qualifiers = {};
    Value defaultValue = {}; ///< null for none, and in tables
    Place place = {};
};

struct ParameterDeclaration : PropertyDeclaration {
    bool in = false;
    bool out = false;
};

struct MethodDeclaration {
    std::string name;
    CMPIType returnType = CMPI_null;
    std::vector<ParameterDeclaration> parameters;
    Qualifiers qualifiers = {};
    Place place = {};
};

struct ClassDeclaration {
    std::string name;
    std::string superclass; ///< empty at the top
    bool association = false;
    std::vector<PropertyDeclaration> properties; ///< its own, without inherited ones
    std::vector<MethodDeclaration> methods;
    Qualifiers qualifiers = {};
    Place place = {};
};

/// Names of classes that a provider serves, in the order of their declaration.
struct ServedNames {
    std::vector<std::string> classes;
    std::vector<std::string> associations;
    std::vector<std::string> all; ///< the classes and then the associations

    void add(const ClassDeclaration& declared);
};

/// A class with all that it inherits, for look-ups by name.
struct ResolvedClass {
    template <class T>
    using Table = std::unordered_map<std::string_view, const T*, NameHash, NameEqual>;

    const ClassDeclaration* declaration = nullptr;
    Table<PropertyDeclaration> properties;
    Table<MethodDeclaration> methods;
    std::vector<const PropertyDeclaration*> keys;
    ServedNames below; ///< the class itself and those that derive from it

    const PropertyDeclaration* findProperty(std::string_view name) const;
    const MethodDeclaration* findMethod(std::string_view name) const;
};

/// The classes that the object manager knows. Every name compares without regard to case; look-ups of properties and
/// methods go up the line of inheritance, nearest class first.
class Schema {
public:
    explicit Schema(const std::vector<ClassDeclaration>& classes);
    Schema(const Schema&) = delete;
    Schema& operator=(const Schema&) = delete;

    /// The classes built in, those served by the default provider and their ancestry.
    static const Schema& builtin();

    /// Adds a class whose name is new and whose superclass is there.
    const ClassDeclaration& add(ClassDeclaration declared);

    const std::deque<ClassDeclaration>& classes() const { return classes_; }
    /// Names of the classes, or of the associations, that are not the standard's (CIM_): the ones that a provider
    /// serves, in the order of their declaration. `served` is the classes and then the associations.
    const std::vector<std::string>& servedClasses() const { return served_.classes; }
    const std::vector<std::string>& servedAssociations() const { return served_.associations; }
    const std::vector<std::string>& served() const { return served_.all; }
    /// Those of `served` that are the class or derive from it.
    const std::vector<std::string>& servedBelow(std::string_view className) const;
    /// The class, property or method of that name, or null.
    const ClassDeclaration* find(std::string_view className) const;
    const ResolvedClass* resolve(std::string_view className) const;
    const PropertyDeclaration* findProperty(std::string_view className, std::string_view property) const;
    const MethodDeclaration* findMethod(std::string_view className, std::string_view method) const;
    /// The words that a class's declaration has for a property's value (om::wordsFor).
    std::vector<std::string_view> wordsFor(std::string_view className, const NamedValue& property) const;
    /// A class and its superclasses, nearest first; empty for an unknown class.
    std::vector<const ClassDeclaration*> line(std::string_view className) const;
    /// Whether `className` is `ancestor` or derives from it; false for unknown classes.
    bool isA(std::string_view className, std::string_view ancestor) const;

private:
    void inherit(ResolvedClass& resolved) const;
    void serve(const ClassDeclaration& declared);

    std::deque<ClassDeclaration> classes_; ///< only ever added to: the tables point into it
    std::unordered_map<std::string_view, ResolvedClass, NameHash, NameEqual> index_;
    ServedNames served_;
};

} // namespace om
