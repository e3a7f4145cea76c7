#include "Configuration/ProductDefinition.h"

#include "Configuration/ProductDefinitions.h"
#include "model/ClassDefinition.h"

namespace Configuration {

template <class Self, class Io>
void ProductDefinition::fields(Self& self, Io& io) {
    io("Name", self.m_name);
    io("ID", self.m_id);
    io("Description", self.m_description);
    io("BinaryPath", self.m_binaryPath);
}

CONFIGURATION_DEFINE(ProductDefinition, "ProductDefinition", Fields::FailureForm::PartialDefaults)

template <class Self, class Io>
void ProductDefinitions::fields(Self& self, Io& io) {
    io("ProductDefinition", self.m_products);
}

CONFIGURATION_DEFINE(ProductDefinitions, "ProductDefinitions", Fields::FailureForm::Failed)

const ProductDefinition* ProductDefinitions::find(const ACE_CString& id) const {
    for (const ProductDefinition& product : m_products) {
        if (product.getID() == id) {
            return &product;
        }
    }
    return nullptr;
}

}  // namespace Configuration
