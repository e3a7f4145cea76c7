// The process-wide caches of the configuration services' host names.
#include <gtest/gtest.h>

#include "Configuration/HttpConfigurationException.h"
#include "client/HttpClientTestSupport.h"

namespace Configuration {
namespace {

using Testing::HOST_NAME_REQUEST;
using Testing::LegacyOk;
using Testing::MASTER_HOST_NAME_REQUEST;
using Testing::RecordingHttpServer;
using Testing::ScriptedResponse;

std::string str(const ACE_CString& text) {
    return std::string(text.c_str(), text.length());
}

class HttpClientHostNames : public ::testing::Test {
protected:
    HttpClientHostNames() : m_server(Testing::StartFreshServer()) {}

    HttpConfigurationClient makeClient() {
        return HttpConfigurationClient(m_server->authority().c_str(), false, false);
    }

    // Expects construction to fail with a plain std::exception saying message.
    void expectConstructionFailure(const char* message) {
        try {
            makeClient();
            ADD_FAILURE() << "no exception";
        } catch (const HttpConfigurationException& e) {
            ADD_FAILURE() << "unexpected " << e.what();
        } catch (const std::exception& e) {
            EXPECT_STREQ(message, e.what());
        }
    }

    std::unique_ptr<RecordingHttpServer> m_server;
};

TEST_F(HttpClientHostNames, TwoClientsOfOneServerAskOnce) {
    Testing::AnswerHostNames(*m_server, "orvel1", "orvel0");
    const HttpConfigurationClient first = makeClient();
    const HttpConfigurationClient second = makeClient();
    EXPECT_EQ("orvel1", str(first.hostName()));
    EXPECT_EQ("orvel0", str(first.masterHostName()));
    EXPECT_EQ("orvel1", str(second.hostName()));
    EXPECT_EQ("orvel0", str(second.masterHostName()));
    EXPECT_EQ(1u, m_server->countBody(HOST_NAME_REQUEST));
    EXPECT_EQ(1u, m_server->countBody(MASTER_HOST_NAME_REQUEST));
    EXPECT_EQ(2u, m_server->requestCount());
}

TEST_F(HttpClientHostNames, CopiesKeepTheNamesWithoutAsking) {
    Testing::AnswerHostNames(*m_server, "orvel1", "orvel0");
    const HttpConfigurationClient original = makeClient();
    m_server->clearRequests();
    HttpConfigurationClient copy(original);
    EXPECT_EQ("orvel1", str(copy.hostName()));
    copy = original;
    EXPECT_EQ("orvel0", str(copy.masterHostName()));
    EXPECT_EQ(0u, m_server->requestCount());
}

TEST_F(HttpClientHostNames, AnEmptyAnswerIsAskedAgain) {
    Testing::AnswerHostNames(*m_server, "", "");
    EXPECT_TRUE(makeClient().hostName().empty());
    EXPECT_TRUE(makeClient().masterHostName().empty());
    EXPECT_EQ(2u, m_server->countBody(HOST_NAME_REQUEST));
    EXPECT_EQ(2u, m_server->countBody(MASTER_HOST_NAME_REQUEST));
}

TEST_F(HttpClientHostNames, AMissingHostNameFailsConstruction) {
    m_server->setDefault(ScriptedResponse::Ok(LegacyOk()));
    expectConstructionFailure("Unable to retrieve hostname for configuration service");
}

TEST_F(HttpClientHostNames, AMissingMasterHostNameFailsConstruction) {
    m_server->answerBody(HOST_NAME_REQUEST,
                         ScriptedResponse::Ok(LegacyOk("<HostName>h</HostName>")));
    m_server->setDefault(ScriptedResponse::Ok(LegacyOk()));
    expectConstructionFailure("Unable to retrieve the master hostname for configuration service");
    EXPECT_EQ(1u, m_server->countBody(HOST_NAME_REQUEST));
    // The host name was cached before the master look-up failed.
    m_server->answerBody(MASTER_HOST_NAME_REQUEST,
                         ScriptedResponse::Ok(LegacyOk("<HostName>m</HostName>")));
    EXPECT_EQ("m", str(makeClient().masterHostName()));
    EXPECT_EQ(1u, m_server->countBody(HOST_NAME_REQUEST));
}

TEST_F(HttpClientHostNames, TheLookUpIsJudgedTheLegacyWay) {
    m_server->setDefault(ScriptedResponse::Ok(
        "<Answer><ReturnStatus>0</ReturnStatus><ErrorMessage>not yet</ErrorMessage></Answer>"));
    expectConstructionFailure("not yet");
}

}  // namespace
}  // namespace Configuration
