#include "Configuration/ApplicationLocationConfiguration.h"

#include "Configuration/DocumentNames.h"
#include "Quorvex/Host.h"
#include "Quorvex/Log.h"
#include "model/ClassDefinition.h"

namespace Configuration {
namespace {

void logNoBinaryPath(const ACE_CString& processName) {
    QUORVEX_LOG(LM_CRITICAL,
                "ApplicationLocationConfiguration::getProductBinPath: Could not find binary path "
                "for process %s\n",
                processName.c_str());
}

// The variable a binary path names: the text itself, or without its first and last character
// when it begins with a percent sign (the last is taken to be the closing one).
ACE_CString variableName(const ACE_CString& binaryPath) {
    if (binaryPath.length() > 0 && binaryPath[0] == '%') {
        return binaryPath.length() < 2 ? ACE_CString()
                                       : binaryPath.substring(1, binaryPath.length() - 2);
    }
    return binaryPath;
}

}  // namespace

template <class Self, class Io>
void ApplicationLocationConfiguration::fields(Self& self, Io& io) {
    io("Solution", self.m_solution);
    io("ProductDefinitions", self.m_products);
    io("AppDefinitions", self.m_applications);
}

CONFIGURATION_DEFINE(ApplicationLocationConfiguration, "ApplicationLocation",
                     Fields::FailureForm::Failed)

ApplicationLocationConfiguration::ApplicationLocationConfiguration()
    : TypedConfigDoc(
          ConfigDoc::getConfigurationRegistryPath() + DocumentNames::kApplicationLocation, false) {}

ACE_CString ApplicationLocationConfiguration::getProductBinPath(
    const ACE_CString& processName) const {
    const ApplicationDefinition* application = m_applications.find(processName);
    if (application == nullptr || application->getProductID().length() == 0) {
        logNoBinaryPath(processName);
        return ACE_CString();
    }
    const ProductDefinition* product = m_products.find(application->getProductID());
    if (product == nullptr || product->getBinaryPath().length() == 0) {
        logNoBinaryPath(processName);
        return ACE_CString();
    }
    const ACE_CString name = variableName(product->getBinaryPath());
    ACE_CString value;
    // An empty value is a look-up that copied nothing: not set, as is one that does not fit.
    const bool found = name.length() > 0 && Quorvex::GetEnvironmentVariable(name.c_str(), value);
    if (!found || value.length() == 0 || value.length() >= kEnvironmentBufferSize) {
        QUORVEX_LOG(LM_CRITICAL,
                    "ApplicationLocationConfiguration::getProductBinPath: Environment Variable %s "
                    "is not set. Please set this to its relevant solution bin folder:\n",
                    name.c_str());
        return ACE_CString();
    }
    return value;
}

}  // namespace Configuration
