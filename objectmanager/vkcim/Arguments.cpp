#include "objectmanager/vkcim/Arguments.h"

#include "objectmanager/vkcim/FaultText.h"
#include "objectmanager/vkcim/PathText.h"
#include "objectmanager/vkcim/Suggestion.h"
#include "objectmanager/vkcim/Utf8.h"

#include <CLI/CLI.hpp>

#include <algorithm>
#include <map>
#include <sstream>

namespace vkcim {
namespace {

constexpr int unusable = 2;
constexpr std::size_t mostThreads = 1024;
constexpr std::size_t mostRuns = 1000000000;
constexpr std::size_t mostTimes = 100000000; // each is kept until the end: 8 bytes

const std::map<std::string, Format> formats = {{"text", Format::Text},
                                               {"mof", Format::Mof},
                                               {"json", Format::Json},
                                               {"facts", Format::Facts},
                                               {"openmetrics", Format::OpenMetrics}};

/// The positional that is shown as NAME=VALUE: CLI11 from 2.4 on refuses a name with '=' in it.
const std::string assignment = "ASSIGNMENT";

std::string readable(const std::string& name) {
    return name == assignment ? "NAME=VALUE" : name;
}

class HelpFormat : public CLI::Formatter {
public:
    std::string make_option_name(const CLI::Option* option, bool positional) const override {
        return readable(CLI::Formatter::make_option_name(option, positional));
    }
};

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

/// `--option=` is the option with an empty text; CLI11 would take the next word for it.
std::vector<std::string> splitEmpty(const std::vector<std::string>& words) {
    std::vector<std::string> split;
    bool options = true;
    for (const std::string& word : words) {
        options = options && word != "--";
        const bool empty = options && word.rfind("--", 0) == 0 && word.find('=') == word.size() - 1;
        split.push_back(empty ? word.substr(0, word.size() - 1) : word);
        if (empty) split.emplace_back();
    }
    return split;
}

std::vector<std::string> commandNames() {
    std::vector<std::string> names;
    for (const Command& command : commands) names.emplace_back(command.name);
    return names;
}

const Command* findCommand(const std::string& name) {
    const auto* found =
        std::find_if(std::begin(commands), std::end(commands), [&](const Command& each) { return name == each.name; });
    return found == std::end(commands) ? nullptr : found;
}

class CommandLine {
public:
    CommandLine() : app("Asks a CMPI provider library and prints what it answers.", "vkcim") {
        app.set_version_flag("-V,--version", "vkcim " VKCIM_VERSION, "Print the version and exit");
        app.set_help_flag("-h,--help", "Print this and exit");
        app.require_subcommand(1, 1);
        app.fallthrough();
        app.formatter(std::make_shared<HelpFormat>());
        app.get_formatter()->label("SUBCOMMAND", "COMMAND");
        app.get_formatter()->label("REQUIRED", "");
        app.footer(
            "PATH is a class name or CLASS.KEY=\"TEXT\",KEY=NUMBER; - reads it from the first line of standard input.\n"
            "VALUE is TYPE:TEXT, null:TYPE, or TEXT alone with the type that the schema declares.\n"
            "'vkcim help COMMAND' shows an example. Exit status: 0 done; 1 the provider answered an error; 2 unusable "
            "arguments; 3 the provider library cannot be used; 4 nothing was found or changed, or the host cannot be "
            "read.");
        addOptions();
        for (const Command& command : commands) addCommand(command);
    }

    Parsed parse(const std::vector<std::string>& given) {
        try {
            const std::vector<std::string> words = splitEmpty(given);
            // CLI11 takes them from the back.
            app.parse(std::vector<std::string>(words.rbegin(), words.rend()));
            finish();
            if (arguments.command->action == Action::Help) return {{}, 0, CommandLine().help(arguments.subject), {}};
            return {std::move(arguments), 0, {}, {}};
        } catch (const CLI::Success& success) { // --help and --version
            std::ostringstream output;
            app.exit(success, output, output);
            return {std::nullopt, 0, output.str(), {}};
        } catch (const CLI::Error& error) {
            return {std::nullopt, unusable, {}, "vkcim: " + shortened(explain(error)) + "\nTry 'vkcim --help'.\n"};
        }
    }

private:
    /// The help on a command, or on the program for an empty name; of a command line that has parsed nothing yet.
    std::string help(const std::string& command) const {
        return command.empty() ? app.help() : app.get_subcommand(command)->help(app.get_name());
    }

