// The repository end to end: a master and two slaves (real service processes on 127.0.0.1), a
// repository in this test process acting as a process on slave1, and a second process on slave2
// that watches its machine's change event.
#include <gtest/gtest.h>

#include <cstdlib>
#include <map>

#include "ChildProcess.h"
#include "Common/NamedEvent.h"
#include "Configuration/ConfigurationRepository.h"
#include "Configuration/HttpConfigurationClient.h"
#include "Configuration/OrvelSystemConfiguration.h"
#include "Configuration/StoredForm.h"
#include "ServiceProcess.h"
#include "TicketFile.h"
#include "model/TestDocument.h"
#include "repository/HttpServiceConnection.h"
#include "testing/ScratchDir.h"

namespace Configuration {
namespace {

using ServiceTesting::ServiceProcess;
using Testing::TestDocument;

const char kShared[] = "BrimmetServer\\Shared";

// Sets an environment variable for the lifetime of the object.
class ScopedEnv {
public:
    ScopedEnv(const char* name, const std::string& value) : m_name(name) {
        const char* old = std::getenv(name);
        m_had = old != nullptr;
        m_old = m_had ? old : "";
        ::setenv(name, value.c_str(), 1);
    }
    ~ScopedEnv() { m_had ? (void)::setenv(m_name, m_old.c_str(), 1) : (void)::unsetenv(m_name); }

private:
    const char* m_name;
    bool m_had;
    std::string m_old;
};

std::string bytesOf(const Vesk::Serializable& object) {
    return StoredForm::encode(*object.writeVesk());
}

class Site : public ::testing::Test {
protected:
    Site()
        : ticket(scratch.path(), "site-ticket-0815"),
          master(settings("master", "")),
          slave1(settings("slave1", master.address())),
          slave2(settings("slave2", master.address())) {
        hosts = "master=" + master.address() + ",slave1=" + slave1.address() +
                ",slave2=" + slave2.address();
        for (const char* host : {"master", "slave1", "slave2"}) {
            client(master).registerService(host, "ConfigurationService", "ModuleType=1");
        }
        for (ServiceProcess* slave : {&slave1, &slave2}) {
            OrvelSystemConfiguration system;
            system.setMasterConfigurationServiceHostName("master");
            put(*slave, slave == &slave1 ? "slave1" : "slave2", system.path().c_str(),
                bytesOf(system));
        }
        TestDocument shared("Shared");
        shared.name = "v1";
        put(master, "master", kShared, bytesOf(shared), "2020-01-01T00:00:00.000");
        put(slave1, "master", kShared, bytesOf(shared), "2020-01-01T00:00:00.000");
        put(slave2, "master", kShared, bytesOf(shared), "2020-01-01T00:00:00.000");
    }

    ServiceProcess::Settings settings(const std::string& host, const std::string& masterAddress) {
        return {
            scratch.file(host + "-store"), host, masterAddress, scratch.file(host + "-events"), {}};
    }
    static HttpConfigurationClient client(const ServiceProcess& service) {
        return HttpConfigurationClient(service.address().c_str(), true, false);
    }
    static void put(const ServiceProcess& service, const char* host, const char* name,
                    const std::string& bytes, const char* time = "") {
        client(service).store(host, name, reinterpret_cast<const unsigned char*>(bytes.data()),
                              bytes.size(), time);
    }
    // A repository as a process on the given host would have it.
    std::unique_ptr<ConfigurationRepository> repositoryOn(const ServiceProcess& service) {
        ServiceLocation location;
        location.localServer = service.address().c_str();
        location.servers = {{"master", master.address()},
                            {"slave1", slave1.address()},
                            {"slave2", slave2.address()},
                            {"ghost", "127.0.0.1:1"}};
        auto repository = std::make_unique<ConfigurationRepository>(
            std::make_shared<HttpServiceConnector>(location));
        repository->SetMasterHostName("master");
        return repository;
    }
    std::map<std::string, std::string> probeEnvironment(const ServiceProcess& service,
                                                        const std::string& host) {
        return {{"QUORVEX_CONFIGURATION_SERVER", service.address()},
                {"QUORVEX_CONFIGURATION_HOSTS", hosts},
                {"QUORVEX_EVENT_DIR", scratch.file(host + "-events")}};
    }

