// The configuration operations of HttpConfigurationClient against a recording server: the exact
// request bodies, how answers are read, and the wrapped failures.
#include <gtest/gtest.h>

#include <cstring>

#include "Configuration/HttpConfigurationException.h"
#include "Quorvex/BDateTime.h"
#include "Quorvex/Host.h"
#include "repository/HttpClientTestSupport.h"
#include "testing/LogCapture.h"

namespace Configuration {
namespace {

using Quorvex::Testing::LogCapture;
using Testing::HttpClientTest;
using Testing::LegacyFailure;
using Testing::LegacyOk;
using Testing::ScriptedResponse;

const unsigned char DATA[] = {'a', 'b', 'c', 0, 0xff};

std::string str(const ACE_CString& text) {
    return std::string(text.c_str(), text.length());
}

class HttpClientOperations : public HttpClientTest {
protected:
    void answerNext(const std::string& body) { server().enqueue(ScriptedResponse::Ok(body)); }
};

TEST_F(HttpClientOperations, StoreSendsBase64AndTheTime) {
    makeClient().store("h1", "DicomScp", DATA, sizeof DATA, "2010-03-04T05:06:07");
    EXPECT_EQ(
        "<Store><Host>h1</Host><ConfigurationName>DicomScp</ConfigurationName>"
        "<Configuration>YWJjAP8=</Configuration>"
        "<LastModifiedTime>2010-03-04T05:06:07</LastModifiedTime></Store>",
        onlyBody());
}

TEST_F(HttpClientOperations, StoreWithoutTimeSendsNoTimeElement) {
    makeClient().store("h1", "n", DATA, 3, "");
    EXPECT_EQ(
        "<Store><Host>h1</Host><ConfigurationName>n</ConfigurationName>"
        "<Configuration>YWJj</Configuration></Store>",
        onlyBody());
}

TEST_F(HttpClientOperations, StoreMasterSendsItsOwnRoot) {
    makeClient().storeMaster("h<&", "n", DATA, 3, "t");
    EXPECT_EQ(
        "<StoreMaster><Host>h<&</Host><ConfigurationName>n</ConfigurationName>"
        "<Configuration>YWJj</Configuration><LastModifiedTime>t</LastModifiedTime></StoreMaster>",
        onlyBody());
}

TEST_F(HttpClientOperations, RetrieveDecodesTheDocument) {
    const HttpConfigurationClient client = makeClient();
    answerNext(LegacyOk("<Configuration>YWJjAP8=</Configuration>"));
    Quorvex::ByteArray data;
    std::size_t length = 0;
    client.retrieve("h1", "DicomScp", data, length);
    EXPECT_EQ("<Retrieve><Host>h1</Host><ConfigurationName>DicomScp</ConfigurationName></Retrieve>",
              onlyBody());
    ASSERT_EQ(sizeof DATA, length);
    EXPECT_EQ(0, std::memcmp(DATA, data.get(), length));
}

TEST_F(HttpClientOperations, RetrieveAllConfigurationsReturnsTheWholeAnswer) {
    const HttpConfigurationClient client = makeClient();
    answerNext("<Items>anything, unread</Items>");  // judged by status, not ReturnStatus
    EXPECT_EQ("<Items>anything, unread</Items>", str(client.retrieveAllConfigurations("h", "a,b")));
    EXPECT_EQ(
        "<RetrieveItems><Host>h</Host><ConfigurationName>a,b</ConfigurationName></RetrieveItems>",
        onlyBody());
}

TEST_F(HttpClientOperations, CheckForExistenceAcceptsOnlyOne) {
    const HttpConfigurationClient client = makeClient();
    bool exists = false;
    answerNext(LegacyOk("<ConfigurationExists>1</ConfigurationExists>"));
    client.checkForExistence("h", "n", exists);
    EXPECT_TRUE(exists);
    EXPECT_EQ("<Exists><Host>h</Host><ConfigurationName>n</ConfigurationName></Exists>",
              onlyBody());
    answerNext(LegacyOk("<ConfigurationExists>true</ConfigurationExists>"));
    client.checkForExistence("h", "n", exists);
    EXPECT_FALSE(exists);
}

TEST_F(HttpClientOperations, GetTimeStampParsesTheServiceTime) {
    const HttpConfigurationClient client = makeClient();
    answerNext(LegacyOk("<LastModifiedTime>2010-03-04T05:06:07.0890000-00:00</LastModifiedTime>"));
    BDateTime stamp;
    client.getTimeStamp("h", "n", stamp);
    EXPECT_EQ(BDateTime("2010-03-04T05:06:07.089"), stamp);
    EXPECT_EQ(
        "<GetLastModifiedTime><Host>h</Host><ConfigurationName>n</ConfigurationName>"
        "</GetLastModifiedTime>",
        onlyBody());
}

TEST_F(HttpClientOperations, GetServerInformationReturnsTheBlob) {
    const HttpConfigurationClient client = makeClient();
    answerNext(LegacyOk("<ServerInfoBlob>v=1 &amp; more</ServerInfoBlob>"));
    EXPECT_EQ("v=1 & more", str(client.getServerInformation()));
    EXPECT_EQ("<GetServerInfo></GetServerInfo>", onlyBody());
}

TEST_F(HttpClientOperations, GetServerInformationWithoutBlobReusesTheHostNameText) {
    const HttpConfigurationClient client = makeClient();
    answerNext(LegacyOk());
    try {
        client.getServerInformation();
        FAIL();
    } catch (const HttpConfigurationException&) {
        FAIL() << "a plain std::exception is expected";
    } catch (const std::exception& e) {
        EXPECT_STREQ("Unable to retrieve hostname for configuration service", e.what());
    }
}

std::string item(const std::string& host, const std::string& name, const std::string& time) {
    return "<ConfigurationItem><HostName>" + host + "</HostName><ConfigurationName>" + name +
           "</ConfigurationName><LastModifiedTime>" + time +
           "</LastModifiedTime></ConfigurationItem>";
}

TEST_F(HttpClientOperations, ListItemsReadsEveryItemInOrder) {
    const HttpConfigurationClient client = makeClient();
    answerNext(LegacyOk(item("h1", "A", "t1") + item("h2", "B&amp;C", "t2")));
    std::vector<_HttpConfigurationItemInfo> items(3);
    client.listItems("h", items);
    EXPECT_EQ("<ListItems><Host>h</Host></ListItems>", onlyBody());
    ASSERT_EQ(2u, items.size());
    EXPECT_EQ("h1", str(items[0].host));
    EXPECT_EQ("A", str(items[0].configurationName));
    EXPECT_EQ("t1", str(items[0].lastModifiedTime));
    EXPECT_EQ("B&C", str(items[1].configurationName));

    answerNext(LegacyOk());
    client.listItems("h", items);
    EXPECT_TRUE(items.empty());
}

TEST_F(HttpClientOperations, ListItemsStopsAtAnIncompleteItem) {
    const HttpConfigurationClient client = makeClient();
    const std::string second =
        "<ConfigurationItem><HostName>h2</HostName><ConfigurationName>B</ConfigurationName>"
        "</ConfigurationItem>";
    answerNext(LegacyOk(item("h1", "A", "t1") + second));
    std::vector<_HttpConfigurationItemInfo> items;
    try {
        client.listItems("h", items);
        FAIL();
    } catch (const HttpConfigurationException& e) {
        EXPECT_EQ("HttpConfigurationClient::listItems lastModifiedTime not found",
                  str(e.Message()));
    }
    ASSERT_EQ(1u, items.size());
    EXPECT_EQ("h1", str(items[0].host));
}

TEST_F(HttpClientOperations, ListItemsNamesTheMissingField) {
    const HttpConfigurationClient client = makeClient();
    const std::pair<std::string, std::string> cases[] = {
        {"<ConfigurationItem><ConfigurationName>B</ConfigurationName></ConfigurationItem>",
         "HttpConfigurationClient::listItems host not found"},
        {"<ConfigurationItem><HostName>h</HostName></ConfigurationItem>",
         "HttpConfigurationClient::listItems configurationName not found"}};
    for (const auto& c : cases) {
        answerNext(LegacyOk(c.first));
        std::vector<_HttpConfigurationItemInfo> items;
        try {
            client.listItems("h", items);
            FAIL();
        } catch (const HttpConfigurationException& e) {
            EXPECT_EQ(c.second, str(e.Message()));
        }
    }
}

TEST_F(HttpClientOperations, ListHostsKeepsAnswerOrderAndDuplicates) {
    const HttpConfigurationClient client = makeClient();
    answerNext(LegacyOk("<HostName>b</HostName><HostName>a</HostName><HostName>b</HostName>"));
    std::vector<ACE_CString> hosts(1, "old");
    client.listHosts(hosts);
    EXPECT_EQ("<ListHosts></ListHosts>", onlyBody());
    ASSERT_EQ(3u, hosts.size());
    EXPECT_EQ("b", str(hosts[0]));
    EXPECT_EQ("a", str(hosts[1]));
    EXPECT_EQ("b", str(hosts[2]));
}

TEST_F(HttpClientOperations, ListHostsByModuleTypeSendsTheNumber) {
    const HttpConfigurationClient client = makeClient();
    answerNext(LegacyOk());
    std::vector<ACE_CString> hosts(2);
    client.listHostsByModuleType(-8, hosts);
    EXPECT_TRUE(hosts.empty());
    EXPECT_EQ(
        "<ListHostsByModuleType><ModuleTypeFilter>-8</ModuleTypeFilter></ListHostsByModuleType>",
        onlyBody());
}

TEST_F(HttpClientOperations, RegisterServiceEscapesAndLogs) {
    const HttpConfigurationClient client = makeClient();
    LogCapture capture;
    client.registerService("h1", "Svc<1>", "a&b");
    EXPECT_EQ(
        "<RegisterService><HostName>h1</HostName><ServiceName>Svc&lt;1&gt;</ServiceName>"
        "<ConnectionString>a&amp;b</ConnectionString></RegisterService>",
        onlyBody());
    EXPECT_TRUE(capture.contains(
        LM_DEBUG, "HttpConfigurationClient::registerService: Register service Svc<1> with h1\n"));
    EXPECT_FALSE(capture.containsFragment("a&b"));
}

TEST_F(HttpClientOperations, UnregisterServiceNamesTheServicesHost) {
    makeClient().unregisterService("");
    EXPECT_EQ(
        "<UnregisterService><HostName>cfg-host</HostName><ServiceName></ServiceName>"
        "</UnregisterService>",
        onlyBody());
}

TEST_F(HttpClientOperations, SwitchoverPersistentSendsTheName) {
    makeClient().switchoverPersistent("Stack 2");
    EXPECT_EQ("<SwitchoverPersistent><Persistent>Stack 2</Persistent></SwitchoverPersistent>",
              onlyBody());
}

TEST_F(HttpClientOperations, EnableMergeNetworkCaptureSendsOneOrZero) {
    const HttpConfigurationClient client = makeClient();
    client.enableMergeNetworkCapture(false, "h1");
    EXPECT_EQ(
        "<EnableMergeNetworkCapture><Enable>0</Enable><Host>h1</Host></EnableMergeNetworkCapture>",
        onlyBody());
    server().clearRequests();
    client.enableMergeNetworkCapture(true, "h1");
    EXPECT_EQ(
        "<EnableMergeNetworkCapture><Enable>1</Enable><Host>h1</Host></EnableMergeNetworkCapture>",
        onlyBody());
}

TEST_F(HttpClientOperations, SignalsSendTheirFixedBodies) {
    const HttpConfigurationClient client = makeClient();
    client.signalChanged();
    EXPECT_EQ(
        "<Changed><FromServer>" + str(Quorvex::GetHostName(false)) + "</FromServer></Changed>",
        onlyBody());
    server().clearRequests();
    client.signalRestart();
    EXPECT_EQ("<Restart></Restart>", onlyBody());
    server().clearRequests();
    client.signalRefresh();
    EXPECT_EQ("<Refresh></Refresh>", onlyBody());
}

// A document operation: its call, its message prefix and its log text.
struct Wrapped {
    const char* name;
    std::function<void(const HttpConfigurationClient&)> call;
    const char* prefix;
    const char* logFormat;
};

std::vector<Wrapped> wrappedOperations() {
    return {
        {"store", [](const HttpConfigurationClient& c) { c.store("h", "n", DATA, 1, ""); },
         "HttpConfigurationClient::store ", "HttpConfigurationClient::store: Standard Exception: "},
        {"storeMaster",
         [](const HttpConfigurationClient& c) { c.storeMaster("h", "n", DATA, 1, ""); },
         "HttpConfigurationClient::store ",
         "HttpConfigurationClient::storeMaster: Standard Exception: "},
        {"retrieve",
         [](const HttpConfigurationClient& c) {
             Quorvex::ByteArray data;
             std::size_t length = 0;
             c.retrieve("h", "n", data, length);
         },
         "HttpConfigurationClient::retrieve: ",
         "HttpConfigurationClient::retrieve: Standard Exception: "},
        {"checkForExistence",
         [](const HttpConfigurationClient& c) {
             bool exists = false;
             c.checkForExistence("h", "n", exists);
         },
         "HttpConfigurationClient::checkForExistence ",
         "HttpConfigurationClient::checkForExistence: Standard Exception: "},
        {"getTimeStamp",
         [](const HttpConfigurationClient& c) {
             BDateTime stamp;
             c.getTimeStamp("h", "n", stamp);
         },
         "HttpConfigurationClient::getLastModifiedTime ",
         "HttpConfigurationClient::getLastModifiedTime: Standard Exception: "},
    };
}

// Runs call expecting exactly an HttpConfigurationException with message; checks the log line.
void expectWrapped(const Wrapped& operation, const HttpConfigurationClient& client,
                   const std::string& inner) {
    SCOPED_TRACE(operation.name);
    LogCapture capture;
    try {
        operation.call(client);
        ADD_FAILURE() << "no exception";
    } catch (const HttpConfigurationException& e) {
        EXPECT_EQ(typeid(HttpConfigurationException), typeid(e));
        EXPECT_EQ(operation.prefix + inner, str(e.Message()));
    }
    EXPECT_TRUE(capture.contains(LM_DEBUG, operation.logFormat + inner + "\n"));
}

TEST_F(HttpClientOperations, DocumentOperationsWrapALegacyErrorMessage) {
    const HttpConfigurationClient client = makeClient();
    server().setDefault(ScriptedResponse::Ok(LegacyFailure("<ErrorMessage>denied</ErrorMessage>")));
    for (const auto& operation : wrappedOperations()) {
        expectWrapped(operation, client, "denied");
    }
}

TEST_F(HttpClientOperations, DocumentOperationsWrapTransportFailures) {
    const HttpConfigurationClient client = makeClient();
    server().setDefault(ScriptedResponse::Close());
    for (const auto& operation : wrappedOperations()) {
        expectWrapped(operation, client,
                      "HttpConfigurationException: HttpConfigurationClient::send error receiving "
                      "HTTP response\n");
    }
}

TEST_F(HttpClientOperations, RetrieveAllConfigurationsWrapsStatusErrors) {
    const HttpConfigurationClient client = makeClient();
    server().enqueue(ScriptedResponse::Status(
        500,
        "<ErrorKey>CF919CA8-84FE-4214-9343-C24F6E6B92B2</ErrorKey><ErrorMessage>gone"
        "</ErrorMessage>"));
    LogCapture capture;
    try {
        client.retrieveAllConfigurations("h", "n");
        FAIL();
    } catch (const HttpConfigurationException& e) {
        EXPECT_EQ(typeid(HttpConfigurationException), typeid(e));
        EXPECT_EQ("HttpConfigurationClient::retrieve: HttpConfigurationException: gone",
                  str(e.Message()));
    }
    EXPECT_TRUE(capture.contains(LM_DEBUG,
                                 "HttpConfigurationClient::retrieve: Standard Exception: "
                                 "HttpConfigurationException: gone\n"));
}

TEST_F(HttpClientOperations, MissingAnswerElementsAreWrappedWithTheirTexts) {
    const HttpConfigurationClient client = makeClient();
    const auto operations = wrappedOperations();
    const std::pair<std::size_t, const char*> cases[] = {
        {2, "HttpConfigurationException: No configuration found in response"},
        {3, "HttpConfigurationException: ConfigurationExists not found in response"},
        {4, "HttpConfigurationException: Last modified time not found in response"}};
    for (const auto& c : cases) {
        expectWrapped(operations[c.first], client, c.second);
    }
}

TEST_F(HttpClientOperations, RetrieveWrapsBadBase64) {
    const HttpConfigurationClient client = makeClient();
    answerNext(LegacyOk("<Configuration>@@@</Configuration>"));
    Quorvex::ByteArray data;
    std::size_t length = 0;
    try {
        client.retrieve("h", "n", data, length);
        FAIL();
    } catch (const HttpConfigurationException& e) {
        EXPECT_EQ(0u, str(e.Message()).find("HttpConfigurationClient::retrieve: "));
    }
}

TEST_F(HttpClientOperations, OtherOperationsLetTheErrorsThrough) {
    const HttpConfigurationClient client = makeClient();
    server().setDefault(ScriptedResponse::Ok(LegacyFailure("<ErrorMessage>no</ErrorMessage>")));
    std::vector<ACE_CString> hosts;
    const std::function<void()> calls[] = {
        [&] { client.signalRestart(); }, [&] { client.listHosts(hosts); },
        [&] { client.registerService("h", "s", "c"); }, [&] { client.unregisterService("s"); },
        [&] { client.switchoverPersistent("p"); }};
    for (const auto& call : calls) {
        try {
            call();
            ADD_FAILURE() << "no exception";
        } catch (const HttpConfigurationException&) {
            ADD_FAILURE() << "the legacy error message is a plain std::exception";
        } catch (const std::exception& e) {
            EXPECT_STREQ("no", e.what());
        }
    }
}

}  // namespace
}  // namespace Configuration
