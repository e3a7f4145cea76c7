// Several stored documents inflated, parsed and returned as one element tree.
#include "StoredDocuments.h"

#include <algorithm>
#include <vector>

#include "Configuration/StoredForm.h"
#include "Operations.h"
#include "TimeText.h"
#include "Vesk/XmlUtils.h"

namespace ConfigurationService {
namespace {

std::vector<std::string> splitNames(const std::string& names, const char* separators) {
    std::vector<std::string> parts;
    std::size_t start = 0;
    while (start <= names.size()) {
        std::size_t end = names.find_first_of(separators, start);
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
                                     const char* separators) {
    const std::vector<std::string> wanted = splitNames(names, separators);
    if (wanted.empty()) {
        throw OperationFailed("RetrieveItems names no configuration");
    }
    std::vector<Configuration::StoredItem> found(wanted.size());
    const std::string* missing = nullptr;
    for (std::size_t i = 0; i < wanted.size(); ++i) {
        if (!store.retrieve(host.c_str(), wanted[i].c_str(), found[i]) && missing == nullptr) {
            missing = &wanted[i];
        }
    }
    if (missing != nullptr) {
        const bool noneFound = std::none_of(found.begin(), found.end(),
                                            [](const auto& item) { return item.bytes != nullptr; });
        if (noneFound) {
            return std::string();  // the client's "empty response"
        }
        throw OperationFailed::notFound(host, *missing);
    }
    Vesk::Element root("ConfigurationItems");
    Vesk::MultiElementValue& items = root.addMultiElement();
    for (const Configuration::StoredItem& item : found) {
        addDocument(items, item);
    }
    return Vesk::XmlUtils::toString(root);
}

}  // namespace ConfigurationService
