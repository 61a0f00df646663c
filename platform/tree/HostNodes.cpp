#include "tree/HostNodes.h"

#include "common/Text.h"
#include "host/State.h"
#include "vk/NodeLexicon.h"
#include "zone/ZoneInForce.h"

namespace VK::Tree {

namespace {

using Lexicon = NodeLexicon;
using Told = std::optional<Value>;

Told text(const Host::Fact& fact) {
    return fact ? Told(fact.text) : std::nullopt;
}

Told text(const Host::Fact& first, const Host::Fact& second) {
    return first ? text(first) : text(second);
}

/// A chassis and what its properties also draw on.
struct ChassisView {
    const Host::HardwareFacts& host;
    const Host::ChassisFacts& chassis;
    bool isFirst;
};

struct ComputerRow {
    Lexicon::Properties property;
    Told (*tell)(const Host::HardwareFacts& host);
};

struct ChassisRow {
    Lexicon::Properties property;
    Told (*tell)(const ChassisView& view);
};

struct ChangingRow {
    Lexicon::Properties property;
    Told (*tell)(const Root& root);
};

constexpr ComputerRow COMPUTER[] = {
    {Lexicon::UUIDProperty, [](const Host::HardwareFacts& host) { return text(host.uuid); }},
    {Lexicon::SerialNumberProperty, [](const Host::HardwareFacts& host) { return text(host.serial); }},
    {Lexicon::ModelProperty, [](const Host::HardwareFacts& host) { return text(host.model); }},
    {Lexicon::PrimaryOwnerContactProperty, [](const Host::HardwareFacts& host) { return text(host.ownerContact); }},
    {Lexicon::PrimaryOwnerNameProperty, [](const Host::HardwareFacts& host) { return text(host.ownerName); }},
};

constexpr ChangingRow COMPUTER_NOW[] = {
    {Lexicon::NameProperty,
     [](const Root& root) {
         const std::optional<std::string> name = Host::hostName(root);
         return name ? Told(*name) : std::nullopt;
     }},
    {Lexicon::PowerStateProperty, [](const Root& root) { return Told(Host::powerState(root)); }},
    {Lexicon::GmtOffsetProperty,
     [](const Root& root) { return Told(static_cast<unsigned int>(Zone::offsetInForce(root))); }},
    {Lexicon::SystemTimeProperty, [](const Root& root) { return Told(Zone::systemTime(root)); }},
    {Lexicon::AutomaticDSTAdjustmentProperty,
     [](const Root& root) { return Told(Zone::hasDaylightSaving(root) ? 1U : 0U); }},
};

constexpr ChassisRow CHASSIS[] = {
    {Lexicon::ManufacturerProperty,
     [](const ChassisView& view) { return text(view.chassis.manufacturer, view.host.manufacturer); }},
    {Lexicon::ModelProperty,
     [](const ChassisView& view) { return text(view.isFirst ? view.host.model : view.chassis.version); }},
    {Lexicon::SerialNumberProperty,
     [](const ChassisView& view) {
         return view.isFirst ? text(view.chassis.serial, view.host.serial) : text(view.chassis.serial);
     }},
    {Lexicon::SKUProperty,
     [](const ChassisView& view) {
         return view.isFirst ? text(view.chassis.sku, view.host.sku) : text(view.chassis.sku);
     }},
    {Lexicon::NameProperty, [](const ChassisView& view) { return Told(Host::chassisTypeName(view.chassis.type)); }},
    {Lexicon::PackageTypeProperty, [](const ChassisView& view) { return Told(Host::packageType(view.chassis.type)); }},
};

/// Fills in what the rows tell.
template <typename Row, std::size_t N, typename View>
void fill(Node& node, const Row (&rows)[N], const View& view) {
    for (const Row& row : rows)
        if (const Told value = row.tell(view)) node.properties[row.property] = *value;
}

std::string firstWord(const std::string& text) {
    return lowerCase(text.substr(0, text.find_first_of(" ,")));
}

/// Manufacturer and model. Some models name their manufacturer themselves: "Dell Computer Corporation" makes a "Dell
/// PowerEdge 8450".
std::string describe(const Host::HardwareFacts& host) {
    const std::string& manufacturer = host.manufacturer.text;
    const std::string& model = host.model.text;
    if (manufacturer.empty() && model.empty()) return "Linux " + host.architecture;
    if (manufacturer.empty() || firstWord(model) == firstWord(manufacturer)) return model;
    return manufacturer + (model.empty() ? "" : " ") + model;
}

} // namespace

std::vector<Node> hostNodes(const Host::HardwareFacts& facts) {
    std::vector<Node> nodes(1 + facts.chassis.size());
    Node& computer = nodes.front();
    computer.type = Lexicon::ComputerSystemNode;
    computer.path = "/computer/0";
    computer.description = describe(facts);
    computer.status = facts.chassis.empty() ? 0 : facts.chassis.front().status;
    fill(computer, COMPUTER, facts);
    for (std::size_t i = 0; i < facts.chassis.size(); ++i) {
        Node& node = nodes[1 + i];
        node.type = Lexicon::SystemChassisNode;
        node.path = computer.path + "/chassis/" + std::to_string(i);
        node.parent = computer.path;
        node.description = Host::chassisTypeName(facts.chassis[i].type);
        node.status = facts.chassis[i].status;
        fill(node, CHASSIS, ChassisView{facts, facts.chassis[i], i == 0});
    }
    return nodes;
}

std::optional<Value> changingProperty(const Root& root, unsigned int property) {
    for (const ChangingRow& row : COMPUTER_NOW)
        if (row.property == property) return row.tell(root);
    return std::nullopt;
}

} // namespace VK::Tree
