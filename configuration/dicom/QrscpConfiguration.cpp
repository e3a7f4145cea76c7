#include "Configuration/QrscpConfiguration.h"

#include "Configuration/DocumentNames.h"
#include "ReadOrder.h"
#include "model/ClassDefinition.h"

namespace Configuration {

template <class Self, class Io>
void QrscpConfiguration::fields(Self& self, Io& io) {
    const auto allowed = Fields::listValue(self.m_allowedAeTitles);
    if constexpr (readingFields<Io>) {
        io("AllowAllAeTitles", self.m_allowAllAeTitles);
        io("NumberOfThreads", self.m_numberOfThreads);
        io("Port", self.m_port);
        io("QrscpAeTitle", self.m_qrscpAeTitle);
        io("MoveCompletionPollInterval", self.m_moveCompletionPollInterval);
        io("IncludeExceptionsInQueries", self.m_includeExceptions);
        io("MaxDatabaseResults", self.m_maxDatabaseResults);
        io("AllowedAeTitles", allowed);
        io("UseSSL", self.m_useSSL);
        io("CertificateFile", self.m_certificateFile);
        io("PrivateKeyFile", self.m_privateKeyFile);
    } else {
        io("AllowedAeTitles", allowed);
        io("AllowAllAeTitles", self.m_allowAllAeTitles);
        io("QrscpAeTitle", self.m_qrscpAeTitle);
        io("NumberOfThreads", self.m_numberOfThreads);
        io("Port", self.m_port);
        io("MoveCompletionPollInterval", self.m_moveCompletionPollInterval);
        io("IncludeExceptionsInQueries", self.m_includeExceptions);
        io("MaxDatabaseResults", self.m_maxDatabaseResults);
        io("UseSSL", self.m_useSSL);
        io("PrivateKeyFile", self.m_privateKeyFile);
        io("CertificateFile", self.m_certificateFile);
    }
}

CONFIGURATION_DEFINE(QrscpConfiguration, QrscpConfiguration::WELL_KNOWN_NAME,
                     Fields::FailureForm::Failed)

QrscpConfiguration::QrscpConfiguration()
    : TypedConfigDoc(ConfigDoc::getConfigurationRegistryPath() + DocumentNames::kQrscp, false) {}

}  // namespace Configuration
