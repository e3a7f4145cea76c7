// binpath_probe FILE PROCESS...: reads the ApplicationLocation document in FILE (the XML form of
// its element tree) and prints, for each process, "PROCESS=[FOLDER]" with the binary folder its
// product names in this process's environment (empty when there is none). Exit status 2 when the
// document does not read complete.
#include <fstream>
#include <iostream>
#include <sstream>

#include "Configuration/ApplicationLocationConfiguration.h"
#include "Vesk/XmlUtils.h"

int main(int argc, char** argv) {
    if (argc < 2) {
        std::cerr << "usage: binpath_probe FILE PROCESS...\n";
        return 1;
    }
    std::ifstream in(argv[1], std::ios::binary);
    std::ostringstream text;
    text << in.rdbuf();
    Vesk::Element tree;
    Vesk::XmlUtils::parse(text.str().data(), text.str().size(), tree);
    Configuration::ApplicationLocationConfiguration location;
    if (!location.readVesk(tree)) {
        return 2;
    }
    for (int i = 2; i < argc; ++i) {
        std::cout << argv[i] << "=[" << location.getProductBinPath(argv[i]).c_str() << "]"
                  << std::endl;
    }
    return 0;
}
