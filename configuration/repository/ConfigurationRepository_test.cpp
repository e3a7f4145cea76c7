// ConfigurationRepository over in-memory services with a controllable clock.
#include "Configuration/ConfigurationRepository.h"

#include <gtest/gtest.h>

#include "Configuration/StoredForm.h"
#include "model/TestDocument.h"
#include "repository/FakeServices.h"
#include "testing/FakeMachine.h"
#include "testing/LogCapture.h"
#include "testing/ScratchDir.h"

namespace Configuration {
namespace {

using Testing::FakeConnector;
using Testing::FakeService;
using Testing::TestDocument;

const std::string kPath = "BrimmetServer\\TestDoc";

std::string storedBytes(const char* name, unsigned size) {
    TestDocument doc;
    doc.name = name;
    doc.size = size;
    return StoredForm::encode(*doc.writeVesk());
}

class RepositoryTest : public ::testing::Test {
protected:
    RepositoryTest() {
        machine.env["QUORVEX_EVENT_DIR"] = events.path();
        local.name = "slave1";
        master.name = "master";
        local.hosts = master.hosts = {"master", "slave1", "slave2"};
        other.name = "slave2";
        connector->add("testhost", local);  // this machine's own name
        connector->add("slave1", local);
        connector->add("master", master);
        connector->add("slave2", other);
        local.put("master", kPath, storedBytes("first", 1), "2010-01-01T00:00:00.000");
        repository = std::make_unique<ConfigurationRepository>(connector);
        repository->SetMasterHostName("master");
    }
    void minutes(int n) { machine.advanceMilliseconds(n * 60000LL); }

