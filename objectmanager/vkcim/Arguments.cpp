#include "objectmanager/vkcim/Arguments.h"

#include "objectmanager/vkcim/Commands.h"

#include <CLI/CLI.hpp>

#include <algorithm>
#include <map>
#include <sstream>

namespace vkcim {
namespace {

constexpr int unusable = 2;
constexpr std::size_t mostThreads = 1024;
constexpr std::size_t mostRuns = 1000000000;

const std::map<std::string, Format> formats = {{"text", Format::Text}, {"mof", Format::Mof}, {"json", Format::Json}};

/// The option `--properties A,B`: an empty text is an empty list.
std::vector<std::string> splitNames(const std::string& text) {
    std::vector<std::string> names;
    if (text.empty()) return names;
    std::istringstream stream(text + ',');
    for (std::string name; std::getline(stream, name, ',');) {
        if (name.empty()) throw CLI::ValidationError("--properties", "a name in \"" + text + "\" is empty");
        names.push_back(name);
    }
    return names;
}

class CommandLine {
public:
    CommandLine() : app("Asks a CMPI provider library and prints what it answers.", "vkcim") {
        app.set_version_flag("--version", "vkcim " VKCIM_VERSION);
        app.set_help_flag("--help", "Print this and exit");
        app.require_subcommand(1, 1);
        app.fallthrough();
        app.footer("PATH is a class name or CLASS.KEY=\"TEXT\",KEY=NUMBER; - reads it from standard input.\n"
                   "VALUE is TYPE:TEXT, null:TYPE, or TEXT alone with the type that the schema declares.\n"
                   "'vkcim COMMAND --help' shows an example. Exit status: 0 done, 1 the provider answered an\n"
                   "error, 2 unusable arguments, 3 the provider library cannot be used.");
        addOptions();
        for (const Command& command : commands) addCommand(command);
    }

    Parsed parse(const std::vector<std::string>& words) {
        try {
            // Taken from the back.
            app.parse(std::vector<std::string>(words.rbegin(), words.rend()));
            finish();
            return {std::move(arguments), 0, {}, {}};
        } catch (const CLI::Success& success) { // --help and --version
            std::ostringstream output;
            app.exit(success, output, output);
            return {std::nullopt, 0, output.str(), {}};
        } catch (const CLI::Error& error) {
            return {std::nullopt, unusable, {}, std::string("vkcim: ") + error.what() + "\nTry 'vkcim --help'.\n"};
        }
    }

private:
    void addOptions() {
        app.add_option("--library", arguments.library, "Provider library (the one beside vkcim)")->type_name("FILE");
        app.add_option("--provider", arguments.provider, "Provider name, the prefix of the factory functions")
            ->capture_default_str()
            ->type_name("NAME");
        app.add_option("--namespace", arguments.nameSpace, "Namespace")->capture_default_str()->type_name("NS");
        app.add_option("--format", formatName, "Output format: text, mof or json")
            ->capture_default_str()
            ->type_name("FORMAT")
            ->check(CLI::IsMember(&formats));
        app.add_option("--assoc-class", arguments.assocClass, "For the association commands: the association's class")
            ->type_name("C");
        app.add_option("--result-class", arguments.resultClass, "For the association commands: the results' class")
            ->type_name("C");
        app.add_option("--role", arguments.role, "For the association commands: the role of PATH")->type_name("R");
        app.add_option("--result-role", arguments.resultRole, "For the association commands: the role of the results")
            ->type_name("R");
        app.add_option("--properties", properties, "Property list handed to the provider; \"\" is an empty list")
            ->type_name("A,B");
        repeat = app.add_option("--repeat", arguments.repeat, "Run the operation N times in each thread")
                     ->capture_default_str()
                     ->type_name("N")
                     ->check(CLI::Range(std::size_t{1}, mostRuns));
        threads = app.add_option("--threads", arguments.threads, "Run in T threads at once")
                      ->capture_default_str()
                      ->type_name("T")
                      ->check(CLI::Range(std::size_t{1}, mostThreads));
        app.add_flag("--timing", arguments.timing, "Print how long the runs took, as JSON on standard error");
    }

    void addCommand(const Command& command) {
        CLI::App* sub = app.add_subcommand(command.name, command.about);
        sub->footer(std::string("Example:\n  ") + command.example + "\nOptions of every command: vkcim --help");
        const char* subject = command.takes == Takes::Class ? "CLASS" : command.takes == Takes::Path ? "PATH" : "TEXT";
        if (command.takes != Takes::Nothing) sub->add_option(subject, arguments.subject)->required()->type_name("");
        if (command.method) sub->add_option("METHOD", arguments.method)->required()->type_name("");
        if (command.assignments) {
            sub->add_option("NAME=VALUE", arguments.assignments)->required(command.needsAssignments)->type_name("");
        }
    }

    void finish() {
        const std::string name = app.get_subcommands().front()->get_name();
        const auto* command = std::find_if(std::begin(commands), std::end(commands),
                                           [&](const Command& each) { return name == each.name; });
        arguments.operation = command->operation;
        arguments.format = formats.at(formatName);
        if (properties) arguments.properties = splitNames(*properties);
        if (!command->operation && repeat->count() + threads->count() > 0) {
            throw CLI::ValidationError("report", "--repeat and --threads do not go with it");
        }
        if (command->takes != Takes::Nothing && arguments.subject.empty()) {
            throw CLI::ValidationError(name, "what it works on is empty");
        }
    }

    CLI::App app;
    Arguments arguments;
    std::string formatName = "text";
    std::optional<std::string> properties;
    CLI::Option* repeat = nullptr;
    CLI::Option* threads = nullptr;
};

} // namespace

Parsed parseArguments(const std::vector<std::string>& words) {
    return CommandLine().parse(words);
}

} // namespace vkcim
