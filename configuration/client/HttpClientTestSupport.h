// Test support for HttpConfigurationClient: answers of a legacy configuration service, a
// recording server that already answers the host-name requests, and access to the client's
// private transport and judgement. Header-only (used by the *_test.cpp files only).
#pragma once

#include <gtest/gtest.h>

#include <functional>
#include <memory>
#include <mutex>
#include <set>
#include <string>
#include <vector>

#include "Configuration/HttpConfigurationClient.h"
#include "testing/RecordingHttpServer.h"

namespace Configuration {

// Reaches the client's private operations from tests.
class HttpConfigurationClientTestAccess {
public:
    static void send(const HttpConfigurationClient& client, const ACE_CString& body,
                     ACE_CString& response, bool legacy) {
        client.send(client.m_configurationUrl, body, response, legacy);
    }
    static void checkResponse(const HttpConfigurationClient& client, const ACE_CString& status,
                              const ACE_CString& body, bool legacy) {
        client.CheckResponse(status, body, legacy);
    }
};

namespace Testing {

using Quorvex::Testing::RecordedRequest;
using Quorvex::Testing::RecordingHttpServer;
using Quorvex::Testing::ScriptedResponse;

const char* const CONFIGURATION_PATH = "/Sundrel/ConfigurationService/ConfigurationService.ashx";
const char* const HOST_NAME_REQUEST = "<GetHostName></GetHostName>";
const char* const MASTER_HOST_NAME_REQUEST = "<GetMasterHostName></GetMasterHostName>";

// A successful legacy answer carrying inner.
inline std::string LegacyOk(const std::string& inner = std::string()) {
    return "<Answer><ReturnStatus>1</ReturnStatus>" + inner + "</Answer>";
}

// A failed legacy answer carrying inner.
inline std::string LegacyFailure(const std::string& inner = std::string()) {
    return "<Answer><ReturnStatus>0</ReturnStatus>" + inner + "</Answer>";
}

// Lets the server answer the two host-name requests.
inline void AnswerHostNames(RecordingHttpServer& server, const std::string& hostName = "cfg-host",
                            const std::string& masterHostName = "cfg-master") {
    server.answerBody(HOST_NAME_REQUEST,
                      ScriptedResponse::Ok(LegacyOk("<HostName>" + hostName + "</HostName>")));
    server.answerBody(
        MASTER_HOST_NAME_REQUEST,
        ScriptedResponse::Ok(LegacyOk("<HostName>" + masterHostName + "</HostName>")));
}

// A server on a port that no server of this process used before, so that the process-wide
// host-name caches know nothing about it. Servers that landed on a used port are kept open
// until a fresh one is found (so the port cannot come back) and then closed.
// make builds the server (plain HTTP when not given).
inline std::unique_ptr<RecordingHttpServer> StartFreshServer(
    const std::function<std::unique_ptr<RecordingHttpServer>()>& make = [] {
        return std::make_unique<RecordingHttpServer>();
    }) {
    static std::mutex mutex;
    static std::set<int> usedPorts;
    std::lock_guard<std::mutex> lock(mutex);
    std::vector<std::unique_ptr<RecordingHttpServer>> reused;
    for (int attempt = 0; attempt < 50; ++attempt) {
        auto server = make();
        if (usedPorts.insert(server->port()).second) {
            return server;
        }
        reused.push_back(std::move(server));
    }
    throw std::runtime_error("StartFreshServer: no fresh port");
}

// A fresh server answering the host-name requests, and a plain client of it whose construction
// requests are already forgotten.
class HttpClientTest : public ::testing::Test {
protected:
    HttpClientTest() : m_server(StartFreshServer()) {
        AnswerHostNames(*m_server);
        m_server->setDefault(ScriptedResponse::Ok(LegacyOk()));
    }

    RecordingHttpServer& server() { return *m_server; }

    ACE_CString serverText() const { return m_server->authority().c_str(); }

    HttpConfigurationClient makeClient(
        const HttpConfigurationClient::CookieMap& cookies = HttpConfigurationClient::CookieMap()) {
        HttpConfigurationClient client(serverText(), false, false, cookies);
        m_server->clearRequests();
        return client;
    }

    // The body of the only request recorded since the client was made.
    std::string onlyBody() {
        const auto requests = m_server->requests();
        EXPECT_EQ(1u, requests.size());
        return requests.empty() ? std::string() : requests.back().body;
    }

private:
    std::unique_ptr<RecordingHttpServer> m_server;
};

}  // namespace Testing
}  // namespace Configuration
