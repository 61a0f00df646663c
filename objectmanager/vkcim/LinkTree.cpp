#include "objectmanager/vkcim/LinkTree.h"

#include <algorithm>
#include <map>
#include <set>

namespace vkcim {
namespace {

class Drawing {
public:
    explicit Drawing(const std::vector<Link>& links) {
        std::set<std::string> below;
        for (const Link& link : links) {
            children[link.above].push_back(&link);
            below.insert(link.below);
        }
        for (const Link& link : links) {
            if (below.count(link.above) == 0) drawFrom(link.above);
        }
        // What is left is in circles, each of which may start anywhere.
        for (const Link& link : links) drawFrom(link.above);
    }

    std::vector<std::string> lines;

private:
    void drawFrom(const std::string& root) {
        if (drawn.count(root) != 0) return;
        lines.push_back(root);
        drawBelow(root, "");
    }

    void drawBelow(const std::string& thing, const std::string& indent) {
        if (!drawn.insert(thing).second) return;
        const std::vector<const Link*>& mine = children[thing];
        for (const Link* link : mine) {
            const bool last = link == mine.back();
            lines.push_back(indent + (last ? "└─ " : "├─ ") + link->below + "  (" + link->association + ')');
            drawBelow(link->below, indent + (last ? "   " : "│  "));
        }
    }

    std::map<std::string, std::vector<const Link*>> children;
    std::set<std::string> drawn;
};

} // namespace

std::vector<std::string> drawLinks(const std::vector<Link>& links) {
    return Drawing(links).lines;
}

} // namespace vkcim
