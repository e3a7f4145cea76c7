// How HttpConfigurationClient's requests travel: routing to the server, the request as sent,
// transport failures and TLS (time-outs: HttpClientTimeOut_test.cpp).
#include <gtest/gtest.h>
#include <netinet/in.h>
#include <sys/socket.h>
#include <unistd.h>

#include <cstdlib>

#include "Configuration/HttpConfigurationTransportException.h"
#include "client/HttpClientTestSupport.h"
#include "client/HttpRoute.h"
#include "client/HttpTransport.h"
#include "testing/LogCapture.h"
#include "testing/ScratchDir.h"
#include "testing/TestCertificates.h"

namespace Configuration {
namespace {

using Quorvex::Testing::LogCapture;
using Testing::HttpClientTest;
using Testing::LegacyOk;
using Testing::RecordedRequest;
using Testing::RecordingHttpServer;
using Testing::ScriptedResponse;

const char* const SEND_FAILURE = "HttpConfigurationClient::send::Unable to send http request\n";
const char* const RECEIVE_FAILURE = "HttpConfigurationClient::send error receiving HTTP response\n";

struct RouteCase {
    const char* server;
    const char* url;
    bool secure;
    const char* connectHost;
    int connectPort;
    const char* sentUrl;
    const char* requestTarget;
};

// The connection always goes to the server; the URL only names the request. Only the exact
// scheme "https" selects TLS; an unparsable URL is sent as the raw request target on port 80.
TEST(HttpClientRoute, ConnectsToTheServerAndKeepsTheUrlAsTheRequest) {
    const RouteCase cases[] = {
        {"cfg:8080", "http://elsewhere:9999/a/b?c", false, "cfg", 8080,
         "http://elsewhere:9999/a/b?c", ""},
        {"cfg", "http://elsewhere:9999/", false, "cfg", 9999, "http://elsewhere:9999/", ""},
        {"cfg", "http://elsewhere/x", false, "cfg", 80, "http://elsewhere/x", ""},
        {"cfg", "https://elsewhere/x", true, "cfg", 443, "https://elsewhere/x", ""},
        {"cfg", "HTTPS://cfg/x", false, "cfg", 80, "http://cfg/x", ""},
        {"cfg", "no url at all", false, "cfg", 80, "http://cfg:80/", "no%20url%20at%20all"},
        {"cfg", "http://cfg:notaport/", false, "cfg", 80, "http://cfg:80/", "http://cfg:notaport/"},
        {"cfg", "http:///path", false, "cfg", 80, "http://cfg:80/", "http:///path"},
        {"[::1]:8080", "http://x/", false, "[::1]", 8080, "http://x/", ""},
        {"::1", "http://x/", false, "[::1]", 80, "http://x/", ""}};
    for (const RouteCase& c : cases) {
        const HttpRoute route = RouteRequest(c.server, c.url);
        EXPECT_EQ(c.secure, route.secure) << c.url;
        EXPECT_EQ(c.connectHost, route.connectHost) << c.url;
        EXPECT_EQ(c.connectPort, route.connectPort) << c.url;
        EXPECT_EQ(c.sentUrl, route.url) << c.url;
        EXPECT_EQ(c.requestTarget, route.requestTarget) << c.url;
    }
}

class HttpClientTransport : public HttpClientTest {};

TEST_F(HttpClientTransport, SendsOnePostWithLengthAndCookiesInKeyOrder) {
    HttpConfigurationClient::CookieMap cookies;
    cookies["zeta"] = "last";
    cookies["alpha"] = "first";
    cookies["mid"] = "a:b";
    makeClient(cookies).signalRestart();
    const RecordedRequest request = server().lastRequest();
    EXPECT_EQ("POST", request.method);
    EXPECT_EQ(Testing::CONFIGURATION_PATH, request.target);
    EXPECT_EQ("<Restart></Restart>", request.body);
    EXPECT_EQ("19", request.header("Content-Length"));
    EXPECT_EQ(1u, request.headerCount("Cookie"));
    EXPECT_EQ("alpha=first; mid=a:b; zeta=last", request.header("Cookie"));
    EXPECT_EQ(server().authority(), request.header("Host"));
    EXPECT_EQ(0u, request.headerCount("Expect"));
}

// Guards against setCookies merging instead of replacing, and against an empty Cookie header.
TEST_F(HttpClientTransport, SetCookiesReplacesTheCookies) {
    HttpConfigurationClient::CookieMap first;
    first["a"] = "1";
    HttpConfigurationClient client = makeClient(first);
    HttpConfigurationClient::CookieMap second;
    second["b"] = "2";
    client.setCookies(second);
    client.signalRefresh();
    EXPECT_EQ("b=2", server().lastRequest().header("Cookie"));
    client.setCookies({});
    client.signalRefresh();
    EXPECT_EQ(0u, server().lastRequest().headerCount("Cookie"));
}

TEST_F(HttpClientTransport, SendsEightBitTextAsItStands) {
    const std::string host = "h\xE9\xFF";
    const unsigned char data[] = {1};
    makeClient().store(host.c_str(), "n", data, 1, "");
    const RecordedRequest request = server().lastRequest();
    EXPECT_NE(std::string::npos, request.body.find("<Host>" + host + "</Host>"));
    EXPECT_EQ(std::to_string(request.body.size()), request.header("Content-Length"));
}

TEST_F(HttpClientTransport, TheUrlsHostOnlyNamesTheRequest) {
    HttpTransport::Answer answer;
    const auto outcome = HttpTransport::post(serverText(), "http://config.invalid:1234/x?y=1",
                                             "body", {}, 5000, answer);
    ASSERT_EQ(HttpTransport::Outcome::Answered, outcome);
    EXPECT_EQ("200", std::string(answer.statusCode.c_str()));
    const RecordedRequest request = server().lastRequest();
    EXPECT_EQ("config.invalid:1234", request.header("Host"));
    EXPECT_EQ("/x?y=1", request.target);
}

TEST_F(HttpClientTransport, AnUnparsableUrlIsStillSentToTheServer) {
    HttpConfigurationClient client(serverText(), "bogus", "cfg", "uwf", true, true);
    client.signalRestart();
    EXPECT_EQ(1u, server().requestCount());  // the explicit constructor asked nothing
    const RecordedRequest request = server().lastRequest();
    EXPECT_EQ("bogus//" + server().authority() + "/cfg", request.target);
    EXPECT_EQ("<Restart></Restart>", request.body);
}

template <class Operation>
void expectTransportFailure(Operation operation, const char* message, const char* logText) {
    LogCapture capture;
    try {
        operation();
        ADD_FAILURE() << "no exception";
    } catch (const HttpConfigurationTransportException& e) {
        EXPECT_EQ(message, std::string(e.Message().c_str()));
        EXPECT_EQ(std::string("HttpConfigurationException: ") + message, e.what());
    }
    EXPECT_TRUE(capture.contains(LM_DEBUG, logText));
}

TEST_F(HttpClientTransport, AServerClosingWithoutAnswerIsAReceiveFailure) {
    const HttpConfigurationClient client = makeClient();
    // Sent once: a connection dropped before any answer is a failure, never tried again.
    server().clearRequests();
    server().enqueue(ScriptedResponse::Close());
    expectTransportFailure([&] { client.signalRestart(); }, RECEIVE_FAILURE,
                           "HttpConfigurationClient::send() - Receive Transport Exception\n");
    EXPECT_EQ(1u, server().requestCount());
    client.signalRestart();  // the client stays usable
}

// A port on which nothing listens: bound but not listening, so connecting is refused.
class RefusingPort {
public:
    RefusingPort() : m_fd(socket(AF_INET, SOCK_STREAM, 0)) {
        sockaddr_in address{};
        address.sin_family = AF_INET;
        address.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
        socklen_t length = sizeof address;
        bind(m_fd, reinterpret_cast<sockaddr*>(&address), length);
        getsockname(m_fd, reinterpret_cast<sockaddr*>(&address), &length);
        m_port = ntohs(address.sin_port);
    }
    ~RefusingPort() { close(m_fd); }
    std::string server() const { return "127.0.0.1:" + std::to_string(m_port); }

private:
    int m_fd;
    int m_port = 0;
};

TEST(HttpClientTransportFailure, ARefusedConnectionIsASendFailure) {
    RefusingPort port;
    const HttpConfigurationClient client(port.server().c_str(), "http:", "cfg", "uwf", false,
                                         false);
    expectTransportFailure([&] { client.signalRestart(); }, SEND_FAILURE,
                           "HttpConfigurationClient::send() - Send Transport Exception\n");
}

TEST(HttpClientTransportFailure, ConstructionFailsWhenTheServerCannotAnswer) {
    RefusingPort port;
    EXPECT_THROW(HttpConfigurationClient(port.server().c_str(), false, false),
                 HttpConfigurationTransportException);
}

// Sets an environment variable for the life of the object.
class ScopedEnvironment {
public:
    ScopedEnvironment(const char* name, const std::string& value) : m_name(name) {
        setenv(name, value.c_str(), 1);
    }
    ~ScopedEnvironment() { unsetenv(m_name); }

private:
    const char* m_name;
};

class HttpClientTls : public ::testing::Test {
protected:
    HttpClientTls()
        : m_certificates(Quorvex::Testing::TestCertificates::Create(m_folder.path())),
          m_tlsServer(Testing::StartFreshServer(
              [this] { return std::make_unique<RecordingHttpServer>(m_certificates.server); })),
          m_server(*m_tlsServer) {
        Testing::AnswerHostNames(m_server, "tls-host", "tls-master");
        m_server.setDefault(ScriptedResponse::Ok(LegacyOk()));
    }

