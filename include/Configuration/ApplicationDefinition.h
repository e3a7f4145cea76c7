// Configuration::ApplicationDefinition: one application (process) of the installed solution.
//
// Element "ApplicationDefinition": "Name" (the process name), "Description", "ProductID" (the ID
// of its product), "ExecutablePath", all strings, empty by default. A read failure logs the
// "Failed - Using partial defaults" form.
// Plain value owned by its caller; not thread-safe.
#pragma once

#include <ace/SString.h>

#include "Configuration/ConfigurationClass.h"

namespace Configuration {

class CONFIGURATION_API ApplicationDefinition : public virtual Vesk::Serializable {
    CONFIGURATION_CLASS(ApplicationDefinition);

public:
    // The process (application) name.
    const ACE_CString& getName() const { return m_name; }
    void setName(const ACE_CString& value) { m_name = value; }
    // Free text.
    const ACE_CString& getDescription() const { return m_description; }
    void setDescription(const ACE_CString& value) { m_description = value; }
    // The ID of the product the application belongs to.
    const ACE_CString& getProductID() const { return m_productID; }
    void setProductID(const ACE_CString& value) { m_productID = value; }
    // The application's executable.
    const ACE_CString& getExecutablePath() const { return m_executablePath; }
    void setExecutablePath(const ACE_CString& value) { m_executablePath = value; }

private:
    ACE_CString m_name;
    ACE_CString m_description;
    ACE_CString m_productID;
    ACE_CString m_executablePath;
};

}  // namespace Configuration
