// What the service answers that the client cannot show: distinct times for quick stores, the
// status of a RetrieveItems that finds nothing, kept-alive connections. Every operation as the
// client sees it is tested against this service in tests/ClientAgainstService_test.cpp.
#include <gtest/gtest.h>

#include "ConfigurationServer.h"
#include "InProcessService.h"
#include "Quorvex/BDateTime.h"
#include "Quorvex/Base64Coder.h"
#include "RawConnection.h"
#include "RawPost.h"

namespace ConfigurationService {
namespace {

using ServiceTesting::elementText;
using ServiceTesting::InProcessService;
using ServiceTesting::itemBody;
using ServiceTesting::RawAnswer;

RawAnswer post(const InProcessService& service, const std::string& body) {
    return ServiceTesting::rawPost(service.port(), body, InProcessService::ticketCookie());
}

std::string storeBody(const std::string& host, const std::string& name, const std::string& base64) {
    return itemBody("Store", host, name, "<Configuration>" + base64 + "</Configuration>");
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

// None found: 200 and an empty body (the client's "empty response"); one of several missing: 404
// with the path-not-found key. Names split at ";" or ",".
TEST(ServiceProtocol, RetrieveItemsReportsMissingDocumentsByStatusAndKey) {
    InProcessService service;
    post(service, storeBody("h", "present", "AA=="));
    const RawAnswer none = post(service, itemBody("RetrieveItems", "h", "absent;other,"));
    EXPECT_EQ(none.status, 200);
    EXPECT_EQ(none.body, "");
    const RawAnswer some = post(service, itemBody("RetrieveItems", "h", "present,absent"));
    EXPECT_EQ(some.status, 404);
    EXPECT_EQ(elementText(some.body, "ErrorKey"), "AF901DEB-1F70-41cf-879D-6EFC19168686");
    EXPECT_NE(some.body.find("absent"), std::string::npos) << some.body;
    EXPECT_EQ(post(service, itemBody("RetrieveItems", "h", ";,;")).status, 400);
}

// Large documents are answered from their kept Base64 text in pieces: every retrieve, on one
// connection and on several, carries the whole text and the closing tags.
TEST(ServiceProtocol, LargeDocumentsComeBackWholeOnEveryRetrieve) {
    InProcessService service;
    for (std::size_t size : {1023u, 1024u, 300000u}) {
        std::string bytes(size, '\0');
        for (std::size_t i = 0; i < size; ++i) {
            bytes[i] = static_cast<char>(i * 7 + i / 300);
        }
        const std::string base64 =
            Base64Coder::Encode(reinterpret_cast<const unsigned char*>(bytes.data()), size).c_str();
        const std::string name = "Doc" + std::to_string(size);
        post(service, storeBody("h", name, base64));
        ServiceTesting::RawConnection connection(service.port());
        for (int i = 0; i < 3; ++i) {
            const RawAnswer answer = post(service, itemBody("Retrieve", "h", name));
            EXPECT_EQ(elementText(answer.body, "Configuration"), base64) << size << " " << i;
            ASSERT_TRUE(connection.send(ServiceTesting::RawConnection::post(
                itemBody("Retrieve", "h", name), InProcessService::ticketCookie())));
            const ServiceTesting::HttpAnswer kept = connection.readAnswer(std::chrono::seconds(5));
            EXPECT_EQ(kept.body, answer.body) << size << " " << i;
        }
    }
}

// Guards against a front that closes a kept-alive connection after a few requests.
TEST(ServiceProtocol, KeepAliveServesManyRequestsOnOneConnection) {
    InProcessService service;
    ServiceTesting::RawConnection connection(service.port());
    for (int i = 0; i < 20; ++i) {
        ASSERT_TRUE(
            connection.send(ServiceTesting::RawConnection::post("<GetHostName></GetHostName>", "")))
            << i;
        const ServiceTesting::HttpAnswer answer = connection.readAnswer(std::chrono::seconds(5));
        ASSERT_EQ(answer.status, 200) << i;
        EXPECT_EQ(answer.fields.count("connection"), 0u) << i;  // no "close"
    }
}

}  // namespace
}  // namespace ConfigurationService
