// The example DICOM site end to end: every document of examples/site stored as bytes through the
// running configuration service, read back through the repository into its class, equal to what
// its XML reads to and holding the values the site's servers depend on. The export module's
// global configuration and its adapter share one stored document, each read through the
// repository whichever of them is cached first.
#include <gtest/gtest.h>

#include <functional>
#include <memory>
#include <string>

#include "Configuration/AutoExportConfiguration.h"
#include "Configuration/ConfigurationRepository.h"
#include "Configuration/HttpConfigurationClient.h"
#include "Configuration/KelExportConfigurationAdapter.h"
#include "Configuration/KelExportGlobalConfiguration.h"
#include "Configuration/KelExportLocalConfiguration.h"
#include "Configuration/KelExportRemoteConfigurations.h"
#include "Configuration/KelExportWebService.h"
#include "Configuration/KelQueryConfiguration.h"
#include "Configuration/QrscpConfiguration.h"
#include "Configuration/SSCPConfiguration.h"
#include "Configuration/StorageCommitConfiguration.h"
#include "InProcessService.h"
#include "ThroughServiceSupport.h"

namespace Configuration {
namespace {

Vesk::Element siteDocument(const std::string& name) {
    return ThroughService::exampleDocument("site/" + name + ".xml");
}

// One document of the site: its class, and a check of the values that matter in it.
struct SiteDocument {
    const char* name;
    std::function<std::unique_ptr<ConfigDoc>()> make;
    std::function<bool(const ConfigDoc&, const ConfigDoc&)> equal;
    std::function<void(const ConfigDoc&)> expect;
};

template <class T>
SiteDocument document(const char* name, std::function<void(const T&)> expect) {
    return SiteDocument{name, [] { return std::make_unique<T>(); },
                        [](const ConfigDoc& a, const ConfigDoc& b) {
                            return dynamic_cast<const T&>(a) == dynamic_cast<const T&>(b);
                        },
                        [expect](const ConfigDoc& d) { expect(dynamic_cast<const T&>(d)); }};
}

void expectStorageProvider(const SSCPConfiguration& scp) {
    EXPECT_EQ("NORTHMED_ARC", scp.getNormalAETitle());
    EXPECT_EQ("NORTHMED_STAT", scp.getHiPriorityAETitle());
    EXPECT_TRUE(scp.getUseSSL());
    EXPECT_EQ("C:\\Quorvex\\tls\\northmed-arc.key", scp.getSSLPrivateKey());
    ASSERT_EQ(4u, scp.getDicomSources().size());
    std::string modalities;
    for (const ServerDicomSource& source : scp.getDicomSources()) {
        modalities += std::string(source.getModality().c_str()) + " ";
    }
    EXPECT_EQ("CT MR US OT ", modalities);
    EXPECT_EQ(1u, scp.getSuidGenerationAETitleFilter().count("US_CARDIO1"));
}

void expectDestinations(const KelExportRemoteConfigurations& remotes) {
    ASSERT_EQ(3u, remotes.getRemoteScps().size());
    const KelExportRemoteScp& archive = remotes.getRemoteScps()[0];
    EXPECT_TRUE(archive.getBsnExport());
    EXPECT_EQ("LTA_NORTH", archive.getStorageCommitScpConfiguration().getAETitle());
    EXPECT_EQ(300, archive.getStorageCommitScpConfiguration().getResponseTimeOut());
    EXPECT_EQ("Annex", remotes.getRemoteScps()[1].getLocationAffinity());
    EXPECT_EQ("2762", remotes.getRemoteScps()[1].getPort());
    EXPECT_EQ(remotes.getLongTermStorageDestination(), archive.getRemoteHostDescription());
}

void expectRules(const AutoExportConfiguration& autoExport) {
    ASSERT_EQ(3u, autoExport.getRules().size());
    EXPECT_EQ("StationAETitle", autoExport.getRules()[1].getCriteria()[1].getName());
    EXPECT_EQ("*CARDIAC*", autoExport.getRules()[2].getCriteria()[1].getValue());
    for (const char* destination :
         {"Long-term archive", "Teleradiology partner", "Regional health exchange (web service)"}) {
        EXPECT_TRUE(autoExport.isDestinationUsed(destination)) << destination;
    }
}

void expectQueryModule(const KelQueryConfiguration& query) {
    ASSERT_EQ(2u, query.getArchives().size());
    EXPECT_EQ("STMARY_PACS", query.getArchives()[1].getAETitle());
    EXPECT_EQ(2, query.getArchives()[1].getQueryModel());
    EXPECT_TRUE(query.getPrefetchConfiguration().getPrefetchEnabled());
    EXPECT_EQ(3u, query.getPrefetchConfiguration().getPrefetchDaysBefore());
}

const SiteDocument kSite[] = {
    document<SSCPConfiguration>("DicomScp", expectStorageProvider),
    document<QrscpConfiguration>("Qrscp",
                                 [](const QrscpConfiguration& qr) {
                                     EXPECT_EQ(11113, qr.getPort());
                                     EXPECT_EQ(3u, qr.getAllowedAeTitles().size());
                                 }),
    document<StorageCommitConfiguration>(
        "StorageCommit",
        [](const StorageCommitConfiguration& commit) {
            ASSERT_EQ(2u, commit.getRemoteConfigurations().size());
            EXPECT_TRUE(commit.getRemoteConfigurations()[1].getRespondInSameAssociation());
        }),
    document<KelExportGlobalConfiguration>(
        "KelExport",
        [](const KelExportGlobalConfiguration& global) {
            EXPECT_TRUE(global.getEnableBsn());
            EXPECT_EQ(3u, global.getAnonymizationParams().size());
            EXPECT_EQ("master", global.getDatabaseConfiguration().getLocation());
        }),
    document<KelExportLocalConfiguration>("KelExportLocal",
                                          [](const KelExportLocalConfiguration& local) {
                                              EXPECT_TRUE(local.isLocal());
                                              EXPECT_EQ("NORTHMED_EXP1",
                                                        local.getKelExportAETitle());
                                          }),
    document<KelExportRemoteConfigurations>("KelExportRemoteConfigurations", expectDestinations),
    document<KelExportWebService>(
        "KelExportWebServiceLocal",
        [](const KelExportWebService& web) { EXPECT_EQ(20u, web.getConnectionTimeout()); }),
    document<AutoExportConfiguration>("AutoExport", expectRules),
    document<KelQueryConfiguration>("KelQuery", expectQueryModule),
};

class DicomSite : public ::testing::Test {
protected:
    DicomSite()
        : client(service.address().c_str(), true, false),
          repository(ThroughService::repositoryAt(service.address())) {}

