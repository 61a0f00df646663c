#include "objectmanager/vkcim/LinkTree.h"

#include "objectmanager/vkcim/Utf8.h"

#include <algorithm>
#include <map>
#include <set>
#include <sstream>

namespace vkcim {
namespace {

class Drawing {
public:
    Drawing(const std::vector<Link>& links, const Look& wanted) : look(wanted) {
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
        draw(root, "", "", 0);
        drawBelow(root, "", 0);
    }

    void drawBelow(const std::string& thing, const std::string& indent, std::size_t depth) {
        if (!drawn.insert(thing).second) return;
        const std::vector<const Link*>& mine = children[thing];
        for (const Link* link : mine) {
            const bool last = link == mine.back();
            const std::string below = indent + (last ? "   " : look.boxes ? "│  " : "|  ");
            drawLink(*link, indent + branch(last), below, 3 * (depth + 1));
            drawBelow(link->below, below, depth + 1);
        }
    }

    const char* branch(bool last) const {
        if (!look.boxes) return last ? "`- " : "|- ";
        return last ? "└─ " : "├─ ";
    }

    void drawLink(const Link& link, const std::string& before, const std::string& below, std::size_t indent) {
        const std::string association = "  (" + link.association + ')';
        const bool fits = look.width == 0 || indent + link.below.size() + association.size() <= look.width;
        draw(link.below + (fits ? association : ""), before, below, indent);
        if (!fits) lines.push_back(below + association);
    }

    /// One line, or several where the text is too long for one.
    void draw(const std::string& text, const std::string& first, const std::string& others, std::size_t indent) {
        const std::size_t room = look.width > indent ? look.width - indent : look.width;
        std::istringstream parts(wrapped(printable(text), room));
        std::string part;
        std::getline(parts, part);
        lines.push_back(first + part);
        while (std::getline(parts, part)) lines.push_back(others + part);
    }

    const Look& look;
    std::map<std::string, std::vector<const Link*>> children;
    std::set<std::string> drawn;
};

} // namespace

std::vector<std::string> drawLinks(const std::vector<Link>& links, const Look& look) {
    return Drawing(links, look).lines;
}

} // namespace vkcim
