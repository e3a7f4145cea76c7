// Configuration::TemplateTransferSyntaxList: a named group of transfer syntaxes that SOP services
// refer to by name. Element "TemplateTxList"; keys in order, with defaults: "TemplateName"
// (string, empty; required), "TemplateDescription" (string, empty; optional: absent leaves it),
// "Additional" (flag, false; absent: false), "TxList" (the numbers of its syntaxes, e.g. "1,2,5";
// optional). The resolved list is derived: the SOP service document builds it from "TxList" and
// its master table after reading. Equality compares name, description, additional flag and the
// resolved list, not the list text. Read-only: writeVesk throws std::exception
// ("TemplateTransferSyntaxList::writeVesk - Not supported.").
// Plain value owned by its caller; not thread-safe.
#pragma once

#include <ace/SString.h>

#include "Configuration/ConfigurationClass.h"
#include "Configuration/TransferSyntaxList.h"

namespace Configuration {

class CONFIGURATION_API TemplateTransferSyntaxList : public virtual Vesk::Serializable {
    CONFIGURATION_CLASS(TemplateTransferSyntaxList);

public:
    static constexpr const char WELL_KNOWN_NAME[] = "TemplateTxList";

    // The name by which services refer to the template.
    const ACE_CString& getName() const { return m_name; }
    void setName(const ACE_CString& name) { m_name = name; }
    // Free text.
    const ACE_CString& getDescription() const { return m_description; }
    void setDescription(const ACE_CString& description) { m_description = description; }
    // Whether the template belongs to the "additional" set (found only by additional services).
    bool getAdditional() const { return m_additional; }
    void setAdditional(bool additional) { m_additional = additional; }
    // The resolved syntaxes, in the order of "TxList" (each once, all enabled).
    const TransferSyntaxList& getTransferSyntaxList() const { return m_transferSyntaxList; }

private:
    friend class SOPServiceConfiguration;

    ACE_CString m_name;
    ACE_CString m_description;
    bool m_additional = false;
    ACE_CString m_listText;
    TransferSyntaxList m_transferSyntaxList;
};

}  // namespace Configuration
