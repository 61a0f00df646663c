#include "support/SimulatedHost.h"

#include <cstdlib>
#include <fstream>
#include <regex>
#include <sstream>
#include <stdexcept>
#include <unistd.h>

namespace test {
namespace {

namespace fs = std::filesystem;

class ProcessDirectory {
public:
    ProcessDirectory() {
        std::string pattern = (fs::temp_directory_path() / "vk-test-XXXXXX").string();
        if (mkdtemp(pattern.data()) == nullptr) throw std::runtime_error("cannot make a temporary directory");
        path = pattern;
        setenv("VK_INSTRUMENTATION_TREE", (path / "tree.json").c_str(), 0);
        setenv("NVLOG_SINK", ("file:" + (path / "log").string()).c_str(), 0);
        setenv("NVLOG_LEVELS", "all", 0);
        setenv("NVLOG_CHANNELS", "log,trace", 0);
    }
    ~ProcessDirectory() {
        if (getpid() != owner) return; // a child of the test, which has no directory of its own
        std::error_code ignored;
        fs::remove_all(path, ignored);
    }

    fs::path path;

private:
    const pid_t owner = getpid();
};

const ProcessDirectory directory;

fs::path treeFile() {
    return directory.path / "tree.json";
}

nlohmann::json asJson(const Node& node) {
    nlohmann::json properties = nlohmann::json::object();
    for (const auto& [number, value] : node.properties) properties[std::to_string(number)] = value;
    return {{"type", node.type},
            {"path", node.path},
            {"parent", node.parent},
            {"status", node.status},
            {"description", node.description},
            {"properties", properties},
            {"readOnly", node.readOnly},
            {"unanswerable", node.unanswerable},
            {"failWrites", node.failWrites}};
}

} // namespace

const fs::path& processDirectory() {
    return directory.path;
}

Node computer(unsigned index, const std::string& name) {
    const std::string number = std::to_string(index);
    Node node;
    node.path = "/computer/" + number;
    node.status = 1;
    node.description = "Rack server " + number;
    node.properties = {{108, name},
                       {64, "4c4c4544-0043-3010-8052-00000000000" + number.substr(number.size() - 1)},
                       {39, "Model " + number},
                       {50, "SYS" + number},
                       {123, 1},
                       {127, 60},
                       {200, 0},
                       {126, ""}};
    node.readOnly = {108};
    return node;
}

Node chassis(unsigned index, unsigned number, const std::string& serial) {
    Node node;
    node.type = 1;
    node.parent = "/computer/" + std::to_string(index);
    node.path = node.parent + "/chassis/" + std::to_string(number);
    node.status = 1;
    node.description = "Rack Mount Chassis";
    node.properties = {{50, serial}, {36, "Example"}, {39, "Box"}, {86, "SKU-1"}, {128, 2}};
    return node;
}

Node without(Node node, unsigned property) {
    node.properties.erase(property);
    return node;
}

void simulate(const std::vector<Node>& nodes) {
    simulate(nodes, {{"architecture", "x86_64"}, {"uid", "uid-1"}, {"kvm", false}});
}

void simulate(const std::vector<Node>& nodes, const nlohmann::json& product) {
    nlohmann::json list = nlohmann::json::array();
    for (const Node& node : nodes) list.push_back(asJson(node));
    simulateText(nlohmann::json{{"product", product}, {"nodes", list}}.dump());
}

void simulateText(const std::string& text) {
    const fs::path temporary = directory.path / "tree.json.new";
    std::ofstream(temporary) << text;
    fs::rename(temporary, treeFile());
}

nlohmann::json simulatedFile() {
    std::ifstream file(treeFile());
    return nlohmann::json::parse(file);
}

nlohmann::json simulatedProperty(const std::string& path, unsigned property) {
    const nlohmann::json file = simulatedFile();
    for (const nlohmann::json& node : file.at("nodes")) {
        if (node["path"] != path) continue;
        const auto found = node["properties"].find(std::to_string(property));
        return found == node["properties"].end() ? nlohmann::json() : *found;
    }
    return {};
}

std::vector<std::string> takeLog() {
    const fs::path path = directory.path / "log";
    std::ifstream file(path);
    std::vector<std::string> lines;
    for (std::string line; std::getline(file, line);) lines.push_back(line);
    std::error_code ignored;
    fs::resize_file(path, 0, ignored);
    return lines;
}

std::vector<std::string> withoutPlaces(const std::vector<std::string>& lines) {
    static const std::regex place("^[^ ]+ ([A-Z]+ [0-9]+ [^ ]+ [^ :]+):[0-9]+ ");
    static const std::regex lineInText("\\[Line: [0-9]+\\]|at line [0-9]+");
    std::vector<std::string> cut;
    cut.reserve(lines.size());
    for (const std::string& line : lines)
        cut.push_back(std::regex_replace(std::regex_replace(line, place, "$1 "), lineInText, "[Line]"));
    return cut;
}

} // namespace test
