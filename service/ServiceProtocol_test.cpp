// The answers of every operation as clients cut them out: elements, texts, times and trees.
#include <gtest/gtest.h>

#include <httplib.h>

#include "ChangeNotifier.h"
#include "Common/NamedEvent.h"
#include "Configuration/StoredForm.h"
#include "ConfigurationServer.h"
#include "InProcessService.h"
#include "Quorvex/BDateTime.h"
#include "Quorvex/Base64Coder.h"
#include "Quorvex/TextConversion.h"
#include "RawPost.h"
#include "Vesk/XmlUtils.h"

namespace ConfigurationService {
namespace {

using ServiceTesting::elementText;
using ServiceTesting::InProcessService;
using ServiceTesting::RawAnswer;

RawAnswer post(const InProcessService& service, const std::string& body) {
    return ServiceTesting::rawPost(service.port(), body, InProcessService::ticketCookie());
}

std::string storeBody(const std::string& host, const std::string& name, const std::string& base64,
                      const std::string& time = "") {
    std::string body = "<Store><Host>" + host + "</Host><ConfigurationName>" + name +
                       "</ConfigurationName><Configuration>" + base64 + "</Configuration>";
    if (!time.empty()) {
        body += "<LastModifiedTime>" + time + "</LastModifiedTime>";
    }
    return body + "</Store>";
}

std::string itemBody(const std::string& operation, const std::string& host,
                     const std::string& name) {
    return "<" + operation + "><Host>" + host + "</Host><ConfigurationName>" + name +
           "</ConfigurationName></" + operation + ">";
}

std::string storedFormBase64(const Vesk::Element& tree) {
    const std::string bytes = Configuration::StoredForm::encode(tree);
    return Base64Coder::Encode(reinterpret_cast<const unsigned char*>(bytes.data()), bytes.size())
        .c_str();
}

Vesk::Element sampleTree(const char* key, const char* value) {
    Vesk::Element tree(key);
    tree.addMultiElement().addElement("Port", {}, -1).addSingle().assign(value);
    return tree;
}

TEST(ServiceProtocol, HostNamesNeedNoTicket) {
    InProcessService service;
    const RawAnswer own =
        ServiceTesting::rawPost(service.port(), "<GetHostName></GetHostName>", "");
    EXPECT_EQ(elementText(own.body, "ReturnStatus"), "1");
    EXPECT_EQ(elementText(own.body, "HostName"), "TestHost");
    const RawAnswer master =
        ServiceTesting::rawPost(service.port(), "<GetMasterHostName></GetMasterHostName>", "");
    EXPECT_EQ(elementText(master.body, "HostName"), "TestHost");  // a master is its own master
}

TEST(ServiceProtocol, StoreThenRetrieveKeepsBytesNamesAndTime) {
    InProcessService service;
    const RawAnswer stored =
        post(service, storeBody("Orvel1", "BrimmetServer\\Location",
                                "AAEC/w==", "2010-03-04T05:06:07.0890000-00:00"));
    ASSERT_EQ(elementText(stored.body, "ReturnStatus"), "1") << stored.body;
    const RawAnswer got = post(service, itemBody("Retrieve", "ORVEL1", "BrimmetServer\\Location"));
    EXPECT_EQ(elementText(got.body, "ReturnStatus"), "1");
    EXPECT_EQ(elementText(got.body, "Configuration"), "AAEC/w==");
    const RawAnswer time =
        post(service, itemBody("GetLastModifiedTime", "orvel1", "BrimmetServer\\Location"));
    EXPECT_EQ(elementText(time.body, "LastModifiedTime"), "2010-03-04T05:06:07.089");
    const RawAnswer listed = post(service, "<ListItems><Host>orvel1</Host></ListItems>");
    EXPECT_EQ(elementText(listed.body, "ConfigurationName"), "BrimmetServer\\Location");
    EXPECT_EQ(elementText(listed.body, "HostName"), "Orvel1");
}

// Guards against two quick stores sharing a timestamp, which would hide the second change.
TEST(ServiceProtocol, StoresMillisecondsApartHaveDifferentTimes) {
    InProcessService service;
    post(service, storeBody("h", "n", "AA=="));
    const std::string first = elementText(
        post(service, itemBody("GetLastModifiedTime", "h", "n")).body, "LastModifiedTime");
    post(service, storeBody("h", "n", "AQ=="));
    const std::string second = elementText(
        post(service, itemBody("GetLastModifiedTime", "h", "n")).body, "LastModifiedTime");
    EXPECT_TRUE(BDateTime(second.c_str()).isValid());
    EXPECT_LT(BDateTime(first.c_str()), BDateTime(second.c_str()));
}

TEST(ServiceProtocol, MissingItemIsALegacyFailure) {
    InProcessService service;
    const RawAnswer answer = post(service, itemBody("Retrieve", "h", "absent"));
    EXPECT_EQ(answer.status, 200);
    EXPECT_EQ(elementText(answer.body, "ReturnStatus"), "0");
    EXPECT_NE(elementText(answer.body, "ErrorMessage").find("not found"), std::string::npos);
}

TEST(ServiceProtocol, ListItemsOfAHostWithoutItemsIsAnEmptySuccess) {
    InProcessService service;
    EXPECT_EQ(post(service, "<ListItems><Host>c</Host></ListItems>").body,
              "<ListItemsResponse><ReturnStatus>1</ReturnStatus></ListItemsResponse>");
}

TEST(ServiceProtocol, RetrieveItemsAnswersOneTreeOfTheNamedDocuments) {
    InProcessService service;
    post(service, storeBody("h", "X\\One", storedFormBase64(sampleTree("One", "104"))));
    post(service, storeBody("h", "X\\Two", storedFormBase64(sampleTree("Two", "11112"))));
    const RawAnswer answer = post(service, itemBody("RetrieveItems", "h", "X\\Two;X\\One;"));
    ASSERT_EQ(answer.status, 200) << answer.body;
    Vesk::Element root;
    Vesk::XmlUtils::parse(answer.body.data(), answer.body.size(), root);
    EXPECT_EQ(root.key(), "ConfigurationItems");
    const Vesk::MultiElementValue& items = root.getMultiElement();
    ASSERT_EQ(items.size(), 2u);
    const Vesk::Element& first = *items.begin();
    bool found = false;
    EXPECT_EQ(first.getAttributeValue("ConfigurationName", found), "X\\Two");
    EXPECT_EQ(*first.getMultiElement().begin(), sampleTree("Two", "11112"));
}

TEST(ServiceProtocol, RetrieveItemsReportsAMissingDocumentByStatusAndKey) {
    InProcessService service;
    const RawAnswer answer = post(service, itemBody("RetrieveItems", "h", "absent"));
    EXPECT_EQ(answer.status, 404);
    EXPECT_EQ(elementText(answer.body, "ErrorKey"), "AF901DEB-1F70-41cf-879D-6EFC19168686");
    EXPECT_EQ(post(service, itemBody("RetrieveItems", "h", ";;")).status, 400);
}

TEST(ServiceProtocol, RegisteredHostsAreListedOnceAndByModuleType) {
    InProcessService service;
    const auto reg = [&](const char* host, const char* name, const char* connection) {
        return post(service, std::string("<RegisterService><HostName>") + host +
                                 "</HostName><ServiceName>" + name +
                                 "</ServiceName><ConnectionString>" + connection +
                                 "</ConnectionString></RegisterService>");
    };
    EXPECT_EQ(elementText(reg("Slave1", "Storage", "ModuleType=3;Port=104").body, "ReturnStatus"),
              "1");
    reg("SLAVE1", "Query", "ModuleType=4");
    reg("Slave2", "Query", "ModuleType=4");
    const RawAnswer hosts = post(service, "<ListHosts></ListHosts>");
    EXPECT_EQ(hosts.body,
              "<ListHostsResponse><ReturnStatus>1</ReturnStatus><HostName>Slave1</HostName>"
              "<HostName>Slave2</HostName></ListHostsResponse>");
    const RawAnswer storage = post(
        service,
        "<ListHostsByModuleType><ModuleTypeFilter>3</ModuleTypeFilter></ListHostsByModuleType>");
    EXPECT_EQ(elementText(storage.body, "HostName"), "Slave1");
    EXPECT_EQ(storage.body.find("Slave2"), std::string::npos);
    post(service,
         "<UnregisterService><HostName>slave2</HostName><ServiceName>Query</ServiceName>"
         "</UnregisterService>");
    EXPECT_EQ(post(service, "<ListHosts></ListHosts>").body.find("Slave2"), std::string::npos);
}

TEST(ServiceProtocol, ServerInfoBlobIsAnEscapedElementTree) {
    InProcessService service;
    const RawAnswer answer = post(service, "<GetServerInfo></GetServerInfo>");
    ACE_CString blob;
    Quorvex::ConvertXmlStringToString(elementText(answer.body, "ServerInfoBlob").c_str(), blob);
    Vesk::Element info;
    Vesk::XmlUtils::parse(blob.c_str(), blob.length(), info);
    EXPECT_EQ(info.key(), "ServerInfo");
    EXPECT_EQ(info.getMultiElement().getElement("HostName").getSingle().value(), "TestHost");
    EXPECT_EQ(info.getMultiElement().getElement("IsMaster").getSingle().value(), "1");
}

TEST(ServiceProtocol, ChangeSignalsSetTheMachineEvent) {
    InProcessService service;
    for (const char* body : {"<Changed><FromServer>Other</FromServer></Changed>",
                             "<Refresh></Refresh>", "<Restart></Restart>"}) {
        Common::NamedEvent event(ChangeNotifier::kEventName);
        EXPECT_EQ(elementText(post(service, body).body, "ReturnStatus"), "1") << body;
        EXPECT_TRUE(event.wait(5000)) << body;
    }
}

// Guards against the HTTP library's default of closing a kept-alive connection after 5 requests.
TEST(ServiceProtocol, KeepAliveServesManyRequestsOnOneConnection) {
    InProcessService service;
    httplib::Client client("127.0.0.1", service.port());
    client.set_keep_alive(true);
    client.set_tcp_nodelay(true);
    for (int i = 0; i < 20; ++i) {
        auto result =
            client.Post(ConfigurationServer::kPath, "<GetHostName></GetHostName>", "text/xml");
        ASSERT_TRUE(result);
        EXPECT_NE(result->get_header_value("Connection"), "close") << i;
        EXPECT_TRUE(result->has_header("Keep-Alive")) << i;
    }
}

}  // namespace
}  // namespace ConfigurationService
