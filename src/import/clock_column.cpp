#include "base/number_text.h"
#include "import/number_field.h"
#include "import/table_text.h"
#include "import/time_names.h"
#include "import/time_reader.h"
#include "import/time_search.h"

namespace ryn {

namespace {

/// A name for hours or times of day. "Hour Ending" is one; "sunshine hours" only counts them.
bool IsClockName(const std::string& name) {
    const std::vector<std::string> words = Words(name);
    if (words.empty() || name.size() < 2)
        return false;
    if (IsOneOf(words.back(),
                "time|tm|clock|zeit|uhrzeit|tijd|tijdstip|heure|hora|ora|orario|tid|klokkeslett|"
                "hhmm|時刻|時間|観測時刻|時分"))
        return true;
    return words.front().size() > 1 && RoleOfName(words.front()) == TimeRole::Hour &&
           (words.size() == 1 || words.front() != "hours");
}

/// How the fields of a column read as times of day.
struct ClockFit {
    TimeRole role = TimeRole::Clock;
    double readable = 0.0;
    double missing = 0.0;
    double bad = 0.0;
    std::size_t firstMissing = 0; ///< rows
    std::size_t firstBad = 0;

    double Total() const { return readable + missing + bad; }
    bool IsWhole() const { return readable > 0.0 && readable >= 0.9 * Total(); }
    /// But for a few faults, which reading names.
    bool IsFaulty() const { return bad > 0.0 && readable >= bad && missing <= 0.1 * Total(); }
};

ClockFit FitClock(const SampleRows& rows, std::size_t column, TimeRole role) {
    TimeLayout probe;
    probe.columns = {{column, role}};
    probe.defaults.year = 2000;
    TimeReader reader(probe);
    ClockFit fit;
    fit.role = role;
    Millis moment = 0;
    for (std::size_t row = 0; row < rows.Count(); ++row) {
        const auto& fields = rows.All()[row];
        if (reader.Read(fields, &moment) == TimeResult::Ok) {
            fit.readable += 1.0;
        } else if (IsMissingWord(fields[column])) {
            fit.firstMissing = fit.missing == 0.0 ? row : fit.firstMissing;
            fit.missing += 1.0;
        } else {
            fit.firstBad = fit.bad == 0.0 ? row : fit.firstBad;
            fit.bad += 1.0;
        }
    }
    return fit;
}

/// Finds the column with the time of day beside a date.
class ClockSearch {
  public:
    ClockSearch(const TimeSearch& timeSearch, TableLayout* tableLayout)
        : search(timeSearch),
          rows(timeSearch.rows),
          layout(tableLayout) {}

    /// The nearest one from the left that reads; else one that does but for faults. What is called
    /// a time of day and is none that can be read is a fault: without it every sample of a day
    /// would stand at midnight.
    Status Find() {
        const std::vector<std::size_t> candidates = Candidates();
        for (const std::size_t column : candidates)
            if (const ClockFit fit = BestFit(column); fit.IsWhole())
                return Take(column, fit.role);
        for (const std::size_t column : candidates)
            if (const ClockFit fit = BestFit(column); fit.IsFaulty())
                return Take(column, fit.role);
        for (const std::size_t column : candidates)
            if (Status status = CheckUnused(column); !status)
                return status;
        return Status::Ok();
    }

  private:
    std::vector<std::size_t> Candidates() const {
        std::vector<std::size_t> candidates;
        const std::vector<TimeColumn>& used = layout->time.columns;
        for (const std::size_t column : search.columns) {
            const ColumnKind kind = rows.Column(column).kind;
            const bool isUsed = std::any_of(used.begin(), used.end(), [column](const auto& time) {
                return time.column == column;
            });
            // Numbers are times of day only under a name for one.
            const bool isNumber = kind == ColumnKind::Number;
            const bool fits = isNumber ? IsClockName(rows.Column(column).name) && !IsCounter(column)
                                       : kind != ColumnKind::Empty;
            if (!isUsed && fits)
                candidates.push_back(column);
        }
        return candidates;
    }

