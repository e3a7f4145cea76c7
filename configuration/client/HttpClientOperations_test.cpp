// The configuration operations of HttpConfigurationClient against a recording server: the exact
// request bodies, how answers are read, and the wrapped failures.
#include <gtest/gtest.h>

#include <cstring>

#include "Configuration/HttpConfigurationException.h"
#include "Quorvex/BDateTime.h"
#include "Quorvex/Host.h"
#include "client/HttpClientTestSupport.h"
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

// Expects call to fail with a plain std::exception (not an HttpConfigurationException).
void expectPlainError(const std::function<void()>& call, const char* message) {
    try {
        call();
        ADD_FAILURE() << "no exception";
    } catch (const HttpConfigurationException& e) {
        ADD_FAILURE() << "a plain std::exception is expected, not " << e.what();
    } catch (const std::exception& e) {
        EXPECT_STREQ(message, e.what());
    }
}

class HttpClientOperations : public HttpClientTest {
protected:
    void answerNext(const std::string& body) { server().enqueue(ScriptedResponse::Ok(body)); }

    const HttpConfigurationClient client = makeClient();  // every test's client
};

using Call = std::function<void(const HttpConfigurationClient&)>;

// The request bodies are the service's protocol, byte for byte.
TEST_F(HttpClientOperations, EachOperationSendsItsExactBody) {
    server().setDefault(ScriptedResponse::Ok(
        LegacyOk("<Configuration>YWJj</Configuration><ConfigurationExists>1</ConfigurationExists>"
                 "<LastModifiedTime>2010-03-04T05:06:07</LastModifiedTime>"
                 "<ServerInfoBlob>i</ServerInfoBlob>")));
    Quorvex::ByteArray data;
    std::size_t length = 0;
    bool exists = false;
    BDateTime stamp;
    std::vector<_HttpConfigurationItemInfo> items;
    std::vector<ACE_CString> hosts;
    const std::pair<Call, std::string> cases[] = {
        {[](auto& c) { c.store("h1", "DicomScp", DATA, sizeof DATA, "2010-03-04T05:06:07"); },
         "<Store><Host>h1</Host><ConfigurationName>DicomScp</ConfigurationName>"
         "<Configuration>YWJjAP8=</Configuration>"
         "<LastModifiedTime>2010-03-04T05:06:07</LastModifiedTime></Store>"},
        {[](auto& c) { c.store("h1", "n", DATA, 3, ""); },
         "<Store><Host>h1</Host><ConfigurationName>n</ConfigurationName>"
         "<Configuration>YWJj</Configuration></Store>"},
        {[](auto& c) { c.storeMaster("h<&", "n", DATA, 3, "t"); },
         "<StoreMaster><Host>h<&</Host><ConfigurationName>n</ConfigurationName>"
         "<Configuration>YWJj</Configuration><LastModifiedTime>t</LastModifiedTime></StoreMaster>"},
        {[&](auto& c) { c.retrieve("h1", "DicomScp", data, length); },
         "<Retrieve><Host>h1</Host><ConfigurationName>DicomScp</ConfigurationName></Retrieve>"},
        {[](auto& c) { c.retrieveAllConfigurations("h", "a,b"); },
         "<RetrieveItems><Host>h</Host><ConfigurationName>a,b</ConfigurationName></RetrieveItems>"},
        {[&](auto& c) { c.checkForExistence("h", "n", exists); },
         "<Exists><Host>h</Host><ConfigurationName>n</ConfigurationName></Exists>"},
        {[&](auto& c) { c.getTimeStamp("h", "n", stamp); },
         "<GetLastModifiedTime><Host>h</Host><ConfigurationName>n</ConfigurationName>"
         "</GetLastModifiedTime>"},
        {[](auto& c) { c.getServerInformation(); }, "<GetServerInfo></GetServerInfo>"},
        {[&](auto& c) { c.listItems("h", items); }, "<ListItems><Host>h</Host></ListItems>"},
        {[&](auto& c) { c.listHosts(hosts); }, "<ListHosts></ListHosts>"},
        {[&](auto& c) { c.listHostsByModuleType(-8, hosts); },
         "<ListHostsByModuleType><ModuleTypeFilter>-8</ModuleTypeFilter></ListHostsByModuleType>"},
        {[](auto& c) { c.registerService("h1", "Svc<1>", "a&b"); },
         "<RegisterService><HostName>h1</HostName><ServiceName>Svc&lt;1&gt;</ServiceName>"
         "<ConnectionString>a&amp;b</ConnectionString></RegisterService>"},
        {[](auto& c) { c.unregisterService(""); },  // names the service's own host
         "<UnregisterService><HostName>cfg-host</HostName><ServiceName></ServiceName>"
         "</UnregisterService>"},
        {[](auto& c) { c.switchoverPersistent("Stack 2"); },
         "<SwitchoverPersistent><Persistent>Stack 2</Persistent></SwitchoverPersistent>"},
        {[](auto& c) { c.enableMergeNetworkCapture(false, "h1"); },
         "<EnableMergeNetworkCapture><Enable>0</Enable><Host>h1</Host></"
         "EnableMergeNetworkCapture>"},
        {[](auto& c) { c.enableMergeNetworkCapture(true, "h1"); },
         "<EnableMergeNetworkCapture><Enable>1</Enable><Host>h1</Host></"
         "EnableMergeNetworkCapture>"},
        {[](auto& c) { c.signalChanged(); },
         "<Changed><FromServer>" + str(Quorvex::GetHostName(false)) + "</FromServer></Changed>"},
        {[](auto& c) { c.signalRestart(); }, "<Restart></Restart>"},
        {[](auto& c) { c.signalRefresh(); }, "<Refresh></Refresh>"},
    };
    for (const auto& c : cases) {
        server().clearRequests();
        c.first(client);
        EXPECT_EQ(c.second, onlyBody());
    }
}

