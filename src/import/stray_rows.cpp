#include "import/stray_rows.h"

#include <algorithm>
#include <string>
#include <vector>

#include "import/bad_rows.h"
#include "import/table_text.h"
#include "import/time_names.h"
#include "import/time_reader.h"
#include "import/time_search.h"

namespace ryn {

namespace {

/// Where a line above the table differs from its rows.
struct StrayField {
    std::size_t column = 0;
    FieldKind kind = FieldKind::Text;
};

/// A line with a number where the rows have one, and digits in every field that is not what its
/// column holds. Without digits it is a line of a preamble: "Altitude;57.2".
std::optional<StrayField> FindStrayField(const TableShape& shape, const HeadRow& row) {
    if (row.isComment || row.isDivider || row.fields.size() != shape.fieldCount)
        return std::nullopt;
    bool hasNumber = false;
    std::optional<StrayField> stray;
    for (std::size_t i = 0; i < shape.fieldCount; ++i) {
        const bool isNumber = shape.kinds[i] == ColumnKind::Number;
        const FieldKind kind = KindOfField(row.fields[i], shape.decimal);
        const bool isFree = !isNumber && shape.kinds[i] != ColumnKind::Time;
        if (isFree || kind == FieldKind::Missing)
            continue;
        if (kind == (isNumber ? FieldKind::Number : FieldKind::Time)) {
            hasNumber = hasNumber || isNumber;
            continue;
        }
        if (std::none_of(row.fields[i].begin(), row.fields[i].end(), IsDigit))
            return std::nullopt;
        stray = stray ? stray : StrayField{i, kind};
    }
    return hasNumber ? stray : std::nullopt;
}

/// Names stand above rows: a single line between may be anything, but not below them.
bool IsLineOfNames(const TableShape& shape, const HeadRow& row) {
    return row.fields.size() == shape.fieldCount &&
           std::all_of(row.fields.begin(), row.fields.end(), [](const std::string& field) {
               return !field.empty() && std::none_of(field.begin(), field.end(), IsDigit);
           });
}

/// A column's rows under one form of a date.
struct DateCount {
    std::size_t ok = 0;
    BadRows bad;
    std::size_t badCount = 0;
};

DateCount CountDates(const TableShape& shape, const RowRun& run, const TimeLayout& time) {
    DateCount count;
    TimeReader reader(time);
    for (std::size_t i = run.first; i <= run.last; ++i) {
        const HeadRow& row = shape.rows[i];
        if (!row.hasData || row.fields.size() != shape.fieldCount)
            continue;
        Millis moment = 0;
        if (reader.Read(row.Views(), &moment) != TimeResult::Bad) {
            ++count.ok;
            continue;
        }
        ++count.badCount;
        count.bad.Add(row.line, Quoted(reader.TextOf(row.Views())) + " is no time of the form " +
                                    DateFormName(time.form));
    }
    return count;
}

/// The forms that a column's look allows.
std::vector<DateForm> FormsOf(const ColumnLayout& column) {
    if (RoleOfName(column.name) == TimeRole::Year)
        return {DateForm::Year};
    if (column.kind == ColumnKind::Number)
        return {};
    return {DateForm::YearMonthDay, DateForm::DayMonthYear, DateForm::MonthDayYear,
            DateForm::YearMonth};
}

} // namespace

Status CheckRowsAbove(const TableShape& shape, const RowRun& run) {
    const HeadRow* first = nullptr;
    StrayField field;
    long last = 0;
    std::size_t count = 0;
    bool isBelowNames = false;
    for (std::size_t i = 0; i < run.first; ++i) {
        const std::optional<StrayField> stray = FindStrayField(shape, shape.rows[i]);
        if (!stray)
            continue;
        last = shape.rows[i].line;
        if (++count > 1)
            continue;
        first = &shape.rows[i];
        field = *stray;
        isBelowNames =
            i > 0 && IsLineOfNames(shape, shape.rows[i - 1]) && stray->kind != FieldKind::Number;
    }
    if (count == 0 || (count == 1 && !isBelowNames))
        return Status::Ok();
    const std::string others = count == 1 ? ""
                                          : " (" + std::to_string(count) + " such lines, up to " +
                                                std::to_string(last) + ")";
    return Status::InputFault(
        "line " + std::to_string(first->line) + ": " + Quoted(first->fields[field.column]) +
        " in column " + std::to_string(field.column + 1) +
        " is not written as in the rows from line " + std::to_string(shape.rows[run.first].line) +
        " on, but the line looks like one of them" + others +
        "; write them alike, or leave out what is none with --skip " + std::to_string(last));
}

Status NameRowsWithoutTime(const TableShape& shape, const RowRun& run,
                           const ImportSettings& settings, const TableLayout& layout,
                           const Status& fault) {
    if (!settings.timeColumns.empty() || settings.pattern || settings.dateForm)
        return fault;
    DateCount best;
    for (std::size_t i = 0; i < layout.columns.size(); ++i) {
        for (const DateForm form : FormsOf(layout.columns[i])) {
            const DateCount count = CountDates(shape, run, DateLayout(i, form));
            if (count.ok > count.badCount && count.ok > best.ok)
                best = count;
        }
    }
    constexpr std::size_t kSeveral = 2;
    return best.ok < kSeveral || best.badCount == 0 ? fault : Status::InputFault(best.bad.Text());
}

} // namespace ryn
