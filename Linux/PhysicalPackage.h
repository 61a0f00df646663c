#pragma once

#include "Linux/NodeCursor.h"

#include <string>
#include <vector>

namespace VK::BaseServerProvider {

/// How a chassis can be selected.
enum class PhysicalPackageFilter : unsigned int {
    TAG = 0,        ///< by its serial number; on purpose, a chassis without one passes
    SYSTEM_NAME = 1 ///< by the path of its parent node
};

/// The server's chassis: a cursor over the chassis nodes, with a getter for each property of the CIM class.
/// A getter returns true when it supplied a value; otherwise its argument is untouched.
class PhysicalPackage : public NodeCursor<PhysicalPackage, PhysicalPackageFilter> {
public:
    PhysicalPackage();
    ~PhysicalPackage() noexcept(false);

    bool getCreationClassName(std::string& className) const;
    /// The serial number.
    bool getTag(std::string& tag) const;
    bool getSerialNumber(std::string& serial) const;
    bool getManufacturer(std::string& manufacturer) const;
    bool getModel(std::string& model) const;
    bool getSKU(std::string& sku) const;
    /// The node's description, if there is one.
    bool getElementName(std::string& name) const;
    /// The node's description, on purpose supplied even when it is empty, unlike the element name.
    bool getDescription(std::string& description) const;
    /// CIM's PackageType; 0 where the host does not say.
    bool getPackageType(unsigned short& type) const;

    /// What this host cannot supply.
    bool getCaption(std::string&) const { return false; }
    bool getInstallDate(std::string&) const { return false; }
    bool getName(std::string&) const { return false; }
    bool getOperationalStatus(std::vector<unsigned short>&) const { return false; }
    bool getStatusDescriptions(std::vector<std::string>&) const { return false; }
    bool getHealthState(unsigned short&) const { return false; }
    bool getPrimaryStatus(unsigned short&) const { return false; }
    bool getDetailedStatus(unsigned short&) const { return false; }
    bool getOperatingStatus(unsigned short&) const { return false; }
    bool getCommunicationStatus(unsigned short&) const { return false; }
    bool getVersion(std::string&) const { return false; }
    bool getPartNumber(std::string&) const { return false; }
    bool getOtherIdentifyingInfo(std::string&) const { return false; }
    bool isPoweredOn(bool&) const { return false; }
    bool getManufactureDate(std::string&) const { return false; }
    bool getVendorEquipmentType(std::string&) const { return false; }
    bool getUserTracking(std::string&) const { return false; }
    bool canBeFRUed(bool&) const { return false; }
    bool getRemovalConditions(unsigned short&) const { return false; }
    bool getHeight(float&) const { return false; }
    bool getDepth(float&) const { return false; }
    bool getWidth(float&) const { return false; }
    bool getWeight(float&) const { return false; }
    bool getOtherPackageType(std::string&) const { return false; }
    bool getVendorCompatibilityStrings(std::vector<std::string>&) const { return false; }

    static const TraceSource& traceSource();
    static constexpr auto nodeType = NodeLexicon::SystemChassisNode;
    static constexpr bool evaluatesUnfiltered = false; // on purpose, unlike the computer
    bool passes(const Filter& filter) const;
};

} // namespace VK::BaseServerProvider
