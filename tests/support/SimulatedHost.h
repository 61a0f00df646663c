#pragma once

#include <nlohmann/json.hpp>

#include <filesystem>
#include <map>
#include <optional>
#include <string>
#include <vector>

namespace test {

/// The process's own directory, removed at its end. Made before main, which also points the libraries at it: the
/// simulated host's file is `tree.json` in it, the log goes to `log` with all levels and both channels. A variable that
/// is set already stays.
const std::filesystem::path& processDirectory();

/// One node of a simulated host.
struct Node {
    unsigned type = 40;
    std::string path;
    std::string parent = "";
    unsigned status = 0;
    std::string description = "";
    std::map<unsigned, nlohmann::json> properties = {};
    std::vector<unsigned> readOnly = {};
    std::vector<unsigned> unanswerable = {};
    std::vector<unsigned> failWrites = {};
};

/// A computer of that name at `/computer/<index>`, healthy, with a UUID, model and serial number of its own.
Node computer(unsigned index, const std::string& name);
/// A chassis at `/computer/<index>/chassis/<number>` with that serial number.
Node chassis(unsigned index, unsigned number, const std::string& serial);

/// The same node without one of its properties.
Node without(Node node, unsigned property);

/// Makes the process's host this one. `product` is fixed to architecture `x86_64`, uid `uid-1` and no KVM.
void simulate(const std::vector<Node>& nodes);
/// The same with these facts of the product, which the libraries read once per process.
void simulate(const std::vector<Node>& nodes, const nlohmann::json& product);
/// The same from the text of the file as it stands.
void simulateText(const std::string& text);
/// The simulated host's file, parsed.
nlohmann::json simulatedFile();
/// A property as it stands in the file; null when the node lacks it.
nlohmann::json simulatedProperty(const std::string& path, unsigned property);

/// The lines that the log holds, and an empty log after it.
std::vector<std::string> takeLog();
/// What stands behind the time stamp of each of these lines, without the line number behind the file's name.
std::vector<std::string> withoutPlaces(const std::vector<std::string>& lines);

} // namespace test
