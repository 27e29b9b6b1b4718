#include "netcdf/cf_time.h"

#include <algorithm>
#include <array>
#include <cctype>
#include <cmath>

#include "netcdf/time_reference.h"

namespace ryn {

namespace {

constexpr double kDay = 86400000.0;
constexpr double kYear = 365.242198781 * kDay; // the tropical year, which UDUNITS takes

struct TimeUnit {
    std::string_view names; // parted by blanks, with one before and behind each
    double milliseconds;
    int months = 0;
};

constexpr std::array kTimeUnits = std::to_array<TimeUnit>({
    {" ns nanosec nanosecs nanosecond nanoseconds ", 1e-6},
    {" us microsec microsecs microsecond microseconds ", 1e-3},
    {" ms msec msecs millisec millisecs millisecond milliseconds ", 1.0},
    {" s sec secs second seconds ", 1000.0},
    {" min mins minute minutes ", 60000.0},
    {" h hr hrs hour hours ", 3600000.0},
    {" d day days ", kDay},
    {" week weeks ", 7.0 * kDay},
    {" fortnight fortnights ", 14.0 * kDay},
    {" common_year common_years ", 365.0 * kDay},
    {" mon month months ", kYear / 12.0, 1},
    {" yr yrs year years ", kYear, 12},
});

// 1 January 100 and 1 January 10000: the years that the system's dates reach.
constexpr std::int64_t kFirstMoment = -59011459200000;
constexpr std::int64_t kPastLastMoment = 253402300800000;
// Beyond every year from 100 to 9999 in any calendar, and far from overflow.
constexpr double kFarthest = 1e16;

std::string Lower(std::string_view text) {
    std::string lower(text);
    std::ranges::transform(lower, lower.begin(),
                           [](unsigned char c) { return static_cast<char>(std::tolower(c)); });
    return lower;
}

std::string_view Trimmed(std::string_view text) {
    const std::size_t first = text.find_first_not_of(" \t\n");
    if (first == std::string_view::npos)
        return {};
    return text.substr(first, text.find_last_not_of(" \t\n") - first + 1);
}

const TimeUnit* FindTimeUnit(std::string_view name) {
    if (name.empty() || name.find(' ') != std::string_view::npos)
        return nullptr;
    const std::string padded = " " + Lower(name) + " ";
    const auto* const unit = std::ranges::find_if(kTimeUnits, [&](const TimeUnit& candidate) {
        return candidate.names.find(padded) != std::string_view::npos;
    });
    return unit != kTimeUnits.end() ? unit : nullptr;
}

struct UnitParts {
    std::string_view unit;
    std::string_view reference; // empty without one
};

UnitParts SplitUnits(std::string_view units) {
    const std::string lower = Lower(units);
    // UDUNITS takes all of these.
    for (const std::string_view word : {" since ", " after ", " from ", " ref ", " @ "})
        if (const std::size_t place = lower.find(word); place != std::string::npos)
            return {Trimmed(units.substr(0, place)), Trimmed(units.substr(place + word.size()))};
    return {Trimmed(units), {}};
}

/// For a message: one line of bounded length, whatever the file holds.
std::string Quoted(std::string_view text) {
    std::string shown(text.substr(0, 80));
    std::ranges::replace_if(
        shown, [](unsigned char c) { return c < 0x20; }, ' ');
    return "\"" + shown + "\"";
}

} // namespace

Status CfTime::Parse(std::string_view units, std::string_view calendarName, CfTime* result) {
    const UnitParts parts = SplitUnits(units);
    const TimeUnit* const unit = FindTimeUnit(parts.unit);
    if (unit == nullptr)
        return Status::InputFault("unit " + Quoted(units) + " is no unit of time");
    const auto calendar = CfCalendarOfName(Trimmed(calendarName));
    if (!calendar)
        return Status::InputFault("calendar " + Quoted(calendarName) + " is not known");
    CfTime time;
    if (!parts.reference.empty()) {
        time.reference = ParseTimeReference(parts.reference, *calendar);
        if (!time.reference)
            return Status::InputFault("unit " + Quoted(units) + " names no valid date");
    }
    time.unitName = parts.unit;
    time.millisecondsInUnit = unit->milliseconds;
    // Without a date there is no calendar to count months by.
    time.monthsInUnit = time.reference ? unit->months : 0;
    time.calendar = *calendar;
    *result = std::move(time);
    return Status::Ok();
}

std::int64_t CfTime::AddMonths(std::int64_t months) const {
    std::int64_t day = *reference / kMillisecondsPerDay;
    if (*reference % kMillisecondsPerDay < 0)
        --day;
    CfDate date = DateOfDayNumber(calendar, day);
    const std::int64_t total = date.year * 12 + date.month - 1 + months;
    date.year = total / 12 - (total % 12 < 0 ? 1 : 0);
    date.month = static_cast<int>(total - date.year * 12) + 1;
    // A month after 31 January is the last day of February.
    date.day = std::min(date.day, DaysInMonth(calendar, date.year, date.month));
    return DayNumber(calendar, date) * kMillisecondsPerDay + *reference - day * kMillisecondsPerDay;
}

std::optional<std::int64_t> CfTime::Milliseconds(double value) const {
    const double span = value * millisecondsInUnit;
    if (!(std::abs(span) < kFarthest)) // NaN too
        return std::nullopt;
    if (IsRelative())
        return std::llround(span);
    const std::int64_t own = monthsInUnit != 0 ? AddMonths(std::llround(value * monthsInUnit))
                                               : *reference + std::llround(span);
    const std::int64_t real = RealMilliseconds(calendar, own);
    return real >= kFirstMoment && real < kPastLastMoment ? std::optional(real) : std::nullopt;
}

std::int64_t CfTime::ReferenceMilliseconds() const {
    return reference ? RealMilliseconds(calendar, *reference) : 0;
}

} // namespace ryn
