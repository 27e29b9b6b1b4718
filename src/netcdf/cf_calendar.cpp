#include "netcdf/cf_calendar.h"

#include <algorithm>
#include <array>
#include <cctype>
#include <string>
#include <tuple>
#include <utility>

namespace ryn {

namespace {

using Int = std::int64_t;

constexpr std::array<int, 13> kDaysBeforeMonth = {0,   31,  59,  90,  120, 151, 181,
                                                  212, 243, 273, 304, 334, 365};

constexpr Int FloorDivide(Int a, Int b) {
    return a / b - (a % b < 0 ? 1 : 0);
}

constexpr bool IsGregorianLeap(Int year) {
    return year % 4 == 0 && (year % 100 != 0 || year % 400 == 0);
}

// Years that start in March have their leap day last: the day of such a year follows from the month
// by a line, and the years of a cycle by a division. The Gregorian cycle is 400 years of 146097
// days, the Julian one 4 years of 1461. The offsets lead from 1 March of year 0 to 1 January 1970
// (Gregorian); the Julian 1 March of year 0 is two days earlier.
constexpr Int kGregorianOffset = 719468;
constexpr Int kJulianOffset = 719470;

struct MarchDate {
    Int year;
    Int dayOfYear;
};

MarchDate ToMarch(const CfDate& date) {
    const Int year = date.month <= 2 ? date.year - 1 : date.year;
    const int month = date.month + (date.month > 2 ? -3 : 9);
    return {year, (153 * month + 2) / 5 + date.day - 1};
}

CfDate FromMarch(const MarchDate& march) {
    const Int month = (5 * march.dayOfYear + 2) / 153;
    CfDate date;
    date.day = static_cast<int>(march.dayOfYear - (153 * month + 2) / 5 + 1);
    date.month = static_cast<int>(month < 10 ? month + 3 : month - 9);
    date.year = march.year + (date.month <= 2 ? 1 : 0);
    return date;
}

Int GregorianDay(const CfDate& date) {
    const MarchDate march = ToMarch(date);
    const Int cycle = FloorDivide(march.year, 400);
    const Int year = march.year - cycle * 400;
    return cycle * 146097 + year * 365 + year / 4 - year / 100 + march.dayOfYear - kGregorianOffset;
}

CfDate GregorianDate(Int number) {
    const Int days = number + kGregorianOffset;
    const Int cycle = FloorDivide(days, 146097);
    const Int day = days - cycle * 146097;
    const Int year = (day - day / 1460 + day / 36524 - day / 146096) / 365;
    return FromMarch({cycle * 400 + year, day - (365 * year + year / 4 - year / 100)});
}

Int JulianDay(const CfDate& date) {
    const MarchDate march = ToMarch(date);
    const Int cycle = FloorDivide(march.year, 4);
    return cycle * 1461 + (march.year - cycle * 4) * 365 + march.dayOfYear - kJulianOffset;
}

CfDate JulianDate(Int number) {
    const Int days = number + kJulianOffset;
    const Int cycle = FloorDivide(days, 1461);
    const Int day = days - cycle * 1461;
    const Int year = (day - day / 1460) / 365;
    return FromMarch({cycle * 4 + year, day - 365 * year});
}

constexpr Int kFirstGregorianDay = -141427; // 15 October 1582

bool IsBeforeReform(const CfDate& date) {
    return std::tie(date.year, date.month, date.day) < std::make_tuple(Int{1582}, 10, 15);
}

/// Days before a month of a year of fixed length: 365 or 366 days.
int DaysBefore(int month, int daysInYear) {
    return kDaysBeforeMonth[static_cast<std::size_t>(month - 1)] +
           (daysInYear == 366 && month > 2 ? 1 : 0);
}

CfDate FixedYearDate(Int number, int daysInYear) {
    CfDate date;
    date.year = FloorDivide(number, daysInYear);
    const int day = static_cast<int>(number - date.year * daysInYear);
    while (date.month < 12 && DaysBefore(date.month + 1, daysInYear) <= day)
        ++date.month;
    date.day = day - DaysBefore(date.month, daysInYear) + 1;
    return date;
}

CfDate Day360Date(Int number) {
    const Int year = FloorDivide(number, 360);
    const int day = static_cast<int>(number - year * 360);
    return {year, day / 30 + 1, day % 30 + 1};
}

Int NewYear(Int year) {
    return GregorianDay({year, 1, 1});
}

/// A day of a year of 360, at the same fraction of the real one: the nearest day, the even one of
/// two equally near, as the field's converters round.
Int RealDayOf360(Int number) {
    const Int year = FloorDivide(number, 360);
    const Int scaled = (number - year * 360 + 1) * (IsGregorianLeap(year) ? 366 : 365);
    const Int below = scaled / 360;
    const Int rest = scaled % 360;
    const bool goesUp = rest > 180 || (rest == 180 && below % 2 != 0);
    return NewYear(year) + below + (goesUp ? 1 : 0) - 1;
}

Int RealMillisecondsOfAllLeap(Int milliseconds) {
    constexpr Int kYear = 366 * kMillisecondsPerDay;
    const Int year = FloorDivide(milliseconds, kYear);
    const Int within = milliseconds - year * kYear;
    const Int scaled =
        IsGregorianLeap(year) ? within : within / 366 * 365 + within % 366 * 365 / 366;
    return NewYear(year) * kMillisecondsPerDay + scaled;
}

} // namespace

std::optional<CfCalendar> CfCalendarOfName(std::string_view name) {
    constexpr auto kNames = std::to_array<std::pair<std::string_view, CfCalendar>>({
        {"", CfCalendar::Standard},
        {"standard", CfCalendar::Standard},
        {"gregorian", CfCalendar::Standard},
        {"proleptic_gregorian", CfCalendar::ProlepticGregorian},
        {"julian", CfCalendar::Julian},
        {"noleap", CfCalendar::NoLeap},
        {"no_leap", CfCalendar::NoLeap},
        {"365_day", CfCalendar::NoLeap},
        {"all_leap", CfCalendar::AllLeap},
        {"366_day", CfCalendar::AllLeap},
        {"360_day", CfCalendar::Day360},
    });
    std::string lower(name);
    std::ranges::transform(lower, lower.begin(),
                           [](unsigned char c) { return static_cast<char>(std::tolower(c)); });
    for (const auto& [known, calendar] : kNames)
        if (lower == known)
            return calendar;
    return std::nullopt;
}

int DaysInMonth(CfCalendar calendar, std::int64_t year, int month) {
    if (calendar == CfCalendar::Day360)
        return 30;
    const bool isJulian =
        calendar == CfCalendar::Julian || (calendar == CfCalendar::Standard && year <= 1582);
    const bool isLeap =
        calendar == CfCalendar::AllLeap ||
        (calendar != CfCalendar::NoLeap && (isJulian ? year % 4 == 0 : IsGregorianLeap(year)));
    if (month == 2)
        return isLeap ? 29 : 28;
    return month == 4 || month == 6 || month == 9 || month == 11 ? 30 : 31;
}

bool HasDate(CfCalendar calendar, const CfDate& date) {
    constexpr Int kMaxYear = 1000000; // keeps the sums far from overflow
    if (date.year < -kMaxYear || date.year > kMaxYear || date.month < 1 || date.month > 12)
        return false;
    const bool isInGap = calendar == CfCalendar::Standard && date.year == 1582 &&
                         date.month == 10 && date.day > 4 && date.day < 15;
    return date.day >= 1 && date.day <= DaysInMonth(calendar, date.year, date.month) && !isInGap;
}

std::int64_t DayNumber(CfCalendar calendar, const CfDate& date) {
    switch (calendar) {
    case CfCalendar::Standard:
        return IsBeforeReform(date) ? JulianDay(date) : GregorianDay(date);
    case CfCalendar::ProlepticGregorian:
        return GregorianDay(date);
    case CfCalendar::Julian:
        return JulianDay(date);
    case CfCalendar::NoLeap:
        return date.year * 365 + DaysBefore(date.month, 365) + date.day - 1;
    case CfCalendar::AllLeap:
        return date.year * 366 + DaysBefore(date.month, 366) + date.day - 1;
    case CfCalendar::Day360:
        return date.year * 360 + (date.month - 1) * Int{30} + date.day - 1;
    }
    return 0;
}

CfDate DateOfDayNumber(CfCalendar calendar, std::int64_t number) {
    switch (calendar) {
    case CfCalendar::Standard:
        return number < kFirstGregorianDay ? JulianDate(number) : GregorianDate(number);
    case CfCalendar::ProlepticGregorian:
        return GregorianDate(number);
    case CfCalendar::Julian:
        return JulianDate(number);
    case CfCalendar::NoLeap:
        return FixedYearDate(number, 365);
    case CfCalendar::AllLeap:
        return FixedYearDate(number, 366);
    case CfCalendar::Day360:
        return Day360Date(number);
    }
    return {};
}

std::int64_t RealMilliseconds(CfCalendar calendar, std::int64_t milliseconds) {
    if (calendar == CfCalendar::AllLeap)
        return RealMillisecondsOfAllLeap(milliseconds);
    const Int day = FloorDivide(milliseconds, kMillisecondsPerDay);
    const Int timeOfDay = milliseconds - day * kMillisecondsPerDay;
    switch (calendar) {
    case CfCalendar::NoLeap:
        return GregorianDay(FixedYearDate(day, 365)) * kMillisecondsPerDay + timeOfDay;
    case CfCalendar::Day360:
        return RealDayOf360(day) * kMillisecondsPerDay + timeOfDay;
    default:
        return milliseconds;
    }
}

} // namespace ryn
