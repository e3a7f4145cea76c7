// Reads this machine's system configuration through the process's repository (from the local
// configuration service, or from a store directory in embedded mode) and prints it.
//
//   QUORVEX_CONFIGURATION_SERVER=127.0.0.1:8771 read_system_configuration
#include <iostream>

#include "Configuration/ConfigurationRepository.h"
#include "Configuration/OrvelSystemConfiguration.h"
#include "Quorvex/OutputMemStream.h"
#include "Vesk/XmlUtils.h"

int main() {
    using Configuration::ConfigurationRepository;
    try {
        ConfigurationRepository* repository = ConfigurationRepository::instance();
        Configuration::OrvelSystemConfiguration system;
        if (repository->GetLatest(system) != 0) {
            std::cerr << "no system configuration stored for "
                      << repository->GetVirtualHostName().c_str() << "; showing the defaults\n";
        }
        std::cout << "host " << repository->GetVirtualHostName().c_str() << ", master "
                  << repository->GetMasterHostName().c_str()
                  << (repository->IsMaster() ? " (us)" : "") << "\nDICOM input directory: "
                  << system.getStack().getDICOMInputDirectory().c_str()
                  << "\nlast stored: " << system.timestamp().ToString().c_str() << "\n";
        OutputMemStream xml;
        Vesk::XmlUtils::streamOut(*system.writeVesk(), xml, Vesk::Ordering::indented());
        std::cout << xml.str() << "\n";
        return 0;
    } catch (const std::exception& e) {
        std::cerr << "read_system_configuration: " << e.what() << "\n";
        return 1;
    }
}
