#include "tools/CommandLine.h"

#include "objectmanager/vkcim/Terminal.h"

#include <filesystem>
#include <sstream>

namespace tools {

void addCommonOptions(CLI::App& app) {
    app.set_help_flag("-h,--help", "Print this and exit");
    app.set_version_flag("--version", app.get_name() + " " VK_VERSION, "Print the version and exit");
    app.get_formatter()->label("REQUIRED", "");
}

std::optional<int> parse(CLI::App& app, const std::vector<std::string>& words, Output output) {
    try {
        app.parse(std::vector<std::string>(words.rbegin(), words.rend())); // CLI11 takes them from the back
        return std::nullopt;
    } catch (const CLI::Success& success) { // --help and --version
        std::ostringstream text;
        const int status = app.exit(success, text, text);
        output.out << vkcim::wrapped(text.str(), vkcim::lookOfStandardOutput().width);
        return status;
    } catch (const CLI::Error& error) {
        return refuse(app, error.what(), output);
    }
}

std::optional<std::string> problemOfDirectory(const std::string& path) {
    std::error_code error;
    if (std::filesystem::is_directory(path, error)) return std::nullopt;
    if (error && error != std::errc::no_such_file_or_directory) return path + ": " + error.message();
    return path + " is no directory";
}

int refuse(const CLI::App& app, const std::string& problem, Output output) {
    output.error << app.get_name() << ": " << problem << "\nTry '" << app.get_name() << " --help'.\n";
    return unusableArguments;
}

} // namespace tools
