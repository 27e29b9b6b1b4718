#include <limits>
#include <string>
#include <vector>

#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

#include "netcdf/cf_calendar.h"
#include "netcdf/cf_time.h"

namespace ryn {
namespace {

const std::vector<CfCalendar> kCalendars = {CfCalendar::Standard, CfCalendar::ProlepticGregorian,
                                            CfCalendar::Julian,   CfCalendar::NoLeap,
                                            CfCalendar::AllLeap,  CfCalendar::Day360};

std::string DateText(const CfDate& date) {
    return std::to_string(date.year) + "-" + std::to_string(date.month) + "-" +
           std::to_string(date.day);
}

/// The real date and time of a value, as text; "none" where there is none.
std::string At(const std::string& units, const std::string& calendar, double value) {
    CfTime time;
    const Status status = CfTime::Parse(units, calendar, &time);
    EXPECT_TRUE(status.IsOk()) << status.Text();
    const auto milliseconds = time.Milliseconds(value);
    if (!milliseconds)
        return "none";
    const std::int64_t day =
        (*milliseconds -
         ((*milliseconds % kMillisecondsPerDay) + kMillisecondsPerDay) % kMillisecondsPerDay) /
        kMillisecondsPerDay;
    const std::int64_t rest = *milliseconds - day * kMillisecondsPerDay;
    return DateText(DateOfDayNumber(CfCalendar::ProlepticGregorian, day)) + " " +
           std::to_string(rest / 3600000) + ":" + std::to_string(rest / 60000 % 60) + ":" +
           std::to_string(rest / 1000 % 60);
}

// Expected dates from `ncdump -t` of netCDF 4.9.0 on a variable with these values, the unit "days
// since 1850-02-28 06:00:00" and the calendar, for all but the two real-world calendars' last row,
// which is the day before the reform (4 October 1582 was followed by 15 October).
TEST(CfCalendar, CountsDaysAsOtherProgramsDo) {
    struct Case {
        CfCalendar calendar;
        std::int64_t days;
        const char* date;
    };
    const Case cases[] = {
        {CfCalendar::Standard, 366, "1851-3-1"},
        {CfCalendar::Standard, 54786, "2000-2-28"},
        {CfCalendar::Standard, 54787, "2000-2-29"},
        {CfCalendar::Standard, -97000, "1584-8-1"},
        {CfCalendar::Standard, -97656, "1582-10-15"},
        {CfCalendar::Standard, -97657, "1582-10-4"},
        {CfCalendar::ProlepticGregorian, 50000, "1987-1-21"},
        {CfCalendar::ProlepticGregorian, -97657, "1582-10-14"},
        {CfCalendar::Julian, 50000, "1987-1-20"},
        {CfCalendar::Julian, 54787, "2000-2-28"},
        {CfCalendar::Julian, -97000, "1584-8-3"},
        {CfCalendar::NoLeap, 366, "1851-3-1"},
        {CfCalendar::NoLeap, 50000, "1987-2-23"},
        {CfCalendar::NoLeap, -97000, "1584-5-29"},
        {CfCalendar::AllLeap, 1, "1850-2-29"},
        {CfCalendar::AllLeap, 50000, "1986-10-9"},
        {CfCalendar::AllLeap, -97000, "1585-2-18"},
        {CfCalendar::Day360, 366, "1851-3-4"},
        {CfCalendar::Day360, 54787, "2002-5-5"},
        {CfCalendar::Day360, -97000, "1580-9-18"},
    };
    for (const Case& c : cases) {
        const std::int64_t start = DayNumber(c.calendar, {1850, 2, 28});
        EXPECT_EQ(DateText(DateOfDayNumber(c.calendar, start + c.days)), c.date)
            << static_cast<int>(c.calendar) << " " << c.days;
    }
    EXPECT_EQ(DayNumber(CfCalendar::Standard, {1970, 1, 1}), 0);
}

RC_GTEST_PROP(CfCalendar, DatesAndDayNumbersInvert, ()) {
    const CfCalendar calendar = *rc::gen::elementOf(kCalendars);
    const std::int64_t number = *rc::gen::inRange<std::int64_t>(-1000000, 1000000);
    const CfDate date = DateOfDayNumber(calendar, number);
    RC_ASSERT(HasDate(calendar, date));
    RC_ASSERT(DayNumber(calendar, date) == number);
}

RC_GTEST_PROP(CfCalendar, LaterMomentsStayLater, ()) {
    const CfCalendar calendar = *rc::gen::elementOf(kCalendars);
    const std::int64_t first =
        *rc::gen::inRange<std::int64_t>(-1000000, 1000000) * kMillisecondsPerDay / 7;
    const std::int64_t apart = *rc::gen::inRange<std::int64_t>(100, 10 * kMillisecondsPerDay);
    RC_ASSERT(RealMilliseconds(calendar, first) < RealMilliseconds(calendar, first + apart));
}

TEST(CfTime, ReadsTheUsualUnitsAndReferences) {
    EXPECT_EQ(At("seconds since 1990-01-01 00:00:00", "", 86400.0), "1990-1-2 0:0:0");
    EXPECT_EQ(At("hours since 1900-01-01 00:00:0.0", "gregorian", 1.5), "1900-1-1 1:30:0");
    EXPECT_EQ(At("days since 2000-1-1", "Standard", -0.25), "1999-12-31 18:0:0");
    EXPECT_EQ(At("Minutes since 2000-02-28T23:59:00Z", "proleptic_gregorian", 2.0),
              "2000-2-29 0:1:0");
    EXPECT_EQ(At("d since 20000101 06", "", 0.0), "2000-1-1 6:0:0");
    EXPECT_EQ(At("hours since 2000-01-01 00:00 +01:30", "", 0.0), "1999-12-31 22:30:0");
    EXPECT_EQ(At("hours since 2000-01-01 00:00:00 -6", "", 0.0), "2000-1-1 6:0:0");
    EXPECT_EQ(At("hours since 2000-01-01 00:00:00 UTC", "", 0.0), "2000-1-1 0:0:0");
    EXPECT_EQ(At("weeks since 2000-01", "", 1.0), "2000-1-8 0:0:0");
    EXPECT_EQ(At("milliseconds since 1970-01-01", "", 1e12), "2001-9-9 1:46:40");
    // Julian days 1721423.5 and 2451544.5: the Julian 1 January of year 1 lies two days earlier.
    EXPECT_EQ(At("days since 1-1-1", "standard", 730121.0), "2000-1-1 0:0:0");
    EXPECT_EQ(At("days since 1-1-1", "proleptic_gregorian", 730119.0), "2000-1-1 0:0:0");
}

TEST(CfTime, MonthsAndYearsFollowTheCalendar) {
    EXPECT_EQ(At("months since 2000-01-31 12:00", "", 1.0), "2000-2-29 12:0:0");
    EXPECT_EQ(At("months since 2000-01-15", "", -13.0), "1998-12-15 0:0:0");
    EXPECT_EQ(At("years since 1850-01-01", "", 150.0), "2000-1-1 0:0:0");
    CfTime time;
    ASSERT_TRUE(CfTime::Parse("months since 2000-01-01", "", &time).IsOk());
    ASSERT_TRUE(time.CountsMonths());
    time.UseMeanMonths();
    EXPECT_EQ(time.Milliseconds(12.0).value() - time.Milliseconds(0.0).value(), 31556925975);
}

TEST(CfTime, OtherCalendarsFindTheirPlaceInTheRealYear) {
    // No leap days: by the fields.
    EXPECT_EQ(At("days since 2000-02-28", "noleap", 1.0), "2000-3-1 0:0:0");
    EXPECT_EQ(At("days since 1999-01-01 12:00", "365_day", 365.0 * 2), "2001-1-1 12:0:0");
    // 360 days: the 30th day of the sixth month is half the year, which is 182.5 days of 365.
    EXPECT_EQ(At("days since 2001-01-01 12:00", "360_day", 0.0), "2001-1-1 12:0:0");
    EXPECT_EQ(At("days since 2001-01-01 12:00", "360_day", 359.0), "2001-12-31 12:0:0");
    EXPECT_EQ(At("days since 2001-01-01", "360_day", 180.0), "2001-7-3 0:0:0");
    EXPECT_EQ(At("days since 2000-01-01", "360_day", 359.0), "2000-12-31 0:0:0");
    EXPECT_EQ(At("days since 2000-02-29", "all_leap", 0.0), "2000-2-29 0:0:0");
    EXPECT_EQ(At("days since 2001-01-01", "all_leap", 183.0), "2001-7-2 12:0:0");
    EXPECT_EQ(At("days since 1900-01-01", "julian", 0.0), "1900-1-13 0:0:0");
}

TEST(CfTime, AUnitWithoutADateIsRelative) {
    CfTime time;
    ASSERT_TRUE(CfTime::Parse("h", "", &time).IsOk());
    EXPECT_TRUE(time.IsRelative());
    EXPECT_EQ(time.Milliseconds(1.5), 5400000);
}

TEST(CfTime, RefusesWhatNamesNoTimeAndSaysWhy) {
    const auto fault = [](const std::string& units, const std::string& calendar) {
        CfTime time;
        return CfTime::Parse(units, calendar, &time).Text();
    };
    EXPECT_EQ(fault("metres", ""), "unit \"metres\" is no unit of time");
    EXPECT_EQ(fault("", ""), "unit \"\" is no unit of time");
    EXPECT_EQ(fault("day as %Y%m%d.%f", ""), "unit \"day as %Y%m%d.%f\" is no unit of time");
    EXPECT_EQ(fault("days since 2000-01-01", "mayan"), "calendar \"mayan\" is not known");
    for (const char* date : {"2001-02-29", "2000-13-01", "2000-00-01", "yesterday",
                             "2000-01-01 25:00", "2000-1-1 1:60", "2000-01-01 00:00 local",
                             "1582-10-10", "99999999999-1-1", "2000-01-01 00:00:00 +99", "-"})
        EXPECT_NE(fault(std::string("days since ") + date, ""), "") << date;
    EXPECT_EQ(fault("days since 2001-02-29", "all_leap"), "");
    EXPECT_EQ(fault("days since 1999-02-30", "360_day"), "");
}

TEST(CfTime, GivesNoDateOutsideTheYears100To9999) {
    EXPECT_EQ(At("days since 0099-12-31", "proleptic_gregorian", 0.0), "none");
    EXPECT_EQ(At("days since 0099-12-31", "proleptic_gregorian", 1.0), "100-1-1 0:0:0");
    EXPECT_EQ(At("days since 9999-12-31", "", 1.0), "none");
    for (const double value : {1e300, -1e300, std::numeric_limits<double>::infinity(),
                               std::numeric_limits<double>::quiet_NaN(), 9.96921e36})
        for (const char* units : {"days since 2000-01-01", "months since 2000-01-01"})
            EXPECT_EQ(At(units, "", value), "none") << value;
}

} // namespace
} // namespace ryn
