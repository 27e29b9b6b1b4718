#include "import/time_reader.h"

#include <cmath>

#include "base/number_text.h"
#include "import/table_text.h"

namespace ryn {

namespace {

/// A small whole number; spreadsheets may write it as "5.0".
bool ReadWhole(std::string_view field, int most, int* value) {
    const std::size_t point = field.find_first_of(".,");
    if (point != std::string_view::npos) {
        if (field.substr(point + 1).find_first_not_of('0') != std::string_view::npos)
            return false;
        field = field.substr(0, point);
    }
    // More digits are no part of a date, and could overflow.
    constexpr std::size_t kMostDigits = 6;
    if (!IsDigits(field) || field.size() > kMostDigits)
        return false;
    *value = *ParseInt(field);
    return *value <= most;
}

bool ReadYear(std::string_view field, int* year) {
    TimeParts parts;
    if (ParseDate(field, DateForm::Year, &parts) != TimeResult::Ok)
        return false;
    *year = parts.year;
    return true;
}

/// "0", "30", "1230", "2400".
bool ReadHourMinute(std::string_view field, TimeParts* parts) {
    int value = 0;
    if (!ReadWhole(field, 2400, &value))
        return false;
    parts->hour = value / 100;
    parts->minute = value % 100;
    return true;
}

bool ReadZone(std::string_view field, TimeParts* parts) {
    int minutes = 0;
    if (!ParseZone(field, &minutes))
        return false;
    parts->offsetMinutes = minutes;
    return true;
}

bool ReadElapsed(std::string_view field, Millis unit, TimeParts* parts) {
    std::string plain(field.substr(0, 40));
    // The form is decided before the decimal sign of the values matters; a number of days has no
    // thousands.
    for (char& c : plain)
        c = c == ',' ? '.' : c;
    const std::optional<double> number = ParseDouble(plain);
    constexpr double kWholeCalendar = 3.2e14; // milliseconds
    if (!number || !(std::abs(*number * static_cast<double>(unit)) < kWholeCalendar))
        return false;
    parts->whole = std::llround(*number * static_cast<double>(unit));
    return true;
}

TimeResult OkIf(bool condition) {
    return condition ? TimeResult::Ok : TimeResult::Bad;
}

} // namespace

TimeResult TimeReader::ReadColumn(const TimeColumn& column, std::string_view field) {
    switch (column.role) {
    case TimeRole::Date:
        return ParseDate(field, layout.form, &parts);
    case TimeRole::Clock:
        return OkIf(ParseClock(field, &parts));
    case TimeRole::Year:
        return OkIf(ReadYear(field, &parts.year));
    case TimeRole::Month:
        if (ReadWhole(field, 12, &parts.month))
            return TimeResult::Ok;
        parts.month = MonthOfName(field);
        return OkIf(parts.month > 0);
    case TimeRole::Day:
        return OkIf(ReadWhole(field, 31, &parts.day));
    case TimeRole::DayOfYear:
        return OkIf(ReadWhole(field, 366, &parts.dayOfYear));
    case TimeRole::Hour:
        return OkIf(ReadWhole(field, 24, &parts.hour));
    case TimeRole::HourMinute:
        return OkIf(ReadHourMinute(field, &parts));
    case TimeRole::Minute:
        return OkIf(ReadWhole(field, 59, &parts.minute));
    case TimeRole::Second:
        return OkIf(ReadWhole(field, 59, &parts.second));
    case TimeRole::Zone:
        return OkIf(ReadZone(field, &parts));
    case TimeRole::Elapsed:
        return OkIf(ReadElapsed(field, layout.elapsedUnit, &parts));
    }
    return TimeResult::Bad;
}

TimeResult TimeReader::Read(std::span<const std::string_view> fields, Millis* moment) {
    parts = {};
    TimeResult result = TimeResult::Ok;
    if (layout.source == TimeSource::Pattern) {
        joined = TextOf(fields);
        result = layout.pattern->Parse(joined, &parts);
    }
    for (const TimeColumn& column : layout.columns) {
        if (layout.source != TimeSource::Columns)
            break;
        if (column.column >= fields.size())
            return TimeResult::Bad;
        // One bad part spoils the row; a missing day does so only if no other part is bad.
        const TimeResult one = ReadColumn(column, fields[column.column]);
        if (one == TimeResult::Bad)
            return one;
        result = one == TimeResult::Ok ? result : one;
    }
    if (result == TimeResult::Ok)
        result = MomentOf(parts, layout.defaults, moment);
    if (result == TimeResult::Incomplete)
        return ReadWithoutDay(moment);
    if (result != TimeResult::Ok)
        return result;
    *moment += layout.origin;
    return layout.isRelative || IsInCalendar(*moment) ? TimeResult::Ok : TimeResult::Bad;
}

/// The peak of a historic flood often has a month and no day. To leave it out would cost the series
/// its largest value.
TimeResult TimeReader::ReadWithoutDay(Millis* moment) {
    if (parts.year < 0 || parts.month < 1 || parts.day > 0)
        return TimeResult::Incomplete;
    parts.day = 1;
    return MomentOf(parts, layout.defaults, moment) == TimeResult::Ok ? TimeResult::FirstOfMonth
                                                                      : TimeResult::Bad;
}

std::string TimeReader::TextOf(std::span<const std::string_view> fields) const {
    std::string text;
    for (const TimeColumn& column : layout.columns) {
        if (column.column >= fields.size())
            break;
        // Blanks between, as a pattern over several columns is written.
        if (!text.empty())
            text += ' ';
        text += fields[column.column];
    }
    return text;
}

} // namespace ryn
