#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

namespace ryn {

/// A moment of the proleptic Gregorian calendar in milliseconds since 1970-01-01 00:00:00, or, on a
/// relative axis, since its origin. Years 100 to 9999, as everywhere in the system.
using Millis = std::int64_t;

inline constexpr Millis kMillisPerSecond = 1000;
inline constexpr Millis kMillisPerMinute = 60 * kMillisPerSecond;
inline constexpr Millis kMillisPerHour = 60 * kMillisPerMinute;
inline constexpr Millis kMillisPerDay = 24 * kMillisPerHour;

/// What a row says about its time. -1 where it says nothing; the rest as found, not yet checked.
struct TimeParts {
    int year = -1;
    int month = -1;
    int day = -1;
    int dayOfYear = -1;
    int hour = -1;
    int minute = -1;
    int second = -1;
    int millisecond = -1;
    std::optional<int> offsetMinutes; ///< local time minus UTC
    /// A length of time from the axis's origin, or a whole moment, in place of calendar fields.
    std::optional<Millis> whole;
};

enum class TimeResult {
    Ok,
    Incomplete,   ///< a date without its day or month ("1869-07", "1895-07-00", "1869")
    FirstOfMonth, ///< a date without its day, taken as the first of its month; of TimeReader only
    Bad,
};

/// What stands in for parts that no column gives.
struct TimeDefaults {
    int year = -1;
    int month = 1;
    int day = 1;
};

/// Checks the parts and puts them together; an offset is taken off, so that the result is UTC. Hour
/// 24 without minutes is midnight at the end of the day. A month or day of 0 is Incomplete.
TimeResult MomentOf(const TimeParts& parts, const TimeDefaults& defaults, Millis* moment);

/// The year that two digits mean: 30 to 99 are 1930 to 1999, 0 to 29 are 2000 to 2029.
int YearOfTwoDigits(int digits);
/// The moment of a decimal year, its fraction counted over the days of that year and rounded to the
/// second; nothing when the year is out of range.
std::optional<Millis> MomentOfDecimalYear(double year);
/// A moment within the years 100 to 9999.
bool IsInCalendar(Millis moment);

std::string DateText(Millis moment);  ///< "YYYY-MM-DD"
std::string ClockText(Millis moment); ///< "HH:MM:SS", milliseconds cut off
std::string
MomentText(Millis moment); ///< "YYYY-MM-DD HH:MM:SS", with milliseconds where it has any

/// The step of an axis: either months or milliseconds, the other 0.
struct TimeStep {
    int months = 0;
    Millis millis = 0;
};

/// "1d", "6h", "10min", "30s", "1mo", "1y", "1w", or a plain number of seconds; greater than 0.
std::optional<TimeStep> ParseTimeStep(std::string_view text);
/// `start` plus `count` steps. Months keep the day, or take the month's last one. Nothing when the
/// result leaves the calendar.
std::optional<Millis> Advance(Millis start, TimeStep step, std::int64_t count);

} // namespace ryn
