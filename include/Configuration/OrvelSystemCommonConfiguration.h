// Configuration::OrvelSystemCommonConfiguration: the site-wide document "OrvelSystemCommon": the
// settings every server of a site shares: the site's name, the hosts of the naming, web,
// database, statistics and integration services, and a handful of timing and behaviour values.
//
// Keys of element "OrvelSystemCommon" in order, with defaults ("the address": the local IPv4
// address, or "127.0.0.1" with a critical log line when the machine has none): "SiteName"
// (empty), "CORBANamingService" (the address), "ConnectRServer" (the address), "HTTPServer" (the
// address), "CalyraAspServer" ("http://" + the address + "/Calyra/Quorvex/QuorvexDefault.asp"),
// "DuplicateStudyUIDCompareLevel" (u32, 1), "EnableGlobalStatisticsCollection" (flag, false),
// "StudyCompleteTimeout" (u32, 600), "PriorInterval" (u32, 96), "MasterDatabaseServer" (the
// address), "MasterDatabaseUser" ("sa"), "MasterDatabasePassword" (a two-character default),
// "MasterDatabase" ("Orvel"), "StatisticsHost" (empty), "UseWindowsAuthentication" (flag,
// false), "MaxTimeForCorbaCallsBeforeWarning" (i32, 0), "SLPServiceHost" (empty),
// "SLPDatabaseHost" (empty), "IntegrationEngineHost" (the address),
// "EnableInternalTransformationEngine" (flag, false), "IntegrationEngineHostPort" (u32 stored as
// a signed decimal, 8001), "ServerCommunicationDefinition" (its number, 1), "MergeLinkDaysToKeep"
// (u32 stored as a signed decimal, 90), "AllowAutomaticTakenStatus" (flag, true).
// Some getters are named otherwise than their keys (getDuplicateUIDCompareLevel,
// getMaxTimeForCorbaCallBeforeWarning, getMasterDB...). The master-database password is a
// credential: it is never logged.
// Plain value owned by its caller; not thread-safe.
#pragma once

#include <ace/SString.h>

#include "Configuration/ConfigurationClass.h"
#include "Configuration/TypedConfigDoc.h"