// As written by the service, and wrapped in lines (also with the line ends as character
// references) as some services and proxies send it.
TEST_F(HttpClientOperations, RetrieveDecodesTheDocument) {
    for (const char* encoded :
         {"YWJjAP8=", "YWJj\r\nAP8=\r\n", "\n  YWJj\n  AP8=\n", "YWJj&#13;&#10;AP8=&#xD;&#xA;"}) {
        answerNext(LegacyOk(std::string("<Configuration>") + encoded + "</Configuration>"));
        Quorvex::ByteArray data;
        std::size_t length = 0;
        client.retrieve("h1", "DicomScp", data, length);
        ASSERT_EQ(sizeof DATA, length) << encoded;
        EXPECT_EQ(0, std::memcmp(DATA, data.get(), length)) << encoded;
    }
}

TEST_F(HttpClientOperations, RetrieveAllConfigurationsReturnsTheWholeAnswer) {
    answerNext("<Items>anything, unread</Items>");  // judged by status, not ReturnStatus
    EXPECT_EQ("<Items>anything, unread</Items>", str(client.retrieveAllConfigurations("h", "a,b")));
}

TEST_F(HttpClientOperations, CheckForExistenceAcceptsOnlyOne) {
    bool exists = false;
    answerNext(LegacyOk("<ConfigurationExists>1</ConfigurationExists>"));
    client.checkForExistence("h", "n", exists);
    EXPECT_TRUE(exists);
    answerNext(LegacyOk("<ConfigurationExists>true</ConfigurationExists>"));
    client.checkForExistence("h", "n", exists);
    EXPECT_FALSE(exists);
}

TEST_F(HttpClientOperations, GetTimeStampParsesTheServiceTime) {
    answerNext(LegacyOk("<LastModifiedTime>2010-03-04T05:06:07.0890000-00:00</LastModifiedTime>"));
    BDateTime stamp;
    client.getTimeStamp("h", "n", stamp);
    EXPECT_EQ(BDateTime("2010-03-04T05:06:07.089"), stamp);
}

TEST_F(HttpClientOperations, GetServerInformationReturnsTheBlobOrReusesTheHostNameText) {
    answerNext(LegacyOk("<ServerInfoBlob>v=1 &amp; more</ServerInfoBlob>"));
    EXPECT_EQ("v=1 & more", str(client.getServerInformation()));
    answerNext(LegacyOk());
    expectPlainError([&] { client.getServerInformation(); },
                     "Unable to retrieve hostname for configuration service");
}

std::string item(const std::string& host, const std::string& name, const std::string& time) {
    return "<ConfigurationItem><HostName>" + host + "</HostName><ConfigurationName>" + name +
           "</ConfigurationName><LastModifiedTime>" + time +
           "</LastModifiedTime></ConfigurationItem>";
}

TEST_F(HttpClientOperations, ListItemsReadsEveryItemInOrder) {
    answerNext(LegacyOk(item("h1", "A", "t1") + item("h2", "B&amp;C", "t2")));
    std::vector<_HttpConfigurationItemInfo> items(3);
    client.listItems("h", items);
    ASSERT_EQ(2u, items.size());
    EXPECT_EQ("h1", str(items[0].host));
    EXPECT_EQ("A", str(items[0].configurationName));
    EXPECT_EQ("t1", str(items[0].lastModifiedTime));
    EXPECT_EQ("B&C", str(items[1].configurationName));

    answerNext(LegacyOk());
    client.listItems("h", items);
    EXPECT_TRUE(items.empty());
}

