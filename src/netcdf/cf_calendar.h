#pragma once

#include <cstdint>
#include <optional>
#include <string_view>

namespace ryn {

/// The calendars of the CF conventions.
enum class CfCalendar {
    Standard,           ///< Julian up to 4 October 1582, Gregorian from 15 October on
    ProlepticGregorian, ///< Gregorian throughout
    Julian,
    NoLeap,  ///< every year has 365 days
    AllLeap, ///< every year has 366 days
    Day360,  ///< twelve months of 30 days
};

/// By the name in a file, in any case; an empty name is the standard calendar. Nothing for an
/// unknown name.
std::optional<CfCalendar> CfCalendarOfName(std::string_view name);

struct CfDate {
    std::int64_t year = 1970; ///< 0 is the year before 1
    int month = 1;
    int day = 1;
};

/// True when the calendar has such a day.
bool HasDate(CfCalendar calendar, const CfDate& date);
int DaysInMonth(CfCalendar calendar, std::int64_t year, int month);

/// Days since 1 January 1970 of the proleptic Gregorian calendar, for the calendars of the real
/// world; days since 1 January of year 0 of the calendar itself for the other three.
std::int64_t DayNumber(CfCalendar calendar, const CfDate& date);
CfDate DateOfDayNumber(CfCalendar calendar, std::int64_t number);

inline constexpr std::int64_t kMillisecondsPerDay = 86400000;

/// A moment of a calendar, in milliseconds from where its day numbers start, as milliseconds since
/// 1970-01-01 00:00:00 of the proleptic Gregorian calendar:
///  - calendars of the real world: the same moment;
///  - no leap days: the same date and time of day;
///  - 360 days: the day nearest to the same fraction of the real year, at the same time of day;
///  - all leap days: the same date and time in a leap year, the same fraction of a common year.
/// Later moments stay later.
std::int64_t RealMilliseconds(CfCalendar calendar, std::int64_t milliseconds);

} // namespace ryn
