#include "import/guess_layout.h"

#include <algorithm>
#include <string>

#include "import/comma_parts.h"
#include "import/date_order.h"
#include "import/hash_fields.h"
#include "import/item_columns.h"
#include "import/spread_columns.h"
#include "import/stray_rows.h"
#include "import/table_names.h"
#include "import/table_shape.h"
#include "import/table_text.h"
#include "import/time_columns.h"
#include "import/time_reader.h"

namespace ryn {

namespace {

constexpr std::size_t kMegabyte = std::size_t{1} << 20;

/// The longest run, the later one of equals. A header's own small tables are shorter.
RowRun LongestRun(const std::vector<RowRun>& runs) {
    RowRun best;
    for (const RowRun& run : runs)
        if (run.count >= best.count)
            best = run;
    return best;
}

/// "16", or "3-12".
std::string LinesText(const TableShape& shape, const RowRun& run) {
    const long first = shape.rows[run.first].line;
    const long last = shape.rows[run.last].line;
    return first == last ? std::to_string(first)
                         : std::to_string(first) + "-" + std::to_string(last);
}

/// Rows before the chosen run: few are a header's own table and are told; many may be data.
Status CheckOtherRuns(const TableShape& shape, const std::vector<RowRun>& runs,
                      const RowRun& chosen, TableLayout* layout) {
    std::string few;
    for (const RowRun& run : runs) {
        if (run.first >= chosen.first)
            break;
        constexpr std::size_t kMany = 10;
        // Taking the longer of two tables without a word would lose the other; a few lines are
        // told, not refused, since gauge histories stand in many headers.
        if (run.count > kMany || run.count * 5 > chosen.count)
            return Status::InputFault("lines " + LinesText(shape, run) + " and " +
                                      LinesText(shape, chosen) +
                                      " look like two tables, with something else between; take "
                                      "that out, or give the lines before the one to take with "
                                      "--skip");
        few += (few.empty() ? "" : ", ") + LinesText(shape, run);
    }
    if (!few.empty())
        layout->notes.push_back("what looks like rows in line " + few +
                                " stands in the header and is not taken");
    return Status::Ok();
}

/// Dates that lack their day count: their rows belong to the table, and are left out later.
bool ReadsAsTime(const TimeLayout& time, const HeadRow& row) {
    Millis moment = 0;
    return TimeReader(time).Read(row.Views(), &moment) != TimeResult::Bad;
}

/// A row whose date is faulty ("2001-02-30") must not pass for a header.
std::size_t WithFaultyRowsBefore(const TableShape& shape, const TimeLayout& time,
                                 std::size_t first) {
    while (first > 0) {
        const HeadRow& row = shape.rows[first - 1];
        if (row.isComment || row.fields.size() != shape.fieldCount)
            break;
        const std::string text = TimeReader(time).TextOf(row.Views());
        const std::string& field = row.fields[time.columns[0].column];
        const FieldKind kind = KindOfField(field, shape.decimal);
        const bool startsAsNumber = !text.empty() && IsDigit(text[0]) && kind == FieldKind::Number;
        if (kind != FieldKind::Time && !startsAsNumber && !IsHashField(field))
            break;
        --first;
    }
    return first;
}

/// By the first row, which stands for the others: a form allows two digits or four in each row.
bool HasTwoDigitYears(const SampleRows& rows, const TimeLayout& time) {
    if (time.source != TimeSource::Columns)
        return false;
    for (const TimeColumn& column : time.columns) {
        const bool isYear = column.role == TimeRole::Year ||
                            (column.role == TimeRole::Date && time.form == DateForm::Year);
        const std::string_view field = rows.All().front()[column.column];
        if (isYear && field.size() <= 2)
            return true;
        if (column.role == TimeRole::Date && time.form == DateForm::ShortYearMonthDay)
            return true;
        const std::string_view date = field.substr(0, field.find(' '));
        const std::size_t last = date.find_last_of("-/.");
        if (column.role == TimeRole::Date &&
            (time.form == DateForm::DayMonthYear || time.form == DateForm::MonthDayYear) &&
            last != std::string_view::npos && date.size() - last == 3 &&
            date.find_first_of("-/.") != last)
            return true;
    }
    return false;
}

/// Rules that place values at moments which the table does not write; the user has to know them.
void NoteTimeRules(const SampleRows& rows, const ImportSettings& settings, TableLayout* layout) {
    const TimeLayout& time = layout->time;
    if (HasTwoDigitYears(rows, time) ||
        (time.pattern && time.pattern->Has("y") && !time.pattern->Has("Y")))
        layout->notes.emplace_back(
            "two-digit years: 30 to 99 are 1930 to 1999, 00 to 29 are 2000 to 2029");
    const bool isDate = !time.columns.empty() && time.columns[0].role == TimeRole::Date;
    const bool isYear = isDate && time.form == DateForm::Year;
    const bool isMonth =
        (isDate && (time.form == DateForm::YearMonth || time.form == DateForm::CompactYearMonth)) ||
        (time.columns.size() == 2 && time.columns[1].role == TimeRole::Month);
    if (time.source != TimeSource::Columns || settings.start || !(isYear || isMonth) ||
        !layout->months.empty())
        return;
    layout->notes.emplace_back(isYear ? "years alone: each value is placed at 1 January"
                                      : "months alone: each value is placed at the first day");
}

void KeepPreview(const SampleRows& rows, TableLayout* layout) {
    constexpr std::size_t kPreviewed = 20;
    for (std::size_t i = 0; i < rows.Count() && i < kPreviewed; ++i)
        layout->preview.emplace_back(rows.All()[i].begin(), rows.All()[i].end());
}

/// The names that the rows' kinds alone suggest, which the search for time columns needs; then the
/// rows that have a time, and the header above them.
Status LayOut(const TableShape& shape, const ImportSettings& settings, TableLayout* layout) {
    const std::vector<RowRun> byKind =
        FindRuns(shape, [&shape](const HeadRow& row) { return HasKindsOfColumns(shape, row); });
    RowRun run = LongestRun(byKind);
    if (run.count == 0)
        return Status::InputFault("no rows with numbers were found");
    Status status = CheckRowsAbove(shape, run);
    if (!status)
        return status;
    FindNames(shape, run.first, layout);
    const SampleRows first(shape, run, layout->columns);
    if (first.Count() == 0) // nothing but numbers with marks
        return Status::InputFault("no rows with numbers were found");
    status = FindTime(first, settings, layout);
    if (!status)
        return NameRowsWithoutTime(shape, run, settings, *layout, status);
    const TimeLayout& time = layout->time;
    std::vector<RowRun> runs = byKind;
    // By their time alone: a row with a bad value still belongs to the table, and reading names it.
    if (time.source != TimeSource::StartAndStep) {
        runs = FindRuns(shape, [&time](const HeadRow& row) { return ReadsAsTime(time, row); });
        run = LongestRun(runs);
    }
    status = CheckOtherRuns(shape, runs, run, layout);
    if (!status)
        return status;
    if (time.source != TimeSource::StartAndStep)
        run.first = WithFaultyRowsBefore(shape, time, run.first);
    else if (shape.fieldCount == 1)
        while (run.first > 0 && IsHashField(Trimmed(shape.rows[run.first - 1].text)))
            --run.first;
    // Again, since the rows may start elsewhere than the kinds of their fields suggested.
    FindNames(shape, run.first, layout);
    ReadPreamble(shape, run.first, layout);
    layout->dataLine = shape.rows[run.first].line;
    const SampleRows rows(shape, run, layout->columns);
    if (rows.Count() == 0)
        return Status::InputFault("no rows with numbers were found");
    status = ChooseItems(rows, settings, layout);
    NoteTimeRules(rows, settings, layout);
    KeepPreview(rows, layout);
    if (status && settings.itemColumns.empty())
        status = CheckSpreadColumns(shape, *layout);
    if (status && !settings.decimal)
        status = CheckCommaPartsColumns(shape, run, settings, *layout);
    return status;
}

/// The layout is set only when all of it was found.
Status GuessFromHead(const TableHead& head, const ImportSettings& settings, TableLayout* layout) {
    const std::optional<TableShape> shape = FindShape(head, settings);
    if (!shape)
        return Status::InputFault("no rows with numbers were found");
    constexpr std::size_t kMostColumns = 10000;
    if (shape->fieldCount > kMostColumns)
        return Status::InputFault("a row has " + std::to_string(shape->fieldCount) +
                                  " columns; at most " + std::to_string(kMostColumns) +
                                  " are read");
    TableLayout guessed;
    guessed.encoding = head.encoding;
    guessed.delimiter = shape->delimiter;
    guessed.decimal = shape->decimal;
    guessed.isDecimalGiven = settings.decimal.has_value();
    guessed.commentMarks = shape->commentMarks;
    Status status = LayOut(*shape, settings, &guessed);
    if (status)
        *layout = std::move(guessed);
    return status;
}

} // namespace

Status GuessLayout(TextSource& source, const ImportSettings& settings, TableLayout* layout) {
    TextEncoding encoding = TextEncoding::Utf8;
    Status status = FindEncoding(source, &encoding);
    if (!status)
        return status;
    // The bytes are looked at even so: an empty table is told here.
    encoding = settings.encoding.value_or(encoding);
    // A preamble may be longer than the first look; then the next one reaches further.
    constexpr HeadLimits kLooks[] = {{2000, 4 * kMegabyte}, {50000, 16 * kMegabyte}};
    for (const HeadLimits& limits : kLooks) {
        TableHead head;
        status = ReadHead(source, encoding, settings.skipLines, limits, &head);
        if (!status)
            return status;
        if (head.lines.empty())
            return Status::InputFault(source.Name() + ": has no lines with text");
        // A fault in the first look may only mean that the rows begin later.
        status = GuessFromHead(head, settings, layout);
        if (status || head.isWhole)
            break;
    }
    if (!status)
        return Status::InputFault(source.Name() + ": " + status.Text());
    return DecideDateOrder(source, layout);
}

} // namespace ryn
