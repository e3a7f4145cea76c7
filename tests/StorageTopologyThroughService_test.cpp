// The example site's storage topology end to end: its documents stored in a running
// configuration service, the queries answered through a repository reading from that service,
// the storage-stack check asked of the service itself, and a second process that sees a switch
// of the active stack after the machine's change event.
#include <gtest/gtest.h>

#include <memory>
#include <string>

#include "ChildProcess.h"
#include "Configuration/ConfigurationRepository.h"
#include "Configuration/HttpConfigurationClient.h"
#include "Configuration/MSMQCommonConfiguration.h"
#include "Configuration/StrategyConfiguration.h"
#include "Configuration/TopologySource.h"
#include "InProcessService.h"
#include "ThroughServiceSupport.h"
#include "testing/LogCapture.h"

namespace Configuration {
namespace {

const char kActive[] = "9B2E7C14-5D3A-4E8F-A1B6-2C7D8E9F0A1B";
const char kNewStack[] = "C4D5E6F7-0819-4A2B-8C3D-4E5F60718293";

std::string queueOf(const char* stack) {
    return std::string("DIRECT=OS:") + stack + "\\private$\\quorvexin";
}

Vesk::Element siteDocument(const std::string& name) {
    return ThroughService::exampleDocument("site/" + name + ".xml");
}

// The queries' documents from this test's repository, the storage-stack hosts from the service.
class ServiceTopology : public TopologySource {
public:
    ServiceTopology(ConfigurationRepository& repository, const HttpConfigurationClient& client)
        : m_repository(repository), m_client(client) {}
    int load(ConfigDoc& document) const override { return m_repository.GetLatest(document); }
    void hostsOfModuleType(int moduleType, std::vector<ACE_CString>& hosts) const override {
        m_client.listHostsByModuleType(moduleType, hosts);
    }

private:
    ConfigurationRepository& m_repository;
    const HttpConfigurationClient& m_client;
};

class StorageSite : public ::testing::Test {
protected:
    StorageSite() : client(service.address().c_str(), true, false) {
        for (const char* name : {"StrategyConfiguration", "Location", "MsmqCommon"}) {
            ThroughService::storeTree(client, "TestHost",
                                      (std::string("BrimmetServer\\") + name).c_str(),
                                      siteDocument(name));
        }
        repository = ThroughService::repositoryAt(service.address());
        source = std::make_unique<ServiceTopology>(*repository, client);
        scoped = std::make_unique<ScopedTopologySource>(*source);
        EXPECT_EQ(repository->GetLatest(msmq), 0);
    }

    // The strategy document with only the stack uid active, stored through the repository.
    void activate(const char* uid) {
        StrategyConfiguration strategy;
        ASSERT_EQ(repository->GetLatest(strategy), 0);
        std::vector<StrategyStack> stacks = strategy.getAvailableStacks();
        for (StrategyStack& stack : stacks) {
            stack.setIsStackActive(stack.getStackUid() == uid ? 1 : 0);
        }
        strategy.setAvailableStacks(stacks);
        ASSERT_EQ(repository->Store(strategy), 0);
    }

    ServiceTesting::InProcessService service;
    HttpConfigurationClient client;
    std::unique_ptr<ConfigurationRepository> repository;
    std::unique_ptr<ServiceTopology> source;
    std::unique_ptr<ScopedTopologySource> scoped;
    MSMQCommonConfiguration msmq;
};

TEST_F(StorageSite, ActiveQueuesResolveThroughTheService) {
    ACE_CString uid, prefix, suffix;
    ASSERT_TRUE(msmq.getActivePersistentStackUid(uid, prefix, suffix));
    EXPECT_EQ(std::string((prefix + uid + suffix).c_str()), queueOf(kActive));
    ASSERT_TRUE(msmq.getActivePersistentMirrorStackUid(uid, prefix, suffix));
    EXPECT_EQ(std::string((prefix + uid + suffix).c_str()),
              queueOf("D1E2F3A4-B5C6-4D7E-8F90-A1B2C3D4E5F6"));

    activate(kNewStack);
    ASSERT_TRUE(msmq.getActivePersistentStackUid(uid, prefix, suffix));
    EXPECT_EQ(uid, kNewStack);
}

// No active stack: the service's registrations decide between a quiet false and an error.
TEST_F(StorageSite, WithoutAnActiveStackTheServiceIsAskedForStorageStacks) {
    activate("none");
    short type = 0;
    ACE_CString resolved, prefix, suffix;
    EXPECT_FALSE(msmq.translateLinkDefinitionWithStackUid(ChainUtils::PersistentKeyword(), type,
                                                          resolved, prefix, suffix));
    client.registerService("qvx-stack-01", "StorageStack", "ModuleType=8;Port=104");
    Quorvex::Testing::LogCapture log;
    EXPECT_THROW(msmq.translateLinkDefinitionWithStackUid(ChainUtils::PersistentMirrorKeyword(),
                                                          type, resolved, prefix, suffix),
                 std::runtime_error);
    EXPECT_TRUE(log.containsFragment("Unable to determine active stack based on strategy"));
}

// Another process resolves the old stack until the switch is stored and the change is signalled.
TEST_F(StorageSite, ASecondProcessSeesTheSwitchAfterItsChangeEvent) {
    IntegrationTesting::ChildProcess probe(
        {TOPOLOGY_PROBE_BINARY, kNewStack, "20000"},
        {{"QUORVEX_CONFIGURATION_SERVER", service.address()},
         {"QUORVEX_CONFIGURATION_HOSTS", "testhost=" + service.address()},
         {"QUORVEX_EVENT_DIR", service.eventDirectory()}});
    ASSERT_EQ(probe.readLine(20000), "initial " + queueOf(kActive) + " " +
                                         queueOf("D1E2F3A4-B5C6-4D7E-8F90-A1B2C3D4E5F6"));
    activate(kNewStack);
    client.signalChanged();  // what the master's SignalChanged sends to this machine's service
    EXPECT_EQ(probe.readLine(20000),
              "seen " + queueOf(kNewStack) + " " + queueOf("0F1E2D3C-4B5A-4978-8695-A4B3C2D1E0F9"));
    EXPECT_EQ(probe.wait(5000), 0);
}

}  // namespace
}  // namespace Configuration
