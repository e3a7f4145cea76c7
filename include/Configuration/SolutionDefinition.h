// Configuration::SolutionDefinition: the installed solution of the "ApplicationLocation" document.
//
// Element "Solution": "Name" (string, empty), "DataPath" (string, empty: the solution's data
// folder). A read failure logs the "Failed - Using partial defaults" form.
// Plain value owned by its caller; not thread-safe.
#pragma once

#include <ace/SString.h>

#include "Configuration/ConfigurationClass.h"

namespace Configuration {

class CONFIGURATION_API SolutionDefinition : public virtual Vesk::Serializable {
    CONFIGURATION_CLASS(SolutionDefinition);

public:
    // The installed solution's name.
    const ACE_CString& getName() const { return m_name; }
    void setName(const ACE_CString& value) { m_name = value; }
    // The solution's data folder.
    const ACE_CString& getDataPath() const { return m_dataPath; }
    void setDataPath(const ACE_CString& value) { m_dataPath = value; }

private:
    ACE_CString m_name;
    ACE_CString m_dataPath;
};

}  // namespace Configuration
