#pragma once

#include "objectmanager/model/Schema.h"

/// What is made of a schema and of our classes in it.
namespace compiler {

using Classes = std::vector<const om::ClassDeclaration*>;

/// The table behind om::Schema::builtin().
std::string tableText(const om::Schema& schema);

/// Our classes with what the MOF files say of each property and method, in JSON.
std::string describedText(const om::Schema& schema, const Classes& ours);

/// Each class with its properties, where their values come from, and its methods: a section of a manual page, in roff.
std::string manualText(const Classes& ours);

/// A frame of a file that names our classes: each @NAME@ in it stands for a text.
std::string filled(std::string frame, const Classes& ours);

/// What registers the provider's classes with object managers.
struct Provider {
    std::string module = "Module";     ///< the registered module's name
    std::string name = "Provider";     ///< the prefix of the factory functions
    std::string location = "provider"; ///< the library, without "lib" and ".so"
    std::string version = "1.0.0";
    std::string vendor;
    std::string description;
    std::string nameSpace = "root/cimv2";
};

/// The provider module, the provider and what it serves, as instances in MOF.
std::string moduleInstances(const Provider& provider, const Classes& ours);

/// A stanza a class, each class once.
std::string stanzas(const Provider& provider, const Classes& ours);

/// A text in quotes, as C++, JSON and MOF have it in common.
std::string quoted(const std::string& text);

} // namespace compiler
