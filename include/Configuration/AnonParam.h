// Configuration::AnonParam: one anonymisation parameter of the export module: the DICOM tag to
// replace, the replacement text and a description for the administrator. Element "AnonParam",
// keys "Tag", "Value", "Description", all strings, empty by default.
// Plain value owned by its caller; not thread-safe.
#pragma once

#include <ace/SString.h>

#include "Configuration/ConfigurationClass.h"

namespace Configuration {

class CONFIGURATION_API AnonParam : public virtual Vesk::Serializable {
    CONFIGURATION_CLASS(AnonParam);

public:
    const ACE_CString& getTag() const { return m_tag; }
    void setTag(const ACE_CString& tag) { m_tag = tag; }
    const ACE_CString& getValue() const { return m_value; }
    void setValue(const ACE_CString& value) { m_value = value; }
    const ACE_CString& getDescription() const { return m_description; }
    void setDescription(const ACE_CString& description) { m_description = description; }

private:
    ACE_CString m_tag;
    ACE_CString m_value;
    ACE_CString m_description;
};

}  // namespace Configuration
