#include "cmpi/CMPIPhysicalPackage.h"

namespace VK::BaseServerProvider {

static const std::string loggerCMPIPhysicalPackage("Norvane.BaseServerProvider");
static const TraceSource source{loggerCMPIPhysicalPackage, "CMPIPhysicalPackage"};

using Data = PhysicalPackage;

const TraceSource& CMPIPhysicalPackage::traceSource() {
    return source;
}

const Key<Data> CMPIPhysicalPackage::keys[] = {
    {"CreationClassName", &Data::getCreationClassName},
    {"Tag", &Data::getTag},
};

const KeyFilter<Data> CMPIPhysicalPackage::keyFilters[] = {
    {"Tag", "tag", Data::FilterType::TAG},
    {"SystemName", "systemName", Data::FilterType::SYSTEM_NAME},
};

const Property<Data> CMPIPhysicalPackage::properties[] = {
    {"Caption", &Data::getCaption},
    {"InstallDate", &Data::getInstallDate, dateTime},
    {"Name", &Data::getName},
    {"OperationalStatus", &Data::getOperationalStatus},
    {"StatusDescriptions", &Data::getStatusDescriptions},
    {"HealthState", &Data::getHealthState},
    {"PrimaryStatus", &Data::getPrimaryStatus},
    {"DetailedStatus", &Data::getDetailedStatus},
    {"OperatingStatus", &Data::getOperatingStatus},
    {"CommunicationStatus", &Data::getCommunicationStatus},
    {"Tag", &Data::getTag},
    {"Description", &Data::getDescription},
    {"CreationClassName", &Data::getCreationClassName},
    {"ElementName", &Data::getElementName},
    {"Manufacturer", &Data::getManufacturer},
    {"Model", &Data::getModel},
    {"SKU", &Data::getSKU},
    {"SerialNumber", &Data::getSerialNumber},
    {"Version", &Data::getVersion},
    {"PartNumber", &Data::getPartNumber},
    {"OtherIdentifyingInfo", &Data::getOtherIdentifyingInfo},
    {"PoweredOn", &Data::isPoweredOn},
    {"ManufactureDate", &Data::getManufactureDate, dateTime},
    {"VendorEquipmentType", &Data::getVendorEquipmentType},
    {"UserTracking", &Data::getUserTracking},
    {"CanBeFRUed", &Data::canBeFRUed},
    {"RemovalConditions", &Data::getRemovalConditions},
    {"Height", &Data::getHeight},
    {"Depth", &Data::getDepth},
    {"Width", &Data::getWidth},
    {"Weight", &Data::getWeight},
    {"PackageType", &Data::getPackageType},
    {"OtherPackageType", &Data::getOtherPackageType},
    {"VendorCompatibilityStrings", &Data::getVendorCompatibilityStrings},
};

void CMPIPhysicalPackage::initialize() {
    traceMethod(source);
    data.initialize();
}

} // namespace VK::BaseServerProvider