    Quorvex::Testing::ScratchDir scratch;
    ServiceTesting::TicketFile ticket;
    ServiceProcess master, slave1, slave2;
    std::string hosts;
};

TEST_F(Site, AStoreOnOneSlaveReachesAProcessWatchingAnotherSlave) {
    IntegrationTesting::ChildProcess probe({REPOSITORY_PROBE_BINARY, "Shared", "v2", "20000"},
                                           probeEnvironment(slave2, "slave2"));
    ASSERT_EQ(probe.readLine(20000), "initial v1");

    ScopedEnv events("QUORVEX_EVENT_DIR", scratch.file("slave1-events"));
    auto repository = repositoryOn(slave1);
    TestDocument doc("Shared");
    ASSERT_EQ(repository->GetLatest(doc), 0);
    doc.name = "v2";
    ASSERT_EQ(repository->Store(doc), 0);
    Quorvex::ByteArray bytes;
    std::size_t length = 0;
    client(master).retrieve("master", kShared, bytes, length);  // landed on the master
    TestDocument onMaster("Shared");
    Vesk::Element tree;
    StoredForm::decode(bytes.get(), length, tree);
    ASSERT_TRUE(onMaster.readVesk(tree));
    EXPECT_EQ(onMaster.name, "v2");

    repository->SignalChanged();
    EXPECT_EQ(probe.readLine(20000), "seen v2");
    EXPECT_EQ(probe.wait(5000), 0);
}

TEST_F(Site, SignalChangedSkipsTheLocalHostAndSurvivesAnUnreachableOne) {
    client(master).registerService("ghost", "ConfigurationService", "ModuleType=1");
    const auto watch = [&](const char* host) {
        ScopedEnv env("QUORVEX_EVENT_DIR", scratch.file(std::string(host) + "-events"));
        return std::make_unique<Common::NamedEvent>("Global\\QuorvexSlaveConfigurationChanged");
    };
    auto onMaster = watch("master");
    auto onSlave1 = watch("slave1");
    auto onSlave2 = watch("slave2");
    ScopedEnv events("QUORVEX_EVENT_DIR", scratch.file("slave1-events"));
    auto repository = repositoryOn(slave1);
    onSlave1->reset();
    repository->SignalChanged();
    EXPECT_TRUE(onMaster->wait(5000));
    EXPECT_TRUE(onSlave2->wait(5000));
    EXPECT_FALSE(onSlave1->wait(200));  // the local host is never signalled by the loop
}

TEST_F(Site, CacheMasterWebToLocalWebCopiesExactlyWhatIsMissingOrChanged) {
    put(master, "slave2", "BrimmetServer\\Msmq", "m", "2021-02-03T04:05:06.007");
    put(master, "master", kShared, "newer", "2021-01-01T00:00:00.000");
    ScopedEnv events("QUORVEX_EVENT_DIR", scratch.file("slave1-events"));
    auto repository = repositoryOn(slave1);
    ASSERT_EQ(repository->CacheMasterWebToLocalWeb(), 0);
    const HttpConfigurationClient local = client(slave1);
    Quorvex::ByteArray bytes;
    std::size_t length = 0;
    local.retrieve("slave2", "BrimmetServer\\Msmq", bytes, length);
    EXPECT_EQ(std::string(reinterpret_cast<char*>(bytes.get()), length), "m");
    local.retrieve("master", kShared, bytes, length);
    EXPECT_EQ(std::string(reinterpret_cast<char*>(bytes.get()), length), "newer");
    BDateTime time;
    local.getTimeStamp("slave2", "BrimmetServer\\Msmq", time);
    EXPECT_EQ(time, BDateTime("2021-02-03T04:05:06.007"));  // the master's time, kept

    std::vector<_HttpConfigurationItemInfo> before;
    local.listItems("*", before);
    ASSERT_EQ(repository->CacheMasterWebToLocalWeb(), 0);  // nothing left to copy
    std::vector<_HttpConfigurationItemInfo> after;
    local.listItems("*", after);
    ASSERT_EQ(after.size(), before.size());
    for (std::size_t i = 0; i < after.size(); ++i) {
        EXPECT_EQ(after[i].lastModifiedTime, before[i].lastModifiedTime);
    }
    // slave1's own documents stay as they are and are not sent anywhere.
    std::vector<_HttpConfigurationItemInfo> onMaster;
    client(master).listItems("slave1", onMaster);
    EXPECT_TRUE(onMaster.empty());
}

TEST_F(Site, TheMasterHostComesFromTheMachinesSystemDocument) {
    IntegrationTesting::ChildProcess probe({REPOSITORY_PROBE_BINARY, "Shared", "never", "300"},
                                           probeEnvironment(slave2, "slave2"));
    EXPECT_EQ(probe.readLine(20000), "initial v1");  // read from slave2's copy of the master's
    EXPECT_EQ(probe.wait(10000), 1);
}

}  // namespace
}  // namespace Configuration
