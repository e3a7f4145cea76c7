// The tape archive: look-ups by address, node and stack, the default node settings, the server
// fall-back, and broken documents, whose messages never carry the password.
#include <gtest/gtest.h>

#include "Configuration/KelArchiveConfiguration.h"
#include "StorageTestSupport.h"
#include "testing/LogCapture.h"

namespace Configuration {
namespace {

class Archive : public ::testing::Test {
protected:
    Archive() { EXPECT_TRUE(archive.readVesk(site)); }
    const Vesk::Element site = Testing::siteDocument("KelArchive");
    KelArchiveConfiguration archive;
};

std::string missText(const std::function<void()>& lookUp) {
    try {
        lookUp();
    } catch (const ArchiveNotConfiguredException& e) {
        return e.what();
    }
    return "(found)";
}

TEST_F(Archive, LookUpsAndTheirMisses) {
    EXPECT_EQ(archive.getTivoliServerInfoByAddress("tsm-b.archive.hospital.example")
                  .getTivoliServerUserAccount(),
              "qvx_archive");
    const ArchiveNodeStackInfo& stack =
        archive.getArchiveStackInfo("9B2E7C14-5D3A-4E8F-A1B6-2C7D8E9F0A1B");
    EXPECT_EQ(stack.getArchiveFilespaceName(), "/quorvex/stack2");
    const ArchiveLocalNodeInfo& node = archive.getArchiveNodeInfo(stack.getLocalNodeName());
    EXPECT_EQ(node.getTivoliNodeInfo("tsm-b.archive.hospital.example").getNumberThreads(), 2u);
    struct Case {
        std::function<void()> lookUp;
        const char* message;
    };
    const Case cases[] = {
        {[&] { archive.getTivoliServerInfoByAddress("TSM-A.archive.hospital.example"); },
         "Tivoli server information not configured for TSM-A.archive.hospital.example"},
        {[&] { archive.getArchiveNodeInfo("qvx_main_node"); },
         "Unable to find Archive node configuration for qvx_main_node"},
        {[&] { archive.getArchiveStackInfo("none"); },
         "Unable to find Archive stack configuration for none"},
        {[&] { node.getTivoliNodeInfo("tsm-c"); },
         "Unable to find Tivoli node configuration for tsm-c"},
        {[&] { ArchiveLocalNodeInfo().getDefaultTivoliNodeInfo(); },
         "Unable to find Tivoli node configuration for default"},
        {[&] { archive.getTivoliServerInfo("no-node", "no-server"); },
         "Unable to find Tivoli server info for no-node"},
    };
    for (const Case& c : cases) {
        EXPECT_EQ(missText(c.lookUp), c.message);
    }
}

// The node's settings name the later server first: the default is still the first by address.
TEST_F(Archive, DefaultNodeSettingsAreTheFirstByAddress) {
    Vesk::Element node = Testing::sampleDocument("ArchiveLocalNodeInfo.xml");
    Vesk::MultiElementValue& items =
        node.getMultiElement().getElement("TivoliNodesConfiguration").getMultiElement();
    std::swap(*items.begin(), *std::next(items.begin()));
    ArchiveLocalNodeInfo info;
    ASSERT_TRUE(info.readVesk(node));
    EXPECT_EQ(info.getDefaultTivoliNodeInfo().getTivoliServer(), "tsm01.archive.example");
}

TEST_F(Archive, AnUnknownServerFallsBackToTheNodesDefault) {
    Quorvex::Testing::LogCapture log;
    EXPECT_EQ(
        archive.getTivoliServerInfo("QVX_MAIN_NODE", "tsm-old").getTivoliStorageManagerHostname(),
        "tsm-a.archive.hospital.example");
    EXPECT_TRUE(log.contains(LM_DEBUG,
                             "Exception caught. Reason Tivoli server information not configured "
                             "for tsm-old. Trying to get default Tivoli server info.\n"));
    EXPECT_EQ(&archive.getTivoliServerInfo("QVX_MAIN_NODE", "tsm-b.archive.hospital.example"),
              &archive.getTivoliServerInfoByAddress("tsm-b.archive.hospital.example"));
}

TEST_F(Archive, BrokenDocumentsFailWithoutShowingThePassword) {
    const auto serverWithout = [&](const char* key) {
        Vesk::Element servers = site.getMultiElement().getElement("TivoliServers");
        Vesk::Element& first = *servers.getMultiElement().begin();
        first = Testing::withoutChild(first, key);
        return Testing::withChild(site, "TivoliServers", servers);
    };
    Vesk::Element nodes = site.getMultiElement().getElement("ArchiveNodesConfiguration");
    Vesk::Element& firstNode = *nodes.getMultiElement().begin();
    firstNode = Testing::withoutChild(firstNode, "ArchiveLocalNodeName");
    struct Case {
        Vesk::Element document;
        const char* message;
    };
    const Case cases[] = {
        {Testing::withoutChild(site, "TivoliServers"), "No Tivoli servers element found"},
        {serverWithout("TivoliStorageManagerServerAddress"),
         "Tivoli storage manager host name was not found."},
        {serverWithout("TivoliStorageManagerServerPort"),
         "Tivoli storage manager port was not found."},
        {serverWithout("TivoliServerUserAccount"), "Tivoli storage manager user was not found."},
        {serverWithout("TivoliServerAccessPassword"),
         "Tivoli storage manager password was not found."},
        {Testing::withChild(site, "ArchiveNodesConfiguration", nodes),
         "Archive node name was not found."},
    };
    for (const Case& c : cases) {
        Quorvex::Testing::LogCapture log;
        KelArchiveConfiguration read;
        EXPECT_FALSE(read.readVesk(c.document)) << c.message;
        ASSERT_EQ(log.records().size(), 1u) << c.message;
        EXPECT_EQ(log.records()[0].text,
                  std::string("KelArchiveConfiguration::readVesk: Failed. Standard Exception: ") +
                      c.message + "\n");
        EXPECT_EQ(log.records()[0].text.find("change-me"), std::string::npos);
    }
}

}  // namespace
}  // namespace Configuration
