// Configuration::Destination: one target of an automatic export rule, named after an export
// destination.
//
// Read from an element of any key; keys, both strings, empty by default and required:
// "DestinationName", "IsStorageCommitRequired" (kept as configured, not converted to a flag).
// Read-only: writeVesk throws std::exception with the criterion's text
// ("Criterion::writeVesk - Class cannot be serialized.").
// Plain value owned by its caller; not thread-safe.
#pragma once

#include <ace/SString.h>

#include "Configuration/ConfigurationClass.h"

namespace Configuration {

class CONFIGURATION_API Destination : public virtual Vesk::Serializable {
    CONFIGURATION_CLASS(Destination);

public:
    // The export destination's name (by value; note the capital initial).
    ACE_CString GetDestinationName() const { return m_destinationName; }
    // The export destination's name, without a copy.
    const ACE_CString& getDestinationName() const { return m_destinationName; }
    void setDestinationName(const ACE_CString& name) { m_destinationName = name; }
    // Whether storage commitment is required, as configured.
    const ACE_CString& getIsStorageCommitRequired() const { return m_storageCommitRequired; }
    void setIsStorageCommitRequired(const ACE_CString& text) { m_storageCommitRequired = text; }

private:
    friend class AutoExportRule;  // compares names without copying them

    ACE_CString m_destinationName;
    ACE_CString m_storageCommitRequired;
};

}  // namespace Configuration
