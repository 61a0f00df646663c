#pragma once

#include "Linux/NodeCursor.h"

#include <string>
#include <vector>

namespace VK::BaseServerProvider {

/// How a capabilities element can be selected.
enum class EnabledLogicalElementCapabilitiesFilter : unsigned int {
    InstanceID = 0 ///< by its node's path
};

/// What a client may change on the computer system: a cursor over the same nodes as ComputerSystem, one element each.
/// A getter returns true when it supplied a value; otherwise its argument is untouched.
class EnabledLogicalElementCapabilities
    : public NodeCursor<EnabledLogicalElementCapabilities, EnabledLogicalElementCapabilitiesFilter> {
public:
    EnabledLogicalElementCapabilities();
    ~EnabledLogicalElementCapabilities() noexcept(false);

    /// The text form of the node's path.
    bool getInstanceID(std::string& instanceID) const;
    bool getElementName(std::string& name) const;
    /// Whether the computer's name can be written; false where the host does not say.
    bool getElementNameEditSupported(bool& supported) const;

    /// What this host cannot supply.
    bool getMaxElementNameLen(unsigned short&) const { return false; }
    bool getRequestedStatesSupported(std::vector<unsigned short>&) const { return false; }
    bool getElementNameMask(std::string&) const { return false; }
    bool getStateAwareness(std::vector<unsigned short>&) const { return false; }

    static const TraceSource& traceSource();
    static constexpr auto nodeType = NodeLexicon::ComputerSystemNode;
    static constexpr bool evaluatesUnfiltered = true;
    bool passes(const Filter& filter) const;
};

} // namespace VK::BaseServerProvider
