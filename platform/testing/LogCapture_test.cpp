#include "testing/LogCapture.h"

#include <ace/Log_Msg.h>
#include <gtest/gtest.h>

#include <cerrno>
#include <string>
#include <thread>

#include "Quorvex/Log.h"

namespace {

using Quorvex::Testing::LogCapture;

TEST(LogCaptureTest, RecordsTextAndPriority) {
    LogCapture capture;
    QUORVEX_LOG(LM_ERROR, "Thing::read: Failed. Standard Exception: %s\n", "boom");
    QUORVEX_LOG(LM_DEBUG, "number %d\n", 42);
    const std::vector<LogCapture::Record> records = capture.records();
    ASSERT_EQ(2u, records.size());
    EXPECT_EQ(LM_ERROR, records[0].priority);
    EXPECT_EQ("Thing::read: Failed. Standard Exception: boom\n", records[0].text);
    EXPECT_TRUE(capture.contains("number 42\n"));
    EXPECT_TRUE(capture.contains(LM_DEBUG, "number 42\n"));
    EXPECT_FALSE(capture.contains(LM_ERROR, "number 42\n"));
    EXPECT_FALSE(capture.contains("number 42"));
    EXPECT_TRUE(capture.containsFragment("Standard Exception"));
    capture.clear();
    EXPECT_TRUE(capture.records().empty());
}

TEST(LogCaptureTest, CapturesEveryThread) {
    const int perThread = 200;
    LogCapture capture;
    auto work = [](const char* who) {
        for (int i = 0; i < perThread; ++i) {
            QUORVEX_LOG(LM_DEBUG, "%s %d\n", who, i);
        }
    };
    std::thread a(work, "a");
    std::thread b(work, "b");
    a.join();
    b.join();
    EXPECT_EQ(static_cast<size_t>(2 * perThread), capture.records().size());
    EXPECT_TRUE(capture.contains("a 0\n"));
    EXPECT_TRUE(capture.contains("b 199\n"));
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

TEST(LogCaptureTest, RestoresFlags) {
    ACE_Log_Msg* log = ACE_Log_Msg::instance();
    const unsigned long before = log->flags();
    {
        LogCapture outer(false);
        EXPECT_NE(0u, log->flags() & ACE_Log_Msg::STDERR);
    }
    {
        LogCapture quiet;
        EXPECT_EQ(0u, log->flags() & ACE_Log_Msg::STDERR);
        EXPECT_NE(0u, log->flags() & ACE_Log_Msg::CUSTOM);
    }
    EXPECT_EQ(before, log->flags());
}

}  // namespace
