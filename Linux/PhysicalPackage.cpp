#include "Linux/PhysicalPackage.h"

#include <iterator>

namespace VK::BaseServerProvider {

static const std::string& loggerPhysicalPackage = lastingString("Norvane.BaseServerProvider");
static const TraceSource source{loggerPhysicalPackage, "PhysicalPackage"};

const TraceSource& PhysicalPackage::traceSource() {
    return source;
}

PhysicalPackage::PhysicalPackage() {
    const TraceScope scope(VK_SCOPE(source));
    selectFirst();
}

PhysicalPackage::~PhysicalPackage() noexcept(false) {
    traceDestructor(VK_METHOD(source));
}

bool PhysicalPackage::passes(const Filter& filter) const {
    switch (filter.type) {
    case FilterType::TAG: {
        std::string serial;
        return !node().getProperty(NodeLexicon::SerialNumberProperty, serial) || serial == filter.reference;
    }
    case FilterType::SYSTEM_NAME:
        return std::string(node().getPathToParentNode()) == filter.reference;
    }
    return true;
}

bool PhysicalPackage::getCreationClassName(std::string& className) const {
    const TraceScope scope(VK_SCOPE(source));
    className = "VESKA_PhysicalPackage";
    return true;
}

bool PhysicalPackage::getTag(std::string& tag) const {
    const TraceScope scope(VK_SCOPE(source));
    if (!node().getProperty(NodeLexicon::SerialNumberProperty, tag)) return false;
    traceVariable(source, "tag", tag.c_str());
    return true;
}

bool PhysicalPackage::getSerialNumber(std::string& serial) const {
    const TraceScope scope(VK_SCOPE(source));
    return node().getProperty(NodeLexicon::SerialNumberProperty, serial);
}

bool PhysicalPackage::getManufacturer(std::string& manufacturer) const {
    const TraceScope scope(VK_SCOPE(source));
    return node().getProperty(NodeLexicon::ManufacturerProperty, manufacturer);
}

bool PhysicalPackage::getModel(std::string& model) const {
    const TraceScope scope(VK_SCOPE(source));
    return node().getProperty(NodeLexicon::ModelProperty, model);
}

bool PhysicalPackage::getSKU(std::string& sku) const {
    const TraceScope scope(VK_SCOPE(source));
    return node().getProperty(NodeLexicon::SKUProperty, sku);
}

bool PhysicalPackage::getElementName(std::string& name) const {
    const TraceScope scope(VK_SCOPE(source));
    std::string description = node().getNodeDescription();
    if (description.empty()) return false;
    name = std::move(description);
    return true;
}

bool PhysicalPackage::getDescription(std::string& description) const {
    const TraceScope scope(VK_SCOPE(source));
    description = node().getNodeDescription();
    return true;
}

bool PhysicalPackage::getPackageType(unsigned short& type) const {
    const TraceScope scope(VK_SCOPE(source));
    // By the node's number; on purpose, 6 is 12, and 4, 5 and all above 6 are 1.
    constexpr unsigned short cimTypes[] = {
        0,  // unknown: Unknown
        3,  // chassis: Chassis/Frame
        2,  // rack: Rack
        16, // blade: Blade
        1,  // Other
        1,  // Other
        12,
    };
    constexpr unsigned short other = 1;
    unsigned int number{};
    type = 0;
    if (node().getProperty(NodeLexicon::PackageTypeProperty, number))
        type = number < std::size(cimTypes) ? cimTypes[number] : other;
    return true;
}

} // namespace VK::BaseServerProvider
