#pragma once

#include "vk/NodeLexicon.h"

#include <memory>
#include <string>
#include <utility>

namespace VK {

/// Where a node stands in the tree. Opaque; its text form is the same after every restart of the host.
class NodePath {
public:
    NodePath() = default;
    NodePath(std::string text) : text_(std::move(text)) {}
    operator std::string() const& { return text_; }
    operator std::string() && { return std::move(text_); }

    friend bool operator==(const NodePath& a, const NodePath& b) { return a.text_ == b.text_; }
    friend bool operator!=(const NodePath& a, const NodePath& b) { return !(a == b); }

private:
    std::string text_;
};

/// A cursor over the host's node tree.
///
/// The tree comes from this host, a snapshot of one, or a simulated host's file (vk/HostSource.h). A source that
/// cannot be read is an empty tree and one log line at level 6000; a simulated host's file may have 16 MiB. What cannot
/// change while a host runs is read once per process. The rest is as it is now: clock and zone at each call, and a
/// node's name and status when a cursor on it is first asked. Of this host power state and memory errors may be one
/// second old, so that a request opens no file; of a snapshot every change shows at once, and its files are read again
/// when they have changed; a simulated host's file is as it stands when nodes are selected. Within a look
/// (vk/WithinLook.h) snapshots and simulated hosts stay as they were at its beginning. What is known stays where
/// descriptors run out, and what could not be read for that is read again the next time. No operation throws but for
/// std::bad_alloc. Cursors are independent of each other; one cursor belongs to one thread at a time.
class Instrumentation {
public:
    /// A cursor that stands on nothing.
    Instrumentation();
    ~Instrumentation();
    Instrumentation(const Instrumentation&) = delete;
    Instrumentation& operator=(const Instrumentation&) = delete;

    /// Stands on the first node of `type`, or on nothing. Drops a filter set before.
    void selectNode(NodeLexicon::NodeType type);
    /// Stands on the node with this path, and on nothing after the next `++`; an empty or unknown path selects
    /// nothing. Drops a filter set before.
    void selectNode(const std::string& path);

    /// Whether the cursor stands on a node.
    explicit operator bool() const;

    /// Moves to the next node of the selected type that the filter lets pass, or off the end. Off the end it stays.
    Instrumentation& operator++();

    /// Lets only nodes pass whose path of that type equals `reference`, and moves on to the first such node from the
    /// current one on. Path types other than NamePath let no node pass.
    void setFilter(NodeLexicon::PathType type, const std::string& reference);

    /// Reads a property of the current node: true and the value, or false (not known, or of the other kind, or no
    /// current node) with the argument untouched.
    bool getProperty(NodeLexicon::Properties property, std::string& value) const;
    bool getProperty(NodeLexicon::Properties property, unsigned int& value) const;

    /// Writes a property of the current node; this cursor and all new ones see it. False, with nothing changed and one
    /// log line at level 6000, when the host does not allow it.
    ///
    /// Of a real host's computer system these can be written, each change with one log line at level 3000: the clock
    /// (126, a CIM date-time from 2000 on; takes CAP_SYS_TIME; never of a snapshot), the offset (127, -840 to 840
    /// minutes in two's complement) and daylight saving (200, 0 or 1); the last two replace /etc/localtime at one
    /// stroke. A simulated host's file is replaced at one stroke too, under the lock file `<file>.lock`.
    bool setProperty(NodeLexicon::Properties property, std::string& value);
    bool setProperty(NodeLexicon::Properties property, unsigned int& value);

    /// Whether a property of the current node can only be read: true and the flag, or false when that is not known.
    bool isPropertyReadOnly(NodeLexicon::Properties property, bool& readOnly) const;

    /// Status of the current node: 1 normal, 20 predictive failure, 21 to 26 degraded or failed, else unknown.
    /// 0 on nothing. The same until the cursor moves or writes.
    unsigned int getNodeStatus() const;
    /// The current node's description for people; empty on nothing.
    std::string getNodeDescription() const;
    /// Paths of the current node and of its parent; empty on nothing.
    NodePath getPathToNode() const;
    NodePath getPathToParentNode() const;

    /// A path's text form and back; each is the other's inverse.
    static std::string convertPathToString(const NodePath& path);
    static NodePath convertStringToPath(const std::string& text);

private:
    class Cursor;
    std::unique_ptr<Cursor> cursor;
};

} // namespace VK
