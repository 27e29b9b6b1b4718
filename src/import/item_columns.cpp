#include "import/item_columns.h"

#include <algorithm>
#include <cmath>

#include "import/number_field.h"
#include "import/table_text.h"
#include "import/time_names.h"

namespace ryn {

namespace {

bool IsTimeColumn(const TableLayout& layout, std::size_t column) {
    return std::any_of(layout.time.columns.begin(), layout.time.columns.end(),
                       [column](const TimeColumn& time) { return time.column == column; });
}

/// Names of what is not measured: who, where, which row, how good.
bool IsLabelName(const std::string& name) {
    const std::vector<std::string> words = Words(name);
    return std::any_of(words.begin(), words.end(), [](const std::string& word) {
        return IsOneOf(
            word, "station|stations|stn|site|siteid|id|no|nr|num|number|nummer|code|cod|cd|wmo|"
                  "index|idx|row|obs|lat|latitude|lon|long|longitude|elev|elevation|flag|"
                  "flags|qc|qn|quality|qual|status|grade|gauge|messstelle|stationid|"
                  "stationsnummer|stationskennung|agency");
    });
}

struct ColumnValues {
    std::vector<float> values;
    bool areWhole = true;
};

/// The values of the rows looked at, and whether all are written without decimals ("5.0" is
/// measured, "5" may count).
ColumnValues ValuesOf(const SampleRows& rows, std::size_t column) {
    ColumnValues found;
    for (const auto& fields : rows.All()) {
        const NumberField number = ReadNumber(fields[column], rows.Decimal());
        // Missing values interrupt neither a constant nor a counter.
        if (number.kind != NumberKind::Value && number.kind != NumberKind::Marked)
            continue;
        found.values.push_back(number.value);
        found.areWhole = found.areWhole && fields[column].find_first_of(".,") == std::string::npos;
    }
    return found;
}

/// A whole number that never changes, other than zero: the number of a station.
bool IsConstantLabel(const ColumnValues& column) {
    constexpr std::size_t kEnough = 3;
    return column.areWhole && column.values.size() >= kEnough && column.values[0] != 0.0F &&
           std::all_of(column.values.begin(), column.values.end(),
                       [&column](float value) { return value == column.values[0]; });
}

/// A number that grows by one from row to row, but for few jumps.
bool IsCounter(const ColumnValues& column) {
    constexpr std::size_t kEnough = 5;
    if (!column.areWhole || column.values.size() < kEnough)
        return false;
    std::size_t steps = 0;
    for (std::size_t i = 1; i < column.values.size(); ++i)
        steps += column.values[i] == column.values[i - 1] + 1.0F ? 1 : 0;
    return static_cast<double>(steps) >= 0.95 * static_cast<double>(column.values.size() - 1);
}

/// How likely a column of numbers is what somebody wants to analyse.
enum class Standing {
    Measured,
    NamedAsTime,  ///< "Min" may be a minimum
    NamedAsLabel, ///< "obs" may be an observation
    Unchanging,   ///< a station's number, a counter
};

/// Values are looked at before names: a station's number is constant whatever it is called.
Standing StandingOf(const SampleRows& rows, std::size_t column) {
    const ColumnValues values = ValuesOf(rows, column);
    const std::string& name = rows.Column(column).name;
    if (IsConstantLabel(values) || IsCounter(values))
        return Standing::Unchanging;
    if (IsLabelName(name))
        return Standing::NamedAsLabel;
    return IsTimeName(name) ? Standing::NamedAsTime : Standing::Measured;
}

/// The first column of the best standing.
std::optional<std::size_t> FirstMeasurement(const SampleRows& rows, const TableLayout& layout) {
    std::optional<std::size_t> best;
    Standing standing = Standing::Unchanging;
    for (std::size_t i = 0; i < layout.columns.size(); ++i) {
        if (layout.columns[i].kind != ColumnKind::Number || IsTimeColumn(layout, i))
            continue;
        const Standing found = StandingOf(rows, i);
        if (best && found >= standing)
            continue;
        best = i;
        standing = found;
    }
    return best;
}

/// The columns of the twelve months, by their names, in a table with a row for each year; empty in
/// another table.
std::vector<std::size_t> MonthColumns(const TableLayout& layout) {
    const TimeLayout& time = layout.time;
    if (time.source != TimeSource::Columns || time.columns.size() != 1 ||
        time.columns[0].role != TimeRole::Date || time.form != DateForm::Year)
        return {};
    constexpr std::size_t kMonths = 12;
    std::vector<std::size_t> months;
    for (std::size_t i = 0; i < layout.columns.size() && months.size() < kMonths; ++i)
        if (MonthOfName(layout.columns[i].name) == static_cast<int>(months.size()) + 1)
            months.push_back(i);
    return months.size() == kMonths ? months : std::vector<std::size_t>();
}

/// As the user says, also where the column looks like a label, or is empty in the rows looked at.
Status ChooseNamed(const ImportSettings& settings, TableLayout* layout) {
    for (const std::string& name : settings.itemColumns) {
        const std::optional<std::size_t> column = FindColumn(layout->columns, name);
        if (!column)
            return NoSuchColumn("--item", name, *layout);
        if (std::find(layout->items.begin(), layout->items.end(), *column) != layout->items.end())
            return Status::InputFault("--item " + Quoted(name) + " names a column twice");
        if (layout->columns[*column].kind == ColumnKind::Text ||
            layout->columns[*column].kind == ColumnKind::Time)
            return Status::InputFault("--item " + Quoted(name) + ": column " +
                                      ColumnTitle(*layout, *column) + " holds no numbers");
        layout->items.push_back(*column);
    }
    return Status::Ok();
}

} // namespace

Status ChooseItems(const SampleRows& rows, const ImportSettings& settings, TableLayout* layout) {
    layout->items.clear();
    if (!settings.itemColumns.empty())
        return ChooseNamed(settings, layout);
    layout->months = MonthColumns(*layout);
    if (!layout->months.empty()) {
        layout->items.push_back(layout->months[0]);
        layout->notes.emplace_back("each row holds the twelve months of a year");
        return Status::Ok();
    }
    const std::optional<std::size_t> column = FirstMeasurement(rows, *layout);
    if (!column)
        return Status::InputFault(
            "no column holds measured numbers; name one with --item if there is");
    layout->items.push_back(*column);
    return Status::Ok();
}

std::vector<std::size_t> OtherItems(const TableLayout& layout) {
    std::vector<std::size_t> others;
    for (std::size_t i = 0; i < layout.columns.size(); ++i) {
        const ColumnLayout& column = layout.columns[i];
        const bool isChosen =
            std::find(layout.items.begin(), layout.items.end(), i) != layout.items.end();
        const bool isOffered = column.kind == ColumnKind::Number ||
                               (column.kind == ColumnKind::Empty && !column.name.empty());
        const bool isMonth =
            std::find(layout.months.begin(), layout.months.end(), i) != layout.months.end();
        const bool isAside = isMonth || IsTimeColumn(layout, i) || IsLabelName(column.name) ||
                             (IsTimeName(column.name) && !IsMinuteName(column.name));
        if (isOffered && !isChosen && !isAside)
            others.push_back(i);
    }
    return others;
}

} // namespace ryn
