// Configuration::DocumentNames: the name of every stored configuration document, as stored
// (case included: "Heartbeat" and "Msmq" differ from their class names by design). A document's
// path is ConfigDoc::getConfigurationRegistryPath() followed by its name. Constants; thread-safe.
#pragma once

namespace Configuration {
namespace DocumentNames {

constexpr const char kApplicationLocation[] =
    "ApplicationLocation";                          // ApplicationLocationConfiguration
constexpr const char kAutoExport[] = "AutoExport";  // AutoExportConfiguration
constexpr const char kClinicalIntegrationCommon[] =
    "ClinicalIntegrationCommon";                      // ClinicalIntegrationCommonConfiguration
constexpr const char kDicomClient[] = "DicomClient";  // DicomClientConfiguration
constexpr const char kEmail[] = "Email";              // EmailConfiguration
constexpr const char kFederationConfiguration[] =
    "FederationConfiguration";                      // FederationConfiguration
constexpr const char kHeartbeat[] = "Heartbeat";    // HeartBeatConfiguration
constexpr const char kKelArchive[] = "KelArchive";  // KelArchiveConfiguration
constexpr const char kKelExport[] =
    "KelExport";  // KelExportConfigurationAdapter and KelExportGlobalConfiguration
constexpr const char kDatabaseConfiguration[] =
    "DatabaseConfiguration";  // the export module's database section
constexpr const char kKelExportLocal[] =
    "KelExportLocal";  // KelExportLocalConfiguration (per machine)
constexpr const char kKelExportRemoteConfigurations[] =
    "KelExportRemoteConfigurations";  // KelExportRemoteConfigurations
constexpr const char kKelExportWebServiceLocal[] =
    "KelExportWebServiceLocal";                                   // KelExportWebService
constexpr const char kKelQuery[] = "KelQuery";                    // KelQueryConfiguration
constexpr const char kOrvelClient[] = "OrvelClient";              // OrvelClientConfiguration
constexpr const char kOrvelSystemCommon[] = "OrvelSystemCommon";  // OrvelSystemCommonConfiguration
constexpr const char kOrvelSystem[] = "OrvelSystem";  // OrvelSystemConfiguration (per machine)
constexpr const char kLocation[] = "Location";        // LocationConfiguration
constexpr const char kMsmqCommon[] = "MsmqCommon";    // MSMQCommonConfiguration
constexpr const char kMsmq[] = "Msmq";                // MSMQConfiguration (per machine)
constexpr const char kNTEventLogMonitor[] = "NTEventLogMonitor";  // NTEventLogMonitorConfiguration
constexpr const char kPerformanceTiming[] = "PerformanceTiming";  // PerformanceTimingConfiguration
constexpr const char kProcessesAndServices[] =
    "ProcessesAndServices";               // ProcessesAndServicesConfiguration (per machine)
constexpr const char kQrscp[] = "Qrscp";  // QrscpConfiguration
constexpr const char kRoutingRules[] = "RoutingRules";        // RulesConfiguration
constexpr const char kSecurity[] = "Security";                // SecurityConfiguration
constexpr const char kServiceRegistry[] = "ServiceRegistry";  // ServiceRegistry
constexpr const char kSOPServiceConfiguration[] =
    "SOPServiceConfiguration";                            // SOPServiceConfiguration
constexpr const char kDicomScp[] = "DicomScp";            // SSCPConfiguration
constexpr const char kStorageCommit[] = "StorageCommit";  // StorageCommitConfiguration
constexpr const char kStrategyConfiguration[] = "StrategyConfiguration";  // StrategyConfiguration
constexpr const char kStudyAuthorityISAPIConfiguration[] =
    "StudyAuthorityISAPIConfiguration";                         // StudyAuthorityISAPIConfiguration
constexpr const char kVNAConfiguration[] = "VNAConfiguration";  // VNAConfiguration

}  // namespace DocumentNames
}  // namespace Configuration