// An incomplete item ends the list with an error naming its missing field; earlier items stay.
TEST_F(HttpClientOperations, ListItemsStopsAtAnIncompleteItemNamingTheField) {
    const std::pair<std::string, std::string> cases[] = {
        {"<ConfigurationName>B</ConfigurationName>", "host"},
        {"<HostName>h</HostName>", "configurationName"},
        {"<HostName>h</HostName><ConfigurationName>B</ConfigurationName>", "lastModifiedTime"}};
    for (const auto& c : cases) {
        answerNext(LegacyOk(item("h1", "A", "t1") + "<ConfigurationItem>" + c.first +
                            "</ConfigurationItem>"));
        std::vector<_HttpConfigurationItemInfo> items;
        try {
            client.listItems("h", items);
            ADD_FAILURE() << "no exception";
        } catch (const HttpConfigurationException& e) {
            EXPECT_EQ("HttpConfigurationClient::listItems " + c.second + " not found",
                      str(e.Message()));
        }
        ASSERT_EQ(1u, items.size());
        EXPECT_EQ("h1", str(items[0].host));
    }
}

TEST_F(HttpClientOperations, ListHostsReplaceTheListKeepingAnswerOrderAndDuplicates) {
    answerNext(LegacyOk("<HostName>b</HostName><HostName>a</HostName><HostName>b</HostName>"));
    std::vector<ACE_CString> hosts(1, "old");
    client.listHosts(hosts);
    EXPECT_EQ((std::vector<ACE_CString>{"b", "a", "b"}), hosts);
    answerNext(LegacyOk());
    client.listHostsByModuleType(-8, hosts);
    EXPECT_TRUE(hosts.empty());
}

TEST_F(HttpClientOperations, RegisterServiceLogsWithoutTheConnectionString) {
    LogCapture capture;
    client.registerService("h1", "Svc<1>", "a&b");
    EXPECT_TRUE(capture.contains(
        LM_DEBUG, "HttpConfigurationClient::registerService: Register service Svc<1> with h1\n"));
    EXPECT_FALSE(capture.containsFragment("a&b"));
}

// A document operation: its call, its message prefix and its log text.
struct Wrapped {
    const char* name;
    Call call;
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

// Runs the operation expecting exactly an HttpConfigurationException with its prefix and inner;
// checks the log line.
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
    server().setDefault(ScriptedResponse::Ok(LegacyFailure("<ErrorMessage>denied</ErrorMessage>")));
    for (const auto& operation : wrappedOperations()) {
        expectWrapped(operation, client, "denied");
    }
}

TEST_F(HttpClientOperations, DocumentOperationsWrapTransportFailures) {
    server().setDefault(ScriptedResponse::Close());
    for (const auto& operation : wrappedOperations()) {
        expectWrapped(operation, client,
                      "HttpConfigurationException: HttpConfigurationClient::send error receiving "
                      "HTTP response\n");
    }
}

TEST_F(HttpClientOperations, RetrieveAllConfigurationsWrapsStatusErrors) {
    server().enqueue(ScriptedResponse::Status(
        500,
        "<ErrorKey>CF919CA8-84FE-4214-9343-C24F6E6B92B2</ErrorKey><ErrorMessage>gone"
        "</ErrorMessage>"));
    const Wrapped operation{"retrieveAllConfigurations",
                            [](auto& c) { c.retrieveAllConfigurations("h", "n"); },
                            "HttpConfigurationClient::retrieve: ",
                            "HttpConfigurationClient::retrieve: Standard Exception: "};
    expectWrapped(operation, client, "HttpConfigurationException: gone");
}

TEST_F(HttpClientOperations, MissingAnswerElementsAreWrappedWithTheirTexts) {
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
    answerNext(LegacyOk("<Configuration>@@@</Configuration>"));
    try {
        wrappedOperations()[2].call(client);
        FAIL();
    } catch (const HttpConfigurationException& e) {
        EXPECT_EQ(0u, str(e.Message()).find("HttpConfigurationClient::retrieve: "));
    }
}

TEST_F(HttpClientOperations, OtherOperationsLetTheErrorsThrough) {
    server().setDefault(ScriptedResponse::Ok(LegacyFailure("<ErrorMessage>no</ErrorMessage>")));
    std::vector<ACE_CString> hosts;
    const std::function<void()> calls[] = {
        [&] { client.signalRestart(); }, [&] { client.listHosts(hosts); },
        [&] { client.registerService("h", "s", "c"); }, [&] { client.unregisterService("s"); },
        [&] { client.switchoverPersistent("p"); }};
    for (const auto& call : calls) {
        expectPlainError(call, "no");
    }
}

}  // namespace
}  // namespace Configuration
