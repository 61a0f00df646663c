#include "schema/compiler/Outputs.h"

#include <fmt/format.h>

#include <array>

namespace compiler {
namespace {

using fmt::format;

/// What the provider does for a class, in words for instances, associations and methods. It runs the methods that the
/// class itself declares, and no inherited one.
std::string kinds(const om::ClassDeclaration& declared, const std::array<const char*, 3>& words,
                  const char* separator) {
    std::string text = words[0];
    if (declared.association) text += std::string(separator) + words[1];
    if (!declared.methods.empty()) text += std::string(separator) + words[2];
    return text;
}

using Properties = std::vector<std::pair<const char*, std::string>>;

std::string instance(const char* className, const Properties& properties) {
    std::string text = format("instance of {}\n{{\n", className);
    for (const auto& [name, value] : properties) text += format("    {} = {};\n", name, value);
    return text + "};\n";
}

} // namespace

std::string moduleInstances(const Provider& provider, const Classes& ours) {
    std::string text = instance("PG_ProviderModule", {{"Name", quoted(provider.module)},
                                                      {"Description", quoted(provider.description)},
                                                      {"Location", quoted(provider.location)},
                                                      {"Vendor", quoted(provider.vendor)},
                                                      {"Version", quoted(provider.version)},
                                                      {"InterfaceType", quoted("CMPI")},
                                                      {"InterfaceVersion", quoted("2.0.0")}});
    text += '\n' +
            instance("PG_Provider", {{"ProviderModuleName", quoted(provider.module)}, {"Name", quoted(provider.name)}});
    for (const om::ClassDeclaration* declared : ours) {
        text += '\n' + instance("PG_ProviderCapabilities",
                                {{"ProviderModuleName", quoted(provider.module)},
                                 {"ProviderName", quoted(provider.name)},
                                 {"CapabilityID", quoted(provider.module + '.' + declared->name)},
                                 {"ClassName", quoted(declared->name)},
                                 {"Namespaces", '{' + quoted(provider.nameSpace) + '}'},
                                 {"ProviderType", '{' + kinds(*declared, {"2", "3", "5"}, ", ") + '}'},
                                 {"SupportedProperties", "NULL"},
                                 {"SupportedMethods", "NULL"}});
    }
    return text;
}

std::string stanzas(const Provider& provider, const Classes& ours) {
    std::string text;
    for (const om::ClassDeclaration* declared : ours) {
        text += format("[{}]\n   provider: {}\n   location: {}\n   type: {}\n   namespace: {}\n#\n", declared->name,
                       provider.name, provider.location, kinds(*declared, {"instance", "association", "method"}, " "),
                       provider.nameSpace);
    }
    return text;
}

} // namespace compiler