namespace Configuration {

class CONFIGURATION_API OrvelSystemCommonConfiguration
    : public TypedConfigDoc<OrvelSystemCommonConfiguration> {
    CONFIGURATION_CLASS(OrvelSystemCommonConfiguration);

public:
    // How the site's servers talk to each other.
    enum ServerCommunicationDefinition {
        CorbaCommunication = 0,           // object request broker only
        CorbaAndWebServiceCommunication,  // both, web services preferred (the default)
        WebServiceCommunication,          // web services only
    };

    // The site-wide document with every host at the local address.
    OrvelSystemCommonConfiguration();

    // The site's name.
    const ACE_CString& getSiteName() const { return m_siteName; }
    void setSiteName(const ACE_CString& value) { m_siteName = value; }
    // Host of the CORBA naming service.
    const ACE_CString& getCorbaNamingService() const { return m_corbaNamingService; }
    void setCorbaNamingService(const ACE_CString& value) { m_corbaNamingService = value; }
    // Host of the ConnectR server.
    const ACE_CString& getConnectRServer() const { return m_connectRServer; }
    void setConnectRServer(const ACE_CString& value) { m_connectRServer = value; }
    // Host of the web server.
    const ACE_CString& getHTTPServer() const { return m_httpServer; }
    void setHTTPServer(const ACE_CString& value) { m_httpServer = value; }
    // Address of the web application's start page.
    const ACE_CString& getCalyraAspServer() const { return m_calyraAspServer; }
    void setCalyraAspServer(const ACE_CString& value) { m_calyraAspServer = value; }
    // How strictly duplicate study UIDs are compared (key "DuplicateStudyUIDCompareLevel").
    unsigned int getDuplicateUIDCompareLevel() const { return m_duplicateUIDCompareLevel; }
    void setDuplicateUIDCompareLevel(unsigned int value) { m_duplicateUIDCompareLevel = value; }
    // Whether statistics are collected site-wide (key "EnableGlobalStatisticsCollection").
    bool getGlobalStatisticsCollection() const { return m_globalStatisticsCollection; }
    void setGlobalStatisticsCollection(bool value) { m_globalStatisticsCollection = value; }
    // Seconds without new images after which a study counts as complete.
    unsigned int getStudyCompleteTimeout() const { return m_studyCompleteTimeout; }
    void setStudyCompleteTimeout(unsigned int value) { m_studyCompleteTimeout = value; }
    // Interval, in hours, within which earlier studies count as priors.
    unsigned int getPriorInterval() const { return m_priorInterval; }
    void setPriorInterval(unsigned int value) { m_priorInterval = value; }
    // Host of the master database (key "MasterDatabaseServer").
    const ACE_CString& getMasterDBServer() const { return m_masterDBServer; }
    void setMasterDBServer(const ACE_CString& value) { m_masterDBServer = value; }
    // Account of the master database (key "MasterDatabaseUser").
    const ACE_CString& getMasterDBUser() const { return m_masterDBUser; }
    void setMasterDBUser(const ACE_CString& value) { m_masterDBUser = value; }
    // Password of the master database (key "MasterDatabasePassword"); a credential, never logged.
    const ACE_CString& getMasterDBPassword() const { return m_masterDBPassword; }
    void setMasterDBPassword(const ACE_CString& value) { m_masterDBPassword = value; }
    // Name of the master database (key "MasterDatabase").
    const ACE_CString& getMasterDBDatabase() const { return m_masterDBDatabase; }
    void setMasterDBDatabase(const ACE_CString& value) { m_masterDBDatabase = value; }
    // Host that collects statistics.
    const ACE_CString& getStatisticsHost() const { return m_statisticsHost; }
    void setStatisticsHost(const ACE_CString& value) { m_statisticsHost = value; }
    // Whether the database is reached with the Windows account instead of user and password.
    bool getUseWindowsAuthentication() const { return m_useWindowsAuthentication; }
    void setUseWindowsAuthentication(bool value) { m_useWindowsAuthentication = value; }
    // Milliseconds a CORBA call may take before a warning (key
    // "MaxTimeForCorbaCallsBeforeWarning").
    int getMaxTimeForCorbaCallBeforeWarning() const { return m_maxTimeForCorbaCallBeforeWarning; }
    void setMaxTimeForCorbaCallBeforeWarning(int value) {
        m_maxTimeForCorbaCallBeforeWarning = value;
    }
    // Host of the SLP service.
    const ACE_CString& getSLPServiceHost() const { return m_slpServiceHost; }
    void setSLPServiceHost(const ACE_CString& value) { m_slpServiceHost = value; }
    // Host of the SLP database.
    const ACE_CString& getSLPDatabaseHost() const { return m_slpDatabaseHost; }
    void setSLPDatabaseHost(const ACE_CString& value) { m_slpDatabaseHost = value; }
    // Host of the integration engine.
    const ACE_CString& getIntegrationEngineHost() const { return m_integrationEngineHost; }
    void setIntegrationEngineHost(const ACE_CString& value) { m_integrationEngineHost = value; }
    // Whether the internal transformation engine runs.
    bool getEnableInternalTransformationEngine() const {
        return m_enableInternalTransformationEngine;
    }
    void setEnableInternalTransformationEngine(bool value) {
        m_enableInternalTransformationEngine = value;
    }
    // Port of the integration engine.
    unsigned int getIntegrationEngineHostPort() const { return m_integrationEngineHostPort; }
    void setIntegrationEngineHostPort(unsigned int value) { m_integrationEngineHostPort = value; }
    // How the site's servers talk to each other.
    ServerCommunicationDefinition getServerCommunicationDefinition() const {
        return m_serverCommunicationDefinition;
    }
    void setServerCommunicationDefinition(ServerCommunicationDefinition value) {
        m_serverCommunicationDefinition = value;
    }
    // Days a merge link is kept.
    unsigned int getMergeLinkDaysToKeep() const { return m_mergeLinkDaysToKeep; }
    void setMergeLinkDaysToKeep(unsigned int value) { m_mergeLinkDaysToKeep = value; }
    // Whether a study may be marked taken automatically.
    bool getAllowAutomaticTakenStatus() const { return m_allowAutomaticTakenStatus; }
    void setAllowAutomaticTakenStatus(bool value) { m_allowAutomaticTakenStatus = value; }

private:
    ACE_CString m_siteName;
    ACE_CString m_corbaNamingService;
    ACE_CString m_connectRServer;
    ACE_CString m_httpServer;
    ACE_CString m_calyraAspServer;
    unsigned int m_duplicateUIDCompareLevel = 1;
    bool m_globalStatisticsCollection = false;
    unsigned int m_studyCompleteTimeout = 600;
    unsigned int m_priorInterval = 96;
    ACE_CString m_masterDBServer;
    ACE_CString m_masterDBUser = "sa";
    ACE_CString m_masterDBPassword;
    ACE_CString m_masterDBDatabase = "Orvel";
    ACE_CString m_statisticsHost;
    bool m_useWindowsAuthentication = false;
    int m_maxTimeForCorbaCallBeforeWarning = 0;
    ACE_CString m_slpServiceHost;
    ACE_CString m_slpDatabaseHost;
    ACE_CString m_integrationEngineHost;
    bool m_enableInternalTransformationEngine = false;
    unsigned int m_integrationEngineHostPort = 8001;
    ServerCommunicationDefinition m_serverCommunicationDefinition = CorbaAndWebServiceCommunication;
    unsigned int m_mergeLinkDaysToKeep = 90;
    bool m_allowAutomaticTakenStatus = true;
};

}  // namespace Configuration
