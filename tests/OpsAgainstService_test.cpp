// OPS, the direct road to one configuration server: against a running master and slave service
// (trees and documents loaded and saved, Store against StoreMaster, the master's name as the
// default target, cookies instead of the ticket, several documents at once, the server
// information), and against dead and hostile servers (return codes, no exception, no hang).
#include <gtest/gtest.h>

#include <chrono>
#include <string>

#include "Configuration/OPS.h"
#include "Configuration/OrvelSystemCommonConfiguration.h"
#include "Configuration/StoredForm.h"
#include "InProcessService.h"
#include "Quorvex/Base64Coder.h"
#include "Store/DirectoryStore.h"
#include "testing/LogCapture.h"
#include "testing/RecordingHttpServer.h"

namespace Configuration {
namespace {

using ServiceTesting::InProcessService;

Vesk::Element tree(const char* key, const char* value) {
    Vesk::Element root(key);
    root.addMultiElement().addElement("Value", {}, -1).addSingle().assign(value);
    return root;
}

ConfigurationService::ServiceOptions named(const char* host, const std::string& masterAddress = "",
                                           const char* masterHost = "") {
    ConfigurationService::ServiceOptions options;
    options.hostName = host;
    options.masterAddress = masterAddress;
    options.masterHostName = masterHost;
    return options;
}

// A master "Master" and a slave "Slave" that forwards to it.
class OpsAgainstService : public ::testing::Test {
protected:
    InProcessService master{named("Master")};
    InProcessService slave{named("Slave", master.address(), "Master")};
    OPS ops{slave.address().c_str(), "", false};
};

TEST_F(OpsAgainstService, AnEmptyTargetHostIsTheMastersNameAndMasterChoosesStoreMaster) {
    EXPECT_EQ(ACE_CString("Slave"), ops.GetHostName());
    EXPECT_EQ(ACE_CString("Master"), ops.GetMasterHostName());
    EXPECT_EQ(ACE_CString("Master"), ops.GetTargetHost());
    Vesk::Element local = tree("Local", "1");
    Vesk::Element shared = tree("Shared", "2");
    BDateTime time;
    ASSERT_EQ(0, ops.SaveConfigVesk("Doc\\Local", local, time, false));
    EXPECT_TRUE(time.isValid());  // stamped as it was stored
    ASSERT_EQ(0, ops.SaveConfigVesk("Doc\\Shared", shared, time, true));
    EXPECT_TRUE(slave.server().store().exists("Master", "Doc\\Local"));
    EXPECT_FALSE(master.server().store().exists("Master", "Doc\\Local"));  // Store stays here
    EXPECT_TRUE(master.server().store().exists("Master", "Doc\\Shared"));  // StoreMaster forwards
    OPS named(slave.address().c_str(), "Orvel7", false);
    EXPECT_EQ(ACE_CString("Orvel7"), named.GetTargetHost());
    ASSERT_EQ(0, named.SaveConfigVesk("Doc\\Local", local, time, false));
    EXPECT_TRUE(slave.server().store().exists("Orvel7", "Doc\\Local"));
}

TEST_F(OpsAgainstService, TreesAndDocumentsComeBackWithTheirTimes) {
    Vesk::Element saved = tree("Tree", "<&> text");
    BDateTime time("2019-08-07T06:05:04.003");
    ASSERT_EQ(0, ops.SaveConfigVesk("Doc\\Tree", saved, time, false));
    Vesk::Element loaded;
    BDateTime loadedTime;
    ASSERT_EQ(0, ops.LoadConfigVesk("Doc\\Tree", loaded, loadedTime));
    EXPECT_EQ(saved, loaded);
    EXPECT_EQ(BDateTime("2019-08-07T06:05:04.003"), loadedTime);

    OrvelSystemCommonConfiguration site;
    site.setSiteName("Northmed");
    site.setMasterDBPassword("never-logged");
    site.setIntegrationEngineHostPort(4294967295u);
    ASSERT_EQ(0, ops.SaveConfigDOC(site, true));
    EXPECT_TRUE(site.timestamp().isValid());
    OrvelSystemCommonConfiguration read;
    read.setSiteName("other");
    ASSERT_EQ(0, ops.LoadConfigDOC(read));
    EXPECT_EQ(site, read);
    EXPECT_EQ(site.timestamp(), read.timestamp());
    EXPECT_TRUE(master.server().store().exists("Master", "BrimmetServer\\OrvelSystemCommon"));
}

TEST_F(OpsAgainstService, MissingAndIncompleteDocumentsFailWithTheirLogLines) {
    Quorvex::Testing::LogCapture log;
    Vesk::Element untouched = tree("Untouched", "1");
    BDateTime time;
    EXPECT_EQ(-1, ops.LoadConfigVesk("Doc\\Absent", untouched, time));
    EXPECT_EQ(tree("Untouched", "1"), untouched);
    EXPECT_TRUE(log.containsFragment(
        "OPS::LoadConfigVesk: Error checking if config exists. Standard Exception: "));
    Vesk::Element incomplete = tree("OrvelSystemCommon", "x");
    ASSERT_EQ(0, ops.SaveConfigVesk("BrimmetServer\\OrvelSystemCommon", incomplete, time, false));
    OrvelSystemCommonConfiguration site;
    EXPECT_EQ(-1, ops.LoadConfigDOC(site));
    EXPECT_TRUE(log.contains(LM_DEBUG,
                             "OPS::LoadConfigDOC: Error parsing configuration: "
                             "BrimmetServer\\OrvelSystemCommon\n"));
}

TEST_F(OpsAgainstService, ACookieMapTakesThePlaceOfTheTicket) {
    Vesk::Element doc = tree("C", "1");
    BDateTime time;
    const OPS::CookieMap ticket = {{"OrvelWebApplication", InProcessService::kTicket}};
    OPS withTicket(slave.address().c_str(), "h", ticket);
    EXPECT_EQ(0, withTicket.SaveConfigVesk("Doc\\C", doc, time, false));
    // A wrong ticket in the map is sent as it is: the machine's ticket is not fetched over it.
    OPS wrong(slave.address().c_str(), "h", OPS::CookieMap{{"OrvelWebApplication", "wrong"}});
    EXPECT_EQ(ACE_CString("Master"), wrong.GetMasterHostName());  // host names need no ticket
    EXPECT_EQ(-1, wrong.SaveConfigVesk("Doc\\C", doc, time, false));
    OPS other(slave.address().c_str(), "h", OPS::CookieMap{{"Session", "4711"}});
    EXPECT_EQ(-1, other.LoadConfigVesk("Doc\\C", doc, time));
    other.SetCookies(ticket);
    EXPECT_EQ(0, other.LoadConfigVesk("Doc\\C", doc, time));
    EXPECT_TRUE(other.GetWebClient() == other.GetWebClient());  // one shared client
}

TEST_F(OpsAgainstService, SeveralConfigurationsAtOnceAndTheEmptyAnswer) {
    Quorvex::Testing::LogCapture log;
    BDateTime time;
    Vesk::Element one = tree("One", "1");
    Vesk::Element two = tree("Two", "2");
    ASSERT_EQ(0, ops.SaveConfigVesk("X\\One", one, time, false));
    ASSERT_EQ(0, ops.SaveConfigVesk("X\\Two", two, time, false));
    Vesk::Element all;
    ASSERT_EQ(0, ops.RetrieveAllConfigurations("X\\One;X\\Two", all));
    ASSERT_EQ(2u, all.getMultiElement().size());
    EXPECT_EQ(one, *all.getMultiElement().begin()->getMultiElement().begin());
    Vesk::Element untouched = tree("Untouched", "1");
    EXPECT_EQ(-2, ops.RetrieveAllConfigurations("X\\Absent,X\\Other", untouched));
    EXPECT_EQ(tree("Untouched", "1"), untouched);
    EXPECT_TRUE(log.contains(
        LM_DEBUG,
        "OPS::RetrieveAllConfigurations empty response for configurations X\\Absent,X\\Other\n"));
    EXPECT_EQ(-1, ops.RetrieveAllConfigurations("X\\One;X\\Absent", untouched));
    EXPECT_EQ(tree("Untouched", "1"), untouched);
    EXPECT_TRUE(log.containsFragment(
        "OPS::RetrieveAllConfigurations http exception caught for configurations "
        "X\\One;X\\Absent, reason HttpConfigurationException: "));
}

TEST_F(OpsAgainstService, ServerInformationAndHosts) {
    ServerInfo info;
    ASSERT_EQ(0, ops.LoadServerInfoDoc(info));
    EXPECT_EQ(ACE_CString("Slave"), info.getHostName());
    EXPECT_EQ(ACE_CString("Master"), info.getMasterHostName());
    EXPECT_FALSE(info.isMaster());
    EXPECT_EQ(slave.port(), info.getPort());
    EXPECT_TRUE(info.getStartTime().isValid());
    OPS onMaster(master.address().c_str(), "", false);
    ASSERT_EQ(0, onMaster.LoadServerInfoDoc(info));
    EXPECT_TRUE(info.isMaster());
    onMaster.GetWebClient()->registerService("Store1", "Storage", "ModuleType=1");
    onMaster.GetWebClient()->registerService("Web1", "Viewer", "ModuleType=5");
    std::vector<ACE_CString> hosts;
    ASSERT_EQ(0, onMaster.ListHosts(hosts));
    EXPECT_EQ((std::vector<ACE_CString>{"Store1", "Web1"}), hosts);
    ASSERT_EQ(0, onMaster.ListHostsByModuleType(5, hosts));
    EXPECT_EQ(std::vector<ACE_CString>{"Web1"}, hosts);
}

// Every operation of an OPS without a server fails by its code, quickly, without an exception
// (but GetWebClient's).
TEST(OpsWithoutServer, ADeadServerGivesFailureCodes) {
    Quorvex::Testing::LogCapture log;
    const auto start = std::chrono::steady_clock::now();
    OPS dead("127.0.0.1:1", "", false);
    EXPECT_THROW(dead.GetWebClient(), std::exception);
    EXPECT_EQ(0u, dead.GetMasterHostName().length());
    EXPECT_EQ(0u, dead.GetTargetHost().length());
    Vesk::Element element = tree("E", "1");
    BDateTime time;
    OrvelSystemCommonConfiguration site;
    ServerInfo info;
    std::vector<ACE_CString> hosts;
    EXPECT_EQ(-1, dead.LoadConfigVesk("n", element, time));
    EXPECT_EQ(-1, dead.SaveConfigVesk("n", element, time, true));
    EXPECT_EQ(-1, dead.LoadConfigDOC(site));
    EXPECT_EQ(-1, dead.SaveConfigDOC(site, false));
    EXPECT_EQ(-1, dead.LoadServerInfoDoc(info));
    EXPECT_EQ(-1, dead.ListHosts(hosts));
    EXPECT_EQ(-1, dead.ListHostsByModuleType(1, hosts));
    EXPECT_EQ(-1, dead.RetrieveAllConfigurations("n", element));
    EXPECT_EQ(tree("E", "1"), element);
    dead.SetCookies({{"a", "b"}});
    EXPECT_LT(std::chrono::steady_clock::now() - start, std::chrono::seconds(10));
    EXPECT_TRUE(
        log.containsFragment("OPS::Initialize: Unable to reach configuration server "
                             "127.0.0.1:1."));
}

const char kHostName[] = "<GetHostName></GetHostName>";
const char kMasterHostName[] = "<GetMasterHostName></GetMasterHostName>";

std::string legacy(const std::string& inner) {
    return "<Answer><ReturnStatus>1</ReturnStatus>" + inner + "</Answer>";
}

std::string configuration(const std::string& bytes) {
    const auto* data = reinterpret_cast<const unsigned char*>(bytes.data());
    return legacy("<Configuration>" + std::string(Base64Coder::Encode(data, bytes.size()).c_str()) +
                  "</Configuration>");
}

// A server that knows its names and then answers what a row scripts.
class HostileServer : public ::testing::Test {
protected:
    HostileServer() {
        server.answerBody(kHostName, Quorvex::Testing::ScriptedResponse::Ok(
                                         legacy("<HostName>Hostile</HostName>")));
        server.answerBody(kMasterHostName, Quorvex::Testing::ScriptedResponse::Ok(
                                               legacy("<HostName>HostileMaster</HostName>")));
    }
    Quorvex::Testing::RecordingHttpServer server;
};

TEST_F(HostileServer, StoreAndStoreMasterAreChosenByTheFlag) {
    OPS ops(server.authority().c_str(), "", OPS::CookieMap{{"Session", "1"}});
    EXPECT_EQ(ACE_CString("HostileMaster"), ops.GetTargetHost());
    server.setDefault(Quorvex::Testing::ScriptedResponse::Ok(legacy("")));
    Vesk::Element element = tree("E", "1");
    BDateTime time("2020-01-02T03:04:05.006");
    ASSERT_EQ(0, ops.SaveConfigVesk("n", element, time, true));
    EXPECT_EQ(0u, server.lastRequest().body.rfind("<StoreMaster><Host>HostileMaster</Host>", 0));
    ASSERT_EQ(0, ops.SaveConfigVesk("n", element, time, false));
    const std::string body = server.lastRequest().body;
    EXPECT_EQ(0u, body.rfind("<Store><Host>HostileMaster</Host><ConfigurationName>n<", 0));
    EXPECT_NE(std::string::npos,
              body.find("<LastModifiedTime>" + std::string(time.ToString().c_str())));
    EXPECT_EQ("Session=1", server.lastRequest().header("Cookie"));
}

TEST_F(HostileServer, TheExplicitFormUsesItsUrlsAndAsksNothingFirst) {
    OPS ops(server.authority().c_str(), "h", "http:", "custom/config.ashx", "custom/flow.ashx",
            OPS::CookieMap{{"Session", "2"}});
    EXPECT_EQ(0u, server.requestCount());
    EXPECT_EQ(0u, ops.GetHostName().length());
    std::vector<ACE_CString> hosts;
    server.setDefault(Quorvex::Testing::ScriptedResponse::Ok(
        legacy("<HostName>A</HostName><HostName>B</HostName>")));
    ASSERT_EQ(0, ops.ListHosts(hosts));
    EXPECT_EQ((std::vector<ACE_CString>{"A", "B"}), hosts);
    EXPECT_EQ("/custom/config.ashx", server.lastRequest().target);
}

struct HostileRow {
    const char* name;
    Quorvex::Testing::ScriptedResponse answer;
};

// Answers a load, the server information or a multi-document fetch may get from a bad server.
const HostileRow kHostile[] = {
    {"NotBase64",
     Quorvex::Testing::ScriptedResponse::Ok(legacy("<Configuration>!!not*base64</Configuration>"))},
    {"NotCompressed", Quorvex::Testing::ScriptedResponse::Ok(configuration("plain <e/> text"))},
    {"CompressedNonsense", Quorvex::Testing::ScriptedResponse::Ok(
                               configuration(StoredForm::encode(tree("E", "1")).substr(0, 9)))},
    {"ServerInfoNotXml",
     Quorvex::Testing::ScriptedResponse::Ok(legacy("<ServerInfoBlob>&lt;e k=</ServerInfoBlob>"))},
    {"ItemsNotXml", Quorvex::Testing::ScriptedResponse::Ok("<e k=\"x\"><l><e")},
    {"ServerError",
     Quorvex::Testing::ScriptedResponse::Status(500, "<ErrorMessage>no</ErrorMessage>")},
    {"Dropped", Quorvex::Testing::ScriptedResponse::Close()},
};

class HostileAnswers : public HostileServer, public testing::WithParamInterface<HostileRow> {};

TEST_P(HostileAnswers, EveryReadFailsByItsCode) {
    Quorvex::Testing::LogCapture log;
    OPS ops(server.authority().c_str(), "", false);
    server.setDefault(GetParam().answer);
    Vesk::Element element = tree("E", "1");
    BDateTime time;
    ServerInfo info;
    EXPECT_EQ(-1, ops.LoadConfigVesk("n", element, time));
    EXPECT_EQ(-1, ops.LoadServerInfoDoc(info));
    EXPECT_EQ(-1, ops.RetrieveAllConfigurations("a;b", element));
    EXPECT_EQ(tree("E", "1"), element);
}

INSTANTIATE_TEST_SUITE_P(Answers, HostileAnswers, testing::ValuesIn(kHostile),
                         [](const testing::TestParamInfo<HostileRow>& info) {
                             return info.param.name;
                         });

}  // namespace
}  // namespace Configuration
