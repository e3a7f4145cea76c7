// Configuration::SOPClass: a SOP class by name and UID (the DICOM client's viewable classes).
// Element "SOPClass"; keys in order, both strings, empty by default: "name", "uid" (lower case on
// purpose, unlike the other keys of the DICOM documents). Read and written.
// Plain value owned by its caller; not thread-safe.
#pragma once

#include <ace/SString.h>

#include "Configuration/ConfigurationClass.h"

namespace Configuration {

class CONFIGURATION_API SOPClass : public virtual Vesk::Serializable {
    CONFIGURATION_CLASS(SOPClass);

public:
    static constexpr const char WELL_KNOWN_NAME[] = "SOPClass";

    // The display name.
    const ACE_CString& getName() const { return m_name; }
    void setName(const ACE_CString& name) { m_name = name; }
    // The SOP class UID.
    const ACE_CString& getUid() const { return m_uid; }
    void setUid(const ACE_CString& uid) { m_uid = uid; }

private:
    ACE_CString m_name;
    ACE_CString m_uid;
};

}  // namespace Configuration
