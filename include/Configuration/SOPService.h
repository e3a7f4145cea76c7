// Configuration::SOPService: one DICOM service (SOP class) that the archive's servers offer, and
// the transfer syntaxes it accepts. Element "SOPService"; keys in order, with defaults: "UID",
// "Name" (strings, empty; required), "Description" (string, empty; optional: absent leaves it),
// "ObjectType" (required; "GSPS", "SR", "KO", "PRIVATE", "CSPS", anything else "IMAGE"),
// "Additional" (flag, false; absent: false), "EnabledDefault" (flag, true; absent: true),
// "Enabled" (flag, true; absent: the enabled default just read), "TxListDefault" (a template name
// or syntax numbers; optional), "TxList" (the numbers of the syntaxes to enable; optional, and
// whether it is present matters: present but empty disables every syntax).
//
// The template name and the resolved list are derived: the SOP service document builds them from
// the two texts after reading. Equality compares every field but the two texts. Read-only:
// writeVesk throws std::exception ("SOPService::writeVesk - Not supported.").
// Plain value owned by its caller; not thread-safe.
#pragma once

#include <ace/SString.h>

#include "Configuration/ConfigurationClass.h"
#include "Configuration/SOPObjectType.h"
#include "Configuration/TransferSyntaxList.h"

namespace Configuration {

class CONFIGURATION_API SOPService : public virtual Vesk::Serializable {
    CONFIGURATION_CLASS(SOPService);

public:
    static constexpr const char WELL_KNOWN_NAME[] = "SOPService";

    // The SOP class UID.
    const ACE_CString& getUID() const { return m_uid; }
    void setUID(const ACE_CString& uid) { m_uid = uid; }
    // The display name.
    const ACE_CString& getName() const { return m_name; }
    void setName(const ACE_CString& name) { m_name = name; }
    // Free text.
    const ACE_CString& getDescription() const { return m_description; }
    void setDescription(const ACE_CString& description) { m_description = description; }
    // The kind of object the service stores.
    SOPObjectType getObjectType() const { return m_objectType; }
    void setObjectType(SOPObjectType type) { m_objectType = type; }
    // Whether the service looks its template up among the "additional" templates.
    bool getAdditional() const { return m_additional; }
    void setAdditional(bool additional) { m_additional = additional; }
    // The factory setting of enabled.
    bool getEnabledDefault() const { return m_enabledDefault; }
    void setEnabledDefault(bool enabledDefault) { m_enabledDefault = enabledDefault; }
    // Whether the service is offered.
    bool getEnabled() const { return m_enabled; }
    void setEnabled(bool enabled) { m_enabled = enabled; }
    // The template whose syntaxes the service took; empty when it named numbers directly.
    const ACE_CString& getTemplateName() const { return m_templateName; }
    void setTemplateName(const ACE_CString& name) { m_templateName = name; }
    // The resolved syntaxes, each with whether the service accepts it.
    const TransferSyntaxList& getTransferSyntaxList() const { return m_transferSyntaxList; }

private:
    friend class SOPServiceConfiguration;

    // The kind a text names: "GSPS", "SR", "KO", "PRIVATE", "CSPS" (whole, case-sensitive);
    // anything else, "SPECIAL" and "IMAGE" included, is SOPObjectTypeImage.
    static SOPObjectType Str2SOPObjectType(ACE_CString text);
    // The text of a kind; a value outside the enumeration is "IMAGE".
    static ACE_CString SOPObjectType2Str(SOPObjectType type);

    ACE_CString m_uid;
    ACE_CString m_name;
    ACE_CString m_description;
    SOPObjectType m_objectType = SOPObjectTypeImage;
    bool m_additional = false;
    bool m_enabledDefault = true;
    bool m_enabled = true;
    ACE_CString m_templateName;
    ACE_CString m_defaultListText;
    ACE_CString m_modificationListText;
    bool m_hasModificationList = false;
    TransferSyntaxList m_transferSyntaxList;
};

}  // namespace Configuration
