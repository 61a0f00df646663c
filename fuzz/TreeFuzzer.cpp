#include "instrumentation/TreeText.h"

#include <cstdlib>

/// What is read must still be read, with the change in it, after one property was changed.
extern "C" int LLVMFuzzerTestOneInput(const unsigned char* data, std::size_t size) {
    using namespace VK::Inside;
    const std::string_view text(reinterpret_cast<const char*>(data), size);
    const TreeText tree = readTreeText(text);
    if (!tree.problem.empty() && !tree.nodes.empty()) std::abort();
    if (!tree.problem.empty() || tree.nodes.empty()) return 0;
    const std::string changed = changeTreeText(text, tree.nodes.back().path, 4711, Value("changed"));
    const TreeText again = readTreeText(changed);
    if (!again.problem.empty() || again.nodes.size() != tree.nodes.size()) std::abort();
    if (again.nodes.back().properties.at(4711) != Value("changed")) std::abort();
    return 0;
}
