#include "Quorvex/BDateTime.h"

#include <gtest/gtest.h>

#include <initializer_list>
#include <random>
#include <string>

#include "Quorvex/Machine.h"
#include "testing/FakeMachine.h"

namespace {

std::string text(const BDateTime& t) {
    return t.ToString().c_str();
}

TEST(BDateTimeParse, AcceptedFormsGiveUtc) {
    const std::pair<const char*, const char*> cases[] = {
        {"2010-03-04T05:06:07.089", "2010-03-04T05:06:07.089"},
        {"2010-03-04T05:06:07.0890000-00:00", "2010-03-04T05:06:07.089"},  // the service form
        {"2010-03-04T05:06:07.0890000+00:00", "2010-03-04T05:06:07.089"},
        {"2010-03-04T05:06:07.089Z", "2010-03-04T05:06:07.089"},
        {"2010-03-04 05:06:07.089", "2010-03-04T05:06:07.089"},
        {"2010-03-04T05:06:07", "2010-03-04T05:06:07.000"},
        {"2010-03-04T05:06:07Z", "2010-03-04T05:06:07.000"},
        {"2010-03-04T05:06:07.5", "2010-03-04T05:06:07.500"},
        {"2010-03-04T05:06:07.05", "2010-03-04T05:06:07.050"},
        {"2010-03-04T05:06:07.0899999", "2010-03-04T05:06:07.089"},  // cut, not rounded
        {"2010-03-04T05:06:07.08912345678901234567", "2010-03-04T05:06:07.089"},
        {"2010-03-04T01:00:00.000+02:00", "2010-03-03T23:00:00.000"},
        {"2010-03-04T23:30:00-05:30", "2010-03-05T05:00:00.000"},
        {"2010-12-31T23:59:59.999-23:59", "2011-01-01T23:58:59.999"},
        {"0000-01-01T00:00:00.000", "0000-01-01T00:00:00.000"},
        {"9999-12-31T23:59:59.999Z", "9999-12-31T23:59:59.999"},
        {"1969-12-31T23:59:59.999", "1969-12-31T23:59:59.999"},
    };
    for (const auto& c : cases) {
        EXPECT_EQ(c.second, text(BDateTime(c.first))) << c.first;
    }
}

void expectInvalid(std::initializer_list<const char*> forms) {
    for (const char* c : forms) {
        const BDateTime t(c);
        EXPECT_FALSE(t.isValid()) << c;
        EXPECT_EQ(BDateTime(), t) << c;
        EXPECT_EQ("", text(t)) << c;
    }
}

TEST(BDateTimeParse, RejectedFormsGiveTheInvalidValue) {
    // Layout, separators, case, offsets and stray characters.
    expectInvalid({"", " ", "2010-03-04", "2010-03-04T", "2010-03-04T05:06", "2010-03-04T05:06:07.",
                   "2010-03-04T05:06:07 ", " 2010-03-04T05:06:07", "2010-03-04T05:06:07x",
                   "2010-03-04T05:06:07.089Zx", "2010-03-04T05:06:07Z+01:00",
                   "2010-03-04T05:06:07+0100", "2010-03-04T05:06:07+01", "2010-03-04t05:06:07",
                   "2010-03-04T05:06:07z", "2010/03/04T05:06:07", "2010-03-04T05:06:07,089",
                   "2010-03-04T05:06:07.0890000-00:00\n"});
    // Field widths and signs.
    expectInvalid({"10-03-04T05:06:07", "12010-03-04T05:06:07", "2010-3-04T05:06:07",
                   "2010-03-4T05:06:07", "2010-03-04T5:06:07", "-010-03-04T05:06:07",
                   "2010-03-04T05:06:07.-1"});
    // Fields and offsets out of range, and offsets that move the instant out of years 0..9999.
    expectInvalid({"2010-13-04T05:06:07", "2010-00-04T05:06:07", "2010-02-30T05:06:07",
                   "2010-04-31T05:06:07", "2010-03-00T05:06:07", "2010-03-04T24:00:00",
                   "2010-03-04T05:60:07", "2010-03-04T05:06:60", "2010-03-04T05:06:07+24:00",
                   "2010-03-04T05:06:07+01:60", "0000-01-01T00:00:00+00:01",
                   "9999-12-31T23:59:59-00:01"});
    EXPECT_FALSE(BDateTime(ACE_CString("2010-03-04T05:06:07\0garbage", 27)).isValid());
}

TEST(BDateTimeParse, LeapYears) {
    EXPECT_TRUE(BDateTime("2000-02-29T00:00:00").isValid());
    EXPECT_TRUE(BDateTime("2004-02-29T00:00:00").isValid());
    EXPECT_FALSE(BDateTime("1900-02-29T00:00:00").isValid());
    EXPECT_FALSE(BDateTime("2100-02-29T00:00:00").isValid());
    EXPECT_FALSE(BDateTime("2010-02-29T00:00:00").isValid());
    EXPECT_EQ("2012-02-29T01:00:00.000", text(BDateTime("2012-02-28T23:00:00") + BTime(2, 0, 0)));
    EXPECT_EQ("2011-03-01T01:00:00.000", text(BDateTime("2011-02-28T23:00:00") + BTime(2, 0, 0)));
}

TEST(BDateTimeParse, RandomInstantsRoundTripThroughText) {
    std::mt19937_64 gen(3);
    std::uniform_int_distribution<std::int64_t> ms(-62167219200000, 253402300799999);
    for (int i = 0; i < 2000; ++i) {
        const BDateTime t = BDateTime::fromMillisecondsSinceEpoch(ms(gen));
        ASSERT_TRUE(t.isValid());
        EXPECT_EQ(t, BDateTime(t.ToString())) << text(t);
    }
}

TEST(BDateTime, EpochAndRangeEdges) {
    EXPECT_EQ("1970-01-01T00:00:00.000", text(BDateTime::fromMillisecondsSinceEpoch(0)));
    EXPECT_EQ(1267679167089, BDateTime("2010-03-04T05:06:07.089").millisecondsSinceEpoch());
    EXPECT_FALSE(BDateTime::fromMillisecondsSinceEpoch(-62167219200001).isValid());
    EXPECT_FALSE(BDateTime::fromMillisecondsSinceEpoch(253402300800000).isValid());
    EXPECT_FALSE((BDateTime("9999-12-31T23:00:00") + BTime(1, 0, 0)).isValid());
}

TEST(BDateTime, OrderingPutsInvalidFirst) {
    const BDateTime invalid;
    const BDateTime a("2010-03-04T05:06:07.089");
    const BDateTime b("2010-03-04T05:06:07.090");
    EXPECT_TRUE(invalid < a);
    EXPECT_FALSE(a < invalid);
    EXPECT_FALSE(invalid < BDateTime("garbage"));
    EXPECT_EQ(invalid, BDateTime("garbage"));
    EXPECT_TRUE(a < b && b > a && a <= b && b >= a && a != b);
    EXPECT_FALSE(a < a);
    EXPECT_EQ(a, BDateTime("2010-03-04T06:06:07.0890000+01:00"));
}

TEST(BDateTime, AddingTimesCrossesDayMonthAndYear) {
    const BDateTime t("2010-12-31T23:30:00");
    EXPECT_EQ("2011-01-01T00:00:00.000", text(t + BTime(0, 30, 0)));
    EXPECT_EQ("2011-01-01T00:29:59.999", text(t + BTime("00:59:59.999")));
    EXPECT_EQ("2011-01-31T23:30:00.000", text(t + BTime("744:00:00")));  // 31 days
    EXPECT_EQ("2010-04-01T00:00:00.000", text(BDateTime("2010-03-31T23:59:59") + BTime(0, 0, 1)));
    EXPECT_EQ("2010-12-30T23:30:00.000", text(t - BTime(24, 0, 0)));
    EXPECT_FALSE((t + BTime("bad")).isValid());
    EXPECT_FALSE((BDateTime() + BTime(1, 0, 0)).isValid());
}

TEST(BDateTime, DifferenceIsASignedSpan) {
    const BDateTime a("2010-03-04T05:06:07.089");
    const BDateTime b("2010-03-05T05:06:08");
    EXPECT_EQ(BTimeSpan(86400911), b - a);
    EXPECT_EQ(BTimeSpan(-86400911), a - b);
    EXPECT_DOUBLE_EQ(86400.911, (b - a).totalSeconds());
    EXPECT_EQ(BTimeSpan(0), BDateTime() - a);
}

TEST(BDateTime, SplitsIntoDateAndTimeOfDayAndBack) {
    const BDateTime t("1969-12-31T23:59:59.999");
    EXPECT_EQ(BDate(1969, 12, 31), t.date());
    EXPECT_EQ(BTime(23, 59, 59, 999), t.timeOfDay());
    EXPECT_EQ(t, BDateTime(t.date(), t.timeOfDay()));
    EXPECT_EQ("2010-03-05T01:00:00.000", text(BDateTime(BDate(2010, 3, 4), BTime("25:00:00"))));
    EXPECT_FALSE(BDateTime(BDate(), BTime(1, 0, 0)).isValid());
    EXPECT_FALSE(BDateTime().date().isValid());
    EXPECT_FALSE(BDateTime().timeOfDay().isValid());
}

TEST(BDateTime, NowReadsTheMachineClock) {
    Quorvex::Testing::FakeMachine machine;
    machine.setNowMilliseconds(1267679167089);
    Quorvex::ScopedMachine installed(machine);
    EXPECT_EQ("2010-03-04T05:06:07.089", text(BDateTime::Now()));
    machine.advanceMilliseconds(5 * 60 * 1000);
    EXPECT_EQ("2010-03-04T05:11:07.089", text(BDateTime::Now()));
}

}  // namespace
