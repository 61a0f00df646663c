#include "tools/check/Run.h"

#include "tools/check/Checks.h"
#include "vk/Architecture.h"

#include <algorithm>
#include <filesystem>
#include <iomanip>
#include <nlohmann/json.hpp>

namespace check {

namespace {

void printText(const std::vector<Finding>& all, std::ostream& out) {
    std::size_t width = 0;
    for (const Finding& finding : all) width = std::max(width, finding.name.size());
    const auto name = std::setw(static_cast<int>(width));
    for (const Finding& finding : all) {
        out << (finding.found ? "found  " : "MISSING") << "  " << std::left << name << finding.name << "  "
            << finding.detail << "\n";
        if (!finding.found)
            out << std::setw(9) << "" << name << ""
                << "  without it: " << finding.without << "\n";
    }
}

std::string quoted(const std::string& text) {
    return nlohmann::json(text).dump(-1, ' ', true, nlohmann::json::error_handler_t::replace);
}

/// On one line, with blanks behind commas and colons.
void printJson(const std::vector<Finding>& all, std::size_t missing, const std::string& architecture,
               std::ostream& out) {
    out << "{\"architecture\": " << quoted(architecture) << ", \"missing\": " << missing << ", \"checks\": [";
    const char* between = "";
    for (const Finding& finding : all) {
        out << between << "{\"name\": " << quoted(finding.name) << ", \"found\": " << (finding.found ? "true" : "false")
            << ", \"detail\": " << quoted(finding.detail) << ", \"without\": " << quoted(finding.without) << "}";
        between = ", ";
    }
    out << "]}\n";
}

} // namespace

int run(const std::vector<std::string>& words, tools::Output output) {
    std::string format = "text";
    std::string directory = "/";
    CLI::App app("Looks for each thing outside the provider that its classes need, and says what does not work without "
                 "it.",
                 "vk-provider-check");
    tools::addCommonOptions(app);
    app.add_option("--format", format, "Output: text or json (text)")
        ->type_name("FORMAT")
        ->check(CLI::IsMember({"text", "json"}).description(""));
    app.add_option("--root", directory, "Look below DIR (/)")->type_name("DIR");
    app.footer("Exit status: 0 everything is there, 1 something is missing, 2 unusable arguments.\n"
               "Run it as the user that the object manager runs as.\n"
               "Example: vk-provider-check --format json");
    if (const std::optional<int> status = tools::parse(app, words, output)) return *status;
    if (!std::filesystem::is_directory(directory)) return tools::refuse(app, directory + " is no directory", output);

    const VK::Root root(directory);
    const std::vector<Finding> all = findings(root);
    const auto missing = static_cast<std::size_t>(
        std::count_if(all.begin(), all.end(), [](const Finding& finding) { return !finding.found; }));
    if (format == "json")
        printJson(all, missing, VK::architectureOf(root), output.out);
    else
        printText(all, output.out);
    return missing > 0 ? 1 : 0;
}

} // namespace check
