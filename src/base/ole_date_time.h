#pragma once

#include <cmath>
#include <limits>
#include <string>
#include <string_view>

namespace ryn {

/// A length of time in days.
class COleDateTimeSpan {
  public:
    COleDateTimeSpan() = default;
    explicit COleDateTimeSpan(double totalDays) : days(totalDays) {}
    COleDateTimeSpan(long wholeDays, int hours, int minutes, int seconds)
        : days(static_cast<double>(wholeDays) + hours / 24.0 + minutes / 1440.0 +
               seconds / 86400.0) {}

    double GetTotalDays() const { return days; }

  private:
    double days = 0.0;
};

/// A date and time of day in the proleptic Gregorian calendar, without a time zone: a count of days
/// since 30 December 1899 with a validity. Years 100 to 9999.
///
/// A count below zero keeps the time of day as a positive fraction: -1.25 is 06:00 on
/// 29 December 1899. Ordering, differences and sums go over the linear count (-0.75 for that
/// moment); fields are those of the nearest whole second.
///
/// Two valid dates are equal when they lie less than half a second apart; < and > compare the
/// linear counts directly, >= and <= are "less or greater, or equal in that sense". Every
/// comparison that involves an invalid date is false, != included.
class COleDateTime {
  public:
    /// The calendar fields of a date; all -1 for an invalid one.
    struct Fields {
        int year = -1;
        int month = -1;
        int day = -1;
        int hour = -1;
        int minute = -1;
        int second = -1;
    };

    /// An invalid date.
    COleDateTime() = default;
    /// From a stored day count; invalid when it is not finite or its year is out of range.
    explicit COleDateTime(double dayCount);
    /// From fields; invalid when any is out of its range, 29 February of a common year included.
    COleDateTime(int year, int month, int day, int hour, int minute, int second);

    /// The date of a linear count; invalid when it is out of range or NaN.
    static COleDateTime FromLinearCount(double count) {
        COleDateTime date;
        if (count >= kFirstDay && count < kPastLastDay)
            date.linear = count;
        return date;
    }

    bool IsValid() const { return linear == linear; }
    /// The day count by the sign rule above; NaN when invalid.
    double DayCount() const;
    /// Days since 30 December 1899 as a number without the sign rule; NaN when invalid.
    double LinearCount() const { return linear; }

    Fields GetFields() const;
    int GetYear() const { return GetFields().year; }
    int GetMonth() const { return GetFields().month; }
    int GetDay() const { return GetFields().day; }
    int GetHour() const { return GetFields().hour; }
    int GetMinute() const { return GetFields().minute; }
    int GetSecond() const { return GetFields().second; }

    /// Text by a pattern of %Y %m %d %H %M %S and plain characters; empty for an invalid date.
    std::string Format(std::string_view pattern) const;

    /// Invalid operands, and results out of range, give an invalid date.
    COleDateTime operator+(COleDateTimeSpan span) const;
    COleDateTime operator-(COleDateTimeSpan span) const;
    /// The difference of the linear counts; NaN days when either is invalid.
    COleDateTimeSpan operator-(const COleDateTime& other) const;

    friend bool operator==(const COleDateTime& a, const COleDateTime& b) {
        return std::fabs(a.LinearCount() - b.LinearCount()) < kHalfSecond;
    }
    friend bool operator!=(const COleDateTime& a, const COleDateTime& b) {
        return a.IsValid() && b.IsValid() && !(a == b);
    }
    friend bool operator<(const COleDateTime& a, const COleDateTime& b) {
        return a.LinearCount() < b.LinearCount();
    }
    friend bool operator>(const COleDateTime& a, const COleDateTime& b) { return b < a; }
    friend bool operator<=(const COleDateTime& a, const COleDateTime& b) { return a < b || a == b; }
    friend bool operator>=(const COleDateTime& a, const COleDateTime& b) { return a > b || a == b; }

    /// Half a second in days: 0.5 / 86400.
    static constexpr double kHalfSecond = 5.787037037037037e-6;

  private:
    // 1 January 100 and 1 January 10000, in days since 30 December 1899.
    static constexpr double kFirstDay = -657434.0;
    static constexpr double kPastLastDay = 2958466.0;

    // The linear count: sums and differences by the signed one would lose a rounding's hair below a
    // whole day to the next day. A NaN stands for "invalid", so that a date takes the room of its
    // number: a series of 10^7 samples holds as many dates.
    double linear = std::numeric_limits<double>::quiet_NaN();
};

/// True when a lies before b by half a second or more. Sums of day fractions are off by some 1e-11
/// days; this keeps a moment that was computed in two ways from lying before itself.
inline bool IsClearlyBefore(const COleDateTime& a, const COleDateTime& b) {
    return a < b && a != b;
}

bool IsLeapYear(int year);
/// Days of a month, 1 to 12, of a year.
int DaysInMonth(int year, int month);

} // namespace ryn
