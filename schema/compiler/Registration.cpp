#include "schema/compiler/Outputs.h"

#include <fmt/format.h>
#include <fmt/ranges.h>

namespace compiler {
namespace {

using fmt::format;

/// A kind of provider, as instances and as stanzas name it.
struct Kind {
    int number;
    const char* word;
};

/// What the provider does for a class. It runs the methods that the class itself declares, and no inherited one.
template <class Member>
std::string kinds(const om::ClassDeclaration& declared, Member member, const char* separator) {
    using Named = std::remove_reference_t<decltype(Kind().*member)>;
    std::vector<Named> found{Kind{2, "instance"}.*member};
    if (declared.association) found.push_back(Kind{3, "association"}.*member);
    if (!declared.methods.empty()) found.push_back(Kind{5, "method"}.*member);
    return format("{}", fmt::join(found, separator));
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
                                 {"ProviderType", '{' + kinds(*declared, &Kind::number, ", ") + '}'},
                                 {"SupportedProperties", "NULL"},
                                 {"SupportedMethods", "NULL"}});
    }
    return text;
}

std::string stanzas(const Provider& provider, const Classes& ours) {
    std::string text;
    for (const om::ClassDeclaration* declared : ours) {
        text += format("[{}]\n   provider: {}\n   location: {}\n   type: {}\n   namespace: {}\n#\n", declared->name,
                       provider.name, provider.location, kinds(*declared, &Kind::word, " "), provider.nameSpace);
    }
    return text;
}

} // namespace compiler
