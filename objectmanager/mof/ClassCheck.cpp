#include "objectmanager/mof/ClassCheck.h"

#include "objectmanager/model/NumberText.h"
#include "objectmanager/model/QualifierTypes.h"
#include "objectmanager/model/TypeNames.h"

#include <algorithm>
#include <set>

namespace mof {
namespace {

/// What may carry qualifiers: a class, a property, a method or a parameter.
struct Feature {
    std::string name; ///< in full
    char scope;       ///< as in om::QualifierType
    const om::Qualifiers& qualifiers;
    const om::Place& place;
    CMPIType type = CMPI_null;
    std::string referenceClass = {};
};

/// A qualifier's value, or null where it has none.
const om::Value* valueOf(const om::Qualifiers& qualifiers, std::string_view name) {
    const om::Value* value = om::findValue(qualifiers, name);
    return value == nullptr || value->isNull() ? nullptr : value;
}

const char* scopeText(char scope) {
    switch (scope) {
    case 'c':
        return "a class";
    case 'a':
        return "an association";
    case 'p':
        return "a property";
    case 'r':
        return "a reference";
    case 'm':
        return "a method";
    default:
        return "a parameter";
    }
}

/// A number of the type, or an open or closed range of two.
bool isRange(std::string_view text, CMPIType type) {
    const auto isEnd = [type](std::string_view end) {
        om::Value number;
        return end.empty() || om::readNumber(end, type, number) == om::NumberError::None;
    };
    const std::size_t dots = text.find("..");
    if (dots == std::string_view::npos) return isEnd(text);
    return isEnd(text.substr(0, dots)) && isEnd(text.substr(dots + 2));
}

bool sameParameter(const om::ParameterDeclaration& a, const om::ParameterDeclaration& b) {
    return om::sameName(a.name, b.name) && a.type == b.type && om::sameName(a.referenceClass, b.referenceClass) &&
           a.in == b.in && a.out == b.out;
}

bool sameSignature(const om::MethodDeclaration& a, const om::MethodDeclaration& b) {
    return a.returnType == b.returnType && std::equal(a.parameters.begin(), a.parameters.end(), b.parameters.begin(),
                                                      b.parameters.end(), sameParameter);
}

/// What a MOF compiler checks of a class that is in the schema, and what we ask of our own beyond that.
class ClassCheck {
public:
    ClassCheck(const om::Schema& classes, const om::ClassDeclaration& checked, bool isOurs,
               std::vector<std::string>& found)
        : schema(classes), declared(checked), above(classes.resolve(checked.superclass)), ours(isOurs),
          complaints(found) {}

    void run() {
        checkClass();
        if (ours) checkOurClass();
        checkFeature({declared.name, declared.association ? 'a' : 'c', declared.qualifiers, declared.place});
        for (const om::PropertyDeclaration& property : declared.properties) {
            const std::string name = declared.name + '.' + property.name;
            const char scope = om::elementType(property.type) == CMPI_ref ? 'r' : 'p';
            checkFeature({name, scope, property.qualifiers, property.place, property.type, property.referenceClass});
            checkProperty(property, name);
        }
        for (const om::MethodDeclaration& method : declared.methods) {
            const std::string name = declared.name + '.' + method.name;
            checkFeature({name, 'm', method.qualifiers, method.place, method.returnType});
            checkMethod(method, name);
            for (const om::ParameterDeclaration& each : method.parameters) checkParameter(each, name);
        }
    }

private:
    void complain(bool wrong, const om::Place& place, const std::string& text) {
        if (wrong) complaints.push_back(shown(place) + ": " + text);
    }

