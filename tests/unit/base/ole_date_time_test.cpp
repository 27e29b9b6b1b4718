#include "base/ole_date_time.h"

#include <cmath>

#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

namespace ryn {
namespace {

TEST(COleDateTime, CountsDaysSince30December1899) {
    EXPECT_EQ(COleDateTime(1899, 12, 30, 0, 0, 0).DayCount(), 0.0);
    EXPECT_EQ(COleDateTime(1900, 1, 1, 12, 0, 0).DayCount(), 2.5);
    EXPECT_EQ(COleDateTime(1990, 1, 1, 0, 0, 0).DayCount(), 32874.0);
    EXPECT_EQ(COleDateTime(100, 1, 1, 0, 0, 0).DayCount(), -657434.0);
    EXPECT_EQ(COleDateTime(9999, 12, 31, 0, 0, 0).DayCount(), 2958465.0);
}

TEST(COleDateTime, KeepsTheTimeOfDayAsAPositiveFractionBelowZero) {
    const COleDateTime date(1899, 12, 29, 6, 0, 0);
    EXPECT_EQ(date.DayCount(), -1.25);
    EXPECT_EQ(date.LinearCount(), -0.75);
    EXPECT_EQ(date.GetHour(), 6);
    EXPECT_EQ((COleDateTime(1899, 12, 30, 6, 0, 0) - date).GetTotalDays(), 1.0);
    EXPECT_EQ((date + COleDateTimeSpan(1.0)).DayCount(), 0.25);
    EXPECT_EQ((COleDateTime(1899, 12, 30, 6, 0, 0) - COleDateTimeSpan(1.0)).DayCount(), -1.25);
    EXPECT_LT(COleDateTime(1899, 12, 29, 6, 0, 0), COleDateTime(1899, 12, 29, 18, 0, 0));
}

// A sum can lie a rounding's hair below a whole day, which the signed count cannot hold.
TEST(COleDateTime, KeepsADateThatASumPutAHairBelowMidnight) {
    for (double day = 2.0; day < 600000.0; day *= 2.0) {
        const double below = std::nextafter(1.0 - day, -1e9);
        const COleDateTime date = COleDateTime(1.0 - day) + COleDateTimeSpan(below - (1.0 - day));
        EXPECT_EQ(date.GetFields().day, COleDateTime(1.0 - day).GetFields().day) << day;
        EXPECT_EQ(date, COleDateTime(1.0 - day));
    }
}

TEST(COleDateTime, RefusesFieldsThatNoCalendarHas) {
    EXPECT_FALSE(COleDateTime(2001, 2, 29, 0, 0, 0).IsValid());
    EXPECT_FALSE(COleDateTime(1900, 2, 29, 0, 0, 0).IsValid());
    EXPECT_TRUE(COleDateTime(2000, 2, 29, 0, 0, 0).IsValid());
    EXPECT_FALSE(COleDateTime(2000, 13, 1, 0, 0, 0).IsValid());
    EXPECT_FALSE(COleDateTime(2000, 1, 1, 24, 0, 0).IsValid());
    EXPECT_FALSE(COleDateTime(99, 12, 31, 0, 0, 0).IsValid());
    EXPECT_FALSE(COleDateTime(10000, 1, 1, 0, 0, 0).IsValid());
    EXPECT_FALSE(COleDateTime(std::nan("")).IsValid());
    EXPECT_FALSE(COleDateTime(1e300).IsValid());
}

TEST(COleDateTime, GivesMinusOneForEachFieldOfAnInvalidDate) {
    const COleDateTime::Fields fields = COleDateTime().GetFields();
    EXPECT_EQ(fields.year, -1);
    EXPECT_EQ(fields.month, -1);
    EXPECT_EQ(fields.day, -1);
    EXPECT_EQ(fields.hour, -1);
    EXPECT_EQ(fields.minute, -1);
    EXPECT_EQ(COleDateTime().Format("%Y"), "");
}

TEST(COleDateTime, ComparesFalselyWithAnInvalidDateInEveryWay) {
    const COleDateTime valid(2000, 1, 1, 0, 0, 0);
    const COleDateTime invalid;
    EXPECT_FALSE(valid == invalid);
    EXPECT_FALSE(valid != invalid);
    EXPECT_FALSE(invalid == invalid);
    EXPECT_FALSE(valid < invalid);
    EXPECT_FALSE(valid > invalid);
    EXPECT_FALSE(valid <= invalid);
    EXPECT_FALSE(valid >= invalid);
    EXPECT_FALSE((valid + (valid - invalid)).IsValid());
}

TEST(COleDateTime, TakesDatesLessThanHalfASecondApartAsEqual) {
    const COleDateTime noon(2000, 1, 1, 12, 0, 0);
    const COleDateTime nearly(noon.DayCount() - 0.4 / 86400.0);
    EXPECT_EQ(nearly, noon);
    EXPECT_GE(nearly, noon);
    EXPECT_LT(nearly, noon);
    EXPECT_NE(COleDateTime(noon.DayCount() - 0.6 / 86400.0), noon);
}

TEST(COleDateTime, FormatsFieldsPaddedWithZeros) {
    EXPECT_EQ(COleDateTime(1990, 1, 2, 3, 4, 5).Format("%Y-%m-%d"), "1990-01-02");
    EXPECT_EQ(COleDateTime(1990, 1, 2, 3, 4, 5).Format("%H:%M:%S"), "03:04:05");
    EXPECT_EQ(COleDateTime(476, 9, 4, 0, 0, 0).Format("%Y"), "0476");
}

RC_GTEST_PROP(COleDateTimeProperty, FieldsSurviveTheWayThroughTheDayCount, ()) {
    const int year = *rc::gen::inRange(100, 10000);
    const int month = *rc::gen::inRange(1, 13);
    const int day = *rc::gen::inRange(1, DaysInMonth(year, month) + 1);
    const int second = *rc::gen::inRange(0, 86400);
    const COleDateTime date(year, month, day, second / 3600, second / 60 % 60, second % 60);
    const COleDateTime::Fields back = COleDateTime(date.DayCount()).GetFields();
    RC_ASSERT(back.year == year);
    RC_ASSERT(back.month == month);
    RC_ASSERT(back.day == day);
    RC_ASSERT(back.hour * 3600 + back.minute * 60 + back.second == second);
}

RC_GTEST_PROP(COleDateTimeProperty, AddingADifferenceLeadsToTheOtherDate, ()) {
    const COleDateTime a(*rc::gen::inRange(-600000, 2900000) + 0.25);
    const COleDateTime b(*rc::gen::inRange(-600000, 2900000) + 0.75);
    RC_ASSERT(a + (b - a) == b);
    RC_ASSERT((a < b) == ((b - a).GetTotalDays() > 0.0));
}

} // namespace
} // namespace ryn
