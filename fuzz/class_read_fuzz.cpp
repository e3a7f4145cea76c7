// Configuration classes fed arbitrary XML: every class (and the convention's test class, which has
// a field of every form) reads whatever tree the XML reader accepts. What an object writes must
// read back complete, and equal to it when its own read was complete (a read cut short by a
// failure leaves derived data unresolved). A read-only class reads the tree twice (the second
// read appends) and refuses to write. readVesk never throws; any mismatch aborts.
#include "ClassFuzz.h"
#include "Configuration/AnonParam.h"
#include "Configuration/ApplicationLocationConfiguration.h"
#include "Configuration/AutoExportConfiguration.h"
#include "Configuration/DMWLTarget.h"
#include "Configuration/DicomClientConfiguration.h"
#include "Configuration/KelArchiveConfiguration.h"
#include "Configuration/KelExportConfigurationAdapter.h"
#include "Configuration/KelExportLocalConfiguration.h"
#include "Configuration/KelExportRemoteConfigurations.h"
#include "Configuration/KelExportWebService.h"
#include "Configuration/KelQueryConfiguration.h"
#include "Configuration/LegacyMirrorStackMapping.h"
#include "Configuration/LocationConfiguration.h"
#include "Configuration/LocationMigrationChain.h"
#include "Configuration/MSMQConfiguration.h"
#include "Configuration/OrvelSystemCommonConfiguration.h"
#include "Configuration/OrvelSystemConfiguration.h"
#include "Configuration/ProcessesAndServicesConfiguration.h"
#include "Configuration/QrscpConfiguration.h"
#include "Configuration/RulesConfiguration.h"
#include "Configuration/SOPServiceConfiguration.h"
#include "Configuration/SSCPConfiguration.h"
#include "Configuration/ServerInfo.h"
#include "Configuration/StorageCommitConfiguration.h"
#include "Configuration/StrategyConfiguration.h"
#include "ConventionSample.h"

using namespace Configuration;

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    Vesk::Element tree;
    if (!ClassFuzz::parse(data, size, tree)) {
        return 0;
    }
    ClassFuzz::readWriteReadAll<
        AnonParam, RestartConfiguration__, VariationPointConfiguration__, StackConfiguration__,
        OrvelSystemConfiguration, SOPClass, DMWLTarget, DicomClientConfiguration,
        RemoteSCPConfiguration, StorageCommitScpConfiguration, StorageCommitRemoteSCPConfiguration,
        StorageCommitConfiguration, ServerDicomSource, SSCPConfiguration, QrscpConfiguration,
        KelExportRemoteScp, KelExportRemoteConfigurations, KelExportDatabaseConfiguration,
        KelExportGlobalConfiguration, KelExportConfigurationAdapter, KelExportLocalConfiguration,
        KelExportWebService, KelQueryRemoteSCPConfiguration, PrefetchConfiguration__,
        KelQueryConfiguration, MSMQConfiguration, LegacyMirrorStackMapping, Strategy, StrategyStack,
        StrategyConfiguration, MigrationRule, RegistrationRule, LocationMigrationFilter,
        LocationMigrationChain, RulesConfiguration, TivoliServerInfo, TivoliNodeInfo,
        ArchiveLocalNodeInfo, ArchiveNodeStackInfo, KelArchiveConfiguration, LocationProfile,
        LocationConfiguration, ProcessesAndServicesConfiguration::Service,
        ProcessesAndServicesConfiguration::Process, ProcessesAndServicesConfiguration,
        OrvelSystemCommonConfiguration, SolutionDefinition, ProductDefinitions,
        ApplicationDefinitions, ApplicationLocationConfiguration, ServerInfo, Testing::Convention>(
        tree);
    ClassFuzz::readTwiceRefuseWriteAll<
        SupportedTransferSyntax, SupportedTransferSyntaxList, TemplateTransferSyntaxList,
        TemplateTransferSyntaxLists, SOPService, SOPServiceList, FilterTag, FilterTagList,
        SOPServiceConfiguration, Criterion, Destination, AutoExportRule, AutoExportConfiguration>(
        tree);
    return 0;
}