    void checkClass() {
        const std::string& name = declared.name;
        const std::size_t mark = name.find('_');
        complain(mark == std::string::npos || mark == 0 || mark + 1 == name.size(), declared.place,
                 "class name " + name + " lacks a schema's prefix");
        complain(declared.association && !om::sameName(declared.qualifiers.front().first, "Association"),
                 declared.place, "Association is not the first qualifier of " + name);
        if (above != nullptr) {
            complain(above->declaration->association != declared.association, declared.place,
                     name + " and its superclass " + above->declaration->name + " are not both associations");
        }
        const om::ResolvedClass& whole = *schema.resolve(name);
        const auto references = std::count_if(whole.properties.begin(), whole.properties.end(), [](const auto& each) {
            return om::elementType(each.second->type) == CMPI_ref;
        });
        complain(declared.association && references < 2, declared.place,
                 "association " + name + " has fewer than two references");
        complain(!declared.association && references > 0, declared.place,
                 "class " + name + " has references and is no association");
    }

    void checkOurClass() {
        const std::string& name = declared.name;
        complain(om::sameName(std::string_view(name).substr(0, name.find('_')), "CIM"), declared.place,
                 "class " + name + " is one of the standard's");
        complain(schema.resolve(name)->keys.empty() && !om::isMarked(declared.qualifiers, "Abstract"), declared.place,
                 "class " + name + " has no key");
        complain(!isVersion(om::textOf(declared.qualifiers, "Version")), declared.place,
                 "class " + name + " has no version of three numbers");
    }

    static bool isVersion(std::string_view text) {
        int numbers = 0;
        for (std::size_t begin = 0; begin <= text.size();) {
            const std::size_t end = std::min(text.find('.', begin), text.size());
            const std::string_view part = text.substr(begin, end - begin);
            numbers += !part.empty() && part.find_first_not_of("0123456789") == std::string_view::npos;
            begin = end + 1;
        }
        return numbers == 3;
    }

    void checkFeature(const Feature& feature) {
        checkQualifiers(feature);
        if (om::elementType(feature.type) == CMPI_ref) {
            complain(schema.find(feature.referenceClass) == nullptr, feature.place,
                     feature.name + " refers to " + feature.referenceClass + ", which is not declared");
        }
        checkValues(feature);
        complain(ours && om::textOf(feature.qualifiers, "Description").empty(), feature.place,
                 feature.name + " has no description");
        const auto [first, added] = seen.emplace(feature.name, &feature.place);
        if (added) return;
        complain(true, feature.place,
                 feature.scope == 'i' ? "parameter " + feature.name + " stands there twice"
                                      : feature.name + " is declared already at " + shown(*first->second));
    }

    void checkQualifiers(const Feature& feature) {
        for (std::size_t i = 0; i < feature.qualifiers.size(); ++i) {
            const auto& [name, value] = feature.qualifiers[i];
            const om::Place place{feature.place.file, feature.place.qualifierLines[i]};
            const om::QualifierType* type = om::findQualifierType(name);
            if (type == nullptr) {
                complain(true, place, "unknown qualifier " + name + " on " + feature.name);
                continue;
            }
            const bool number = type->type == CMPI_uint32 || type->type == CMPI_sint64;
            complain(type->scopes.find(feature.scope) == std::string_view::npos, place,
                     name + " may not stand on " + scopeText(feature.scope) + ", as " + feature.name + " is");
            complain(value.type != type->type, place,
                     name + " of " + feature.name + " takes a " + (number ? "integer" : typeText(type->type)));
        }
    }

    void checkValues(const Feature& feature) {
        const bool mapped = valueOf(feature.qualifiers, "ValueMap") != nullptr;
        if (!mapped && valueOf(feature.qualifiers, "Values") == nullptr) return;
        const std::vector<std::string_view> numbers = om::textsOf(feature.qualifiers, "ValueMap");
        if (!mapped || numbers.size() != om::textsOf(feature.qualifiers, "Values").size()) {
            complain(true, feature.place, "ValueMap and Values of " + feature.name + " do not pair");
            return;
        }
        const CMPIType type = om::elementType(feature.type);
        for (const std::string_view number : numbers) {
            complain((type & CMPI_UINT) != 0 && !isRange(number, type), feature.place,
                     "'" + std::string(number) + "' in the ValueMap of " + feature.name + " is no " + typeText(type));
        }
        complain(std::set(numbers.begin(), numbers.end()).size() != numbers.size(), feature.place,
                 "a value stands twice in the ValueMap of " + feature.name);
    }

