#pragma once

#include "Linux/PhysicalPackage.h"
#include "cmpi/InstanceAdapter.h"

namespace VK::BaseServerProvider {

/// VESKA_PhysicalPackage.
class CMPIPhysicalPackage : public InstanceAdapter<CMPIPhysicalPackage, PhysicalPackage> {
public:
    using InstanceAdapter::InstanceAdapter;
    using Data = PhysicalPackage;

    /// Drops all filters and starts again at the first chassis.
    void initialize();

    static constexpr char className[] = "VESKA_PhysicalPackage";
    static constexpr char adapterName[] = "CMPIPhysicalPackage";
    static constexpr char destructorName[] = "~CMPIPhysicalPackage";
    static const TraceSource& traceSource();

    static constexpr Key<Data> keys[] = {
        {"CreationClassName", &Data::getCreationClassName},
        {"Tag", &Data::getTag},
    };

    static constexpr KeyFilter<Data> keyFilters[] = {
        {"Tag", "tag", Data::FilterType::TAG},
        {"SystemName", "systemName", Data::FilterType::SYSTEM_NAME},
    };

    static constexpr Property<Data> properties[] = {
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
};

} // namespace VK::BaseServerProvider
