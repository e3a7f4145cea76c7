// How HttpConfigurationClient judges answers: by HTTP status and error record, or the legacy way
// by "ReturnStatus"; which exception each failure becomes.
#include <gtest/gtest.h>

#include "Configuration/HttpConfigurationException.h"
#include "Configuration/HttpConfigurationFolderLimitReachedException.h"
#include "Configuration/HttpConfigurationInvalidNodeIdException.h"
#include "Configuration/HttpConfigurationItemLimitReachedException.h"
#include "Configuration/HttpConfigurationPathNotFoundException.h"
#include "client/HttpClientTestSupport.h"

namespace Configuration {
namespace {

using Testing::HttpClientTest;
using Testing::LegacyFailure;
using Testing::LegacyOk;
using Testing::ScriptedResponse;

std::string str(const ACE_CString& text) {
    return std::string(text.c_str(), text.length());
}

class HttpClientResponses : public HttpClientTest {
protected:
    // Sends through the real transport, answered with status and body.
    ACE_CString exchange(int status, const std::string& body, bool legacy) {
        server().enqueue(ScriptedResponse::Status(status, body));
        ACE_CString response;
        HttpConfigurationClientTestAccess::send(m_client, "<Q></Q>", response, legacy);
        return response;
    }

    HttpConfigurationClient m_client = makeClient();
};

std::string errorRecord(const std::string& key, const std::string& code) {
    return "<Error><ErrorKey>" + key + "</ErrorKey><ErrorCode>" + code +
           "</ErrorCode><ErrorMessage>msg</ErrorMessage></Error>";
}

template <class Expected>
void expectOnly(const std::function<void()>& call) {
    try {
        call();
        ADD_FAILURE() << "no exception";
    } catch (const HttpConfigurationException& e) {
        EXPECT_EQ(typeid(Expected), typeid(e)) << e.what();
        EXPECT_EQ("msg", str(e.Message()));
        EXPECT_TRUE(e.Key().empty());
        EXPECT_TRUE(e.Code().empty());
    }
}

// Regression: the status must equal "200" exactly, not merely parse as 200.
TEST_F(HttpClientResponses, OnlyTheExactStatus200IsSuccessWhateverTheBody) {
    EXPECT_EQ("<anything/>", str(exchange(200, "<anything/>", false)));
    EXPECT_EQ("", str(exchange(200, "", false)));
    for (const char* status : {"200 ", "0200", "201", ""}) {
        EXPECT_THROW(HttpConfigurationClientTestAccess::checkResponse(m_client, status, "", false),
                     HttpConfigurationException)
            << status;
    }
}

TEST_F(HttpClientResponses, ErrorKeysAndCodesSelectTheExceptionIgnoringCase) {
    expectOnly<HttpConfigurationInvalidNodeIdException>([&] {
        exchange(500, errorRecord("cf919ca8-84fe-4214-9343-c24f6e6b92b2", "42794"), false);
    });
    expectOnly<HttpConfigurationPathNotFoundException>([&] {
        exchange(404, errorRecord("AF901DEB-1F70-41CF-879D-6EFC19168686", "42795"), false);
    });
    expectOnly<HttpConfigurationFolderLimitReachedException>(
        [&] { exchange(400, errorRecord("other", "42794"), false); });
    expectOnly<HttpConfigurationItemLimitReachedException>(
        [&] { exchange(400, errorRecord("", "42795"), false); });
}

TEST_F(HttpClientResponses, OtherErrorsCarryTheWholeRecord) {
    try {
        exchange(500,
                 "<ErrorKey>K</ErrorKey><ErrorCode>1</ErrorCode><ErrorMessage>M</ErrorMessage>"
                 "<LocalizedErrorMessage>\xC3\xA9</LocalizedErrorMessage>"
                 "<ErrorOriginalStackTrace>T</ErrorOriginalStackTrace>",
                 false);
        FAIL();
    } catch (const HttpConfigurationException& e) {
        EXPECT_EQ(typeid(HttpConfigurationException), typeid(e));
        EXPECT_STREQ("HttpConfigurationException: M ErrorKey: K ErrorCode: 1 OriginalStackTrace: T",
                     e.what());
        EXPECT_EQ("\xE9", str(e.LocalizedMessage()));
    }
}

TEST_F(HttpClientResponses, AnErrorWithoutRecordHasAnEmptyMessage) {
    try {
        exchange(503, "Service Unavailable", false);
        FAIL();
    } catch (const HttpConfigurationException& e) {
        EXPECT_EQ(typeid(HttpConfigurationException), typeid(e));
        EXPECT_STREQ("HttpConfigurationException: ", e.what());
    }
}

// Any ReturnStatus but "0" is success, whatever the HTTP status.
TEST_F(HttpClientResponses, LegacyAnswersAreJudgedByReturnStatusOnly) {
    EXPECT_EQ(LegacyOk(), str(exchange(500, LegacyOk(), true)));
    for (const char* status : {"1", "true", "-1", "yes", ""}) {
        exchange(200, std::string("<ReturnStatus>") + status + "</ReturnStatus>", true);
    }
}

TEST_F(HttpClientResponses, LegacyFailureWithMessageIsAPlainException) {
    try {
        exchange(200, LegacyFailure("<ErrorMessage>it &amp; failed</ErrorMessage>"), true);
        FAIL();
    } catch (const HttpConfigurationException&) {
        FAIL() << "must not be an HttpConfigurationException";
    } catch (const std::exception& e) {
        EXPECT_STREQ("it & failed", e.what());
    }
}

TEST_F(HttpClientResponses, LegacyFailuresWithoutMessageOrReturnStatus) {
    const std::pair<std::string, std::string> cases[] = {
        {LegacyFailure(), "CheckResponse: request failed."},
        {"<Answer><ReturnStatus/></Answer>",
         "Error in response: <Answer><ReturnStatus/></Answer>"}};
    for (const auto& c : cases) {
        try {
            exchange(200, c.first, true);
            ADD_FAILURE() << "no exception";
        } catch (const HttpConfigurationException& e) {
            EXPECT_EQ(c.second, str(e.Message()));
        }
    }
}

}  // namespace
}  // namespace Configuration