    void checkProperty(const om::PropertyDeclaration& property, const std::string& name) {
        complain(property.type == CMPI_refA, property.place, "reference " + name + " is an array");
        complain(!property.defaultValue.isNull() && property.defaultValue.type != property.type, property.place,
                 "the default of " + name + " is no " + typeText(property.type, property.referenceClass));
        const om::PropertyDeclaration* inherited = above == nullptr ? nullptr : above->findProperty(property.name);
        checkOverride(property, inherited, name);
        if (inherited != nullptr) {
            complain(!narrows(property, *inherited), property.place,
                     name + " is " + typeText(property.type, property.referenceClass) + ", but " +
                         typeText(inherited->type, inherited->referenceClass) + " in a superclass");
        }
        if (om::isMarked(property.qualifiers, "Key")) checkKey(property, name);
    }

    void checkKey(const om::PropertyDeclaration& property, const std::string& name) {
        complain(om::isArray(property.type), property.place, "key " + name + " is an array");
        if (!ours || above == nullptr || above->keys.empty()) return;
        const om::PropertyDeclaration* inherited = above->findProperty(property.name);
        if (inherited != nullptr && inherited->key) {
            complain(true, property.place, name + " redefines an inherited key");
        } else {
            complain(true, property.place, name + " adds a key to those of " + above->declaration->name);
        }
    }

    void checkMethod(const om::MethodDeclaration& method, const std::string& name) {
        const om::MethodDeclaration* inherited = above == nullptr ? nullptr : above->findMethod(method.name);
        checkOverride(method, inherited, name);
        if (inherited == nullptr) return;
        complain(!sameSignature(method, *inherited), method.place,
                 name + " differs from the method that it overrides, at " + shown(inherited->place));
    }

    void checkParameter(const om::ParameterDeclaration& parameter, const std::string& method) {
        const std::string name = method + '(' + parameter.name + ')';
        checkFeature({name, 'i', parameter.qualifiers, parameter.place, parameter.type, parameter.referenceClass});
        complain(!valueOf(parameter.qualifiers, "In") && !valueOf(parameter.qualifiers, "Out"), parameter.place,
                 name + " is neither In nor Out");
    }

    template <class Declaration>
    void checkOverride(const Declaration& feature, const Declaration* inherited, const std::string& name) {
        const bool overrides = valueOf(feature.qualifiers, "Override") != nullptr;
        const std::string overridden(om::textOf(feature.qualifiers, "Override"));
        complain(inherited == nullptr && overrides, feature.place, name + " overrides what no superclass declares");
        complain(inherited != nullptr && !overrides, feature.place,
                 name + " is inherited and declared again without Override");
        complain(!overridden.empty() && !om::sameName(overridden, feature.name), feature.place,
                 name + " overrides " + overridden + ", which is named otherwise");
    }

    bool narrows(const om::PropertyDeclaration& property, const om::PropertyDeclaration& inherited) const {
        return property.type == inherited.type && (om::elementType(property.type) != CMPI_ref ||
                                                   schema.isA(property.referenceClass, inherited.referenceClass));
    }

    const om::Schema& schema;
    const om::ClassDeclaration& declared;
    const om::ResolvedClass* above; ///< the superclass, or null
    const bool ours;
    std::vector<std::string>& complaints;
    std::unordered_map<std::string, const om::Place*, om::NameHash, om::NameEqual> seen;
};

} // namespace

void checkClass(const om::Schema& schema, const om::ClassDeclaration& declared, bool ours,
                std::vector<std::string>& complaints) {
    ClassCheck(schema, declared, ours, complaints).run();
}

std::string shown(const om::Place& place) {
    return place.file + ':' + std::to_string(place.line);
}

std::string typeText(CMPIType type, const std::string& referenceClass) {
    if (om::elementType(type) != CMPI_ref) return om::typeName(type);
    return referenceClass + (om::isArray(type) ? " ref[]" : " ref");
}

} // namespace mof
