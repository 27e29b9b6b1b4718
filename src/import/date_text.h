#pragma once

#include <string>
#include <string_view>

#include "import/civil_time.h"

namespace ryn {

/// The ways to write a date that are told apart without help. A clock time and a zone may stand
/// behind those that end with a day.
enum class DateForm {
    YearMonthDay,      ///< 2001-12-31, 2001/12/31, 2001.12.31, 2001-Dec-31
    DayMonthYear,      ///< 31-12-2001, 31.12.2001, 31/12/01, 31 Dec 2001
    MonthDayYear,      ///< 12/31/2001, 12-31-01, Dec 31, 2001
    ShortYearMonthDay, ///< 99-12-31
    Compact,           ///< 20011231, 2001123123, 200112312359, 20011231235959
    CompactDayFirst,   ///< 31122001
    YearMonth,         ///< 2001-12, 12/2001, Dec 2001
    CompactYearMonth,  ///< 200112
    Year,              ///< 2001, 01
    DecimalYear,       ///< 2001.9973
    Duration,          ///< "0 days 00:10:00", "26:10:00": relative
    ExcelSerial,       ///< days since 1899-12-30; on request only
    UnixSeconds,       ///< seconds since 1970-01-01; on request only
};

/// Reads a trimmed text. A form with a day gives Incomplete for a date that lacks it. Calendar
/// fields are not checked against each other here (MomentOf does).
TimeResult ParseDate(std::string_view text, DateForm form, TimeParts* parts);

/// A time of day: "23:59", "23:59:59.5", "2359", "23", "11:59 PM", "7h30", "0730 hrs", "9時30分",
/// with or without a zone behind.
bool ParseClock(std::string_view text, TimeParts* parts);

/// A zone's name, "Z", "+01:00", "UTC", "CET", "EDT", ...; its offset in minutes from UTC.
bool ParseZone(std::string_view text, int* offsetMinutes);

/// The month of a name or its abbreviation in English, German, Dutch, French, Spanish, Italian or
/// Portuguese; 0 for no month.
int MonthOfName(std::string_view name);

/// How reports write a form: "YYYY-MM-DD", ...
std::string DateFormName(DateForm form);

} // namespace ryn
