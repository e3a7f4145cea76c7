// Changes this machine's system configuration through the process's repository: reads the latest
// (defaults when none is stored yet), sets the log root and the CORBA endpoints given on the
// command line, stores it on the master and tells the other hosts.
//
//   store_system_configuration LOG_ROOT [ENDPOINT...]
#include <iostream>

#include "Configuration/ConfigurationRepository.h"
#include "Configuration/OrvelSystemConfiguration.h"

int main(int argc, char** argv) {
    using Configuration::ConfigurationRepository;
    if (argc < 2) {
        std::cerr << "usage: store_system_configuration LOG_ROOT [ENDPOINT...]\n";
        return 2;
    }
    try {
        ConfigurationRepository* repository = ConfigurationRepository::instance();
        Configuration::OrvelSystemConfiguration system;
        repository->GetLatest(system);  // keeps the defaults when nothing is stored yet
        system.setLogRoot(argv[1]);
        system.setCORBAEndpoints(std::vector<ACE_CString>(argv + 2, argv + argc));
        if (repository->Store(system) != 0) {
            std::cerr << "store_system_configuration: the document could not be stored\n";
            return 1;
        }
        repository->SignalChanged();
        std::cout << "stored " << system.path().c_str() << " for "
                  << repository->GetVirtualHostName().c_str() << " at "
                  << system.timestamp().ToString().c_str() << "\n";
        return 0;
    } catch (const std::exception& e) {
        std::cerr << "store_system_configuration: " << e.what() << "\n";
        return 1;
    }
}
