// Configuration::ProductDefinitions: the products of the installed solution.
//
// Element "ProductDefinitions" with one "ProductDefinition" child per product, in order. Reading
// replaces the list with every "ProductDefinition" child (other children are ignored), keeping
// entries whose read was incomplete (the read then reports false).
// Plain value owned by its caller; not thread-safe.
#pragma once

#include <vector>

#include "Configuration/ConfigurationClass.h"
#include "Configuration/ProductDefinition.h"

namespace Configuration {

class CONFIGURATION_API ProductDefinitions : public virtual Vesk::Serializable {
    CONFIGURATION_CLASS(ProductDefinitions);

public:
    // The products, in order.
    const std::vector<ProductDefinition>& getProductDefinitions() const { return m_products; }
    void setProductDefinitions(const std::vector<ProductDefinition>& value) { m_products = value; }
    // The first product with that ID, or null.
    const ProductDefinition* find(const ACE_CString& id) const;

private:
    std::vector<ProductDefinition> m_products;
};

}  // namespace Configuration
