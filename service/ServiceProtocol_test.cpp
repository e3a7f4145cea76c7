// What the service answers that the client cannot show: distinct times for quick stores, the
// status of a RetrieveItems that finds nothing, kept-alive connections. Every operation as the
// client sees it is tested against this service in tests/ClientAgainstService_test.cpp.
#include <gtest/gtest.h>

#include <httplib.h>

#include "ConfigurationServer.h"
#include "InProcessService.h"
#include "Quorvex/BDateTime.h"
#include "RawPost.h"

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

TEST(ServiceProtocol, RetrieveItemsReportsAMissingDocumentByStatusAndKey) {
    InProcessService service;
    const RawAnswer answer = post(service, itemBody("RetrieveItems", "h", "absent"));
    EXPECT_EQ(answer.status, 404);
    EXPECT_EQ(elementText(answer.body, "ErrorKey"), "AF901DEB-1F70-41cf-879D-6EFC19168686");
    EXPECT_EQ(post(service, itemBody("RetrieveItems", "h", ";;")).status, 400);
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
