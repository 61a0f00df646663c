#pragma once

#include "Linux/NodeCursor.h"

#include <string>
#include <vector>

namespace VK::BaseServerProvider {

/// How a computer system can be selected.
enum class ComputerSystemFilter : unsigned int {
    Name = 0 ///< by its name; on purpose, a computer without a name passes
};

/// The host computer: a cursor over the computer-system nodes, with a getter for each property of the CIM class.
/// A getter returns true when it supplied a value; otherwise its argument is untouched.
class ComputerSystem : public NodeCursor<ComputerSystem, ComputerSystemFilter> {
public:
    ComputerSystem();
    ~ComputerSystem() noexcept(false);

    bool getName(std::string& name) const;
    /// The same as the name.
    bool getElementName(std::string& name) const;
    bool getUUID(std::string& uuid) const;
    bool getPrimaryOwnerContact(std::string& contact) const;
    bool getPrimaryOwnerName(std::string& name) const;
    bool getDescription(std::string& description) const;
    bool getCreationClassName(std::string& className) const;
    /// 5 OK, 10 degraded or warning, 0 unknown.
    bool getHealthState(unsigned short& state) const;
    /// "OK", "Pred Fail", "Degraded" or "Unknown".
    bool getStatus(std::string& status) const;
    /// Appends to `states` on purpose: what the caller put there stays.
    bool getOperationalStatus(std::vector<unsigned short>& states) const;
    /// 2 enabled, 4 shutting down, 0 unknown; on purpose, another power state returns true and leaves `state`.
    bool getEnabledState(unsigned short& state) const;
    bool getDedicated(std::vector<unsigned short>& purposes) const;
    /// Appends what identifies the computer now, pair by pair. Returns whether there is a chassis, and not whether
    /// there are pairs. On purpose: without a chassis it returns false although both vectors were filled.
    bool getIdentifyingInfo(std::vector<std::string>& descriptions, std::vector<std::string>& values) const;
    bool getOtherIdentifyingInfo(std::vector<std::string>& values) const;
    bool getIdentifyingDescriptions(std::vector<std::string>& descriptions) const;
    /// The last two for a reader that wants the texts only where they return true: otherwise the argument stays empty.
    bool supplyOtherIdentifyingInfo(std::vector<std::string>& values) const;
    bool supplyIdentifyingDescriptions(std::vector<std::string>& descriptions) const;

    /// What this host cannot supply.
    bool getCaption(std::string&) const { return false; }
    bool getInstallDate(std::string&) const { return false; }
    bool getStatusDescriptions(std::vector<std::string>&) const { return false; }
    bool getPrimaryStatus(unsigned short&) const { return false; }
    bool getDetailedStatus(unsigned short&) const { return false; }
    bool getOperatingStatus(unsigned short&) const { return false; }
    bool getCommunicationStatus(unsigned short&) const { return false; }
    bool getOtherEnabledState(std::string&) const { return false; }
    bool getRequestedState(unsigned short&) const { return false; }
    bool getEnabledDefault(unsigned short&) const { return false; }
    bool getTimeOfLastStateChange(std::string&) const { return false; }
    bool getAvailableRequestedStates(std::vector<unsigned short>&) const { return false; }
    bool getTransitioningToState(unsigned short&) const { return false; }
    bool getRoles(std::vector<std::string>&) const { return false; }
    bool getNameFormat(std::string&) const { return false; }
    bool getOtherDedicatedDescriptions(std::vector<std::string>&) const { return false; }
    bool getResetCapability(unsigned short&) const { return false; }

    static const TraceSource& traceSource();
    static constexpr auto nodeType = NodeLexicon::ComputerSystemNode;
    static constexpr bool evaluatesUnfiltered = true;
    bool passes(const Filter& filter) const;

private:
    using Texts = std::vector<std::string>;

    bool identify(Texts* descriptions, Texts* values, bool alwaysTexts = true) const;
};

} // namespace VK::BaseServerProvider
