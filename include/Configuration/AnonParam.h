// Configuration::AnonParam: one anonymisation parameter of the export module: the DICOM tag to
// replace, the replacement text and a description for the administrator. Element "AnonParam",
// keys "Tag", "Value", "Description", all strings, empty by default.
// Plain value owned by its caller; not thread-safe.
#pragma once

#include <ace/SString.h>

#include "Configuration/Export.h"
#include "Configuration/FieldAccess.h"
#include "Vesk/Serializable.h"

namespace Configuration {

class CONFIGURATION_API AnonParam : public virtual Vesk::Serializable {
public:
    AnonParam();
    AnonParam(const AnonParam& other);
    AnonParam& operator=(const AnonParam& other);
    ~AnonParam() override;

    // Fills the object from an "AnonParam" element; true when every key was present.
    bool readVesk(const Vesk::Element& element) override;
    // A new "AnonParam" element with the three keys in order.
    Quorvex::auto_ptr<Vesk::Element> writeVesk() const override;

    const ACE_CString& getTag() const { return m_tag; }
    void setTag(const ACE_CString& tag) { m_tag = tag; }
    const ACE_CString& getValue() const { return m_value; }
    void setValue(const ACE_CString& value) { m_value = value; }
    const ACE_CString& getDescription() const { return m_description; }
    void setDescription(const ACE_CString& description) { m_description = description; }

private:
    friend struct Fields::Access;
    template <class Self, class Io>
    static void fields(Self& self, Io& io);

    ACE_CString m_tag;
    ACE_CString m_value;
    ACE_CString m_description;
};

CONFIGURATION_API bool operator==(const AnonParam& a, const AnonParam& b);
inline bool operator!=(const AnonParam& a, const AnonParam& b) {
    return !(a == b);
}

}  // namespace Configuration
