// Configuration classes fed arbitrary XML: every class (and the convention's test class, which has
// a field of every form) reads whatever tree the XML reader accepts. What an object writes must
// read back complete, and equal to it when its own read was complete (a read cut short by a
// failure leaves derived data unresolved). A read-only class reads the tree twice (the second
// read appends) and refuses to write. readVesk never throws; any mismatch aborts.
#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <exception>

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
#include "Vesk/XmlUtils.h"

namespace {

template <class T>
void readWriteRead(const Vesk::Element& tree) {
    T first;
    const bool complete = first.readVesk(tree);
    T second;
    if (!second.readVesk(*first.writeVesk()) || (complete && !(first == second))) {
        std::abort();
    }
}

template <class T>
void readTwiceRefuseWrite(const Vesk::Element& tree) {
    T object;
    object.readVesk(tree);
    object.readVesk(tree);
    const T copy = object;
    if (!(copy == object)) {
        std::abort();
    }
    try {
        object.writeVesk();
    } catch (const std::exception&) {
        return;
    }
    std::abort();
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    Vesk::Element tree;
    try {
        Vesk::XmlUtils::parse(reinterpret_cast<const char*>(data), size, tree);
    } catch (const std::exception&) {
        return 0;  // refused cleanly
    }
    readWriteRead<Configuration::AnonParam>(tree);
    readWriteRead<Configuration::RestartConfiguration__>(tree);
    readWriteRead<Configuration::VariationPointConfiguration__>(tree);
    readWriteRead<Configuration::StackConfiguration__>(tree);
    readWriteRead<Configuration::OrvelSystemConfiguration>(tree);
    readWriteRead<Configuration::SOPClass>(tree);
    readWriteRead<Configuration::DMWLTarget>(tree);
    readWriteRead<Configuration::DicomClientConfiguration>(tree);
    readTwiceRefuseWrite<Configuration::SupportedTransferSyntax>(tree);
    readTwiceRefuseWrite<Configuration::SupportedTransferSyntaxList>(tree);
    readTwiceRefuseWrite<Configuration::TemplateTransferSyntaxList>(tree);
    readTwiceRefuseWrite<Configuration::TemplateTransferSyntaxLists>(tree);
    readTwiceRefuseWrite<Configuration::SOPService>(tree);
    readTwiceRefuseWrite<Configuration::SOPServiceList>(tree);
    readTwiceRefuseWrite<Configuration::FilterTag>(tree);
    readTwiceRefuseWrite<Configuration::FilterTagList>(tree);
    readTwiceRefuseWrite<Configuration::SOPServiceConfiguration>(tree);
    readWriteRead<Configuration::RemoteSCPConfiguration>(tree);
    readWriteRead<Configuration::StorageCommitScpConfiguration>(tree);
    readWriteRead<Configuration::StorageCommitRemoteSCPConfiguration>(tree);
    readWriteRead<Configuration::StorageCommitConfiguration>(tree);
    readWriteRead<Configuration::ServerDicomSource>(tree);
    readWriteRead<Configuration::SSCPConfiguration>(tree);
    readWriteRead<Configuration::QrscpConfiguration>(tree);
    readWriteRead<Configuration::KelExportRemoteScp>(tree);
    readWriteRead<Configuration::KelExportRemoteConfigurations>(tree);
    readWriteRead<Configuration::KelExportDatabaseConfiguration>(tree);
    readWriteRead<Configuration::KelExportGlobalConfiguration>(tree);
    readWriteRead<Configuration::KelExportConfigurationAdapter>(tree);
    readWriteRead<Configuration::KelExportLocalConfiguration>(tree);
    readWriteRead<Configuration::KelExportWebService>(tree);
    readTwiceRefuseWrite<Configuration::Criterion>(tree);
    readTwiceRefuseWrite<Configuration::Destination>(tree);
    readTwiceRefuseWrite<Configuration::AutoExportRule>(tree);
    readTwiceRefuseWrite<Configuration::AutoExportConfiguration>(tree);
    readWriteRead<Configuration::KelQueryRemoteSCPConfiguration>(tree);
    readWriteRead<Configuration::PrefetchConfiguration__>(tree);
    readWriteRead<Configuration::KelQueryConfiguration>(tree);
    readWriteRead<Configuration::MSMQConfiguration>(tree);
    readWriteRead<Configuration::LegacyMirrorStackMapping>(tree);
    readWriteRead<Configuration::Strategy>(tree);
    readWriteRead<Configuration::StrategyStack>(tree);
    readWriteRead<Configuration::StrategyConfiguration>(tree);
    readWriteRead<Configuration::MigrationRule>(tree);
    readWriteRead<Configuration::RegistrationRule>(tree);
    readWriteRead<Configuration::LocationMigrationFilter>(tree);
    readWriteRead<Configuration::LocationMigrationChain>(tree);
    readWriteRead<Configuration::RulesConfiguration>(tree);
    readWriteRead<Configuration::TivoliServerInfo>(tree);
    readWriteRead<Configuration::TivoliNodeInfo>(tree);
    readWriteRead<Configuration::ArchiveLocalNodeInfo>(tree);
    readWriteRead<Configuration::ArchiveNodeStackInfo>(tree);
    readWriteRead<Configuration::KelArchiveConfiguration>(tree);
    readWriteRead<Configuration::LocationProfile>(tree);
    readWriteRead<Configuration::LocationConfiguration>(tree);
    readWriteRead<Configuration::ProcessesAndServicesConfiguration::Service>(tree);
    readWriteRead<Configuration::ProcessesAndServicesConfiguration::Process>(tree);
    readWriteRead<Configuration::ProcessesAndServicesConfiguration>(tree);
    readWriteRead<Configuration::OrvelSystemCommonConfiguration>(tree);
    readWriteRead<Configuration::SolutionDefinition>(tree);
    readWriteRead<Configuration::ProductDefinitions>(tree);
    readWriteRead<Configuration::ApplicationDefinitions>(tree);
    readWriteRead<Configuration::ApplicationLocationConfiguration>(tree);
    readWriteRead<Configuration::ServerInfo>(tree);
    readWriteRead<Configuration::Testing::Convention>(tree);
    return 0;
}
