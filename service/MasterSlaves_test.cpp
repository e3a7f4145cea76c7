// A master and two slaves on loopback, each its own process, store and event directory.
#include <gtest/gtest.h>

#include <cstdlib>

#include "ChangeNotifier.h"
#include "Common/NamedEvent.h"
#include "RawPost.h"
#include "ServiceProcess.h"
#include "TicketFile.h"
#include "testing/ScratchDir.h"

namespace ConfigurationService {
namespace {

using ServiceTesting::elementText;
using ServiceTesting::itemBody;
using ServiceTesting::ServiceProcess;

const char kCookie[] = "OrvelWebApplication=site-ticket";

ServiceProcess::Settings machine(const Quorvex::Testing::ScratchDir& scratch,
                                 const std::string& host, const std::string& master) {
    ServiceProcess::Settings settings;
    settings.storeDirectory = scratch.file(host + "-store");
    settings.eventDirectory = scratch.file(host + "-events");
    settings.hostName = host;
    settings.masterAddress = master;
    return settings;
}

std::string post(const ServiceProcess& service, const std::string& body) {
    return ServiceTesting::rawPost(service.port(), body, kCookie).body;
}

std::string storeBody(const std::string& operation, const std::string& host,
                      const std::string& name, const std::string& base64) {
    return itemBody(operation, host, name, "<Configuration>" + base64 + "</Configuration>");
}

class MasterSlaves : public ::testing::Test {
protected:
    MasterSlaves()
        : ticket(scratch.path(), "site-ticket"),
          master(machine(scratch, "Master", "")),
          slave1(machine(scratch, "Slave1", master.address())),
          slave2(machine(scratch, "Slave2", master.address())) {}

    Quorvex::Testing::ScratchDir scratch;
    ServiceTesting::TicketFile ticket;
    ServiceProcess master;
    ServiceProcess slave1;
    ServiceProcess slave2;
};

TEST_F(MasterSlaves, SlavesKnowTheirMaster) {
    EXPECT_EQ(elementText(post(slave1, "<GetMasterHostName></GetMasterHostName>"), "HostName"),
              "Master");
    EXPECT_EQ(elementText(post(slave2, "<GetHostName></GetHostName>"), "HostName"), "Slave2");
}

TEST_F(MasterSlaves, StoreMasterOnASlaveLandsOnTheMasterWithOneTime) {
    ASSERT_EQ(
        elementText(post(slave1, storeBody("StoreMaster", "Slave1", "Brimmet\\Doc", "c2xhdmUx")),
                    "ReturnStatus"),
        "1");
    EXPECT_EQ(
        elementText(post(master, itemBody("Retrieve", "slave1", "Brimmet\\Doc")), "Configuration"),
        "c2xhdmUx");
    const std::string onMaster =
        elementText(post(master, itemBody("GetLastModifiedTime", "Slave1", "Brimmet\\Doc")),
                    "LastModifiedTime");
    const std::string onSlave =
        elementText(post(slave1, itemBody("GetLastModifiedTime", "Slave1", "Brimmet\\Doc")),
                    "LastModifiedTime");
    EXPECT_EQ(onMaster, onSlave);
    EXPECT_NE(onMaster, "<none>");
}

TEST_F(MasterSlaves, ListItemsWithStarOnTheMasterListsEveryHost) {
    post(slave1, storeBody("StoreMaster", "Slave1", "One", "AA=="));
    post(slave2, storeBody("StoreMaster", "Slave2", "Two", "AA=="));
    post(master, storeBody("Store", "Master", "Own", "AA=="));
    const std::string all = post(master, "<ListItems><Host>*</Host></ListItems>");
    EXPECT_NE(all.find("<HostName>Slave1</HostName><ConfigurationName>One<"), std::string::npos);
    EXPECT_NE(all.find("<HostName>Slave2</HostName><ConfigurationName>Two<"), std::string::npos);
    EXPECT_NE(all.find("<HostName>Master</HostName><ConfigurationName>Own<"), std::string::npos);
}

TEST_F(MasterSlaves, PlainStoreOnASlaveStaysLocal) {
    post(slave1, storeBody("Store", "Slave1", "LocalOnly", "AA=="));
    EXPECT_EQ(
        elementText(post(master, itemBody("Exists", "Slave1", "LocalOnly")), "ConfigurationExists"),
        "0");
    EXPECT_EQ(
        elementText(post(slave1, itemBody("Exists", "Slave1", "LocalOnly")), "ConfigurationExists"),
        "1");
}

TEST_F(MasterSlaves, ChangedSetsOnlyThatMachinesEvent) {
    ::setenv("QUORVEX_EVENT_DIR", scratch.file("Slave1-events").c_str(), 1);
    Common::NamedEvent first(ChangeNotifier::kEventName);
    ::setenv("QUORVEX_EVENT_DIR", scratch.file("Slave2-events").c_str(), 1);
    Common::NamedEvent second(ChangeNotifier::kEventName);
    EXPECT_EQ(elementText(post(slave1, "<Changed><FromServer>Master</FromServer></Changed>"),
                          "ReturnStatus"),
              "1");
    EXPECT_TRUE(first.wait(5000));
    EXPECT_FALSE(second.wait(200));
}

TEST_F(MasterSlaves, StoreMasterFailsCleanlyWhenTheMasterIsDown) {
    master.stop(SIGTERM);
    const std::string answer = post(slave2, storeBody("StoreMaster", "Slave2", "Lost", "AA=="));
    EXPECT_EQ(elementText(answer, "ReturnStatus"), "0");
    EXPECT_NE(elementText(answer, "ErrorMessage").find("master"), std::string::npos);
    EXPECT_EQ(
        elementText(post(slave2, itemBody("Exists", "Slave2", "Lost")), "ConfigurationExists"),
        "0");
}

}  // namespace
}  // namespace ConfigurationService
