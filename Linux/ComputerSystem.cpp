#include "Linux/ComputerSystem.h"

#include "vk/Product.h"
#include "vk/make_string.h"

#include <optional>

namespace VK::BaseServerProvider {

static const std::string& loggerComputerSystem = lastingString("Norvane.BaseServerProvider");
static const TraceSource source{loggerComputerSystem, "ComputerSystem"};

namespace {

enum class Health { Unknown, Normal, PredictiveFailure, Degraded };

Health healthOf(unsigned int nodeStatus) {
    if (nodeStatus == 1) return Health::Normal;
    if (nodeStatus == 20) return Health::PredictiveFailure;
    if (nodeStatus >= 21 && nodeStatus <= 26) return Health::Degraded;
    return Health::Unknown;
}

bool hasChassis() {
    Instrumentation chassis;
    chassis.selectNode(NodeLexicon::SystemChassisNode);
    return static_cast<bool>(chassis);
}

} // namespace

const TraceSource& ComputerSystem::traceSource() {
    return source;
}

ComputerSystem::ComputerSystem() {
    const TraceScope scope(VK_SCOPE(source));
    selectFirst();
}

ComputerSystem::~ComputerSystem() noexcept(false) {
    const DestructorTraceScope scope(VK_SCOPE(source));
}

bool ComputerSystem::passes(const Filter& filter) const {
    std::string name;
    return filter.type != FilterType::Name || !node().getProperty(NodeLexicon::NameProperty, name) ||
           name == filter.reference;
}

bool ComputerSystem::getName(std::string& name) const {
    const TraceScope scope(VK_SCOPE(source));
    return node().getProperty(NodeLexicon::NameProperty, name);
}

bool ComputerSystem::getElementName(std::string& name) const {
    const TraceScope scope(VK_SCOPE(source));
    return node().getProperty(NodeLexicon::NameProperty, name);
}

bool ComputerSystem::getUUID(std::string& uuid) const {
    const TraceScope scope(VK_SCOPE(source));
    return node().getProperty(NodeLexicon::UUIDProperty, uuid);
}

bool ComputerSystem::getPrimaryOwnerContact(std::string& contact) const {
    const TraceScope scope(VK_SCOPE(source));
    return node().getProperty(NodeLexicon::PrimaryOwnerContactProperty, contact);
}

bool ComputerSystem::getPrimaryOwnerName(std::string& name) const {
    const TraceScope scope(VK_SCOPE(source));
    return node().getProperty(NodeLexicon::PrimaryOwnerNameProperty, name);
}

bool ComputerSystem::getDescription(std::string& description) const {
    const TraceScope scope(VK_SCOPE(source));
    description = node().getNodeDescription();
    return true;
}

bool ComputerSystem::getCreationClassName(std::string& className) const {
    const TraceScope scope(VK_SCOPE(source));
    className = "VESKA_ComputerSystem";
    return true;
}

bool ComputerSystem::getHealthState(unsigned short& state) const {
    const TraceScope scope(VK_SCOPE(source));
    switch (healthOf(node().getNodeStatus())) {
    case Health::Normal:
        state = 5; // OK
        break;
    case Health::PredictiveFailure:
    case Health::Degraded:
        state = 10; // Degraded/Warning
        break;
    case Health::Unknown:
        state = 0;
    }
    return true;
}

bool ComputerSystem::getStatus(std::string& status) const {
    const TraceScope scope(VK_SCOPE(source));
    switch (healthOf(node().getNodeStatus())) {
    case Health::Normal:
        status = "OK";
        break;
    case Health::PredictiveFailure:
        status = "Pred Fail";
        break;
    case Health::Degraded:
        status = "Degraded";
        break;
    case Health::Unknown:
        status = "Unknown";
    }
    return true;
}

bool ComputerSystem::getOperationalStatus(std::vector<unsigned short>& states) const {
    const TraceScope scope(VK_SCOPE(source));
    switch (healthOf(node().getNodeStatus())) {
    case Health::Normal:
        states.insert(states.end(), {2, 11}); // OK, In Service
        break;
    case Health::PredictiveFailure:
        states.insert(states.end(), {3, 5}); // Degraded, Predictive Failure
        break;
    case Health::Degraded:
        states.push_back(3);
        break;
    case Health::Unknown:
        states.push_back(0);
    }
    return true;
}

bool ComputerSystem::getEnabledState(unsigned short& state) const {
    const TraceScope scope(VK_SCOPE(source));
    unsigned int powerState{};
    if (!node().getProperty(NodeLexicon::PowerStateProperty, powerState)) return false;
    if (powerState == 0)
        state = 0; // Unknown
    else if (powerState == 1)
        state = 2; // Enabled
    else if (powerState == 16)
        state = 4; // Shutting Down
    return true;   // on purpose: with any other power state the output stays as it was, and is supplied
}

bool ComputerSystem::getDedicated(std::vector<unsigned short>& purposes) const {
    const TraceScope scope(VK_SCOPE(source));
    purposes.assign(1, 0); // Not Dedicated
    return true;
}

/// Appends to the lists that are not null. Returns whether there is a chassis; where there is none, the texts are made
/// only if they are wanted always.
bool ComputerSystem::identify(Texts* descriptions, Texts* values, bool alwaysTexts) const {
    const TraceScope scope(VK_SCOPE_OF(source, "getIdentifyingInfo"));
    const auto add = [&](const std::string& value, const char* description) {
        if (values != nullptr) values->push_back(value);
        if (descriptions != nullptr) descriptions->emplace_back(description);
    };

    std::string uuid;
    const bool hasUuid = getUUID(uuid);
    std::optional<bool> chassis;
    if (!alwaysTexts) {
        chassis = hasChassis();
        if (!*chassis) return false;
    }
    if (hasUuid) {
        add(uuid, "CIM:GUID");
        add(make_string(Product::getUid()), "CIM:UniqueSystemID");
    }
    if (!chassis) chassis = hasChassis();
    std::string serial;
    std::string model;
    // On purpose: the computer's own serial number and model, not the chassis'.
    if (*chassis && node().getProperty(NodeLexicon::SerialNumberProperty, serial) &&
        node().getProperty(NodeLexicon::ModelProperty, model)) {
        add(model + ":" + serial, "CIM:Model:SerialNumber");
        add(serial, "CIM:Tag");
    }
    add(make_string(Product::getArchitecture()), "CIM:Architecture");
    add("true", "CIM:SecureIndicationEnabled");
    return *chassis;
}

bool ComputerSystem::getIdentifyingInfo(std::vector<std::string>& descriptions,
                                        std::vector<std::string>& values) const {
    return identify(&descriptions, &values);
}

bool ComputerSystem::getOtherIdentifyingInfo(std::vector<std::string>& values) const {
    const TraceScope scope(VK_SCOPE(source));
    values.clear();
    return identify(nullptr, &values);
}

bool ComputerSystem::getIdentifyingDescriptions(std::vector<std::string>& descriptions) const {
    const TraceScope scope(VK_SCOPE(source));
    descriptions.clear();
    return identify(&descriptions, nullptr);
}

// The lines are those of the getters.

bool ComputerSystem::supplyOtherIdentifyingInfo(std::vector<std::string>& values) const {
    const TraceScope scope(VK_SCOPE_OF(source, "getOtherIdentifyingInfo"));
    values.clear();
    return identify(nullptr, &values, false);
}

bool ComputerSystem::supplyIdentifyingDescriptions(std::vector<std::string>& descriptions) const {
    const TraceScope scope(VK_SCOPE_OF(source, "getIdentifyingDescriptions"));
    descriptions.clear();
    return identify(&descriptions, nullptr, false);
}

} // namespace VK::BaseServerProvider
