// Remote nodes, storage commitment and the export module's documents: where a node's identity
// sits, which keys count towards a destination's read, which destinations a list keeps, the
// adapter's view of the global document, and hostile documents.
#include <gtest/gtest.h>

#include "Configuration/KelExportConfigurationAdapter.h"
#include "Configuration/KelExportGlobalConfiguration.h"
#include "Configuration/KelExportLocalConfiguration.h"
#include "Configuration/KelExportRemoteConfigurations.h"
#include "Configuration/KelExportWebService.h"
#include "Configuration/StorageCommitConfiguration.h"
#include "DicomTestSupport.h"
#include "testing/LogCapture.h"

namespace Configuration {
namespace {

using Testing::sampleDocument;
using Testing::withChild;
using Testing::withoutChild;

TEST(RemoteNodes, AMissingPortKeepsItsTextDefault) {
    RemoteSCPConfiguration node;
    EXPECT_FALSE(node.readVesk(withoutChild(sampleDocument("RemoteSCPConfiguration.xml"), "Port")));
    EXPECT_EQ("104", node.getPort());
    EXPECT_EQ("LTA_ARCHIVE", node.getAETitle());
}

// The identity is read from the child "RemoteScp" only, never from the node's own keys.
TEST(RemoteNodes, IdentityKeysBesideTheChildAreNotRead) {
    Vesk::Element tree = sampleDocument("StorageCommitScpConfiguration.xml");
    Testing::text(tree.getMultiElement(), "HostName", "elsewhere.example.org");
    StorageCommitScpConfiguration node;
    EXPECT_TRUE(node.readVesk(tree));
    EXPECT_EQ("lta01.radiology.example.org", node.getHostName());
    EXPECT_EQ(300, node.getResponseTimeOut());
}

TEST(RemoteNodes, DefaultsOfTheCommitmentNodes) {
    EXPECT_EQ(60, StorageCommitScpConfiguration().getResponseTimeOut());
    const StorageCommitRemoteSCPConfiguration requester;
    EXPECT_EQ(30u, requester.getMaxMinutesToWaitForImagesToArrive());
    EXPECT_FALSE(requester.getRespondInSameAssociation());
    EXPECT_EQ("104", requester.getPort());
}

TEST(ExportDestination, ForwardingKeysDoNotCountAndTakeTheirDefaults) {
    Vesk::Element tree = withoutChild(
        withoutChild(sampleDocument("KelExportRemoteScp.xml"), "ForwardImages"), "ForwardMPPS");
    KelExportRemoteScp destination;
    destination.setForwardImages(false);
    destination.setForwardMPPS(true);
    EXPECT_TRUE(destination.readVesk(tree));
    EXPECT_TRUE(destination.getForwardImages());
    EXPECT_FALSE(destination.getForwardMPPS());
}

// Without "RemoteScp" the read ends, logged, after the destination's own keys: the storage
// commitment settings, read after it, keep theirs.
TEST(ExportDestination, WithoutItsIdentityTheReadEndsAfterItsOwnKeys) {
    Quorvex::Testing::LogCapture log;
    KelExportRemoteScp destination;
    EXPECT_FALSE(destination.readVesk(withoutChild(sampleDocument("KelExportRemoteScp.xml"),
                                                   RemoteSCPConfiguration::WELL_KNOWN_NAME)));
    EXPECT_EQ(4, destination.getMaximumNumberOfConcurrentRequests());
    EXPECT_FALSE(destination.getForwardImages());
    EXPECT_EQ("", destination.getAETitle());
    EXPECT_EQ("", destination.getStorageCommitScpConfiguration().getAETitle());
    EXPECT_TRUE(log.onlyStartsWith("KelExportRemoteScp::readVesk: Failed. Standard Exception: "));
}

TEST(ExportDestination, CommitmentSettingsAreReadOnlyWhenPresent) {
    KelExportRemoteScp destination;
    StorageCommitScpConfiguration settings;
    settings.setAETitle("KEPT");
    destination.setStorageCommitScpConfiguration(settings);
    EXPECT_TRUE(destination.readVesk(withoutChild(sampleDocument("KelExportRemoteScp.xml"),
                                                  StorageCommitScpConfiguration::WELL_KNOWN_NAME)));
    EXPECT_EQ("KEPT", destination.getStorageCommitScpConfiguration().getAETitle());
    EXPECT_TRUE(destination.readVesk(sampleDocument("KelExportRemoteScp.xml")));
    EXPECT_EQ("LTA_COMMIT", destination.getStorageCommitScpConfiguration().getAETitle());
}

// The destinations sample with a second and third destination, the second without
// "HostAffinity".
Vesk::Element threeDestinations() {
    Vesk::Element tree = sampleDocument("KelExportRemoteConfigurations.xml");
    Vesk::MultiElementValue& list =
        tree.getMultiElement().getElement("KelExportRemoteSCPs").getMultiElement();
    const Vesk::Element first = *list.begin();
    list.addElement(withoutChild(first, "HostAffinity"));
    Vesk::Element third = first;
    third.getMultiElement().getElement("LocationAffinity").getSingle().assign("Annex");
    list.addElement(third);
    return tree;
}

TEST(ExportDestinations, ADestinationLackingAKeyIsDropped) {
    KelExportRemoteConfigurations destinations;
    EXPECT_FALSE(destinations.readVesk(threeDestinations()));
    ASSERT_EQ(2u, destinations.getRemoteScps().size());
    EXPECT_EQ("Annex", destinations.getRemoteScps()[1].getLocationAffinity());
    EXPECT_EQ("Long-term archive", destinations.getLongTermStorageDestination());
}

TEST(ExportDestinations, WithoutTheListTheReadFailsLoggedAndKeepsIt) {
    KelExportRemoteConfigurations destinations;
    destinations.readVesk(sampleDocument("KelExportRemoteConfigurations.xml"));
    Quorvex::Testing::LogCapture log;
    EXPECT_FALSE(destinations.readVesk(
        withoutChild(sampleDocument("KelExportRemoteConfigurations.xml"), "KelExportRemoteSCPs")));
    EXPECT_EQ(1u, destinations.getRemoteScps().size());
    EXPECT_TRUE(log.onlyStartsWith(
        "KelExportRemoteConfigurations::readVesk: Failed. Standard Exception: "));
}

TEST(ExportGlobal, AnIncompleteAnonymisationParameterIsDropped) {
    Vesk::Element tree = sampleDocument("KelExportGlobalConfiguration.xml");
    Vesk::MultiElementValue& params =
        tree.getMultiElement().getElement("AnonymizationParams").getMultiElement();
    params.addElement(withoutChild(*params.begin(), "Value"));
    KelExportGlobalConfiguration global;
    EXPECT_FALSE(global.readVesk(tree));
    ASSERT_EQ(2u, global.getAnonymizationParams().size());
    EXPECT_EQ("0010,0030", global.getAnonymizationParams()[1].getTag());
    EXPECT_EQ("ORVEL-DB1", global.getDatabaseConfiguration().getLocation());  // read after them
}

TEST(ExportGlobal, TheDatabaseSectionCountsAndDefaultsToTheMaster) {
    KelExportGlobalConfiguration global;
    EXPECT_EQ("master", global.getDatabaseConfiguration().getLocation());
    EXPECT_FALSE(global.readVesk(
        withoutChild(sampleDocument("KelExportGlobalConfiguration.xml"), "DatabaseConfiguration")));
    EXPECT_EQ("master", global.getDatabaseConfiguration().getLocation());
    EXPECT_EQ(48, global.getCommandStatusLifetime());
    Vesk::Element section = sampleDocument("KelExportDatabaseConfiguration.xml");
    KelExportDatabaseConfiguration database;
    EXPECT_FALSE(database.readVesk(withoutChild(section, "CommandTimeout")));
    EXPECT_EQ(30u, database.getCommandTimeout());
    EXPECT_EQ("KelExportMain", database.getDatabaseName());
    EXPECT_EQ("BrimmetServer\\DatabaseConfiguration", database.path());
}

// The adapter reads the global document through the global class: same values, same failures.
TEST(ExportAdapter, ReadsTheGlobalDocumentAsTheGlobalClassDoes) {
    const Vesk::Element tree = sampleDocument("KelExportGlobalConfiguration.xml");
    KelExportGlobalConfiguration global;
    KelExportConfigurationAdapter adapter;
    ASSERT_TRUE(global.readVesk(tree));
    ASSERT_TRUE(adapter.readVesk(tree));
    EXPECT_EQ(global.getCommandStatusLifetime(), adapter.getCommandStatusLifetime());
    EXPECT_EQ(30, adapter.getMaxNumberOfRetries());
    EXPECT_EQ(global.getRetryDelay(), adapter.getRetryDelay());
    EXPECT_EQ(global.getPollInterval(), adapter.getPollInterval());
    EXPECT_EQ(12, adapter.getServiceStatusReportingFrequency());
    EXPECT_EQ(global.getBsnIssuerId(), adapter.getBsnIssuerId());
    EXPECT_TRUE(adapter.getEnableBsn());
    EXPECT_EQ(global.getAnonymizationParams(), adapter.getAnonymizationParams());
    EXPECT_EQ(global.path(), adapter.path());
    EXPECT_EQ(Vesk::XmlUtils::toString(*global.writeVesk()),
              Vesk::XmlUtils::toString(*adapter.writeVesk()));

    Quorvex::Testing::LogCapture log;
    EXPECT_FALSE(adapter.readVesk(withoutChild(tree, "AnonymizationParams")));
    EXPECT_TRUE(log.onlyStartsWith("KelExportGlobalConfiguration::readVesk: Failed."));
    KelExportConfigurationAdapter other = adapter;
    other.setMaxNumberOfRetries(1);
    EXPECT_NE(other, adapter);
}

TEST(ExportDocuments, NamesAndThePerMachineDocument) {
    const struct {
        const ConfigDoc& document;
        const char* path;
        bool isLocal;
    } kDocuments[] = {
        {KelExportGlobalConfiguration(), "BrimmetServer\\KelExport", false},
        {KelExportConfigurationAdapter(), "BrimmetServer\\KelExport", false},
        {KelExportLocalConfiguration(), "BrimmetServer\\KelExportLocal", true},
        {KelExportRemoteConfigurations(), "BrimmetServer\\KelExportRemoteConfigurations", false},
        {KelExportWebService(), "BrimmetServer\\KelExportWebServiceLocal", false},
        {StorageCommitConfiguration(), "BrimmetServer\\StorageCommit", false},
    };
    for (const auto& d : kDocuments) {
        EXPECT_EQ(d.path, d.document.path());
        EXPECT_EQ(d.isLocal, d.document.isLocal()) << d.path;
    }
    EXPECT_EQ("c:\\Quorvex\\KelExportCache", KelExportLocalConfiguration().getImageCacheFolder());
}

TEST(StorageCommit, ARequesterWithoutItsIdentityIsDropped) {
    Vesk::Element tree = sampleDocument("StorageCommitConfiguration.xml");
    Vesk::MultiElementValue& list =
        tree.getMultiElement().getElement("StorageCommitRemoteConfigurations").getMultiElement();
    list.addElement(withoutChild(*list.begin(), RemoteSCPConfiguration::WELL_KNOWN_NAME));
    Quorvex::Testing::LogCapture log;
    StorageCommitConfiguration config;
    EXPECT_FALSE(config.readVesk(tree));
    ASSERT_EQ(2u, config.getRemoteConfigurations().size());
    EXPECT_EQ("STMARY_PACS", config.getRemoteConfigurations()[1].getAETitle());
    EXPECT_TRUE(log.onlyStartsWith(
        "StorageCommitRemoteSCPConfiguration::readVesk: Failed. Standard Exception: "));
}

// 100,000 destinations and a 4 MiB name read whole, without a log line.
TEST(ExportHostile, ManyDestinationsAndHugeTextsReadInBoundedTime) {
    Vesk::Element tree = sampleDocument("KelExportRemoteConfigurations.xml");
    Vesk::MultiElementValue& list =
        tree.getMultiElement().getElement("KelExportRemoteSCPs").getMultiElement();
    const Vesk::Element first = *list.begin();
    list.reserve(100000);
    for (int i = 1; i < 100000; ++i) {
        list.addElement(first);
    }
    tree.getMultiElement()
        .getElement("LongTermStorageDestination")
        .getSingle()
        .assign(std::string(4 << 20, 'x').c_str());
    Quorvex::Testing::LogCapture log;
    KelExportRemoteConfigurations destinations;
    EXPECT_TRUE(destinations.readVesk(tree));
    EXPECT_EQ(100000u, destinations.getRemoteScps().size());
    EXPECT_EQ(4u << 20, destinations.getLongTermStorageDestination().length());
    EXPECT_TRUE(log.records().empty());
}

}  // namespace
}  // namespace Configuration
