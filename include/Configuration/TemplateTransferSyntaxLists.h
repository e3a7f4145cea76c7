// Configuration::TemplateTransferSyntaxLists: the templates of the SOP service document. Element
// "TemplateTxLists" with one child "TemplateTxList" per template, in document order; every
// template is kept, also one whose read was incomplete. Reading appends to what the list holds.
// Read-only: writeVesk throws std::exception
// ("TemplateTransferSyntaxLists::writeVesk - Not supported.").
// Plain value owned by its caller; not thread-safe.
#pragma once

#include <vector>

#include "Configuration/ConfigurationClass.h"
#include "Configuration/TemplateTransferSyntaxList.h"

namespace Configuration {

class CONFIGURATION_API TemplateTransferSyntaxLists : public virtual Vesk::Serializable {
    CONFIGURATION_CLASS(TemplateTransferSyntaxLists);

public:
    static constexpr const char WELL_KNOWN_NAME[] = "TemplateTxLists";

    // The templates, in document order.
    const std::vector<TemplateTransferSyntaxList>& getTemplateTransferSyntaxLists() const {
        return m_templates;
    }

private:
    friend class SOPServiceConfiguration;

    std::vector<TemplateTransferSyntaxList> m_templates;
};

}  // namespace Configuration
