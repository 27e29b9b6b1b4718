#include "import/time_columns.h"

#include <algorithm>

#include "import/hash_fields.h"
#include "import/table_text.h"
#include "import/time_search.h"

namespace ryn {

namespace {

std::vector<std::size_t> AllColumns(const SampleRows& rows) {
    std::vector<std::size_t> columns;
    for (std::size_t i = 0; i < rows.ColumnCount(); ++i)
        columns.push_back(i);
    return columns;
}

/// What --start gives without a step: parts that no column has, and where lengths of time begin.
void UseStart(const ImportSettings& settings, TableLayout* layout) {
    TimeLayout& time = layout->time;
    if (!settings.start)
        return;
    TimeParts parts;
    (void)ParseDate(DateText(*settings.start), DateForm::YearMonthDay, &parts);
    time.defaults = {parts.year, parts.month, parts.day};
    // A date for the origin turns lengths of time into moments.
    if (time.isRelative) {
        time.origin = *settings.start;
        time.isRelative = false;
    }
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

/// The columns given, joined; else the first ones that read as the pattern.
Status FindPattern(const SampleRows& rows, const ImportSettings& settings,
                   const std::vector<std::size_t>& given, TableLayout* layout) {
    if (Status status = CheckPattern(settings); !status)
        return status;
    TimeLayout& time = layout->time;
    time = {};
    time.source = TimeSource::Pattern;
    time.pattern = settings.pattern;
    UseStart(settings, layout);
    for (const std::size_t column : given)
        time.columns.push_back({column, TimeRole::Date});
    if (!given.empty())
        return Status::Ok();
    // Where blanks part the columns, a pattern with a blank in it spans two of them.
    const std::size_t most = BlankCount(settings.pattern->Text()) + 1;
    for (std::size_t width = 1; width <= most; ++width) {
        for (std::size_t first = 0; first + width <= rows.ColumnCount(); ++first) {
            time.columns.clear();
            for (std::size_t i = 0; i < width; ++i)
                time.columns.push_back({first + i, TimeRole::Date});
            if (FitTime(rows, time).IsGood())
                return Status::Ok();
        }
    }
    return Status::InputFault("no column reads as --time-format " +
                              Quoted(settings.pattern->Text()) + "; name the column with --time");
}

/// Forms that are plain numbers, in the first column that fits them.
Status FindSerial(const SampleRows& rows, const ImportSettings& settings,
                  const std::vector<std::size_t>& candidates, TableLayout* layout) {
    for (const std::size_t column : candidates) {
        layout->time = DateLayout(column, *settings.dateForm);
        if (!FitTime(rows, layout->time).IsGood())
            continue;
        UseStart(settings, layout);
        return Status::Ok();
    }
    return Status::InputFault("no column reads as " + DateFormName(*settings.dateForm) +
                              "; name the column with --time");
}

/// What to do depends on what was found and on what the user gave.
Status NoTime(PartsResult parts, const ImportSettings& settings, const TableLayout& layout) {
    if (parts == PartsResult::NoMonth)
        return Status::InputFault("the columns give year and day but no month; give it with "
                                  "--start YYYY-MM-DD (the date of the first row)");
    if (settings.timeColumns.empty())
        return Status::InputFault(
            "no column holds dates or times; name one with --time (and --time-format, such as "
            "excel "
            "or unix), or give the time of the first row and the step with --start DATE --step S");
    std::string titles;
    for (const std::string& name : settings.timeColumns)
        titles +=
            (titles.empty() ? "" : ", ") + ColumnTitle(layout, *FindColumn(layout.columns, name));
    return Status::InputFault("column " + titles +
                              " does not read as time; tell its form with --time-format");
}

/// "1999/00" names the year that begins in 1999, at a day that the table does not tell.
Status RefuseHydrologicalYears(const SampleRows& rows, std::size_t column,
                               const TableLayout& layout) {
    std::size_t row = 0;
    while (!IsHydrologicalYear(rows.All()[row][column]))
        ++row;
    constexpr std::size_t kYearSize = 4;
    const std::string_view first = rows.All()[row][column];
    const std::string format = "%Y" + std::string(first.substr(kYearSize, 1)) +
                               (first.size() > 2 * kYearSize ? "%Y" : "%y");
    return Status::InputFault(
        "line " + std::to_string(rows.LineOf(row)) + ": " + Quoted(first) +
        " and the like in column " + ColumnTitle(layout, column) +
        " are hydrological years, not months; take the year in which each begins with "
        "--time-format " +
        format + " (and its first day with --start, such as 1999-10-01)");
}

/// The axis of --start and --step; columns with times are told, and are no items.
void UseStep(const ImportSettings& settings, TableLayout* layout) {
    TimeLayout& time = layout->time;
    if (!time.columns.empty())
        layout->notes.push_back("the times of column " +
                                ColumnTitle(*layout, time.columns[0].column) +
                                " are not used: --start and --step are");
    time.source = TimeSource::StartAndStep;
    time.rivals.clear();
    time.isRelative = false;
    time.start = *settings.start;
    time.step = *settings.step;
}

/// A column that was named for the time and left over would be a misunderstanding.
Status CheckAllUsed(const std::vector<std::size_t>& given, const TableLayout& layout) {
    for (const std::size_t column : given)
        if (std::none_of(layout.time.columns.begin(), layout.time.columns.end(),
                         [column](const TimeColumn& used) { return used.column == column; }))
            return Status::InputFault("--time: column " + ColumnTitle(layout, column) +
                                      " adds nothing to the time; tell its form with "
                                      "--time-format");
    return Status::Ok();
}

bool LacksMonth(const TimeLayout& time) {
    const auto has = [&time](TimeRole role) {
        return std::any_of(time.columns.begin(), time.columns.end(),
                           [role](const TimeColumn& column) { return column.role == role; });
    };
    return has(TimeRole::Day) && !has(TimeRole::Month);
}

/// Whole dates before dates in parts, parts before months, years and lengths: the more a reading
/// says, the less likely it is chance.
Status Search(const SampleRows& rows, const ImportSettings& settings,
              const std::vector<std::size_t>& given, TableLayout* layout) {
    // The user's columns alone, when given: what they do not hold is a fault, not a reason to look
    // elsewhere.
    const TimeSearch search{rows, given.empty() ? AllColumns(rows) : given,
                            settings.start.has_value()};
    PartsResult parts = PartsResult::None;
    bool isFound = FindDateColumn(search, &layout->time);
    const bool isDate = isFound;
    if (!isFound) {
        parts = FindPartColumns(search, &layout->time);
        isFound = parts == PartsResult::Found ||
                  (parts == PartsResult::None && FindOtherTime(search, &layout->time));
    }
    if (!isFound)
        layout->time = {};
    Status clock = FindClockColumn(search, layout);
    if (isDate)
        FindZoneColumn(search, &layout->time);
    // The user's own axis goes before the table's times; these are still known not to be items.
    if (settings.step) {
        UseStep(settings, layout);
        return Status::Ok();
    }
    const std::optional<std::size_t> hydrological =
        isFound ? std::nullopt : FindHydrologicalYears(search);
    if (hydrological)
        return RefuseHydrologicalYears(rows, *hydrological, *layout);
    if (!isFound)
        return NoTime(parts, settings, *layout);
    if (!clock)
        return clock;
    UseStart(settings, layout);
    if (LacksMonth(layout->time))
        layout->notes.emplace_back("the month is that of --start: no column gives it");
    return CheckAllUsed(given, *layout);
}

/// A column in which so many fields are such signs that it passes for one of texts: the search
/// would take another one.
Status CheckHashColumns(const SampleRows& rows, const TableLayout& layout) {
    const auto& all = rows.All();
    for (std::size_t column = 0; column < rows.ColumnCount(); ++column) {
        const auto isHash = [column](const auto& fields) { return IsHashField(fields[column]); };
        const auto first = std::find_if(all.begin(), all.end(), isHash);
        const auto count = std::count_if(all.begin(), all.end(), isHash);
        if (layout.columns[column].kind != ColumnKind::Text || first == all.end() ||
            static_cast<std::size_t>(count) * 10 < all.size())
            continue;
        const auto row = static_cast<std::size_t>(first - all.begin());
        return Status::InputFault("line " + std::to_string(rows.LineOf(row)) + ": " +
                                  Quoted((*first)[column]) + " in column " +
                                  ColumnTitle(layout, column) + std::string(kHashAdvice));
    }
    return Status::Ok();
}

} // namespace

Status FindTime(const SampleRows& rows, const ImportSettings& settings, TableLayout* layout) {
    // Who names the items need not care for the other columns.
    if (settings.itemColumns.empty())
        if (Status status = CheckHashColumns(rows, *layout); !status)
            return status;
    std::vector<std::size_t> given;
    for (const std::string& name : settings.timeColumns) {
        const std::optional<std::size_t> column = FindColumn(layout->columns, name);
        if (!column)
            return NoSuchColumn("--time", name, *layout);
        given.push_back(*column);
    }
    if (settings.pattern)
        return FindPattern(rows, settings, given, layout);
    if (settings.dateForm)
        return FindSerial(rows, settings, given.empty() ? AllColumns(rows) : given, layout);
    return Search(rows, settings, given, layout);
}

} // namespace ryn
