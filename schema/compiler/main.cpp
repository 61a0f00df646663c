#include "objectmanager/mof/Checker.h"
#include "objectmanager/mof/MofError.h"
#include "objectmanager/mof/Parser.h"
#include "schema/compiler/Facts.h"
#include "schema/compiler/Outputs.h"

#include <CLI/CLI.hpp>

#include <cerrno>
#include <filesystem>
#include <fstream>
#include <iostream>
#include <sstream>
#include <system_error>

namespace {

using Path = std::filesystem::path;
using Strings = std::vector<std::string>;

constexpr int unusableArguments = 2;

struct Options {
    Strings files;
    std::string list = VK_SCHEMA_SOURCES "/classes.list";
    std::string facts = VK_SCHEMA_SOURCES "/superclasses.facts";
    std::string stub, mof, cpp, json, moduleMof, reg;
    std::vector<std::pair<std::string, std::string>> fill;
    compiler::Provider provider;
};

void addOptions(CLI::App& app, Options& options) {
    const auto option = [&app](const char* name, std::string& value, const char* what) {
        return app.add_option(name, value, what);
    };
    app.set_help_flag("-h,--help", "Print this and exit");
    app.add_option("files", options.files, "MOF files in order (default: those of the list)");
    option("--list", options.list, "The files in order");
    option("--facts", options.facts, "The standard classes");
    option("--stub", options.stub, "Write the stub of the standard classes, in MOF");
    option("--mof", options.mof, "Write all of our classes in one file");
    option("--cpp", options.cpp, "Write the embedded object manager's table");
    option("--json", options.json, "Write a description of our classes");
    option("--module-mof", options.moduleMof, "Write registration as instances");
    option("--reg", options.reg, "Write registration as stanzas");
    app.add_option("--fill", options.fill, "Write a file that names our classes: FRAME with its @NAMES@ filled")
        ->type_name("FRAME OUT")
        ->allow_extra_args(false);
    option("--module", options.provider.module, "Name of the provider's module")->capture_default_str();
    option("--provider", options.provider.name, "Prefix of the factory functions")->capture_default_str();
    option("--location", options.provider.location, "The library's name")->capture_default_str();
    option("--provider-version", options.provider.version, "Its version")->capture_default_str();
    option("--vendor", options.provider.vendor, "Who made it");
    option("--description", options.provider.description, "What it is");
    option("--namespace", options.provider.nameSpace, "Where it serves its classes")->capture_default_str();
}

[[noreturn]] void failAt(const std::string& path) {
    throw std::runtime_error(path + ": " + std::generic_category().message(errno == 0 ? EIO : errno));
}

std::string read(const std::string& path) {
    errno = 0;
    std::ifstream stream(path, std::ios::binary);
    std::ostringstream text;
    if (!stream || (!(text << stream.rdbuf()) && errno != 0)) failAt(path); // an empty file fails, too
    return text.str();
}

void write(const std::string& path, const std::string& text) {
    if (path.empty()) return;
    std::error_code ignored; // what cannot be made cannot be opened below it
    create_directories(Path(path).parent_path(), ignored);
    errno = 0;
    if (!(std::ofstream(path, std::ios::binary) << text).flush()) failAt(path);
}

/// The files of the options, or else of the list.
Strings filesOf(const Options& options) {
    if (!options.files.empty()) return options.files;
    Strings files;
    for (const std::string& name : compiler::wordsOf(read(options.list))) {
        files.push_back(Path(options.list).parent_path() / name);
    }
    return files;
}

/// Compiles the files over a stub of the standard classes.
class Compilation {
public:
    explicit Compilation(const Options& wanted)
        : options(wanted), stub(compiler::stub(read(wanted.facts), wanted.facts)) {
        add(stub, "stub of " + Path(options.facts).filename().string(), false);
        standard = checker.schema().classes().size();
        for (const std::string& file : filesOf(options)) {
            texts.push_back(read(file));
            add(texts.back(), file, true);
        }
    }

    /// Prints what is wrong, or else writes what is wanted.
    bool finish() const {
        for (const std::string& complaint : checker.complaints()) std::cerr << complaint << '\n';
        if (!checker.complaints().empty()) return false;
        const om::Schema& schema = checker.schema();
        compiler::Classes ours;
        for (std::size_t i = standard; i < schema.classes().size(); ++i) ours.push_back(&schema.classes()[i]);
        write(options.stub, stub);
        write(options.mof, CLI::detail::join(texts, "\n"));
        write(options.cpp, compiler::tableText(schema));
        write(options.json, compiler::describedText(schema, ours));
        write(options.moduleMof, compiler::moduleInstances(options.provider, ours));
        write(options.reg, compiler::stanzas(options.provider, ours));
        for (const auto& [frame, out] : options.fill) write(out, compiler::filled(read(frame), ours));
        return true;
    }

private:
    void add(const std::string& text, const std::string& file, bool ours) { checker.add(mof::parse(text, file), ours); }

    const Options& options;
    const std::string stub;
    mof::Checker checker;
    std::size_t standard = 0; ///< of the schema's classes
    Strings texts;
};

int run(int argc, char** argv) {
    CLI::App app("Compiles this directory's MOF files over a stub of the standard classes, and writes what is made of "
                 "them.\nWithout an output it only checks. Every complaint is FILE:LINE: TEXT on standard error; then "
                 "nothing is written and the exit status is 1.",
                 "vk-mof");
    Options options;
    addOptions(app, options);
    try {
        app.parse(argc, argv);
    } catch (const CLI::Error& error) {
        return app.exit(error) == 0 ? 0 : unusableArguments;
    }
    return Compilation(options).finish() ? 0 : 1;
}

} // namespace

int main(int argc, char** argv) {
    try {
        return run(argc, argv);
    } catch (const std::exception& error) {
        std::cerr << error.what() << '\n';
        return 1;
    }
}
