#include "import/civil_time.h"

#include <algorithm>
#include <chrono>
#include <cmath>

#include "base/number_text.h"
#include "base/ole_date_time.h"
#include "import/table_text.h"

namespace ryn {

namespace {

constexpr int kFirstYear = 100;
constexpr int kLastYear = 9999;

Millis StartOfDay(int year, int month, int day) {
    const std::chrono::year_month_day date{std::chrono::year(year),
                                           std::chrono::month(static_cast<unsigned>(month)),
                                           std::chrono::day(static_cast<unsigned>(day))};
    return std::chrono::sys_days(date).time_since_epoch().count() * kMillisPerDay;
}

/// Rounds towards the past, also before 1970.
Millis WholeDays(Millis moment) {
    const Millis days = moment / kMillisPerDay;
    return moment % kMillisPerDay < 0 ? days - 1 : days;
}

std::chrono::year_month_day DateOf(Millis moment) {
    return std::chrono::sys_days(std::chrono::days(WholeDays(moment)));
}

std::string Padded(std::int64_t value, std::size_t width) {
    std::string digits = std::to_string(value);
    return digits.size() < width ? std::string(width - digits.size(), '0') + digits : digits;
}

/// Midnight at the start of the parts' day.
TimeResult DayOf(const TimeParts& parts, const TimeDefaults& defaults, Millis* start) {
    const int year = parts.year >= 0 ? parts.year : defaults.year;
    if (year < kFirstYear || year > kLastYear)
        return TimeResult::Bad;
    // A day of the year needs no month; a month beside it (some archives give both) says the same.
    if (parts.dayOfYear >= 0) {
        if (parts.dayOfYear < 1 || parts.dayOfYear > (IsLeapYear(year) ? 366 : 365))
            return TimeResult::Bad;
        *start = StartOfDay(year, 1, 1) + (parts.dayOfYear - 1) * kMillisPerDay;
        return TimeResult::Ok;
    }
    const int month = parts.month >= 0 ? parts.month : defaults.month;
    const int day = parts.day >= 0 ? parts.day : defaults.day;
    if (month > 12 || day > 31)
        return TimeResult::Bad;
    // Archives of historic floods write what they know: "1895-07-00" is July of that year.
    if (month == 0 || day == 0)
        return TimeResult::Incomplete;
    if (day > DaysInMonth(year, month))
        return TimeResult::Bad;
    *start = StartOfDay(year, month, day);
    return TimeResult::Ok;
}

/// -1 stands for nothing said.
bool ClockOf(const TimeParts& parts, Millis* sinceMidnight) {
    const int hour = std::max(parts.hour, 0);
    const int minute = std::max(parts.minute, 0);
    const int second = std::max(parts.second, 0);
    const int millisecond = std::max(parts.millisecond, 0);
    *sinceMidnight =
        hour * kMillisPerHour + minute * kMillisPerMinute + second * kMillisPerSecond + millisecond;
    // 24:00:00 is the last moment that a day can be written with; a leap second has no place in a
    // calendar of equal days.
    return minute <= 59 && second <= 59 && *sinceMidnight <= kMillisPerDay;
}

} // namespace

TimeResult MomentOf(const TimeParts& parts, const TimeDefaults& defaults, Millis* moment) {
    if (parts.whole) {
        *moment = *parts.whole;
        return TimeResult::Ok;
    }
    Millis day = 0;
    Millis clock = 0;
    const TimeResult result = DayOf(parts, defaults, &day);
    if (result != TimeResult::Ok)
        return result;
    if (!ClockOf(parts, &clock))
        return TimeResult::Bad;
    // Local time with daylight saving has an hour twice; in UTC the two are apart.
    *moment = day + clock - parts.offsetMinutes.value_or(0) * kMillisPerMinute;
    return IsInCalendar(*moment) ? TimeResult::Ok : TimeResult::Bad;
}

int YearOfTwoDigits(int digits) {
    return digits >= 30 ? 1900 + digits : 2000 + digits;
}

std::optional<Millis> MomentOfDecimalYear(double year) {
    if (!(year >= kFirstYear && year < kLastYear + 1))
        return std::nullopt;
    const int whole = static_cast<int>(year);
    const double days = IsLeapYear(whole) ? 366.0 : 365.0;
    // Eleven decimals of a year are a third of a millisecond, six are half a minute: a second is
    // what the system resolves, and rounding gives back whole minutes that a program has turned
    // into years.
    const auto seconds = static_cast<Millis>(std::llround((year - whole) * days * 86400.0));
    return StartOfDay(whole, 1, 1) + seconds * kMillisPerSecond;
}

bool IsInCalendar(Millis moment) {
    static const Millis first = StartOfDay(kFirstYear, 1, 1);
    static const Millis past = StartOfDay(kLastYear, 12, 31) + kMillisPerDay;
    return moment >= first && moment < past;
}

std::string DateText(Millis moment) {
    const std::chrono::year_month_day date = DateOf(moment);
    return Padded(static_cast<int>(date.year()), 4) + "-" +
           Padded(static_cast<unsigned>(date.month()), 2) + "-" +
           Padded(static_cast<unsigned>(date.day()), 2);
}

std::string ClockText(Millis moment) {
    const Millis clock = moment - WholeDays(moment) * kMillisPerDay;
    return Padded(clock / kMillisPerHour, 2) + ":" + Padded(clock / kMillisPerMinute % 60, 2) +
           ":" + Padded(clock / kMillisPerSecond % 60, 2);
}

std::string MomentText(Millis moment) {
    const Millis rest = (moment % kMillisPerSecond + kMillisPerSecond) % kMillisPerSecond;
    return DateText(moment) + " " + ClockText(moment) +
           (rest != 0 ? "." + Padded(rest, 3) : std::string());
}

std::optional<TimeStep> ParseTimeStep(std::string_view text) {
    text = Trimmed(text);
    std::size_t digits = 0;
    while (digits < text.size() && (IsDigit(text[digits]) || text[digits] == '.'))
        ++digits;
    const std::optional<double> number = ParseDouble(text.substr(0, digits));
    // Beyond it no axis of two steps fits into the calendar.
    constexpr double kMost = 1e6;
    if (!number || !(*number > 0.0 && *number <= kMost * 1000))
        return std::nullopt;
    const std::string unit = Lowercase(Trimmed(text.substr(digits)));
    for (const std::string_view month : {"mo", "mon", "month", "months"})
        if (unit == month && *number <= kMost && *number == std::floor(*number))
            return TimeStep{static_cast<int>(*number), 0};
    for (const std::string_view year : {"y", "yr", "a", "year", "years"})
        if (unit == year && *number <= kMost && *number == std::floor(*number))
            return TimeStep{static_cast<int>(*number) * 12, 0};
    struct Unit {
        std::string_view name;
        Millis millis;
    };
    constexpr Unit kUnits[] = {
        {"", kMillisPerSecond},       {"s", kMillisPerSecond},       {"sec", kMillisPerSecond},
        {"second", kMillisPerSecond}, {"seconds", kMillisPerSecond}, {"min", kMillisPerMinute},
        {"minute", kMillisPerMinute}, {"minutes", kMillisPerMinute}, {"h", kMillisPerHour},
        {"hour", kMillisPerHour},     {"hours", kMillisPerHour},     {"d", kMillisPerDay},
        {"day", kMillisPerDay},       {"days", kMillisPerDay},       {"w", 7 * kMillisPerDay},
        {"week", 7 * kMillisPerDay},  {"weeks", 7 * kMillisPerDay}};
    for (const Unit& known : kUnits) {
        const auto millis = std::llround(*number * static_cast<double>(known.millis));
        if (unit == known.name && millis > 0)
            return TimeStep{0, millis};
    }
    return std::nullopt;
}

std::optional<Millis> Advance(Millis start, TimeStep step, std::int64_t count) {
    if (step.months == 0) {
        constexpr Millis kWholeCalendar = 9900LL * 366 * kMillisPerDay;
        if (step.millis > 0 && count > kWholeCalendar / step.millis)
            return std::nullopt;
        const Millis moment = start + count * step.millis;
        return IsInCalendar(moment) ? std::optional(moment) : std::nullopt;
    }
    // Before the multiplication, which could overflow.
    if (count > kLastYear * 12 / step.months)
        return std::nullopt;
    const std::chrono::year_month_day date = DateOf(start);
    const std::int64_t month = static_cast<std::int64_t>(static_cast<int>(date.year())) * 12 +
                               static_cast<unsigned>(date.month()) - 1 + count * step.months;
    const int year = static_cast<int>(month / 12);
    const int monthOfYear = static_cast<int>(month % 12) + 1;
    if (year > kLastYear)
        return std::nullopt;
    const int day = std::min(static_cast<int>(static_cast<unsigned>(date.day())),
                             DaysInMonth(year, monthOfYear));
    return StartOfDay(year, monthOfYear, day) + (start - WholeDays(start) * kMillisPerDay);
}

} // namespace ryn
