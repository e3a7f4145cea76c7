#include "Quorvex/BDate.h"

#include <gtest/gtest.h>

#include <string>

namespace {

TEST(BDate, TextRoundTrips) {
    for (const char* s : {"2010-03-04", "2000-02-29", "0000-01-01", "9999-12-31"}) {
        const BDate d(s);
        EXPECT_TRUE(d.isValid()) << s;
        EXPECT_STREQ(s, d.ToString().c_str());
    }
    EXPECT_EQ(BDate("2010-03-04"), BDate(2010, 3, 4));
}

TEST(BDate, ImpossibleDatesAreInvalid) {
    for (const char* s :
         {"", "2010-02-29", "1900-02-29", "2010-13-01", "2010-00-10", "2010-04-31", "2010-03-00",
          "2010-3-4", "20100304", "2010-03-04 ", "2010-03-04T00", "12010-03-04"}) {
        EXPECT_FALSE(BDate(s).isValid()) << s;
        EXPECT_STREQ("", BDate(s).ToString().c_str()) << s;
    }
    EXPECT_FALSE(BDate().isValid());
    EXPECT_FALSE(BDate(2010, 2, 30).isValid());
    EXPECT_FALSE(BDate(2010, 1, 257).isValid());  // a day that would wrap to 1 in one byte
    EXPECT_FALSE(BDate(-1, 1, 1).isValid());
    EXPECT_FALSE(BDate(10000, 1, 1).isValid());
}

TEST(BDate, Ordering) {
    EXPECT_TRUE(BDate() < BDate(0, 1, 1));
    EXPECT_TRUE(BDate(2010, 3, 4) < BDate(2010, 3, 5));
    EXPECT_TRUE(BDate(2010, 3, 31) < BDate(2010, 4, 1));
    EXPECT_TRUE(BDate(2009, 12, 31) < BDate(2010, 1, 1));
    EXPECT_FALSE(BDate(2010, 3, 4) < BDate(2010, 3, 4));
    EXPECT_EQ(BDate(), BDate("nonsense"));
}

}  // namespace
