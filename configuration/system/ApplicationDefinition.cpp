#include "Configuration/ApplicationDefinition.h"

#include "Configuration/ApplicationDefinitions.h"
#include "model/ClassDefinition.h"

namespace Configuration {

template <class Self, class Io>
void ApplicationDefinition::fields(Self& self, Io& io) {
    io("Name", self.m_name);
    io("Description", self.m_description);
    io("ProductID", self.m_productID);
    io("ExecutablePath", self.m_executablePath);
}

CONFIGURATION_DEFINE(ApplicationDefinition, "ApplicationDefinition",
                     Fields::FailureForm::PartialDefaults)

template <class Self, class Io>
void ApplicationDefinitions::fields(Self& self, Io& io) {
    io("ApplicationDefinition", self.m_applications);
}

CONFIGURATION_DEFINE(ApplicationDefinitions, "AppDefinitions", Fields::FailureForm::PartialDefaults)

const ApplicationDefinition* ApplicationDefinitions::find(const ACE_CString& name) const {
    for (const ApplicationDefinition& application : m_applications) {
        if (application.getName() == name) {
            return &application;
        }
    }
    return nullptr;
}

}  // namespace Configuration
