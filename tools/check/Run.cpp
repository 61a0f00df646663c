#include "tools/check/Run.h"

#include "tools/check/Checks.h"
#include "vk/Architecture.h"

#include <algorithm>
#include <iomanip>
#include <nlohmann/json.hpp>

namespace check {

namespace {

const char* nameOf(Part part) {
    return part == Part::Reading ? "reading" : "setting";
}

void printText(const Finding& finding, std::size_t width, std::ostream& out) {
    const auto name = std::setw(static_cast<int>(width));
    out << (finding.found ? "found  " : "MISSING") << "  " << std::left << name << finding.name << "  "
        << finding.detail << "\n";
    if (!finding.found)
        out << std::setw(9) << "" << name << ""
            << "  without it: " << finding.without << "\n";
}

void printText(const std::vector<Finding>& all, std::ostream& out) {
    std::size_t width = 0;
    for (const Finding& finding : all) width = std::max(width, finding.name.size());
    const char* between = "";
    for (const Part part : {Part::Reading, Part::Setting}) {
        out << between << "For " << nameOf(part) << ":\n";
        for (const Finding& finding : all)
            if (finding.part == part) printText(finding, width, out);
        between = "\n";
    }
}

std::string quoted(const std::string& text) {
    return nlohmann::json(text).dump(-1, ' ', true, nlohmann::json::error_handler_t::replace);
}

/// On one line, with blanks behind commas and colons.
void printJson(const std::vector<Finding>& all, const std::string& asked, std::size_t missing,
               const std::string& architecture, std::ostream& out) {
    out << "{\"architecture\": " << quoted(architecture) << ", \"asked\": " << quoted(asked)
        << ", \"missing\": " << missing << ", \"checks\": [";
    const char* between = "";
    for (const Finding& finding : all) {
        out << between << "{\"part\": " << quoted(nameOf(finding.part)) << ", \"name\": " << quoted(finding.name)
            << ", \"found\": " << (finding.found ? "true" : "false") << ", \"detail\": " << quoted(finding.detail)
            << ", \"without\": " << quoted(finding.without) << "}";
        between = ", ";
    }
    out << "]}\n";
}

} // namespace

int run(const std::vector<std::string>& words, tools::Output output) {
    std::string asked = nameOf(Part::Reading);
    std::string format = "text";
    std::string directory = "/";
    CLI::App app("Looks for each thing outside the provider that its classes need, and says what does not work without "
                 "it: for reading what the host is, and for setting its time, zone and CIM server.",
                 "vk-provider-check");
    tools::addCommonOptions(app);
    app.add_option("PART", asked, "What the exit status is about: reading or setting (reading)")
        ->type_name("")
        ->check(CLI::IsMember({nameOf(Part::Reading), nameOf(Part::Setting)}).description(""));
    app.add_option("--format", format, "Output: text or json (text)")
        ->type_name("FORMAT")
        ->check(CLI::IsMember({"text", "json"}).description(""));
    app.add_option("--root", directory, "Look below DIR (/)")->type_name("DIR");
    app.footer("Exit status: 0 everything is there that the part needs, 1 something of it is missing, 2 unusable "
               "arguments.\n"
               "Run it as the user that the object manager runs as.\n"
               "Example: vk-provider-check setting --format json");
    if (const std::optional<int> status = tools::parse(app, words, output)) return *status;
    if (const auto problem = tools::problemOfDirectory(directory)) return tools::refuse(app, *problem, output);

    const VK::Root root(directory);
    const std::vector<Finding> all = findings(root);
    const auto missing = static_cast<std::size_t>(std::count_if(all.begin(), all.end(), [&](const Finding& finding) {
        return !finding.found && nameOf(finding.part) == asked;
    }));
    if (format == "json")
        printJson(all, asked, missing, VK::architectureOf(root), output.out);
    else
        printText(all, output.out);
    return missing > 0 ? 1 : 0;
}

} // namespace check
