// Configuration::SupportedTransferSyntax: one row of the SOP service document's master table of
// transfer syntaxes: the number templates and services use to name it, its UID, a display name
// and a description. Element "SupportedTx"; keys in order, with defaults: "TxNr" (int, 0),
// "TxUID", "TxName" (strings, empty; all three required), "TxDescription" (string, empty;
// optional: absent leaves it as it was). Read-only: writeVesk throws std::exception
// ("SupportedTransferSyntax::writeVesk - Not supported.").
// Plain value owned by its caller; not thread-safe.
#pragma once

#include <ace/SString.h>

#include "Configuration/ConfigurationClass.h"

namespace Configuration {

class CONFIGURATION_API SupportedTransferSyntax : public virtual Vesk::Serializable {
    CONFIGURATION_CLASS(SupportedTransferSyntax);

public:
    static constexpr const char WELL_KNOWN_NAME[] = "SupportedTx";

    // The number by which templates and services name this syntax.
    int getNr() const { return m_nr; }
    void setNr(int nr) { m_nr = nr; }
    // The transfer syntax UID.
    const ACE_CString& getUID() const { return m_uid; }
    void setUID(const ACE_CString& uid) { m_uid = uid; }
    // The display name.
    const ACE_CString& getName() const { return m_name; }
    void setName(const ACE_CString& name) { m_name = name; }
    // Free text.
    const ACE_CString& getDescription() const { return m_description; }
    void setDescription(const ACE_CString& description) { m_description = description; }

private:
    int m_nr = 0;
    ACE_CString m_uid;
    ACE_CString m_name;
    ACE_CString m_description;
};

}  // namespace Configuration
