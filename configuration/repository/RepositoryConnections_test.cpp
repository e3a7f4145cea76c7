// Cold reads through the HTTP service: each asks for the timestamp and then the document through
// fresh clients, every request over a connection of its own that the client closes.
#include <gtest/gtest.h>

#include <memory>
#include <string>

#include "Configuration/ConfigurationRepository.h"
#include "Configuration/StoredForm.h"
#include "Quorvex/Base64Coder.h"
#include "client/HttpClientTestSupport.h"
#include "client/KeepAliveTestServer.h"
#include "model/TestDocument.h"
#include "repository/HttpServiceConnection.h"

namespace Configuration {
namespace {

using Testing::KeepAliveTestServer;
using Testing::TestDocument;

// One answer for every request of a cold read: host names, the timestamp, the stored document.
std::string serviceAnswer() {
    TestDocument stored;
    stored.name = "stored";
    const std::string bytes = StoredForm::encode(*stored.writeVesk());
    const ACE_CString encoded =
        Base64Coder::Encode(reinterpret_cast<const unsigned char*>(bytes.data()), bytes.size());
    return Testing::LegacyOk(
        "<HostName>keep-host</HostName><LastModifiedTime>2010-03-04T05:06:07"
        "</LastModifiedTime><Configuration>" +
        std::string(encoded.c_str()) + "</Configuration>");
}

TEST(RepositoryConnections, EveryRequestOfAColdReadHasAConnectionOfItsOwn) {
    KeepAliveTestServer server(serviceAnswer());
    ServiceLocation location;
    location.localServer = server.authority().c_str();
    location.servers["keep-host"] = server.authority();
    ConfigurationRepository repository(std::make_shared<HttpServiceConnector>(location));
    const int kReads = 12;
    for (int i = 0; i < kReads; ++i) {
        TestDocument document(("Cold" + std::to_string(i)).c_str());
        ASSERT_EQ(0, repository.GetLatest(document)) << "read " << i;
        EXPECT_STREQ("stored", document.name.c_str());
    }
    EXPECT_LE(2 * kReads, server.requests());  // a timestamp and a retrieve per read
    EXPECT_EQ(server.requests(), server.accepted());
}

}  // namespace
}  // namespace Configuration
