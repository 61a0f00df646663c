#include "bench/Host.h"

#include <nlohmann/json.hpp>

#include <cstdlib>
#include <fstream>
#include <stdexcept>

namespace bench {
namespace {

namespace fs = std::filesystem;

nlohmann::json computer(const std::string& number) {
    return {{"type", 40},
            {"path", "/computer/" + number},
            {"status", 1},
            {"description", "Example Rack Server"},
            {"properties",
             {{"108", "node" + number},
              {"64", "4c4c4544-0043-3010-8052-b4c04f564231"},
              {"39", "Rack Server 7"},
              {"50", "SYS" + number},
              {"115", "ops@example.org"},
              {"116", "Operations"},
              {"123", 1},
              {"127", 60},
              {"200", 0}}},
            {"readOnly", {108}}};
}

nlohmann::json chassis(const std::string& number) {
    return {{"type", 1},
            {"path", "/computer/" + number + "/chassis/0"},
            {"parent", "/computer/" + number},
            {"status", 1},
            {"description", "Rack Mount Chassis"},
            {"properties", {{"50", "CZ" + number}, {"36", "Example"}, {"39", "Box"}, {"86", "SKU-1"}, {"128", 2}}}};
}

} // namespace

Host::Host(bool isLiveHost) : live(isLiveHost) {
    setenv("NVLOG_SINK", "none", 1);
    if (live) return;
    std::string pattern = (fs::temp_directory_path() / "provider-bench-XXXXXX").string();
    if (mkdtemp(pattern.data()) == nullptr) throw std::runtime_error("cannot make a directory for the simulated host");
    directory = pattern;
    setenv("VK_INSTRUMENTATION_TREE", (directory / "tree.json").c_str(), 1);
}

Host::~Host() {
    std::error_code ignored;
    if (!live) fs::remove_all(directory, ignored);
}

void Host::use(int computers) {
    if (live || computers == present) return;
    nlohmann::json nodes = nlohmann::json::array();
    for (int i = 0; i < computers; ++i) {
        nodes.push_back(computer(std::to_string(i)));
        nodes.push_back(chassis(std::to_string(i)));
    }
    const nlohmann::json tree = {{"product", {{"architecture", "x86_64"}, {"uid", "uid-1"}, {"kvm", false}}},
                                 {"nodes", nodes}};
    std::ofstream(directory / "tree.json.new") << tree.dump();
    fs::rename(directory / "tree.json.new", directory / "tree.json");
    present = computers;
}

} // namespace bench
