// Configuration::Criterion: one condition of an automatic export rule: a name and a value, kept as
// configured (the export server decides how they match a study).
//
// Read from an element of any key: the key is the name, the element's text the value (empty when
// it has no text). Reading always succeeds. Read-only: writeVesk throws std::exception
// ("Criterion::writeVesk - Class cannot be serialized.").
// Plain value owned by its caller; not thread-safe.
#pragma once

#include <ace/SString.h>

#include "Configuration/ConfigurationClass.h"

namespace Configuration {

class CONFIGURATION_API Criterion : public virtual Vesk::Serializable {
    CONFIGURATION_CLASS(Criterion);

public:
    // The criterion's name (its element's key).
    const ACE_CString& getName() const { return m_name; }
    void setName(const ACE_CString& name) { m_name = name; }
    // The value to match.
    const ACE_CString& getValue() const { return m_value; }
    void setValue(const ACE_CString& value) { m_value = value; }

private:
    ACE_CString m_name;
    ACE_CString m_value;
};

}  // namespace Configuration
