// Configuration::FilterTag: a DICOM tag that filters apply to, kept as configured (nothing here
// parses the tag). Element "FilterTag"; keys in order, with defaults: "Tag" (string, empty;
// required), "TagName", "SOPClassUID", "SOPClassName" (strings, empty; optional: absent leaves
// them), "Additional" (flag, false; absent: false). Read-only: writeVesk throws std::exception
// ("FilterTag::writeVesk - Not supported.").
// Plain value owned by its caller; not thread-safe.
#pragma once

#include <ace/SString.h>

#include "Configuration/ConfigurationClass.h"

namespace Configuration {

class CONFIGURATION_API FilterTag : public virtual Vesk::Serializable {
    CONFIGURATION_CLASS(FilterTag);

public:
    static constexpr const char WELL_KNOWN_NAME[] = "FilterTag";

    // The tag as configured (for example "0008,0060").
    const ACE_CString& getTag() const { return m_tag; }
    void setTag(const ACE_CString& tag) { m_tag = tag; }
    // The tag's name.
    const ACE_CString& getTagName() const { return m_tagName; }
    void setTagName(const ACE_CString& name) { m_tagName = name; }
    // The SOP class the filter belongs to, by UID.
    const ACE_CString& getSOPClassUID() const { return m_sopClassUID; }
    void setSOPClassUID(const ACE_CString& uid) { m_sopClassUID = uid; }
    // The SOP class the filter belongs to, by name.
    const ACE_CString& getSOPClassName() const { return m_sopClassName; }
    void setSOPClassName(const ACE_CString& name) { m_sopClassName = name; }
    // Whether the tag belongs to the "additional" set.
    bool getAdditional() const { return m_additional; }
    void setAdditional(bool additional) { m_additional = additional; }

private:
    ACE_CString m_tag;
    ACE_CString m_tagName;
    ACE_CString m_sopClassUID;
    ACE_CString m_sopClassName;
    bool m_additional = false;
};

}  // namespace Configuration
