#include "import/time_search.h"

#include <cmath>

#include "import/number_field.h"
#include "import/table_text.h"
#include "import/text_cursor.h"
#include "import/time_names.h"
#include "import/time_reader.h"

namespace ryn {

namespace {

/// Months written so would have to be January 2000, February 2001, ...: one alone may be a month,
/// several are none.
bool HoldsHydrologicalYears(const SampleRows& rows, std::size_t column) {
    std::size_t years = 0;
    std::size_t others = 0;
    for (const auto& fields : rows.All())
        if (!IsMissingWord(fields[column]))
            (IsHydrologicalYear(fields[column]) ? years : others) += 1;
    return years >= 2 && years >= 4 * others;
}

/// "2001-12" or, in digits alone, 200112.
bool FindMonths(const TimeSearch& search, TimeLayout* time) {
    for (const std::size_t column : search.columns) {
        const bool isNumber = search.rows.Column(column).kind == ColumnKind::Number;
        // Discharges of six digits exist; months that rise from row to row do not come by chance.
        if ((isNumber && !search.rows.HasDigitsOnly(column, 6)) ||
            HoldsHydrologicalYears(search.rows, column))
            continue;
        *time = DateLayout(column, isNumber ? DateForm::CompactYearMonth : DateForm::YearMonth);
        const TimeFit fit = FitTime(search.rows, *time);
        if (isNumber ? fit.Rises() : fit.IsGood())
            return true;
    }
    return false;
}

bool FindLengths(const TimeSearch& search, TimeLayout* time) {
    for (const std::size_t column : search.columns) {
        *time = DateLayout(column, DateForm::Duration);
        if (search.rows.Column(column).kind == ColumnKind::Time &&
            FitTime(search.rows, *time).IsGood())
            return true;
    }
    return false;
}

/// A column of years: by its name, or without one in front and rising.
bool FindYears(const TimeSearch& search, TimeLayout* time) {
    for (const std::size_t column : search.columns) {
        *time = DateLayout(column, DateForm::Year);
        const TimeFit fit = FitTime(search.rows, *time);
        const std::string& name = search.rows.Column(column).name;
        // A column of years may repeat them (several events a year): the name is enough, and
        // repeated times are then told.
        if (RoleOfName(name) == TimeRole::Year && fit.IsGood())
            return true;
        if (column == 0 && search.rows.ColumnCount() > 1 && name.empty() &&
            search.rows.HasDigitsOnly(column, 4) && fit.Rises())
            return true;
    }
    return false;
}

/// Values between 1500 and 2200 of which some have a fraction.
bool LooksLikeDecimalYears(const SampleRows& rows, std::size_t column) {
    bool hasFraction = false;
    for (const auto& fields : rows.All()) {
        const NumberField number = ReadNumber(fields[column], rows.Decimal());
        if (number.kind == NumberKind::Missing)
            continue;
        if (number.value < 1500.0F || number.value > 2200.0F)
            return false;
        hasFraction = hasFraction || fields[column].find_first_of(".,") != std::string_view::npos;
    }
    return hasFraction;
}

/// They have to rise: values between 1500 and 2200 with decimals are common too.
bool FindDecimalYears(const TimeSearch& search, TimeLayout* time) {
    for (const std::size_t column : search.columns) {
        *time = DateLayout(column, DateForm::DecimalYear);
        if (search.rows.ColumnCount() > 1 && LooksLikeDecimalYears(search.rows, column) &&
            FitTime(search.rows, *time).Rises())
            return true;
    }
    return false;
}

/// 0 for what is no unit of time, months and years included: they have no fixed length.
Millis UnitMillis(std::string_view unit) {
    const std::string text = Lowercase(Trimmed(unit));
    const std::optional<TimeStep> step = ParseTimeStep("1 " + text);
    return step && !text.empty() ? step->millis : 0;
}

/// The unit and origin of "time (s)" or "days since 1950-01-01"; false for another name.
bool ReadElapsedTitle(const ColumnLayout& column, TimeLayout* time) {
    const std::string unit = column.unit.empty() ? column.name : column.unit;
    const std::size_t since = unit.find(" since ");
    time->elapsedUnit = UnitMillis(unit.substr(0, since));
    time->isRelative = since == std::string::npos;
    if (time->isRelative)
        return !column.unit.empty() && time->elapsedUnit > 0 &&
               IsOneOf(column.name, "time|t|elapsed|elapsed time|zeit|tijd");
    constexpr std::size_t kSinceSize = 7;
    TimeParts parts;
    return time->elapsedUnit > 0 &&
           ParseDate(Trimmed(std::string_view(unit).substr(since + kSinceSize)),
                     DateForm::YearMonthDay, &parts) == TimeResult::Ok &&
           MomentOf(parts, {}, &time->origin) == TimeResult::Ok;
}

bool FindElapsed(const TimeSearch& search, TimeLayout* time) {
    for (const std::size_t column : search.columns) {
        TimeLayout probe;
        probe.columns = {{column, TimeRole::Elapsed}};
        if (!ReadElapsedTitle(search.rows.Column(column), &probe) ||
            !FitTime(search.rows, probe).IsGood())
            continue;
        *time = probe;
        return true;
    }
    return false;
}

} // namespace

bool IsHydrologicalYear(std::string_view field) {
    TextCursor cursor(field);
    int digits = 0;
    const int first = cursor.TakeNumber(4, &digits);
    if (digits != 4 || (cursor.Peek() != '/' && cursor.Peek() != '-'))
        return false;
    cursor.Skip();
    const int second = cursor.TakeNumber(4, &digits);
    return cursor.IsAtEnd() &&
           ((digits == 2 && second == (first + 1) % 100) || (digits == 4 && second == first + 1));
}

/// The whole of the rows, since one that does not fit may decide between two forms.
TimeFit FitTime(const SampleRows& rows, const TimeLayout& time) {
    TimeReader reader(time);
    TimeFit fit;
    Millis moment = 0;
    std::optional<Millis> previous;
    for (const auto& fields : rows.All()) {
        const TimeResult result = reader.Read(fields, &moment);
        fit.bad += result == TimeResult::Bad ? 1.0 : 0.0;
        fit.incomplete +=
            result == TimeResult::Incomplete || result == TimeResult::FirstOfMonth ? 1.0 : 0.0;
        if (result != TimeResult::Ok)
            continue;
        fit.ok += 1.0;
        fit.withClock += reader.HadClock() ? 1.0 : 0.0;
        fit.withoutRise += previous && moment <= *previous ? 1.0 : 0.0;
        previous = moment;
    }
    return fit;
}

TimeLayout DateLayout(std::size_t column, DateForm form) {
    TimeLayout time;
    time.columns = {{column, TimeRole::Date}};
    time.form = form;
    time.isRelative = form == DateForm::Duration;
    return time;
}

bool TimeSearch::IsUsable(std::size_t column, TimeRole role) const {
    TimeLayout probe;
    probe.columns = {{column, role}};
    probe.defaults.year = 2000; // a leap year, so that any month and day will do
    const TimeFit fit = FitTime(rows, probe);
    return fit.ok > 0.0 && fit.ok + fit.incomplete >= 0.9 * fit.Total();
}

std::optional<std::size_t> FindHydrologicalYears(const TimeSearch& search) {
    const auto at =
        std::find_if(search.columns.begin(), search.columns.end(), [&search](std::size_t column) {
            return HoldsHydrologicalYears(search.rows, column);
        });
    return at == search.columns.end() ? std::nullopt : std::optional(*at);
}

bool FindOtherTime(const TimeSearch& search, TimeLayout* time) {
    // From the most telling text to the least.
    return FindMonths(search, time) || FindLengths(search, time) ||
           FindUnnamedParts(search, time) || FindYears(search, time) ||
           FindDecimalYears(search, time) || FindElapsed(search, time);
}

} // namespace ryn