    void addOptions() {
        app.add_option("--library", arguments.library, "Provider library (the one beside vkcim)")
            ->type_name("FILE")
            ->check(notEmpty);
        app.add_option("--provider", arguments.provider, "Provider name, the prefix of the factory functions")
            ->capture_default_str()
            ->type_name("NAME")
            ->check(notEmpty);
        app.add_option("--namespace", arguments.nameSpace, "Namespace")->capture_default_str()->type_name("NS");
        app.add_option("--format", formatName, "Output format: text, mof or json; for report also facts or openmetrics")
            ->capture_default_str()
            ->type_name("FORMAT")
            ->check(CLI::IsMember(&formats).description(""));
        app.add_option("--assoc-class", arguments.assocClass,
                       "For the association commands: the association's class (all)")
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
                     ->check(CLI::Range(std::size_t{1}, mostRuns).description(""));
        threads = app.add_option("--threads", arguments.threads, "Run in T threads at once")
                      ->capture_default_str()
                      ->type_name("T")
                      ->check(CLI::Range(std::size_t{1}, mostThreads).description(""));
        timing = app.add_flag("--timing", arguments.timing, "Print how long the runs took, as JSON on standard error");
        verbose =
            app.add_flag("--verbose", arguments.verbose, "For report: show what commands print on standard error");
        withSerials = app.add_flag("--with-serials", arguments.withSerials,
                                   "For report --format openmetrics: with serial numbers");
        dryRun = app.add_flag("--dry-run", arguments.dryRun,
                              "For modify and invoke: say what would be asked of which host, and do not ask");
        addFaults();
        addRemote();
    }

    void addRemote() {
        url = app.add_option("--url", arguments.remote.url,
                             "Ask the CIM server there: https://HOST:5989, http://HOST:5988 or unix:PATH")
                  ->type_name("URL")
                  ->check(notEmpty); // else this host would be asked in place of another one
        app.add_option("--user", arguments.remote.user, "With --url: who asks; the password is asked for")
            ->type_name("NAME")
            ->needs(url);
        app.add_option("--netrc-file", arguments.remote.netrcFile, "With --url: where user and password stand")
            ->type_name("FILE")
            ->needs(url);
        app.add_option("--cacert", arguments.remote.certificates, "With --url: the certificates that are trusted")
            ->type_name("FILE")
            ->needs(url);
        app.add_flag("--insecure", arguments.remote.insecure, "With --url: trust every certificate")->needs(url);
    }

    void addFaults() {
        fault = app.add_option("--fault", faultText,
                               "Let the N-th call of a broker operation fail in each run; N+ lets all from the N-th on "
                               "fail, and :null behind it leaves the status OK")
                    ->type_name("KIND:N");
        app.add_flag_callback(
            "--list-faults", [] { throw CLI::CallForVersion(faultList(), 0); }, "Print every KIND and exit");
    }

    std::vector<std::string> optionNames() const {
        std::vector<std::string> names;
        for (const CLI::Option* option : app.get_options()) names.push_back(option->get_name());
        return names;
    }

    std::string explain(const CLI::Error& error) const {
        for (const std::string& word : app.remaining(true)) {
            if (word.size() > 1 && word.front() == '-')
                return "there is no option '" + word + "'" + didYouMean(nearestName(word, optionNames()));
        }
        if (error.what() == std::string(CLI::RequiredError(assignment).what()))
            return CLI::RequiredError(readable(assignment)).what();
        if (!app.get_subcommands().empty() ||
            error.get_exit_code() != static_cast<int>(CLI::ExitCodes::RequiredError)) {
            return error.what();
        }
        const std::vector<std::string> unknown = app.remaining();
        if (unknown.empty()) return "a command is missing";
        return "there is no command '" + unknown.front() + "'" +
               didYouMean(nearestName(unknown.front(), commandNames()));
    }

