#include "DocumentCodec.h"

#include <stdexcept>
#include <string>
#include <utility>

#include "Configuration/StoredForm.h"

namespace Configuration {
namespace DocumentCodec {

Quorvex::auto_ptr<Vesk::Element> writeItem(const ACE_CString& name, ConfigDoc& document,
                                           const StoreFunction& store) {
    Quorvex::auto_ptr<Vesk::Element> tree = document.writeVesk();
    if (!tree) {  // a class that writes nothing (its document is kept by other means)
        throw std::runtime_error(std::string("ConfigurationRepository::WriteItem: nothing to store "
                                             "for ") +
                                 document.path().c_str());
    }
    const std::string bytes = StoredForm::encode(*tree);
    document.timestamp(BDateTime::Now());
    const int result =
        store(name, document.path(), reinterpret_cast<const unsigned char*>(bytes.data()),
              bytes.size(), document.timestamp());
    if (result != 0) {
        tree.reset();
    }
    return tree;
}

int readItem(const ACE_CString& name, ConfigDoc& document, const RetrieveFunction& retrieve,
             Vesk::Element* treeOut) {
    Quorvex::ByteArray bytes;
    std::size_t length = 0;
    BDateTime stored;
    if (retrieve(name, document.path(), bytes, length, stored) != 0) {
        return -1;
    }
    Vesk::Element tree(ACE_CString(), -1);
    StoredForm::decode(bytes.get(), length, tree);
    readTree(tree, document);
    document.timestamp(stored);
    if (treeOut != nullptr) {
        *treeOut = std::move(tree);
    }
    return 0;
}

void readTree(const Vesk::Element& tree, ConfigDoc& document) {
    if (!document.readVesk(tree)) {
        throw std::runtime_error(std::string("ConfigurationRepository::ReadItem: Error parsing "
                                             "configuration: ") +
                                 document.path().c_str() + "\n");
    }
}

}  // namespace DocumentCodec
}  // namespace Configuration
