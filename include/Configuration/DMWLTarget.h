// Configuration::DMWLTarget: a DICOM modality worklist target: its AE title and its port (kept as
// text). Element "DMWLTarget"; keys in order, both strings, empty by default and required:
// "AeTitle", "Port".
// Plain value owned by its caller; not thread-safe.
#pragma once

#include <ace/SString.h>

#include "Configuration/ConfigurationClass.h"

namespace Configuration {

class CONFIGURATION_API DMWLTarget : public virtual Vesk::Serializable {
    CONFIGURATION_CLASS(DMWLTarget);

public:
    // The target's AE title.
    const ACE_CString& getAETitle() const { return m_aeTitle; }
    void setAETitle(const ACE_CString& title) { m_aeTitle = title; }
    // The target's port, as text.
    const ACE_CString& getPort() const { return m_port; }
    void setPort(const ACE_CString& port) { m_port = port; }

private:
    ACE_CString m_aeTitle;
    ACE_CString m_port;
};

}  // namespace Configuration
