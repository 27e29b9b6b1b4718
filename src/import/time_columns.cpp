#include "import/time_columns.h"

#include <algorithm>
#include <cmath>

#include "base/number_text.h"
#include "import/number_field.h"
#include "import/table_text.h"
#include "import/time_names.h"
#include "import/time_reader.h"
#include "import/unit_text.h"

namespace ryn {

namespace {

constexpr double kNearlyAll = 0.9;

/// How well rows read under a layout.
struct Fit {
    double ok = 0.0;
    double incomplete = 0.0;
    double bad = 0.0;
    double withClock = 0.0;
    double withoutRise = 0.0; ///< rows that are not later than the one before
    std::vector<Millis> moments;

    double Total() const { return ok + incomplete + bad; }
    bool IsGood() const {
        return ok > 0.0 && ok >= 0.5 * Total() && ok + incomplete >= kNearlyAll * Total();
    }
    bool Rises() const { return IsGood() && withoutRise <= 0.02 * Total(); }
};

Fit FitRows(const SampleRows& rows, const TimeLayout& time) {
    TimeReader reader(time);
    Fit fit;
    Millis moment = 0;
    for (const auto& fields : rows.All()) {
        const TimeResult result = reader.Read(fields, &moment);
        (result == TimeResult::Ok    ? fit.ok
         : result == TimeResult::Bad ? fit.bad
                                     : fit.incomplete) += 1.0;
        if (result != TimeResult::Ok)
            continue;
        fit.withClock += reader.HadClock() ? 1.0 : 0.0;
        fit.withoutRise += !fit.moments.empty() && moment <= fit.moments.back() ? 1.0 : 0.0;
        fit.moments.push_back(moment);
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

/// Number columns are plain digits in all rows where a date could be; "20011231" is one.
bool HasDigitsOnly(const SampleRows& rows, std::size_t column, std::size_t size) {
    return std::all_of(rows.All().begin(), rows.All().end(), [column, size](const auto& fields) {
        return column >= fields.size() || fields[column].empty() ||
               (IsDigits(fields[column]) && fields[column].size() == size);
    });
}

/// Tells how rows of a table are dated, from one column at a time up to several.
class TimeFinder {
  public:
    TimeFinder(const SampleRows& sampleRows, const std::vector<std::size_t>& candidates,
               const ImportSettings& importSettings)
        : rows(sampleRows),
          columns(candidates),
          settings(importSettings) {}

    /// False where nothing fits.
    bool Find(TimeLayout* time, std::vector<std::string>* notes) {
        if (FindDate(time, notes) || FindParts(time, notes))
            return true;
        return !lacksMonth &&
               (FindMonthOfYear(time) || FindLength(time) || FindPartsWithoutNames(time) ||
                FindYear(time) || FindDecimalYear(time) || FindElapsed(time));
    }
    /// Columns of year and day, but none of month.
    bool LacksMonth() const { return lacksMonth; }

  private:
    bool FindDate(TimeLayout* time, std::vector<std::string>* notes);
    bool FindParts(TimeLayout* time, std::vector<std::string>* notes);
    bool FindPartsWithoutNames(TimeLayout* time) const;
    bool FindMonthOfYear(TimeLayout* time) const;
    bool FindLength(TimeLayout* time) const;
    bool FindYear(TimeLayout* time) const;
    bool FindDecimalYear(TimeLayout* time) const;
    bool FindElapsed(TimeLayout* time) const;

    bool FitDate(std::size_t column, TimeLayout* time) const;
    bool IsUsable(std::size_t column, TimeRole role) const;
    void AddClock(TimeLayout* time) const;
    void AddZone(TimeLayout* time) const;
    bool Contains(std::size_t column) const {
        return std::find(columns.begin(), columns.end(), column) != columns.end();
    }

    const SampleRows& rows;
    const std::vector<std::size_t>& columns;
    const ImportSettings& settings;
    bool lacksMonth = false;
};

/// True when nearly all rows have something that fits the role.
bool TimeFinder::IsUsable(std::size_t column, TimeRole role) const {
    TimeLayout probe;
    probe.columns = {{column, role}};
    probe.defaults.year = 2000; // a leap year, so that any month and day will do
    if (role == TimeRole::Day || role == TimeRole::Hour || role == TimeRole::Clock)
        probe.defaults.month = 1;
    const Fit fit = FitRows(rows, probe);
    return fit.ok + fit.incomplete >= kNearlyAll * fit.Total() && fit.ok > 0.0;
}

/// Whether a column holds whole dates; which form, and which others it may be.
bool TimeFinder::FitDate(std::size_t column, TimeLayout* time) const {
    constexpr DateForm kSeparated[] = {DateForm::YearMonthDay, DateForm::DayMonthYear,
                                       DateForm::MonthDayYear, DateForm::ShortYearMonthDay};
    std::vector<DateForm> fitting;
    if (rows.Column(column).kind == ColumnKind::Number) {
        bool isDigits = false;
        for (const std::size_t size : {8, 10, 12, 14})
            isDigits = isDigits || HasDigitsOnly(rows, column, size);
        if (isDigits)
            for (const DateForm form : {DateForm::Compact, DateForm::CompactDayFirst})
                if (FitRows(rows, DateLayout(column, form)).IsGood())
                    fitting.push_back(form);
        fitting.resize(std::min<std::size_t>(fitting.size(), 1)); // the year first, if it can be
    } else {
        double most = 0.0;
        for (const DateForm form : kSeparated) {
            const Fit fit = FitRows(rows, DateLayout(column, form));
            if (!fit.IsGood() || fit.ok < most)
                continue;
            if (fit.ok > most)
                fitting.clear(); // one row that only this form reads decides against the others
            most = fit.ok;
            fitting.push_back(form);
        }
        if (fitting.empty() && FitRows(rows, DateLayout(column, DateForm::Compact)).IsGood())
            fitting.push_back(DateForm::Compact);
    }
    if (fitting.empty())
        return false;
    *time = DateLayout(column, fitting[0]);
    time->rivals.assign(fitting.begin() + 1, fitting.end());
    return true;
}

bool TimeFinder::FindDate(TimeLayout* time, std::vector<std::string>* notes) {
    for (const std::size_t column : columns) {
        if (!FitDate(column, time))
            continue;
        // Nobody writes the month first with points between.
        const auto& fields = rows.All().front();
        if (column < fields.size() &&
            std::count(fields[column].begin(), fields[column].end(), '.') >= 2)
            time->rivals.clear();
        if (FitRows(rows, *time).withClock == 0.0)
            AddClock(time);
        AddZone(time);
        (void)notes;
        return true;
    }
    return false;
}

/// The time of day in a column of its own: clock times, or a number under a name for one.
void TimeFinder::AddClock(TimeLayout* time) const {
    const std::size_t date = time->columns[0].column;
    for (const std::size_t column : columns) {
        if (column == date)
            continue;
        const ColumnLayout& layout = rows.Column(column);
        if (layout.kind == ColumnKind::Time && IsUsable(column, TimeRole::Clock)) {
            time->columns.push_back({column, TimeRole::Clock});
            return;
        }
        const std::vector<std::string> words = Words(layout.name);
        const bool isNamed = RoleOfName(layout.name) == TimeRole::Hour ||
                             (!words.empty() && IsOneOf(words.back(), {"time", "tm", "zeit", "tijd",
                                                                       "hhmm", "uhrzeit"}));
        if (!isNamed || layout.kind != ColumnKind::Number)
            continue;
        for (const TimeRole role : {TimeRole::Hour, TimeRole::HourMinute}) {
            if (!IsUsable(column, role))
                continue;
            time->columns.push_back({column, role});
            const auto roles =
                RolesOfNames({layout, column + 1 < rows.ColumnCount() ? rows.Column(column + 1)
                                                                      : ColumnLayout()});
            if (role == TimeRole::Hour && roles[1] == TimeRole::Minute && Contains(column + 1) &&
                IsUsable(column + 1, TimeRole::Minute))
                time->columns.push_back({column + 1, TimeRole::Minute});
            return;
        }
    }
}

/// A column of zone names ("EST", "EDT") beside the time.
void TimeFinder::AddZone(TimeLayout* time) const {
    const std::size_t column = time->columns.back().column + 1;
    if (column >= rows.ColumnCount() || !Contains(column) ||
        rows.Column(column).kind != ColumnKind::Text)
        return;
    TimeLayout probe = *time;
    probe.columns.push_back({column, TimeRole::Zone});
    if (FitRows(rows, probe).IsGood())
        *time = probe;
}

/// Year, month, day and so on in columns of their own, by their names.
bool TimeFinder::FindParts(TimeLayout* time, std::vector<std::string>* notes) {
    std::vector<ColumnLayout> layouts;
    for (std::size_t i = 0; i < rows.ColumnCount(); ++i)
        layouts.push_back(Contains(i) ? rows.Column(i) : ColumnLayout());
    const std::vector<std::optional<TimeRole>> roles = RolesOfNames(layouts);
    TimeLayout found;
    bool has[static_cast<int>(TimeRole::Elapsed) + 1] = {};
    // From the year downwards: an hour without a day, or a minute without an hour ("Min" may be a
    // minimum), is none.
    constexpr TimeRole kOrder[] = {TimeRole::Year,  TimeRole::Month, TimeRole::DayOfYear,
                                   TimeRole::Day,   TimeRole::Hour,  TimeRole::Minute,
                                   TimeRole::Second};
    for (TimeRole role : kOrder) {
        const auto at = std::find(roles.begin(), roles.end(), std::optional(role));
        if (at == roles.end())
            continue;
        const auto column = static_cast<std::size_t>(at - roles.begin());
        const bool hasDay =
            has[static_cast<int>(TimeRole::Day)] || has[static_cast<int>(TimeRole::DayOfYear)];
        if ((role == TimeRole::Hour && !hasDay) ||
            (role == TimeRole::Minute && !has[static_cast<int>(TimeRole::Hour)]) ||
            (role == TimeRole::Second && !has[static_cast<int>(TimeRole::Minute)]))
            continue;
        if (role == TimeRole::Day && !has[static_cast<int>(TimeRole::Month)] &&
            !IsUsable(column, role))
            role = TimeRole::DayOfYear;
        if (role == TimeRole::Hour && !IsUsable(column, role))
            role = TimeRole::HourMinute;
        if (!IsUsable(column, role))
            continue;
        has[static_cast<int>(role)] = true;
        found.columns.push_back({column, role});
    }
    const bool hasMonth = has[static_cast<int>(TimeRole::Month)];
    lacksMonth = has[static_cast<int>(TimeRole::Year)] && has[static_cast<int>(TimeRole::Day)] &&
                 !hasMonth && !settings.start;
    if (!has[static_cast<int>(TimeRole::Year)] || found.columns.size() < 2 || lacksMonth)
        return false;
    if (settings.start && !hasMonth && has[static_cast<int>(TimeRole::Day)])
        notes->push_back("the month is that of --start: no column gives it");
    *time = found;
    return true;
}

/// Three columns of whole numbers side by side that are dates in every row.
bool TimeFinder::FindPartsWithoutNames(TimeLayout* time) const {
    constexpr TimeRole kOrders[][3] = {{TimeRole::Year, TimeRole::Month, TimeRole::Day},
                                       {TimeRole::Day, TimeRole::Month, TimeRole::Year},
                                       {TimeRole::Month, TimeRole::Day, TimeRole::Year}};
    for (std::size_t first = 0; first + 3 < rows.ColumnCount() && first < 3; ++first) {
        if (!rows.Column(first).name.empty())
            continue;
        for (const auto& order : kOrders) {
            TimeLayout probe;
            for (std::size_t i = 0; i < 3; ++i)
                probe.columns.push_back({first + i, order[i]});
            const std::size_t year = order[0] == TimeRole::Year ? first : first + 2;
            if (!HasDigitsOnly(rows, year, 4) || !FitRows(rows, probe).Rises())
                continue;
            *time = probe;
            return true;
        }
        // With clock columns behind, days repeat: the hours and minutes make the times rise.
        TimeLayout probe;
        probe.columns = {
            {first, TimeRole::Year}, {first + 1, TimeRole::Month}, {first + 2, TimeRole::Day}};
        for (const TimeRole role : {TimeRole::Hour, TimeRole::Minute, TimeRole::Second}) {
            probe.columns.push_back({probe.columns.back().column + 1, role});
            if (probe.columns.back().column + 1 >= rows.ColumnCount())
                break;
            if (HasDigitsOnly(rows, first, 4) && FitRows(rows, probe).Rises()) {
                *time = probe;
                return true;
            }
        }
    }
    return false;
}

/// "2001-12" or, under a name or in front, 200112.
bool TimeFinder::FindMonthOfYear(TimeLayout* time) const {
    for (const std::size_t column : columns) {
        const bool isNumber = rows.Column(column).kind == ColumnKind::Number;
        const DateForm form = isNumber ? DateForm::CompactYearMonth : DateForm::YearMonth;
        if (isNumber && !HasDigitsOnly(rows, column, 6))
            continue;
        *time = DateLayout(column, form);
        const Fit fit = FitRows(rows, *time);
        if (isNumber ? fit.Rises() : fit.IsGood())
            return true;
    }
    return false;
}

bool TimeFinder::FindLength(TimeLayout* time) const {
    for (const std::size_t column : columns) {
        *time = DateLayout(column, DateForm::Duration);
        if (rows.Column(column).kind == ColumnKind::Time && FitRows(rows, *time).IsGood())
            return true;
    }
    return false;
}

/// A column of years: by its name, or in front and rising.
bool TimeFinder::FindYear(TimeLayout* time) const {
    for (const std::size_t column : columns) {
        *time = DateLayout(column, DateForm::Year);
        const Fit fit = FitRows(rows, *time);
        if (RoleOfName(rows.Column(column).name) == TimeRole::Year && fit.IsGood())
            return true;
        const bool inFront = column == 0 && rows.ColumnCount() > 1 && rows.Column(0).name.empty();
        if (inFront && HasDigitsOnly(rows, column, 4) && fit.Rises())
            return true;
    }
    return false;
}

bool TimeFinder::FindDecimalYear(TimeLayout* time) const {
    constexpr double kFirst = 1500.0;
    constexpr double kLast = 2200.0;
    for (const std::size_t column : columns) {
        *time = DateLayout(column, DateForm::DecimalYear);
        bool hasFraction = false;
        bool inRange = true;
        for (const auto& fields : rows.All()) {
            if (column >= fields.size() || fields[column].empty())
                continue;
            const NumberField number = ReadNumber(fields[column], rows.Decimal());
            inRange = inRange && number.value >= kFirst && number.value <= kLast;
            hasFraction = hasFraction || number.value != std::floor(number.value);
        }
        if (inRange && hasFraction && rows.ColumnCount() > 1 && FitRows(rows, *time).Rises())
            return true;
    }
    return false;
}

Millis UnitMillis(std::string_view unit) {
    const std::string text = Lowercase(Trimmed(unit));
    const std::optional<TimeStep> step = ParseTimeStep("1 " + text);
    return step && !text.empty() ? step->millis : 0;
}

/// A number of seconds, hours or days under a name such as "time (s)" or "days since 1950-01-01".
bool TimeFinder::FindElapsed(TimeLayout* time) const {
    for (const std::size_t column : columns) {
        const ColumnLayout& layout = rows.Column(column);
        const std::string unit = layout.unit.empty() ? layout.name : layout.unit;
        const std::size_t since = unit.find(" since ");
        TimeLayout probe;
        probe.columns = {{column, TimeRole::Elapsed}};
        probe.elapsedUnit = UnitMillis(unit.substr(0, since));
        probe.isRelative = since == std::string::npos;
        if (!probe.isRelative) {
            TimeParts parts;
            if (ParseDate(Trimmed(std::string_view(unit).substr(since + 7)), DateForm::YearMonthDay,
                          &parts) != TimeResult::Ok ||
                MomentOf(parts, {}, &probe.origin) != TimeResult::Ok)
                continue;
        } else if (layout.unit.empty() || !IsOneOf(layout.name, {"time", "t", "elapsed",
                                                                 "elapsed time", "zeit", "tijd"})) {
            continue;
        }
        if (probe.elapsedUnit > 0 && FitRows(rows, probe).IsGood()) {
            *time = probe;
            return true;
        }
    }
    return false;
}

std::vector<std::size_t> AllColumns(const SampleRows& rows) {
    std::vector<std::size_t> columns;
    for (std::size_t i = 0; i < rows.ColumnCount(); ++i)
        columns.push_back(i);
    return columns;
}

Status UseStart(const ImportSettings& settings, TableLayout* layout) {
    TimeLayout& time = layout->time;
    if (!settings.start)
        return Status::Ok();
    TimeParts parts;
    (void)ParseDate(DateText(*settings.start), DateForm::YearMonthDay, &parts);
    time.defaults = {parts.year, parts.month, parts.day};
    if (time.isRelative) {
        time.origin = *settings.start;
        time.isRelative = false;
    }
    return Status::Ok();
}

/// Whether a pattern leaves open a part that stands between two others.
Status CheckPattern(const ImportSettings& settings) {
    const TimePattern& pattern = *settings.pattern;
    if (settings.start || (pattern.Has("Yy") && (pattern.Has("mbBhj") || !pattern.Has("de"))))
        return Status::Ok();
    return Status::InputFault("--time-format " + Quoted(pattern.Text()) +
                              (pattern.Has("Yy") ? " has a day but no month" : " has no year") +
                              "; give what it lacks with --start YYYY-MM-DD");
}

/// How many columns a pattern spreads over where blanks part the columns.
std::size_t BlankCount(const std::string& text) {
    return static_cast<std::size_t>(std::count(text.begin(), text.end(), ' '));
}

Status FindPattern(const SampleRows& rows, const ImportSettings& settings,
                   const std::vector<std::size_t>& given, TableLayout* layout) {
    Status status = CheckPattern(settings);
    if (!status)
        return status;
    TimeLayout& time = layout->time;
    time = {};
    time.source = TimeSource::Pattern;
    time.pattern = settings.pattern;
    status = UseStart(settings, layout);
    for (const std::size_t column : given)
        time.columns.push_back({column, TimeRole::Date});
    if (!given.empty() || !status)
        return status;
    const std::size_t most = BlankCount(settings.pattern->Text()) + 1;
    for (std::size_t width = 1; width <= most; ++width) {
        for (std::size_t first = 0; first + width <= rows.ColumnCount(); ++first) {
            time.columns.clear();
            for (std::size_t i = 0; i < width; ++i)
                time.columns.push_back({first + i, TimeRole::Date});
            if (FitRows(rows, time).IsGood())
                return status;
        }
    }
    return Status::InputFault("no column reads as --time-format " +
                              Quoted(settings.pattern->Text()) + "; name the column with --time");
}

Status FindSerial(const SampleRows& rows, const ImportSettings& settings,
                  const std::vector<std::size_t>& candidates, TableLayout* layout) {
    for (const std::size_t column : candidates) {
        layout->time = DateLayout(column, *settings.dateForm);
        if (FitRows(rows, layout->time).IsGood())
            return UseStart(settings, layout);
    }
    return Status::InputFault("no column reads as " + DateFormName(*settings.dateForm) +
                              "; name the column with --time");
}

Status NoTime(const TimeFinder& finder, const ImportSettings& settings, const TableLayout& layout) {
    if (finder.LacksMonth())
        return Status::InputFault("the columns give year and day but no month; give it with "
                                  "--start YYYY-MM-DD (the date of the first row)");
    if (settings.timeColumns.empty())
        return Status::InputFault(
            "no column holds dates or times; name one with --time, or give the time of the first "
            "row and the step with --start DATE --step S");
    std::string titles;
    for (const std::string& name : settings.timeColumns)
        titles +=
            (titles.empty() ? "" : ", ") + ColumnTitle(layout, *FindColumn(layout.columns, name));
    return Status::InputFault("column " + titles +
                              " does not read as time; tell its form with --time-format");
}

} // namespace

SampleRows::SampleRows(const TableShape& shape, const RowRun& run,
                       const std::vector<ColumnLayout>& columnLayouts)
    : columns(columnLayouts),
      decimal(shape.decimal) {
    for (std::size_t i = run.first; i <= run.last && i < shape.rows.size(); ++i) {
        const HeadRow& row = shape.rows[i];
        if (!row.isComment && !row.isDivider && row.fields.size() == shape.fieldCount)
            rows.push_back(row.Views());
    }
}

Status FindTime(const SampleRows& rows, const ImportSettings& settings, TableLayout* layout) {
    std::vector<std::size_t> given;
    for (const std::string& name : settings.timeColumns) {
        const std::optional<std::size_t> column = FindColumn(layout->columns, name);
        if (!column)
            return NoSuchColumn("--time", name, *layout);
        given.push_back(*column);
    }
    if (settings.pattern)
        return FindPattern(rows, settings, given, layout);
    const std::vector<std::size_t> candidates = given.empty() ? AllColumns(rows) : given;
    if (settings.dateForm)
        return FindSerial(rows, settings, candidates, layout);
    TimeFinder finder(rows, candidates, settings);
    const bool isFound = finder.Find(&layout->time, &layout->notes);
    if (!isFound)
        layout->time = {};
    if (settings.step) {
        if (isFound)
            layout->notes.push_back("the times of column " +
                                    ColumnTitle(*layout, layout->time.columns[0].column) +
                                    " are not used: --start and --step are");
        layout->time.source = TimeSource::StartAndStep;
        layout->time.start = *settings.start;
        layout->time.step = *settings.step;
        layout->time.isRelative = false;
        return Status::Ok();
    }
    return isFound ? UseStart(settings, layout) : NoTime(finder, settings, *layout);
}

std::optional<std::size_t> FindColumn(const std::vector<ColumnLayout>& columns,
                                      const std::string& nameOrNumber) {
    const std::string wanted(Trimmed(nameOrNumber));
    const std::optional<int> number = IsDigits(wanted) ? ParseInt(wanted) : std::nullopt;
    if (number && *number >= 1 && static_cast<std::size_t>(*number) <= columns.size())
        return static_cast<std::size_t>(*number) - 1;
    std::string name;
    std::string unit;
    SplitNameAndUnit(wanted, &name, &unit);
    const auto find = [&columns](const auto& test) -> std::optional<std::size_t> {
        const auto at = std::find_if(columns.begin(), columns.end(), test);
        return at == columns.end() ? std::nullopt
                                   : std::optional(static_cast<std::size_t>(at - columns.begin()));
    };
    std::optional<std::size_t> found =
        find([&wanted](const ColumnLayout& column) { return column.name == wanted; });
    if (!found)
        found = find([&wanted, &name](const ColumnLayout& column) {
            return !column.name.empty() && (Lowercase(column.name) == Lowercase(wanted) ||
                                            Lowercase(column.name) == Lowercase(name));
        });
    return found;
}

Status NoSuchColumn(const std::string& option, const std::string& name, const TableLayout& layout) {
    std::string list;
    constexpr std::size_t kMostListed = 30;
    for (std::size_t i = 0; i < layout.columns.size() && i < kMostListed; ++i)
        list += (i > 0 ? ", " : "") + ColumnTitle(layout, i);
    return Status::InputFault(option + " " + Quoted(name) + ": no such column; there are " + list);
}

std::string ColumnTitle(const TableLayout& layout, std::size_t column) {
    const std::string number = std::to_string(column + 1);
    if (column >= layout.columns.size() || layout.columns[column].name.empty())
        return number;
    return number + " " + Quoted(layout.columns[column].name);
}

} // namespace ryn
