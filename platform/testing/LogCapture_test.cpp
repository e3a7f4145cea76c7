#include "testing/LogCapture.h"

#include <ace/Log_Msg.h>
#include <gtest/gtest.h>

#include <cerrno>
#include <string>
#include <thread>

#include "Quorvex/Log.h"

namespace {

using Quorvex::Testing::LogCapture;

// Guards the matching every log assertion relies on: exact text and priority, not a prefix.
TEST(LogCaptureTest, RecordsFromEveryThreadMatchedExactly) {
    LogCapture capture;
    QUORVEX_LOG(LM_ERROR, "Thing::read: Failed. Standard Exception: %s\n", "boom");
    std::thread([] {
        for (int i = 0; i < 200; ++i) {
            QUORVEX_LOG(LM_DEBUG, "number %d\n", i);
        }
    }).join();
    EXPECT_EQ(201u, capture.records().size());
    EXPECT_EQ(LM_ERROR, capture.records()[0].priority);
    EXPECT_TRUE(capture.contains(LM_DEBUG, "number 199\n"));
    EXPECT_FALSE(capture.contains(LM_ERROR, "number 42\n"));
    EXPECT_FALSE(capture.contains("number 42"));
    EXPECT_TRUE(capture.containsFragment("Exception: boom"));
    EXPECT_FALSE(capture.onlyStartsWith("Thing::read"));  // not the only message
    capture.clear();
    EXPECT_TRUE(capture.records().empty());
    QUORVEX_LOG(LM_ERROR, "Thing::read: Failed.\n");
    EXPECT_TRUE(capture.onlyStartsWith("Thing::read: "));
    EXPECT_FALSE(capture.onlyStartsWith("read"));
}

// Regression: the source location must reach the message (ACE's %N and %l).
TEST(LogCaptureTest, LogCarriesFileAndLine) {
    LogCapture capture;
    const int line = __LINE__ + 1;
    QUORVEX_LOG(LM_DEBUG, "%N:%l\n");
    const std::string expected = std::string(__FILE__) + ":" + std::to_string(line) + "\n";
    EXPECT_TRUE(capture.contains(expected)) << capture.records().at(0).text;
    EXPECT_STREQ(__FILE__, ACE_Log_Msg::instance()->file());
    EXPECT_EQ(line, ACE_Log_Msg::instance()->linenum());
}

// Regression: %m must print the errno of the caller, not one changed while logging.
TEST(LogCaptureTest, LogCarriesErrno) {
    LogCapture capture;
    errno = ENOENT;
    QUORVEX_LOG(LM_ERROR, "%mopen failed\n");
    ASSERT_EQ(1u, capture.records().size());
    EXPECT_NE(std::string::npos, capture.records()[0].text.find("No such file"))
        << capture.records()[0].text;
}

TEST(LogCaptureTest, QuietCaptureSilencesStderrAndRestoresFlags) {
    ACE_Log_Msg* log = ACE_Log_Msg::instance();
    const unsigned long before = log->flags();
    {
        LogCapture quiet;
        EXPECT_EQ(0u, log->flags() & ACE_Log_Msg::STDERR);
    }
    EXPECT_EQ(before, log->flags());
}

}  // namespace
