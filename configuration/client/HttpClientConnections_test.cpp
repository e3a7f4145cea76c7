// Connections: every request opens a connection of its own and the client closes it after the
// answer, even when the server would keep it open; a request whose connection was dropped is
// never sent again; a forked child's requests work and leave the parent's working; a silent
// server is given up on.
#include <gtest/gtest.h>
#include <sys/wait.h>
#include <unistd.h>

#include <chrono>
#include <string>
#include <thread>

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

// Waits (at most 2 s) until the server has seen the client end every connection it accepted.
void expectEveryConnectionEndedByClient(const KeepAliveTestServer& server) {
    for (int i = 0; i < 40 && server.endedByClient() < server.accepted(); ++i) {
        std::this_thread::sleep_for(std::chrono::milliseconds(50));
    }
    EXPECT_EQ(server.accepted(), server.endedByClient());
}

// Guards against connection reuse: a kept connection would let libcurl send a request twice.
TEST(HttpClientConnections, EveryRequestOpensItsOwnConnectionAndClosesIt) {
    KeepAliveTestServer server(kAnswer);
    retrieveThroughFreshClients(server.authority(), 20);
    EXPECT_EQ(22, server.requests());  // the two host-name look-ups and the retrieves
    EXPECT_EQ(22, server.accepted());
    expectEveryConnectionEndedByClient(server);
}

TEST(HttpClientConnections, AForkedChildsRequestsWorkAndLeaveTheParentsWorking) {
    KeepAliveTestServer server(kAnswer);
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
    retrieveThroughFreshClients(server.authority(), 1);
    EXPECT_EQ(server.requests(), server.accepted());
}

TEST(HttpClientConnections, ASilentServerIsGivenUpOnAndAskedOnce) {
    KeepAliveTestServer server(kAnswer, 1);
    const ACE_CString url(("http://" + server.authority() + "/x").c_str());
    HttpTransport::Answer answer;
    ASSERT_EQ(HttpTransport::Outcome::Answered,
              HttpTransport::post(server.authority().c_str(), url, "<a/>", {}, 1000, answer));
    const auto start = std::chrono::steady_clock::now();
    EXPECT_EQ(HttpTransport::Outcome::NotReceived,
              HttpTransport::post(server.authority().c_str(), url, "<b/>", {}, 1000, answer));
    EXPECT_LT(std::chrono::steady_clock::now() - start, std::chrono::seconds(5));
    EXPECT_EQ(2, server.requests());
    EXPECT_EQ(2, server.accepted());
}

}  // namespace
}  // namespace Configuration