    // Stores every document of the site as bytes, as an administrator's tool would.
    void storeSite() {
        for (const SiteDocument& d : kSite) {
            ThroughService::storeTree(client, "TestHost", d.make()->path(), siteDocument(d.name));
        }
    }

    ServiceTesting::InProcessService service;
    HttpConfigurationClient client;
    std::unique_ptr<ConfigurationRepository> repository;
};

TEST_F(DicomSite, EveryDocumentReadsThroughTheRepositoryIntoItsClass) {
    storeSite();
    for (const SiteDocument& d : kSite) {
        auto direct = d.make();
        ASSERT_TRUE(direct->readVesk(siteDocument(d.name))) << d.name;
        auto viaService = d.make();
        ASSERT_EQ(0, repository->GetLatest(*viaService)) << d.name;
        EXPECT_EQ(std::string("BrimmetServer\\") + d.name, viaService->path().c_str());
        EXPECT_TRUE(d.equal(*direct, *viaService)) << d.name;
        d.expect(*viaService);
        auto cached = d.make();  // a fresh object again, from the cache
        ASSERT_EQ(0, repository->GetLatest(*cached)) << d.name;
        EXPECT_TRUE(d.equal(*direct, *cached)) << d.name;
    }
}

// The adapter and the global configuration read one document; whichever is cached first, the
// other reads it too, and a change stored through one is what the other reads.
TEST_F(DicomSite, GlobalExportSettingsAndTheirAdapterShareOneDocument) {
    storeSite();
    for (const bool adapterFirst : {false, true}) {
        const auto fresh = ThroughService::repositoryAt(service.address());
        KelExportGlobalConfiguration global;
        KelExportConfigurationAdapter adapter;
        if (adapterFirst) {
            ASSERT_EQ(0, fresh->GetLatest(adapter));
            ASSERT_EQ(0, fresh->GetLatest(global));
        } else {
            ASSERT_EQ(0, fresh->GetLatest(global));
            ASSERT_EQ(0, fresh->GetLatest(adapter));
        }
        EXPECT_EQ(48, adapter.getCommandStatusLifetime()) << adapterFirst;
        EXPECT_EQ(global.getMaximumNumberOfRetries(), adapter.getMaxNumberOfRetries());
        EXPECT_EQ(global.getAnonymizationParams(), adapter.getAnonymizationParams());
    }
    KelExportConfigurationAdapter adapter;
    ASSERT_EQ(0, repository->GetLatest(adapter));
    adapter.setMaxNumberOfRetries(7);
    ASSERT_EQ(0, repository->Store(adapter));
    KelExportGlobalConfiguration global;
    ASSERT_EQ(0, repository->GetLatest(global, true));
    EXPECT_EQ(7, global.getMaximumNumberOfRetries());
    EXPECT_EQ(3u, global.getAnonymizationParams().size());
}

// Writable documents store themselves through the repository; the read-only rules refuse.
TEST_F(DicomSite, DocumentsStoreThroughTheRepositoryAndTheRulesRefuse) {
    storeSite();
    KelExportRemoteConfigurations remotes;
    ASSERT_EQ(0, repository->GetLatest(remotes));
    auto destinations = remotes.getRemoteScps();
    destinations.pop_back();
    remotes.setRemoteScps(destinations);
    ASSERT_EQ(0, repository->Store(remotes));
    KelExportRemoteConfigurations again;
    ASSERT_EQ(0, repository->GetLatest(again, true));
    EXPECT_EQ(2u, again.getRemoteScps().size());
    EXPECT_EQ(remotes, again);

    AutoExportConfiguration rules;
    ASSERT_EQ(0, repository->GetLatest(rules));
    EXPECT_EQ(-1, repository->Store(rules));
    AutoExportConfiguration unchanged;
    ASSERT_EQ(0, repository->GetLatest(unchanged, true));
    EXPECT_EQ(rules, unchanged);
}

}  // namespace
}  // namespace Configuration
