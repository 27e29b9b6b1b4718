#include "import/spread_columns.h"

#include <algorithm>
#include <array>
#include <map>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "base/number_text.h"
#include "import/table_text.h"

namespace ryn {

namespace {

constexpr std::size_t kMonths = 12;

/// The span of time that a row stands for.
enum class RowSpan { Year, Month, Day, Other };

bool HasRole(const TimeLayout& time, TimeRole role) {
    return std::any_of(time.columns.begin(), time.columns.end(),
                       [role](const TimeColumn& column) { return column.role == role; });
}

RowSpan SpanOfForm(DateForm form) {
    switch (form) {
    case DateForm::Year:
        return RowSpan::Year;
    case DateForm::YearMonth:
    case DateForm::CompactYearMonth:
        return RowSpan::Month;
    case DateForm::DecimalYear:
    case DateForm::Duration:
    case DateForm::ExcelSerial:
    case DateForm::UnixSeconds:
        return RowSpan::Other;
    default:
        return RowSpan::Day;
    }
}

RowSpan SpanOfRow(const TimeLayout& time) {
    if (time.source != TimeSource::Columns || time.columns.empty() ||
        HasRole(time, TimeRole::Clock) || HasRole(time, TimeRole::Hour) ||
        HasRole(time, TimeRole::HourMinute) || HasRole(time, TimeRole::Elapsed))
        return RowSpan::Other;
    if (HasRole(time, TimeRole::Date))
        return SpanOfForm(time.form);
    if (HasRole(time, TimeRole::Day) || HasRole(time, TimeRole::DayOfYear))
        return RowSpan::Day;
    return HasRole(time, TimeRole::Month) ? RowSpan::Month : RowSpan::Year;
}

/// Columns side by side, or with flags between them, that count up or name the months.
struct Sequence {
    std::size_t first = 0; ///< columns
    std::size_t last = 0;
    std::size_t count = 0;
    std::string stem; ///< "d" of "d1"; in lower case
};

/// "d01" is "d" and 1; no number for another title.
std::optional<int> PartTitle(std::string_view title, std::string* stem) {
    const std::size_t end = title.find_last_not_of("0123456789");
    const std::size_t start = end == std::string_view::npos ? 0 : end + 1;
    *stem = Lowercase(title.substr(0, start));
    return ParseInt(title.substr(start));
}

/// The titles that count on from 0 or 1, a sequence for each stem.
std::vector<Sequence> CountedTitles(const std::vector<std::string>& titles) {
    struct Counting {
        Sequence columns;
        int next = 0;
    };
    std::map<std::string, Counting> byStem;
    std::string stem;
    for (std::size_t i = 0; i < titles.size(); ++i) {
        const std::optional<int> number = PartTitle(titles[i], &stem);
        if (!number || (byStem.count(stem) == 0 && *number > 1))
            continue;
        Counting& found =
            byStem.try_emplace(stem, Counting{{i, i, 0, stem}, *number}).first->second;
        if (*number != found.next)
            continue;
        ++found.next;
        ++found.columns.count;
        found.columns.last = i;
    }
    std::vector<Sequence> sequences;
    sequences.reserve(byStem.size() + 1);
    for (const auto& [name, counting] : byStem)
        sequences.push_back(counting.columns);
    return sequences;
}

/// The twelve months by name, in any order: the hydrological year begins in autumn.
Sequence NamedMonths(const std::vector<std::string>& titles) {
    std::array<bool, kMonths + 1> isFound{};
    Sequence found;
    for (std::size_t i = 0; i < titles.size(); ++i) {
        const auto month = static_cast<std::size_t>(MonthOfName(titles[i]));
        if (month == 0 || isFound[month])
            continue;
        isFound[month] = true;
        found.first = found.count == 0 ? i : found.first;
        found.last = i;
        ++found.count;
    }
    return found;
}

/// Without titles, the columns of numbers that are no times.
Sequence UntitledNumbers(const TableLayout& layout) {
    Sequence found;
    for (std::size_t i = 0; i < layout.columns.size(); ++i) {
        const bool isTime = std::any_of(layout.time.columns.begin(), layout.time.columns.end(),
                                        [i](const TimeColumn& time) { return time.column == i; });
        if (isTime || layout.columns[i].kind != ColumnKind::Number)
            continue;
        found.first = found.count == 0 ? i : found.first;
        found.last = i;
        ++found.count;
    }
    return found;
}

/// What each of so many columns holds of the row's span; empty where they are something else:
/// twelve stations, say.
std::string PartOfRow(RowSpan row, const Sequence& columns) {
    const std::size_t count = columns.count;
    if (row == RowSpan::Month && count >= 28 && count <= 31)
        return "day";
    if (row == RowSpan::Year && (count == 365 || count == 366))
        return "day";
    if (row == RowSpan::Year && count == kMonths &&
        (columns.stem.size() <= 1 || StartsWithOneOf(columns.stem, "m")))
        return "month";
    if (row == RowSpan::Day && count == 24 &&
        (columns.stem.size() <= 1 || StartsWithOneOf(columns.stem, "h|st|u")))
        return "hour";
    return {};
}

/// As the table writes them: the layout leaves out names that are only numbers.
std::vector<std::string> TitlesOf(const TableShape& shape, const TableLayout& layout) {
    std::vector<std::string> titles(layout.columns.size());
    for (std::size_t i = 0; i < titles.size(); ++i)
        titles[i] = layout.columns[i].name;
    const auto row =
        std::find_if(shape.rows.begin(), shape.rows.end(),
                     [&layout](const HeadRow& line) { return line.line == layout.nameLine; });
    if (row != shape.rows.end() && row->fields.size() == titles.size())
        for (std::size_t i = 0; i < titles.size(); ++i)
            if (titles[i].empty())
                titles[i] = row->fields[i];
    return titles;
}

std::string TitleText(const std::vector<std::string>& titles, std::size_t column) {
    return titles[column].empty() ? std::to_string(column + 1) : Quoted(titles[column]);
}

} // namespace

Status CheckSpreadColumns(const TableShape& shape, const TableLayout& layout) {
    if (!layout.months.empty())
        return Status::Ok();
    const std::vector<std::string> titles = TitlesOf(shape, layout);
    const auto fault = [&titles, &layout](const std::string& part, const Sequence& columns) {
        return Status::InputFault(
            "line " + std::to_string(layout.nameLine > 0 ? layout.nameLine : layout.dataLine) +
            ": the table has one column for each " + part + ", " +
            TitleText(titles, columns.first) + " to " + TitleText(titles, columns.last) +
            "; bring it into one row for each " + part +
            " first, or take one of the columns with --item");
    };
    const Sequence months = NamedMonths(titles);
    if (months.count == kMonths)
        return fault("month", months);
    std::vector<Sequence> sequences = CountedTitles(titles);
    if (layout.nameLine == 0)
        sequences.push_back(UntitledNumbers(layout));
    const RowSpan span = SpanOfRow(layout.time);
    for (const Sequence& columns : sequences) {
        const std::string part = PartOfRow(span, columns);
        if (!part.empty())
            return fault(part, columns);
    }
    return Status::Ok();
}

} // namespace ryn
