// The library's HttpConfigurationClient against the real configuration service: every
// configuration operation, and the failures as the client reports them.
#include <gtest/gtest.h>

#include "Common/NamedEvent.h"
#include "Configuration/HttpConfigurationClient.h"
#include "Configuration/HttpConfigurationPathNotFoundException.h"
#include "Configuration/StoredForm.h"
#include "InProcessService.h"
#include "Quorvex/BDateTime.h"
#include "Store/DirectoryStore.h"
#include "Vesk/XmlUtils.h"

namespace Configuration {
namespace {

using ServiceTesting::InProcessService;

const char kEvent[] = "Global\\QuorvexSlaveConfigurationChanged";

class ClientAgainstService : public ::testing::Test {
protected:
    ClientAgainstService() : client(service.address().c_str(), true, false) {}

    void store(const char* host, const char* name, const std::string& bytes,
               const char* time = "") {
        client.store(host, name, reinterpret_cast<const unsigned char*>(bytes.data()), bytes.size(),
                     time);
    }

    InProcessService service;
    HttpConfigurationClient client;
};

Vesk::Element tree(const char* key, const char* value) {
    Vesk::Element root(key);
    root.addMultiElement().addElement("Value", {}, -1).addSingle().assign(value);
    return root;
}

TEST_F(ClientAgainstService, KnowsTheServiceAndItsMaster) {
    EXPECT_EQ(client.hostName(), "TestHost");
    EXPECT_EQ(client.masterHostName(), "TestHost");
}

TEST_F(ClientAgainstService, StoreRetrieveExistsAndTimeStamp) {
    const std::string bytes("\0\x01\xfe\xff binary", 11);
    // The service's own time form, with its seven digits and zone, is taken as the time it says.
    store("Orvel1", "BrimmetServer\\Location", bytes, "2010-03-04T05:06:07.0890000-00:00");
    Quorvex::ByteArray data;
    std::size_t length = 0;
    client.retrieve("ORVEL1", "BrimmetServer\\Location", data, length);
    EXPECT_EQ(std::string(reinterpret_cast<const char*>(data.get()), length), bytes);
    bool exists = false;
    client.checkForExistence("orvel1", "BrimmetServer\\Location", exists);
    EXPECT_TRUE(exists);
    client.checkForExistence("orvel1", "Absent", exists);
    EXPECT_FALSE(exists);
    BDateTime time;
    client.getTimeStamp("orvel1", "BrimmetServer\\Location", time);
    EXPECT_EQ(time, BDateTime("2010-03-04T05:06:07.089"));
}

TEST_F(ClientAgainstService, StoreMasterOnTheMasterStoresHere) {
    client.storeMaster("h", "n", reinterpret_cast<const unsigned char*>("abc"), 3, "");
    EXPECT_TRUE(service.server().store().exists("h", "n"));
}

TEST_F(ClientAgainstService, MissingDocumentsRaiseTheClientsExceptions) {
    Quorvex::ByteArray data;
    std::size_t length = 0;
    try {
        client.retrieve("h", "Absent", data, length);
        FAIL() << "no exception";
    } catch (const HttpConfigurationException& e) {
        EXPECT_EQ(std::string(e.Message().c_str()).rfind("HttpConfigurationClient::retrieve: ", 0),
                  0u);
        EXPECT_NE(std::string(e.what()).find("not found"), std::string::npos);
    }
    BDateTime time;
    EXPECT_THROW(client.getTimeStamp("h", "Absent", time), HttpConfigurationException);
    // None of the names exists: an empty answer, which the store access reports as such.
    EXPECT_EQ(client.retrieveAllConfigurations("h", "Absent,Other").length(), 0u);
    store("h", "Present", StoredForm::encode(tree("P", "1")));
    try {
        client.retrieveAllConfigurations("h", "Present;Absent");
        FAIL() << "no exception";
    } catch (const HttpConfigurationException& e) {
        // The path-not-found exception arrives wrapped; its text is kept.
        EXPECT_NE(std::string(e.what()).find("not found"), std::string::npos);
    }
}

TEST_F(ClientAgainstService, RetrieveAllConfigurationsAnswersTheTrees) {
    const std::string one = StoredForm::encode(tree("One", "1"));
    const std::string two = StoredForm::encode(tree("Two", "2"));
    store("h", "X\\One", one);
    store("h", "X\\Two", two);
    const ACE_CString answer = client.retrieveAllConfigurations("h", "X\\One;X\\Two");
    Vesk::Element root;
    Vesk::XmlUtils::parse(answer.c_str(), answer.length(), root);
    ASSERT_EQ(root.getMultiElement().size(), 2u);
    auto item = root.getMultiElement().begin();
    EXPECT_EQ(*item->getMultiElement().begin(), tree("One", "1"));
    ++item;
    EXPECT_EQ(*item->getMultiElement().begin(), tree("Two", "2"));
}

TEST_F(ClientAgainstService, ListItemsOfOneHostAndOfAll) {
    store("a", "One", "1");
    store("b", "Two", "2");
    std::vector<_HttpConfigurationItemInfo> items;
    client.listItems("A", items);
    ASSERT_EQ(items.size(), 1u);
    EXPECT_EQ(items[0].configurationName, "One");
    EXPECT_EQ(items[0].host, "a");  // the host as it was stored
    EXPECT_TRUE(BDateTime(items[0].lastModifiedTime).isValid());
    client.listItems("*", items);
    EXPECT_EQ(items.size(), 2u);
    client.listItems("c", items);
    EXPECT_TRUE(items.empty());
}

TEST_F(ClientAgainstService, RegisteredServicesMakeTheHostList) {
    client.registerService("Slave1", "Storage", "ModuleType=7;Port=104");
    client.registerService("SLAVE1", "Query", "ModuleType=8");  // one host, whatever the case
    client.registerService(client.hostName(), "Query", "ModuleType=8");
    std::vector<ACE_CString> hosts;
    client.listHosts(hosts);
    EXPECT_EQ(hosts, (std::vector<ACE_CString>{"Slave1", "TestHost"}));
    client.listHostsByModuleType(7, hosts);
    EXPECT_EQ(hosts, std::vector<ACE_CString>{"Slave1"});
    client.unregisterService("Query");  // of the service's own host
    client.listHosts(hosts);
    EXPECT_EQ(hosts, std::vector<ACE_CString>{"Slave1"});
}

TEST_F(ClientAgainstService, SiteSwitchesAreKept) {
    client.switchoverPersistent("Stack <2> & more");
    client.enableMergeNetworkCapture(false, "Slave1");
    ACE_CString value;
    ASSERT_TRUE(service.server().store().setting("PersistentStorage", value));
    EXPECT_EQ(value, "Stack <2> & more");
    ASSERT_TRUE(service.server().store().setting("MergeNetworkCapture:slave1", value));
    EXPECT_EQ(value, "0");
}

TEST_F(ClientAgainstService, ServerInformationIsAnElementTree) {
    const ACE_CString text = client.getServerInformation();
    Vesk::Element info;
    Vesk::XmlUtils::parse(text.c_str(), text.length(), info);
    EXPECT_EQ(info.getMultiElement().getElement("HostName").getSingle().value(), "TestHost");
    EXPECT_EQ(info.getMultiElement().getElement("IsMaster").getSingle().value(), "1");
}

TEST_F(ClientAgainstService, SignalsSetTheMachineEvent) {
    Common::NamedEvent event(kEvent);
    client.signalChanged();
    EXPECT_TRUE(event.wait(5000));
    event.reset();
    client.signalRefresh();
    EXPECT_TRUE(event.wait(5000));
    event.reset();
    client.signalRestart();
    EXPECT_TRUE(event.wait(5000));
}

TEST_F(ClientAgainstService, WithoutTheTicketNothingIsStored) {
    HttpConfigurationClient stranger(service.address().c_str(), false, false);
    EXPECT_EQ(stranger.hostName(), "TestHost");  // the host names need no ticket
    EXPECT_THROW(stranger.store("h", "n", reinterpret_cast<const unsigned char*>("x"), 1, ""),
                 HttpConfigurationException);
    std::vector<ACE_CString> hosts;
    EXPECT_THROW(stranger.listHosts(hosts), std::exception);
    EXPECT_EQ(service.server().store().size(), 0u);
}

}  // namespace
}  // namespace Configuration
