// Several stored documents inflated, parsed and returned as one element tree.
#include "StoredDocuments.h"

#include <vector>

#include "Configuration/StoredForm.h"
#include "Operations.h"
#include "TimeText.h"
#include "Vesk/XmlUtils.h"

namespace ConfigurationService {
namespace {

std::vector<std::string> splitNames(const std::string& names, char separator) {
    std::vector<std::string> parts;
    std::size_t start = 0;
    while (start <= names.size()) {
        std::size_t end = names.find(separator, start);
        if (end == std::string::npos) {
            end = names.size();
        }
        if (end > start) {
            parts.push_back(names.substr(start, end - start));
        }
        start = end + 1;
    }
    return parts;
}

// One "ConfigurationItem" holding the document's tree.
void addDocument(Vesk::MultiElementValue& items, const Configuration::StoredItem& item) {
    Vesk::Element tree;
    try {
        Configuration::StoredForm::decode(
            reinterpret_cast<const unsigned char*>(item.bytes->data()), item.bytes->size(), tree);
    } catch (const std::exception& e) {
        throw OperationFailed("configuration \"" + std::string(item.name.c_str()) +
                                  "\" of host \"" + item.host.c_str() +
                                  "\" is not a stored element tree: " + e.what(),
                              500);
    }
    Vesk::Element& entry = items.addElement(
        "ConfigurationItem",
        Vesk::Attributes{{"Host", item.host},
                         {"ConfigurationName", item.name},
                         {"LastModifiedTime", TimeText::format(item.lastModifiedMs).c_str()}},
        -1);
    entry.addMultiElement().addElement(new Vesk::Element(std::move(tree)));
}

}  // namespace

std::string StoredDocuments::collect(const Configuration::DirectoryStore& store,
                                     const std::string& host, const std::string& names,
                                     char separator) {
    const std::vector<std::string> wanted = splitNames(names, separator);
    if (wanted.empty()) {
        throw OperationFailed("RetrieveItems names no configuration");
    }
    Vesk::Element root("ConfigurationItems");
    Vesk::MultiElementValue& items = root.addMultiElement();
    for (const std::string& name : wanted) {
        Configuration::StoredItem item;
        if (!store.retrieve(host.c_str(), name.c_str(), item)) {
            throw OperationFailed::notFound(host, name);
        }
        addDocument(items, item);
    }
    return Vesk::XmlUtils::toString(root);
}

}  // namespace ConfigurationService
