// Configuration::LegacyMirrorStackMapping: a mirror machine that was known under an old mirror
// stack GUID, and the GUID it has now. Element "LegacyMirrorStackMapping"; keys in order, all
// strings with default "": "MirrorMachineName", "OldMirrorStackGuid", "NewMirrorStackGuid".
// Plain value owned by its caller; not thread-safe.
#pragma once

#include <ace/SString.h>

#include "Configuration/ConfigurationClass.h"

namespace Configuration {

class CONFIGURATION_API LegacyMirrorStackMapping : public virtual Vesk::Serializable {
    CONFIGURATION_CLASS(LegacyMirrorStackMapping);

public:
    static constexpr const char WELL_KNOWN_NAME[] = "LegacyMirrorStackMapping";

    LegacyMirrorStackMapping() = default;
    // A mapping of machine from oldGuid to newGuid.
    LegacyMirrorStackMapping(const ACE_CString& machine, const ACE_CString& oldGuid,
                             const ACE_CString& newGuid)
        : m_machine(machine), m_oldGuid(oldGuid), m_newGuid(newGuid) {}

    // The mirror machine's name.
    const ACE_CString& getMirrorMachineName() const { return m_machine; }
    void setMirrorMachineName(const ACE_CString& name) { m_machine = name; }
    // The GUID the machine's mirror stack had.
    const ACE_CString& getOldMirrorStackGuid() const { return m_oldGuid; }
    void setOldMirrorStackGuid(const ACE_CString& guid) { m_oldGuid = guid; }
    // The GUID it has now.
    const ACE_CString& getNewMirrorStackGuid() const { return m_newGuid; }
    void setNewMirrorStackGuid(const ACE_CString& guid) { m_newGuid = guid; }

private:
    ACE_CString m_machine;
    ACE_CString m_oldGuid;
    ACE_CString m_newGuid;
};

}  // namespace Configuration