    Quorvex::Testing::ScratchDir events;
    Quorvex::Testing::FakeMachine machine;
    Quorvex::ScopedMachine scoped{machine};
    FakeService local, master, other;
    std::shared_ptr<FakeConnector> connector = std::make_shared<FakeConnector>("testhost");
    std::unique_ptr<ConfigurationRepository> repository;
};

TEST_F(RepositoryTest, VirtualHostIsWhatTheLocalServiceReportsAndEmptyMasterNamesIt) {
    EXPECT_EQ(repository->GetVirtualHostName(), "slave1");
    EXPECT_FALSE(repository->IsMaster());
    repository->SetMasterHostName("");
    EXPECT_EQ(repository->GetMasterHostName(), "slave1");
    EXPECT_TRUE(repository->IsMaster());
    repository->SetMasterHostName("SLAVE1");
    EXPECT_TRUE(repository->IsMaster());  // without regard to case
}

TEST_F(RepositoryTest, FirstReadFillsTheDocumentAndCachesIt) {
    local.put("slave1", "BrimmetServer\\Mine", storedBytes("local", 3), "2010-01-01T00:00:00.000");
    TestDocument doc;
    ASSERT_EQ(repository->GetLatest(doc), 0);
    EXPECT_EQ(doc.name, "first");
    EXPECT_EQ(doc.timestamp(), BDateTime("2010-01-01T00:00:00.000"));
    ConfigCacheItemInfo info;
    ASSERT_EQ(repository->GetConfigCacheItemInfo(kPath.c_str(), info), 0);
    EXPECT_EQ(info.timestamp, doc.timestamp());
    EXPECT_EQ(repository->GetConfigCacheItemInfo("BrimmetServer\\Other", info), -1);
    TestDocument mine("Mine", true);  // per-machine: looked up under the virtual host
    ASSERT_EQ(repository->GetLatest(mine), 0);
    EXPECT_EQ(mine.name, "local");
}

TEST_F(RepositoryTest, OneCheckTimeThrottlesEveryDocument) {
    local.put("master", "BrimmetServer\\Second", storedBytes("second", 2),
              "2010-01-01T00:00:00.000");
    TestDocument a, b("Second");
    repository->GetLatest(a);
    repository->GetLatest(b);
    minutes(6);
    const int before = local.timestamps;
    repository->GetLatest(a);  // the first request after five minutes checks...
    EXPECT_EQ(local.timestamps, before + 1);
    local.put("master", "BrimmetServer\\Second", storedBytes("newer", 2),
              "2011-01-01T00:00:00.000");
    minutes(1);
    TestDocument b2("Second");
    repository->GetLatest(b2);  // ...and the next one is served unchecked, though stale
    EXPECT_EQ(b2.name, "second");
    EXPECT_EQ(local.timestamps, before + 1);
    minutes(5);
    repository->GetLatest(b2);
    EXPECT_EQ(b2.name, "newer");
}

TEST_F(RepositoryTest, ForcedReadChecksAndRereadsOnlyWhenTheTimestampDiffers) {
    TestDocument doc;
    repository->GetLatest(doc);
    const int retrieves = local.retrieves;
    repository->GetLatest(doc, true);
    EXPECT_EQ(local.retrieves, retrieves);  // same timestamp: nothing read
    local.put("master", kPath, storedBytes("second", 2), "2010-01-02T00:00:00.000");
    repository->GetLatest(doc, true);
    EXPECT_EQ(local.retrieves, retrieves + 1);
    EXPECT_EQ(doc.name, "second");
    EXPECT_EQ(doc.timestamp(), BDateTime("2010-01-02T00:00:00.000"));
}

TEST_F(RepositoryTest, ChangeEventForcesACheckOfEveryCachedDocument) {
    TestDocument doc;
    repository->GetLatest(doc);
    local.put("master", kPath, storedBytes("changed", 2), "2010-01-03T00:00:00.000");
    Quorvex::Testing::LogCapture log;
    EXPECT_EQ(repository->handle_signal(0), 0);
    EXPECT_TRUE(log.contains(LM_DEBUG,
                             "ConfigurationRepository::handle_signal: Event "
                             "QuorvexSlaveConfigurationChanged was received.\n"));
    TestDocument read;
    repository->GetLatest(read);  // within five minutes: from the refreshed cache
    EXPECT_EQ(read.name, "changed");
}

TEST_F(RepositoryTest, UnreadableDocumentGivesMinusOneAndKeepsDefaults) {
    Quorvex::Testing::LogCapture log;
    TestDocument doc("Missing");
    EXPECT_EQ(repository->GetLatest(doc), -1);
    EXPECT_EQ(doc.name, "default");
    EXPECT_TRUE(log.containsFragment(
        "ConfigurationRepository::GetConfigItemTimeStamp: Unable to connect to local "
        "configuration web service. Standard Exception: "));
    EXPECT_TRUE(log.containsFragment("ConfigurationRepository: Unable to read configuration"));
}

// A second class of the stored document "TestDoc" that reads only its name.
class NameOnly : public TypedConfigDoc<NameOnly> {
    CONFIGURATION_CLASS(NameOnly);

public:
    NameOnly() : TypedConfigDoc(ConfigDoc::getConfigurationRegistryPath() + "TestDoc", false) {}
    ACE_CString name;
};

template <class Self, class Io>
void NameOnly::fields(Self& self, Io& io) {
    io("Name", self.name);
}

CONFIGURATION_DEFINE(NameOnly, "TestDoc", Fields::FailureForm::Failed)

// Guards against the cache keeping only the first class's copy: a second class of the same
// document got std::bad_cast and -1.
TEST_F(RepositoryTest, ClassesNamingTheSameDocumentAreAllServedFromTheCache) {
    TestDocument whole;
    ASSERT_EQ(repository->GetLatest(whole), 0);
    NameOnly name;
    ASSERT_EQ(repository->GetLatest(name), 0);
    EXPECT_EQ(name.name, "first");
    EXPECT_EQ(name.timestamp(), whole.timestamp());
    ASSERT_EQ(repository->GetLatest(whole), 0);  // the first class is still served its own copy
    EXPECT_EQ(whole.size, 1u);
    EXPECT_EQ(local.retrieves, 1);
}

// A document class that refuses to be written, as the read-only classes do.
class ReadOnly : public TypedConfigDoc<ReadOnly> {
    CONFIGURATION_CLASS(ReadOnly);

public:
    ReadOnly() : TypedConfigDoc(ConfigDoc::getConfigurationRegistryPath() + "TestDoc", false) {}
    ACE_CString name;
};

template <class Self, class Io>
void ReadOnly::fields(Self& self, Io& io) {
    io("Name", self.name);
}

CONFIGURATION_DEFINE_READ(ReadOnly, Fields::FailureForm::Failed)
CONFIGURATION_DEFINE_NO_WRITE(ReadOnly, "ReadOnly::writeVesk - Not supported.")
CONFIGURATION_DEFINE_EQUAL(ReadOnly)

// Guards against a refused writeVesk escaping Store as an exception.
TEST_F(RepositoryTest, StoringAReadOnlyDocumentIsMinusOneAndALogLine) {
    Quorvex::Testing::LogCapture log;
    ReadOnly document;
    EXPECT_EQ(repository->Store(document), -1);
    EXPECT_TRUE(
        log.containsFragment("ConfigurationRepository::Store: Unable to write "
                             "BrimmetServer\\TestDoc. Standard Exception: "
                             "ReadOnly::writeVesk - Not supported."));
    EXPECT_EQ(master.stores, 0);
}

// A document class whose writeVesk gives no tree, as the site's queue settings do.
class WritesNothing : public TypedConfigDoc<WritesNothing> {
public:
    WritesNothing() : TypedConfigDoc(ConfigDoc::getConfigurationRegistryPath() + "Empty", false) {}
    bool readVesk(const Vesk::Element&) override { return true; }
    Quorvex::auto_ptr<Vesk::Element> writeVesk() const override {
        return Quorvex::auto_ptr<Vesk::Element>();
    }
};

// Guards against Store dereferencing the missing tree of a class that writes nothing.
TEST_F(RepositoryTest, StoringADocumentThatWritesNothingIsMinusOne) {
    Quorvex::Testing::LogCapture log;
    WritesNothing document;
    EXPECT_EQ(repository->Store(document), -1);
    EXPECT_TRUE(log.containsFragment("nothing to store for BrimmetServer\\Empty"));
    EXPECT_EQ(master.stores, 0);
}

TEST_F(RepositoryTest, DocumentMissingAKeyIsAnErrorAndNotCached) {
    Vesk::Element partial("TestDoc", -1);
    partial.addMultiElement().addElement("Name", {}, -1).addSingle().assign("only");
    local.put("master", kPath, StoredForm::encode(partial), "2010-01-01T00:00:00.000");
    Quorvex::Testing::LogCapture log;
    TestDocument doc;
    EXPECT_EQ(repository->GetLatest(doc), -1);
    EXPECT_TRUE(log.containsFragment(
        "ConfigurationRepository::ReadItem: Error reading configuration item "
        "BrimmetServer\\TestDoc. "
        "Standard Exception: ConfigurationRepository::ReadItem: Error parsing configuration: "
        "BrimmetServer\\TestDoc\n"));
    ConfigCacheItemInfo info;
    EXPECT_EQ(repository->GetConfigCacheItemInfo(kPath.c_str(), info), -1);
}

TEST_F(RepositoryTest, StaleCheckFailureKeepsTheCachedCopyWhole) {
    TestDocument doc;
    repository->GetLatest(doc);
    local.put("master", kPath, "not a stored document", "2010-01-05T00:00:00.000");
    TestDocument again;
    EXPECT_EQ(repository->GetLatest(again, true), -1);
    local.down = true;
    minutes(1);
    TestDocument cached;
    EXPECT_EQ(repository->GetLatest(cached), 0);  // within the check time: from the cache
    EXPECT_EQ(cached.name, "first");
}

TEST_F(RepositoryTest, StoreGoesToTheMasterAndIsReadBackFromTheCache) {
    TestDocument doc;
    doc.name = "stored";
    ASSERT_EQ(repository->Store(doc), 0);
    EXPECT_EQ(master.stores, 1);
    EXPECT_EQ(local.stores, 0);
    EXPECT_EQ(master.items.count({"master", kPath}), 1u);
    EXPECT_EQ(doc.timestamp(), BDateTime::Now());
    TestDocument read;
    ASSERT_EQ(repository->GetLatest(read), 0);
    EXPECT_EQ(read.name, "stored");
}

TEST_F(RepositoryTest, FailedStoreIsMinusOneButKeepsTheNewTimestamp) {
    master.down = true;
    Quorvex::Testing::LogCapture log;
    TestDocument doc;
    EXPECT_EQ(repository->Store(doc), -1);
    EXPECT_EQ(doc.timestamp(), BDateTime::Now());
    EXPECT_TRUE(log.containsFragment(
        "ConfigurationRepository::Store: Unable to send configuration via http. Standard "
        "Exception: service master unreachable"));
}

TEST_F(RepositoryTest, SignalChangedReachesEveryOtherHostAndSkipsTheLocalOne) {
    other.down = true;  // one unreachable host does not stop the others
    local.hosts = {"slave2", "SLAVE1", "master"};
    Quorvex::Testing::LogCapture log;
    repository->SignalChanged();
    EXPECT_EQ(local.changed, 0);
    EXPECT_EQ(master.changed, 1);
    EXPECT_TRUE(
        log.contains(LM_DEBUG, "ConfigurationRepository::SignalChanged: Signaling host master\n"));
    EXPECT_TRUE(log.containsFragment(
        "ConfigurationRepository::SignalChanged: Unable to signal configuration changed to host "
        "slave2. Standard Exception: service slave2 unreachable"));
}

TEST_F(RepositoryTest, RefreshAndRestartGoToTheLocalServiceOnly) {
    repository->SignalRefresh();
    repository->SignalRestart();
    EXPECT_EQ(local.refreshes, 1);
    EXPECT_EQ(local.restarts, 1);
    local.down = true;
    Quorvex::Testing::LogCapture log;
    repository->SignalRestart();
    EXPECT_TRUE(log.containsFragment(
        "ConfigurationRepository::SignalRestart: Unable to connect to local configuration web "
        "service. Standard Exception: "));
}

TEST_F(RepositoryTest, CacheMasterCopiesExactlyTheMissingAndChangedItemsAndNothingOnTheMaster) {
    master.put("master", "A", "a", "2010-01-01T00:00:00.000");
    master.put("slave2", "B", "b", "2010-01-01T00:00:00.000");
    master.put("master", "C", "c-new", "2010-01-02T00:00:00.000");
    local.put("master", "C", "c-old", "2010-01-01T00:00:00.000");
    local.put("slave1", "Own", "own", "2010-01-01T00:00:00.000");
    const int before = local.stores;
    ASSERT_EQ(repository->CacheMasterWebToLocalWeb(), 0);
    EXPECT_EQ(local.stores, before + 3);
    EXPECT_EQ(local.find("slave2", "B").bytes, "b");
    EXPECT_EQ(local.find("master", "C").bytes, "c-new");
    EXPECT_EQ(local.find("master", "C").time, "2010-01-02T00:00:00.000");  // the master's time
    ASSERT_EQ(repository->CacheMasterWebToLocalWeb(), 0);  // a second run copies nothing
    EXPECT_EQ(local.stores, before + 3);
    master.put("master", "D", "d", "2010-01-01T00:00:00.000");
    repository->SetMasterHostName("SLAVE1");  // on the master itself nothing is copied
    EXPECT_EQ(repository->CacheMasterWebToLocalWeb(), 0);
    EXPECT_EQ(local.stores, before + 3);
}

TEST_F(RepositoryTest, ServiceOperationsGoToTheRightHostAndReportFailures) {
    EXPECT_EQ(repository->RegisterService("Dicom", "tcp://x:104"), 0);
    ASSERT_EQ(master.registrations.size(), 1u);
    EXPECT_EQ(master.registrations[0], "slave1|Dicom|tcp://x:104");
    std::vector<ACE_CString> servers;
    EXPECT_EQ(repository->ListServers(servers), 0);
    EXPECT_EQ(servers.size(), 3u);
    EXPECT_EQ(repository->UnregisterService("Dicom"), 0);
    master.down = true;
    Quorvex::Testing::LogCapture log;
    EXPECT_EQ(repository->RegisterService("Dicom", "x"), -1);
    EXPECT_EQ(repository->SwitchoverPersistent("P2"), -1);
    EXPECT_EQ(repository->EnableMergeNetworkCapture(true), -1);
    EXPECT_TRUE(log.containsFragment(
        "ConfigurationRepository::RegisterService: Unable to register service Dicom via http. "
        "Standard Exception: service master unreachable"));
    EXPECT_EQ(repository->Remove("x", true), 0);
    EXPECT_TRUE(log.contains(LM_INFO, "ConfigurationRepository::Remove: Not implemented\n"));
}

}  // namespace
}  // namespace Configuration
