// An out-of-tree program built against an installed configuration library: with "store TEXT" it
// stores this machine's system configuration with TEXT as its log root; with "read" it reads the
// document back through the repository and prints the log root. Exit status 0 on success.
#include <cstring>
#include <iostream>

#include "Configuration/ConfigurationRepository.h"
#include "Configuration/OrvelSystemConfiguration.h"

int main(int argc, char** argv) {
    using Configuration::ConfigurationRepository;
    const bool store = argc == 3 && std::strcmp(argv[1], "store") == 0;
    if (!store && !(argc == 2 && std::strcmp(argv[1], "read") == 0)) {
        std::cerr << "usage: consumer store TEXT | consumer read\n";
        return 2;
    }
    try {
        ConfigurationRepository* repository = ConfigurationRepository::instance();
        Configuration::OrvelSystemConfiguration system;
        const int found = repository->GetLatest(system);
        if (store) {
            system.setLogRoot(argv[2]);
            return repository->Store(system) == 0 ? 0 : 1;
        }
        if (found != 0) {
            std::cerr << "consumer: no system configuration stored\n";
            return 1;
        }
        std::cout << system.getLogRoot().c_str() << "\n";
        return 0;
    } catch (const std::exception& e) {
        std::cerr << "consumer: " << e.what() << "\n";
        return 1;
    }
}
