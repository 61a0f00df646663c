// Uses each of the installed libraries and the CMPI headers.
#include <nvlog/NVLogger.h>
#include <vk/Instrumentation.h>
#include <vk/Moniker.h>
#include <vk/Product.h>
#include <vk/ProviderUtilities.h>
#include <vk/make_string.h>

#include <cmpidt.h>
#include <iostream>

int main() {
    NVLog::NVLogger::logLevelMessage("main", "main", __LINE__, "Consumer", 3000, nullptr, 0, 0, "asked");
    std::cout << "architecture " << VK::make_string(VK::Product::getArchitecture()) << "\n";

    VK::Moniker moniker;
    moniker.addKey("Name", "node7");
    std::cout << "keys " << moniker.getKeyCount() << "\n";
    std::cout << "class " << VK::ProviderUtilities::getClassId("VESKA_PhysicalPackage") << "\n";

    VK::Instrumentation nodes;
    nodes.selectNode("/computer/0");
    std::cout << "computer " << nodes.getNodeDescription() << "\n";
    std::cout << "CMPI " << CMPI_VERSION << "\n";
}
