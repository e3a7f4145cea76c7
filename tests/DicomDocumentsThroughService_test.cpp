// The DICOM sample documents end to end: stored as bytes through the running configuration
// service, read back through the repository into their classes, equal to what the XML itself
// reads to; the DICOM client document also stores itself through the repository.
#include <gtest/gtest.h>

#include <memory>
#include <string>

#include "Configuration/ConfigurationRepository.h"
#include "Configuration/DicomClientConfiguration.h"
#include "Configuration/HttpConfigurationClient.h"
#include "Configuration/SOPServiceConfiguration.h"
#include "InProcessService.h"
#include "ThroughServiceSupport.h"

namespace Configuration {
namespace {

class DicomDocuments : public ::testing::Test {
protected:
    DicomDocuments()
        : client(service.address().c_str(), true, false),
          repository(ThroughService::repositoryAt(service.address())) {}

    // Stores tree as the site-wide document of doc's path, as an administrator's tool would.
    void store(const ConfigDoc& doc, const Vesk::Element& tree) {
        ThroughService::storeTree(client, "TestHost", doc.path(), tree);
    }

    ServiceTesting::InProcessService service;
    HttpConfigurationClient client;
    std::unique_ptr<ConfigurationRepository> repository;
};

TEST_F(DicomDocuments, SOPServicesReadThroughTheRepositoryResolveAsTheirXml) {
    const Vesk::Element tree = ThroughService::exampleDocument("dicom/SOPServiceConfiguration.xml");
    SOPServiceConfiguration direct;
    ASSERT_TRUE(direct.readVesk(tree));
    store(direct, tree);

    SOPServiceConfiguration viaService;
    ASSERT_EQ(repository->GetLatest(viaService), 0);
    EXPECT_EQ(viaService.path(), "BrimmetServer\\SOPServiceConfiguration");
    EXPECT_EQ(viaService, direct);
    const auto& services = viaService.getSOPServiceList().getSOPServices();
    ASSERT_GE(services.size(), 60u);
    std::size_t offered = 0;
    for (const SOPService& service : services) {
        for (const TransferSyntax& entry : service.getTransferSyntaxList().getTransferSyntaxes()) {
            offered += service.getEnabled() && entry.getEnabled() ? 1 : 0;
        }
    }
    EXPECT_GT(offered, 500u);

    SOPServiceConfiguration cached;  // a fresh object again, served from the cache
    ASSERT_EQ(repository->GetLatest(cached), 0);
    EXPECT_EQ(cached, direct);
}

TEST_F(DicomDocuments, DicomClientStoredAndReadBack) {
    const Vesk::Element tree = ThroughService::exampleDocument("dicom/DicomClient.xml");
    DicomClientConfiguration direct;
    ASSERT_TRUE(direct.readVesk(tree));
    store(direct, tree);

    DicomClientConfiguration viaService;
    ASSERT_EQ(repository->GetLatest(viaService), 0);
    EXPECT_EQ(viaService, direct);
    EXPECT_TRUE(viaService.IsSopClassViewable("1.2.840.10008.5.1.4.1.1.2"));

    auto classes = viaService.getViewableSopClasses();
    classes.erase("1.2.840.10008.5.1.4.1.1.2");
    viaService.setViewableSopClasses(classes);
    ASSERT_EQ(repository->Store(viaService), 0);
    DicomClientConfiguration again;
    ASSERT_EQ(repository->GetLatest(again, true), 0);
    EXPECT_FALSE(again.IsSopClassViewable("1.2.840.10008.5.1.4.1.1.2"));
    EXPECT_EQ(again.getViewableSopClasses().size(), direct.getViewableSopClasses().size() - 1);
}

}  // namespace
}  // namespace Configuration