    Quorvex::Testing::ScratchDir m_folder;
    Quorvex::Testing::TestCertificates m_certificates;
    std::unique_ptr<RecordingHttpServer> m_tlsServer;
    RecordingHttpServer& m_server;
};

TEST_F(HttpClientTls, TalksToAServerWhoseAuthorityIsTrusted) {
    ScopedEnvironment trust(HttpTransport::CA_FILE_VARIABLE, m_certificates.caFile);
    const HttpConfigurationClient client(m_server.authority().c_str(), false, true);
    EXPECT_EQ("tls-host", std::string(client.hostName().c_str()));
    EXPECT_EQ("tls-master", std::string(client.masterHostName().c_str()));
    client.signalRefresh();
    EXPECT_EQ("<Refresh></Refresh>", m_server.lastRequest().body);
}

TEST_F(HttpClientTls, RefusesAServerThatTheSystemStoreDoesNotTrust) {
    const HttpConfigurationClient client(m_server.authority().c_str(), "https:", "cfg", "uwf",
                                         false, true);
    expectTransportFailure([&] { client.signalRefresh(); }, SEND_FAILURE,
                           "HttpConfigurationClient::send() - Send Transport Exception\n");
    EXPECT_EQ(0u, m_server.requestCount());
}

}  // namespace
}  // namespace Configuration
