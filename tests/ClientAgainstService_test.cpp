// The library's HttpConfigurationClient against the real configuration service: documents in and
// out, listings, site switches, and the failures as the client reports them. (Each operation's
// request and answer texts are pinned on both sides by the client's and the service's own tests.)
#include <gtest/gtest.h>

#include "Configuration/HttpConfigurationClient.h"
#include "Configuration/HttpConfigurationException.h"
#include "InProcessService.h"
#include "Quorvex/BDateTime.h"
#include "repository/DirectoryStore.h"

namespace Configuration {
namespace {

using ServiceTesting::InProcessService;

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

TEST_F(ClientAgainstService, StoreRetrieveExistsAndTimeStamp) {
    const std::string bytes("\0\x01\xfe\xff binary", 11);
    store("Orvel1", "BrimmetServer\\Location", bytes, "2010-03-04T05:06:07.089");
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
    try {
        client.retrieveAllConfigurations("h", "Absent");
        FAIL() << "no exception";
    } catch (const HttpConfigurationException& e) {
        // The path-not-found exception arrives wrapped; its text is kept.
        EXPECT_NE(std::string(e.what()).find("not found"), std::string::npos);
    }
}

TEST_F(ClientAgainstService, ListItemsOfOneHostAndOfAll) {
    store("a", "One", "1");
    store("b", "Two", "2");
    std::vector<_HttpConfigurationItemInfo> items;
    client.listItems("A", items);
    ASSERT_EQ(items.size(), 1u);
    EXPECT_EQ(items[0].configurationName, "One");
    EXPECT_TRUE(BDateTime(items[0].lastModifiedTime).isValid());
    client.listItems("*", items);
    EXPECT_EQ(items.size(), 2u);
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

TEST_F(ClientAgainstService, WithoutTheTicketNothingIsStored) {
    HttpConfigurationClient stranger(service.address().c_str(), false, false);
    EXPECT_EQ(stranger.hostName(), "TestHost");  // the host names need no ticket
    EXPECT_EQ(stranger.masterHostName(), "TestHost");
    EXPECT_THROW(stranger.store("h", "n", reinterpret_cast<const unsigned char*>("x"), 1, ""),
                 HttpConfigurationException);
    std::vector<ACE_CString> hosts;
    EXPECT_THROW(stranger.listHosts(hosts), std::exception);
    EXPECT_EQ(service.server().store().size(), 0u);
}

}  // namespace
}  // namespace Configuration
