#include "Quorvex/BTime.h"

#include <gtest/gtest.h>

#include <string>

namespace {

std::string text(const BTime& t) {
    return t.ToString().c_str();
}

TEST(BTime, TextFormsAndFields) {
    EXPECT_EQ("00:00:00", text(BTime()));
    EXPECT_EQ("05:06:07", text(BTime(5, 6, 7)));
    EXPECT_EQ("05:06:07.089", text(BTime(5, 6, 7, 89)));
    EXPECT_EQ("100:00:00", text(BTime::fromMilliseconds(360000000)));
    const BTime t("26:05:09.5");
    EXPECT_EQ(26, t.hours());
    EXPECT_EQ(5, t.minutes());
    EXPECT_EQ(9, t.seconds());
    EXPECT_EQ(500, t.milliseconds());
    EXPECT_EQ(93909500, t.totalMilliseconds());
}

TEST(BTime, TextRoundTrips) {
    for (const char* s : {"00:00:00", "23:59:59.999", "00:05:00", "999999999:59:59.999"}) {
        EXPECT_EQ(s, text(BTime(s)));
    }
    EXPECT_EQ(BTime(0, 0, 1, 234), BTime("00:00:01.2345678"));
}

TEST(BTime, InvalidFormsAndFields) {
    for (const char* s : {"", "5:00:00", "05:00", "05:60:00", "05:00:60", "05:00:00.", "05:00:00 ",
                          "-01:00:00", "1000000000:00:00", "05-00-00", "aa:bb:cc"}) {
        const BTime t(s);
        EXPECT_FALSE(t.isValid()) << s;
        EXPECT_EQ(0, t.totalMilliseconds()) << s;
        EXPECT_EQ("", text(t)) << s;
    }
    EXPECT_FALSE(BTime(-1, 0, 0).isValid());
    EXPECT_FALSE(BTime(0, 60, 0).isValid());
    EXPECT_FALSE(BTime(0, 0, 0, 1000).isValid());
    EXPECT_FALSE(BTime::fromMilliseconds(-1).isValid());
    EXPECT_NE(BTime(""), BTime());
}

}  // namespace