    ClockFit BestFit(std::size_t column) const {
        if (rows.Column(column).kind != ColumnKind::Number)
            return FitClock(rows, column, TimeRole::Clock);
        // "6 am" and "0730 hrs" are numbers with marks.
        ClockFit best;
        for (const TimeRole role : {TimeRole::Hour, TimeRole::HourMinute, TimeRole::Clock})
            if (const ClockFit fit = FitClock(rows, column, role);
                fit.readable > best.readable || best.Total() == 0.0)
                best = fit;
        return best;
    }

    /// "Time" may number the rows: one more in each, while the dates change.
    bool IsCounter(std::size_t column) const {
        constexpr std::size_t kEnough = 3;
        if (rows.Count() < kEnough || RoleOfName(rows.Column(column).name) == TimeRole::Hour)
            return false;
        const auto& all = rows.All();
        for (std::size_t row = 1; row < all.size(); ++row) {
            const std::optional<int> before = ParseInt(all[row - 1][column]);
            const std::optional<int> now = ParseInt(all[row][column]);
            if (!before || !now || *now - *before != 1)
                return false;
        }
        const std::vector<TimeColumn>& date = layout->time.columns;
        return std::any_of(date.begin(), date.end(), [&all](const TimeColumn& part) {
            return all.front()[part.column] != all.back()[part.column];
        });
    }

    /// With the minutes beside its hours.
    Status Take(std::size_t column, TimeRole role) {
        std::vector<TimeColumn>& columns = layout->time.columns;
        columns.push_back({column, role});
        const std::size_t next = column + 1;
        if (role == TimeRole::Hour && search.Contains(next) &&
            IsMinuteName(rows.Column(next).name) && search.IsUsable(next, TimeRole::Minute))
            columns.push_back({next, TimeRole::Minute});
        return Status::Ok();
    }

    Status CheckUnused(std::size_t column) {
        const std::string& name = rows.Column(column).name;
        const bool isNumber = rows.Column(column).kind == ColumnKind::Number;
        // Numbers may be lengths of time: a "lead time" is one.
        if (!IsClockName(name) || (isNumber && Words(name).size() > 1))
            return Status::Ok();
        const ClockFit fit = BestFit(column);
        const std::string title = ColumnTitle(*layout, column);
        if (fit.bad > fit.readable)
            return Status::InputFault(
                "line " + std::to_string(rows.LineOf(fit.firstBad)) + ": " +
                Quoted(rows.All()[fit.firstBad][column]) + " in column " + title +
                " is no time of day; tell its form with --time and --time-format, or leave the "
                "times of day out by naming the date alone with --time");
        if (fit.readable > 0.0)
            layout->notes.push_back("the times of day in column " + title +
                                    " are not used: many rows have none, the first in line " +
                                    std::to_string(rows.LineOf(fit.firstMissing)));
        return Status::Ok();
    }

    const TimeSearch& search;
    const SampleRows& rows;
    TableLayout* layout;
};

bool Has(const TimeLayout& time, TimeRole role) {
    return std::any_of(time.columns.begin(), time.columns.end(),
                       [role](const TimeColumn& column) { return column.role == role; });
}

} // namespace

Status FindClockColumn(const TimeSearch& search, TableLayout* layout) {
    const TimeLayout& time = layout->time;
    const bool hasDay =
        Has(time, TimeRole::Date) || Has(time, TimeRole::Day) || Has(time, TimeRole::DayOfYear);
    if (!hasDay || Has(time, TimeRole::Hour) || Has(time, TimeRole::HourMinute) ||
        FitTime(search.rows, time).withClock > 0.0)
        return Status::Ok();
    return ClockSearch(search, layout).Find();
}

void FindZoneColumn(const TimeSearch& search, TimeLayout* time) {
    const std::size_t column = time->columns.back().column + 1;
    if (!search.Contains(column) || search.rows.Column(column).kind != ColumnKind::Text)
        return;
    TimeLayout probe = *time;
    probe.columns.push_back({column, TimeRole::Zone});
    if (FitTime(search.rows, probe).IsGood())
        *time = probe;
}

} // namespace ryn
