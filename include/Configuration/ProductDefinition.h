// Configuration::ProductDefinition: one product of the installed solution.
//
// Element "ProductDefinition": "Name", "ID" (what applications refer to), "Description",
// "BinaryPath" (the name of the environment variable that holds the product's binary folder,
// bare or between percent signs), all strings, empty by default. A read failure logs the
// "Failed - Using partial defaults" form.
// Plain value owned by its caller; not thread-safe.
#pragma once

#include <ace/SString.h>

#include "Configuration/ConfigurationClass.h"

namespace Configuration {

class CONFIGURATION_API ProductDefinition : public virtual Vesk::Serializable {
    CONFIGURATION_CLASS(ProductDefinition);

public:
    // The product's name.
    const ACE_CString& getName() const { return m_name; }
    void setName(const ACE_CString& value) { m_name = value; }
    // The product's identifier, referred to by applications.
    const ACE_CString& getID() const { return m_id; }
    void setID(const ACE_CString& value) { m_id = value; }
    // Free text.
    const ACE_CString& getDescription() const { return m_description; }
    void setDescription(const ACE_CString& value) { m_description = value; }
    // The environment variable naming the product's binary folder ("QX_BIN" or "%QX_BIN%").
    const ACE_CString& getBinaryPath() const { return m_binaryPath; }
    void setBinaryPath(const ACE_CString& value) { m_binaryPath = value; }

private:
    ACE_CString m_name;
    ACE_CString m_id;
    ACE_CString m_description;
    ACE_CString m_binaryPath;
};

}  // namespace Configuration
