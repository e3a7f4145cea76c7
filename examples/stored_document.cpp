// Builds a configuration object, stores it in its stored form (compressed XML) in a directory,
// reads the file back into a new object and prints the document as indented XML.
//
//   stored_document [DIRECTORY]      (default: ./run/example)
#include <cstdio>
#include <filesystem>
#include <fstream>
#include <iostream>
#include <iterator>

#include "Configuration/AnonParam.h"
#include "Configuration/StoredForm.h"
#include "Quorvex/OutputMemStream.h"
#include "Vesk/XmlUtils.h"

int main(int argc, char** argv) {
    const std::filesystem::path dir = argc > 1 ? argv[1] : "run/example";
    std::filesystem::create_directories(dir);
    const std::filesystem::path file = dir / "AnonParam.xml.z";

    Configuration::AnonParam param;
    param.setTag("0010,0010");
    param.setValue("ANONYMOUS");
    param.setDescription("Patient's name <replaced> & kept short");

    const std::string bytes = Configuration::StoredForm::encode(*param.writeVesk());
    std::ofstream(file, std::ios::binary) << bytes;

    std::ifstream in(file, std::ios::binary);
    const std::string stored((std::istreambuf_iterator<char>(in)),
                             std::istreambuf_iterator<char>());
    Vesk::Element tree;
    Configuration::StoredForm::decode(reinterpret_cast<const unsigned char*>(stored.data()),
                                      stored.size(), tree);
    Configuration::AnonParam read;
    const bool complete = read.readVesk(tree);

    OutputMemStream xml;
    Vesk::XmlUtils::streamOut(*read.writeVesk(), xml, Vesk::Ordering::indented());
    std::cout << "stored " << bytes.size() << " bytes in " << file.string() << "\n"
              << "read back " << (complete ? "complete" : "INCOMPLETE") << ", "
              << (read == param ? "equal" : "DIFFERENT") << ":\n"
              << xml.str() << "\n";
    return complete && read == param ? 0 : 1;
}
