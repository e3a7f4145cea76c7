// Configuration::ApplicationDefinitions: the applications of the installed solution.
//
// Element "AppDefinitions" with one "ApplicationDefinition" child per application, in order.
// Reading replaces the list with every "ApplicationDefinition" child (other children are
// ignored), keeping entries whose read was incomplete (the read then reports false). A read
// failure logs the "Failed - Using partial defaults" form.
// Plain value owned by its caller; not thread-safe.
#pragma once

#include <vector>

#include "Configuration/ApplicationDefinition.h"
#include "Configuration/ConfigurationClass.h"

namespace Configuration {

class CONFIGURATION_API ApplicationDefinitions : public virtual Vesk::Serializable {
    CONFIGURATION_CLASS(ApplicationDefinitions);

public:
    // The applications, in order.
    const std::vector<ApplicationDefinition>& getApplicationDefinitions() const {
        return m_applications;
    }
    void setApplicationDefinitions(const std::vector<ApplicationDefinition>& value) {
        m_applications = value;
    }
    // The first application with that name (exact), or null.
    const ApplicationDefinition* find(const ACE_CString& name) const;

private:
    std::vector<ApplicationDefinition> m_applications;
};

}  // namespace Configuration
