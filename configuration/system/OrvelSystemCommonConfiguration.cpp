#include "Configuration/OrvelSystemCommonConfiguration.h"

#include "Configuration/DocumentNames.h"
#include "Quorvex/Host.h"
#include "Quorvex/Log.h"
#include "model/ClassDefinition.h"

namespace Configuration {
namespace {

const char kFallbackAddress[] = "127.0.0.1";
const char kDefaultMasterDatabasePassword[] = "qx";
const char kAspPage[] = "Calyra/Quorvex/QuorvexDefault.asp";

}  // namespace

template <class Self, class Io>
void OrvelSystemCommonConfiguration::fields(Self& self, Io& io) {
    io("SiteName", self.m_siteName);
    io("CORBANamingService", self.m_corbaNamingService);
    io("ConnectRServer", self.m_connectRServer);
    io("HTTPServer", self.m_httpServer);
    io("CalyraAspServer", self.m_calyraAspServer);
    io("DuplicateStudyUIDCompareLevel", self.m_duplicateUIDCompareLevel);
    io("EnableGlobalStatisticsCollection", self.m_globalStatisticsCollection);
    io("StudyCompleteTimeout", self.m_studyCompleteTimeout);
    io("PriorInterval", self.m_priorInterval);
    io("MasterDatabaseServer", self.m_masterDBServer);
    io("MasterDatabaseUser", self.m_masterDBUser);
    io("MasterDatabasePassword", self.m_masterDBPassword);
    io("MasterDatabase", self.m_masterDBDatabase);
    io("StatisticsHost", self.m_statisticsHost);
    io("UseWindowsAuthentication", self.m_useWindowsAuthentication);
    io("MaxTimeForCorbaCallsBeforeWarning", self.m_maxTimeForCorbaCallBeforeWarning);
    io("SLPServiceHost", self.m_slpServiceHost);
    io("SLPDatabaseHost", self.m_slpDatabaseHost);
    io("IntegrationEngineHost", self.m_integrationEngineHost);
    io("EnableInternalTransformationEngine", self.m_enableInternalTransformationEngine);
    io("IntegrationEngineHostPort", Fields::asSigned(self.m_integrationEngineHostPort));
    io("ServerCommunicationDefinition", self.m_serverCommunicationDefinition);
    io("MergeLinkDaysToKeep", Fields::asSigned(self.m_mergeLinkDaysToKeep));
    io("AllowAutomaticTakenStatus", self.m_allowAutomaticTakenStatus);
}

CONFIGURATION_DEFINE(OrvelSystemCommonConfiguration, "OrvelSystemCommon",
                     Fields::FailureForm::Failed)

OrvelSystemCommonConfiguration::OrvelSystemCommonConfiguration()
    : TypedConfigDoc(ConfigDoc::getConfigurationRegistryPath() + DocumentNames::kOrvelSystemCommon,
                     false),
      m_masterDBPassword(kDefaultMasterDatabasePassword) {
    if (Quorvex::GetLocalIPAddress(m_corbaNamingService) != 0) {
        QUORVEX_LOG(
            LM_CRITICAL,
            "OrvelSystemCommonConfiguration::OrvelSystemCommonConfiguration: Unable to find "
            "a local IP address, using default! Check configuration.\n");
        m_corbaNamingService = kFallbackAddress;
    }
    m_httpServer = m_corbaNamingService;
    m_calyraAspServer = ACE_CString("http://") + m_corbaNamingService + "/" + kAspPage;
    m_connectRServer = m_corbaNamingService;
    m_masterDBServer = m_corbaNamingService;
    m_integrationEngineHost = m_corbaNamingService;
}

}  // namespace Configuration
