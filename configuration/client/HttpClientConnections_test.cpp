// Connections: every client is fresh, but the TCP connection to a server is taken up again by the
// next request, whichever client sends it; a connection the server dropped is replaced without
// the caller noticing; a forked child never uses its parent's connections; a server that stops
// answering on a pooled connection is still given up on.
#include <gtest/gtest.h>
#include <sys/wait.h>
#include <unistd.h>

#include <chrono>
#include <string>

#include "Configuration/HttpConfigurationClient.h"
#include "client/HttpClientTestSupport.h"
#include "client/HttpTransport.h"
#include "client/KeepAliveTestServer.h"

namespace Configuration {
namespace {

using Testing::KeepAliveTestServer;

// One answer that serves every request of the tests: host names, a document, a host list.
const std::string kAnswer =
    Testing::LegacyOk("<HostName>keep-host</HostName><Configuration>AAECAw==</Configuration>");

// n fresh clients, each retrieving once; every retrieve must give the document.
void retrieveThroughFreshClients(const std::string& server, int n) {
    for (int i = 0; i < n; ++i) {
        const HttpConfigurationClient client(server.c_str(), false, false);
        Quorvex::ByteArray data;
        std::size_t length = 0;
        client.retrieve("keep-host", "Doc", data, length);
        ASSERT_EQ(4u, length) << "read " << i;
    }
}

TEST(HttpClientConnections, FreshClientsToOneServerShareOneConnection) {
    KeepAliveTestServer server(kAnswer, KeepAliveTestServer::Mode::KeepOpen);
    retrieveThroughFreshClients(server.authority(), 20);
    EXPECT_EQ(22, server.requests());  // the two host-name look-ups and the retrieves
    EXPECT_EQ(1, server.accepted());
}

TEST(HttpClientConnections, AConnectionTheServerDroppedIsReplacedUnnoticed) {
    KeepAliveTestServer server(kAnswer, KeepAliveTestServer::Mode::CloseAfterAnswer);
    retrieveThroughFreshClients(server.authority(), 10);
    EXPECT_EQ(12, server.accepted());
}

// A forked child talking over its parent's pooled socket would mix the two processes' exchanges on
// one connection; the child opens its own, and the parent's stays usable.
TEST(HttpClientConnections, AForkedChildOpensAConnectionOfItsOwn) {
    KeepAliveTestServer server(kAnswer, KeepAliveTestServer::Mode::KeepOpen);
    retrieveThroughFreshClients(server.authority(), 1);
    const pid_t child = fork();
    if (child == 0) {
        try {
            const HttpConfigurationClient client(server.authority().c_str(), false, false);
            Quorvex::ByteArray data;
            std::size_t length = 0;
            client.retrieve("keep-host", "Doc", data, length);
            _exit(length == 4 ? 0 : 3);
        } catch (...) {
            _exit(2);
        }
    }
    ASSERT_GT(child, 0);
    int status = 0;
    ASSERT_EQ(child, waitpid(child, &status, 0));
    EXPECT_TRUE(WIFEXITED(status) && WEXITSTATUS(status) == 0) << status;
    EXPECT_EQ(2, server.accepted());
    retrieveThroughFreshClients(server.authority(), 1);
    EXPECT_EQ(2, server.accepted());
}

TEST(HttpClientConnections, ASilentServerOnAPooledConnectionIsStillGivenUpOn) {
    KeepAliveTestServer server(kAnswer, KeepAliveTestServer::Mode::KeepOpen, 1);
    const ACE_CString url(("http://" + server.authority() + "/x").c_str());
    HttpTransport::Answer answer;
    ASSERT_EQ(HttpTransport::Outcome::Answered,
              HttpTransport::post(server.authority().c_str(), url, "<a/>", {}, 1000, answer));
    const auto start = std::chrono::steady_clock::now();
    EXPECT_EQ(HttpTransport::Outcome::NotReceived,
              HttpTransport::post(server.authority().c_str(), url, "<b/>", {}, 1000, answer));
    EXPECT_LT(std::chrono::steady_clock::now() - start, std::chrono::seconds(5));
    EXPECT_EQ(1, server.accepted());  // the second request went over the pooled connection
}

}  // namespace
}  // namespace Configuration