    void addCommand(const Command& command) {
        CLI::App* sub = app.add_subcommand(command.name, command.about);
        sub->group("Commands");
        const std::string warning = *command.warning ? command.warning + std::string("\n\n") : "";
        sub->footer(warning + "Example:\n  " + command.example + "\nOptions of every command: vkcim --help");
        const auto add = [&](const std::string& name, auto& text, bool required, const char* about) {
            sub->add_option(name, text, about)->required(required)->type_name("");
        };
        if (command.takes == Takes::Class) add("CLASS", arguments.subject, true, "Name of a class");
        if (command.takes == Takes::Path)
            add("PATH", arguments.subject, true, "Path; - reads it from the first line of standard input");
        if (command.takes == Takes::Query) add("TEXT", arguments.subject, true, "The query");
        if (command.takes == Takes::Command) add("COMMAND", arguments.subject, false, "Name of a command");
        if (command.member) add(command.member, arguments.member, true, "Its name");
        if (command.assignments) {
            add(assignment, arguments.assignments, command.needsAssignments, "Names and values, as many as there are");
        }
    }

    void finish() {
        const std::string name = app.get_subcommands().front()->get_name();
        arguments.command = findCommand(name);
        arguments.format = formats.at(formatName);
        if (properties) arguments.properties = splitNames(*properties);
        refuseMisplacedOptions();
        if (arguments.timing && arguments.repeat > mostTimes / arguments.threads) {
            throw CLI::ValidationError("--timing", "at most " + std::to_string(mostTimes) + " runs can be timed");
        }
        if (fault->count() > 0) arguments.fault = readFault();
        if (const auto problem = nameSpaceProblem(arguments.nameSpace)) {
            throw CLI::ValidationError("--namespace", *problem);
        }
        if (arguments.command->takes == Takes::Command) return checkHelp();
        if (arguments.command->takes != Takes::Nothing && arguments.subject.empty()) {
            throw CLI::ValidationError(name, "what it works on is empty");
        }
    }

    void checkHelp() const {
        if (arguments.subject.empty() || findCommand(arguments.subject) != nullptr) return;
        throw CLI::ValidationError("help", "there is no command '" + arguments.subject + "'" +
                                               didYouMean(nearestName(arguments.subject, commandNames())));
    }

    /// Options that would be ignored might hide a mistake; a dry run above all.
    void refuseMisplacedOptions() const {
        const Command& command = *arguments.command;
        const auto refuse = [&](bool fits, std::initializer_list<const CLI::Option*> options) {
            for (const CLI::Option* option : options) {
                if (!fits && option->count() > 0)
                    throw CLI::ValidationError(command.name, option->get_name() + " does not go with it");
            }
        };
        const bool operates = command.action == Action::Operate;
        const bool answers = operates || command.action == Action::Report;
        refuse(operates, {repeat, threads, fault});
        refuse(answers, {timing});
        refuse(answers || command.action == Action::Value, {url});
        refuse(command.action == Action::Report, {verbose});
        refuse(command.action == Action::Report && arguments.format == Format::OpenMetrics, {withSerials});
        refuse(command.operation == om::Operation::ModifyInstance || command.operation == om::Operation::InvokeMethod,
               {dryRun});
        if (arguments.format != Format::Text && (!answers || arguments.dryRun))
            throw CLI::ValidationError(arguments.dryRun ? "--dry-run" : command.name, "its output is text alone");
        if (isForEngines(arguments.format) && command.action != Action::Report)
            throw CLI::ValidationError(command.name, "--format " + formatName + " is a format of report");
    }

    om::Fault readFault() const {
        try {
            return parseFault(faultText);
        } catch (const std::runtime_error& error) {
            throw CLI::ValidationError("--fault", std::string(error.what()) + "; see 'vkcim --list-faults'");
        }
    }

    const CLI::Validator notEmpty{[](const std::string& text) { return text.empty() ? "is empty" : ""; }, ""};
    CLI::App app;
    Arguments arguments;
    std::string formatName = "text";
    std::optional<std::string> properties;
    CLI::Option* repeat = nullptr;
    CLI::Option* threads = nullptr;
    std::string faultText;
    CLI::Option* fault = nullptr;
    CLI::Option* url = nullptr;
    CLI::Option* timing = nullptr;
    CLI::Option* verbose = nullptr;
    CLI::Option* withSerials = nullptr;
    CLI::Option* dryRun = nullptr;
};

} // namespace

Parsed parseArguments(const std::vector<std::string>& words) {
    return CommandLine().parse(words);
}

} // namespace vkcim
