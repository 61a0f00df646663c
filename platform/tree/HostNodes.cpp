#include "tree/HostNodes.h"

#include "common/Text.h"
#include "zone/Clock.h"
#include "zone/ZoneChange.h"
#include "zone/ZoneInForce.h"

#include <algorithm>
#include <climits>

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

constexpr ComputerRow computerRows[] = {
    {Lexicon::UUIDProperty, [](const Host::HardwareFacts& host) { return text(host.uuid); }},
    {Lexicon::SerialNumberProperty, [](const Host::HardwareFacts& host) { return text(host.serial); }},
    {Lexicon::ModelProperty, [](const Host::HardwareFacts& host) { return text(host.model); }},
    {Lexicon::PrimaryOwnerContactProperty, [](const Host::HardwareFacts& host) { return text(host.ownerContact); }},
    {Lexicon::PrimaryOwnerNameProperty, [](const Host::HardwareFacts& host) { return text(host.ownerName); }},
};

/// Passes a number on; nothing for a text.
template <typename Change>
std::optional<bool> withNumber(const Value& value, unsigned int largest, Change change) {
    const unsigned int* const number = std::get_if<unsigned int>(&value);
    if (number == nullptr || *number > largest) return std::nullopt;
    return change(*number);
}

constexpr ChangingProperty computerNow[] = {
    {.number = Lexicon::NameProperty,
     .read =
         [](HostNow& host) {
             const std::optional<std::string> name = host.name();
             return name ? Told(*name) : std::nullopt;
         }},
    {.number = Lexicon::PowerStateProperty,
     .read = [](HostNow& host) { return Told(host.isShuttingDown() ? 16U : 1U); }},
    {.number = Lexicon::GmtOffsetProperty,
     .read = [](HostNow& host) { return Told(static_cast<unsigned int>(Zone::offsetInForce(*host.zone()))); },
     .change =
         [](const Root& root, const Value& value) {
             return withNumber(value, UINT_MAX, [&root](unsigned int minutes) {
                 return Zone::changeOffset(root, static_cast<int>(minutes)); // two's complement
             });
         }},
    {.number = Lexicon::SystemTimeProperty,
     .read = [](HostNow& host) { return Told(Zone::systemTime(*host.zone())); },
     .change =
         [](const Root& root, const Value& value) {
             const std::string* const time = std::get_if<std::string>(&value);
             return time != nullptr ? std::optional<bool>(Zone::changeClock(root, *time)) : std::nullopt;
         },
     .onLiveHostsOnly = true},
    {.number = Lexicon::AutomaticDSTAdjustmentProperty,
     .read = [](HostNow& host) { return Told(Zone::hasDaylightSaving(*host.zone()) ? 1U : 0U); },
     .change =
         [](const Root& root, const Value& value) {
             return withNumber(value, 1,
                               [&root](unsigned int on) { return Zone::changeDaylightSaving(root, on == 1); });
         }},
};

constexpr ChassisRow chassisRows[] = {
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

/// Fills in what the rows supply.
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
    fill(computer, computerRows, facts);
    for (std::size_t i = 0; i < facts.chassis.size(); ++i) {
        Node& node = nodes[1 + i];
        node.type = Lexicon::SystemChassisNode;
        node.path = computer.path + "/chassis/" + std::to_string(i);
        node.parent = computer.path;
        node.description = Host::chassisTypeName(facts.chassis[i].type);
        node.status = facts.chassis[i].status;
        fill(node, chassisRows, ChassisView{facts, facts.chassis[i], i == 0});
    }
    return nodes;
}

const ChangingProperty* changingProperty(const Node& node, unsigned int number) {
    if (node.type != Lexicon::ComputerSystemNode) return nullptr;
    for (const ChangingProperty& row : computerNow)
        if (row.number == number) return &row;
    return nullptr;
}

unsigned int statusOf(HostNow& host, const Node& node) {
    constexpr unsigned int uncorrectableErrors = 22;
    if (node.type == Lexicon::ComputerSystemNode && host.hasUncorrectableMemoryErrors())
        return std::max(node.status, uncorrectableErrors); // the worse, the larger
    return node.status;
}

void readEverything(const Root& root) {
    HostNow now(root);
    for (const Node& node : hostNodes(Host::readHardware(root))) statusOf(now, node);
    for (const ChangingProperty& row : computerNow) row.read(now);
}

} // namespace VK::Tree
