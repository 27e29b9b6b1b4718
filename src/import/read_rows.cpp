#include "import/read_rows.h"

#include <algorithm>
#include <optional>

#include "import/bad_rows.h"
#include "import/comma_parts.h"
#include "import/field_split.h"
#include "import/group_columns.h"
#include "import/hash_fields.h"
#include "import/item_values.h"
#include "import/number_field.h"
#include "import/record_reader.h"
#include "import/table_shape.h"
#include "import/table_text.h"
#include "import/time_reader.h"

namespace ryn {

namespace {

class RowParser {
  public:
    RowParser(const TableLayout& tableLayout, const MissingRules& missingRules,
              TableSamples* tableSamples, ImportReport* importReport)
        : layout(tableLayout),
          samples(tableSamples),
          report(importReport),
          values(tableLayout, missingRules, importReport, &bad),
          time(tableLayout.time),
          groups(tableLayout),
          row(tableLayout.items.size()) {
        samples->values.resize(layout.items.size());
        samples->isRelative = layout.time.isRelative;
    }

    /// A line that is no row by its look: blank, a comment, a divider.
    bool PassOver(const TableRecord& record);
    void TakeRow(const TableRecord& record, const std::vector<std::string_view>& fields);
    Status Finish(const std::string& source);

  private:
    bool HasTimeColumns() const { return layout.time.source != TimeSource::StartAndStep; }
    TimeResult ReadTime(const std::vector<std::string_view>& fields, Millis* moment);
    void TakeRowWithoutTime(const TableRecord& record, const std::vector<std::string_view>& fields);
    bool IsHeaderAgain(const std::vector<std::string_view>& fields) const;
    bool HasFields(const TableRecord& record, std::size_t count);
    bool HasDigitsTooMany(const TableRecord& record, const std::vector<std::string_view>& fields);
    void TakeSample(long line, Millis moment, const std::vector<std::string_view>& fields,
                    const std::vector<std::size_t>& columns);
    void CheckOffset(long line);
    void PendingAreBad();

    const TableLayout& layout;
    TableSamples* samples;
    ImportReport* report;
    BadRows bad;
    ItemValues values;
    TimeReader time;
    GroupColumns groups;
    std::vector<float> row;
    std::int64_t steps = 0;  // rows before this one, for an axis of start and step
    DroppedRows pendingText; // lines of text, which are a footer when no row follows
    std::string firstPendingText;
    std::vector<long> pendingBlank; // blank lines, which may be missing values without time columns
    std::optional<long> firstWithOffset;
    std::optional<long> firstWithoutOffset;
    long rowsWithHour24 = 0;
    DroppedRows withoutDay; ///< lines of dates without a day, which are not dropped
};

bool RowParser::PassOver(const TableRecord& record) {
    if (Trimmed(record.text).empty()) {
        // Kept until it is known whether rows follow: blank lines at the end mean nothing.
        if (!HasTimeColumns() && pendingBlank.size() < DroppedRows::kMostLines)
            pendingBlank.push_back(record.line);
        if (!HasTimeColumns() && values.IsEmptyGiven()) {
            ++steps;
            ++report->rowsRead;
            pendingBlank.clear();
            report->Dropped(DropReason::MissingValue).Add(record.line);
            (void)values.CountMissing("");
        }
        return true;
    }
    // Passed over, a value on an axis without times would shift those behind it.
    const bool isHashValue = layout.columns.size() == 1 && IsHashField(Trimmed(record.text));
    if (CommentMarkSize(record.text, layout.commentMarks) > 0 && !isHashValue &&
        !IsRowWithHashes(record.text, layout.delimiter))
        return true;
    // In a single column "---" is a missing value.
    if (layout.columns.size() > 1 && IsSeparatorLine(record.text, layout.delimiter) &&
        !IsRowWithHashes(record.text, layout.delimiter)) {
        report->Dropped(DropReason::Divider).Add(record.line);
        return true;
    }
    return false;
}

TimeResult RowParser::ReadTime(const std::vector<std::string_view>& fields, Millis* moment) {
    if (HasTimeColumns())
        return time.Read(fields, moment);
    const std::optional<Millis> later = Advance(layout.time.start, layout.time.step, steps++);
    *moment = later.value_or(0);
    return later ? TimeResult::Ok : TimeResult::Bad;
}

bool RowParser::IsHeaderAgain(const std::vector<std::string_view>& fields) const {
    if (layout.nameLine == 0 || fields.size() < layout.columns.size())
        return false;
    // By the names of the columns in use; a name's unit has been parted from it.
    const auto isName = [this, &fields](std::size_t column) {
        const std::string& name = layout.columns[column].name;
        return fields[column].substr(0, name.size()) == name;
    };
    return std::all_of(layout.items.begin(), layout.items.end(), isName) &&
           std::any_of(layout.items.begin(), layout.items.end(),
                       [this](std::size_t item) { return !layout.columns[item].name.empty(); });
}

/// A row whose time does not read: an empty row, a header again, a text, or a fault.
void RowParser::TakeRowWithoutTime(const TableRecord& record,
                                   const std::vector<std::string_view>& fields) {
    if (!HasTimeColumns()) {
        bad.Add(record.line, "the axis of --start and --step leaves the calendar here");
        return;
    }
    const std::string text = time.TextOf(fields);
    const auto hashes = std::find_if(
        layout.time.columns.begin(), layout.time.columns.end(), [&fields](const TimeColumn& part) {
            return part.column < fields.size() && IsHashField(fields[part.column]);
        });
    if (hashes != layout.time.columns.end()) {
        bad.Add(record.line, Quoted(fields[hashes->column]) + " in column " +
                                 ColumnTitle(layout, hashes->column) + std::string(kHashAdvice));
        return;
    }
    // Spreadsheets export the empty rows below a table.
    if (std::all_of(fields.begin(), fields.end(), IsMissingWord)) {
        report->Dropped(DropReason::EmptyRow).Add(record.line);
    } else if (IsHeaderAgain(fields)) {
        report->Dropped(DropReason::RepeatedHeader).Add(record.line);
        // What begins like a time and is none is a fault, at the end of the table too, where the
        // file may be cut. What begins like a word may be a footer, if no row follows.
    } else if (!text.empty() && !IsDigit(text[0]) && text[0] != '-' && text[0] != '+') {
        if (pendingText.count == 0)
            firstPendingText = record.text.substr(0, 200);
        pendingText.Add(record.line);
    } else {
        bad.Add(record.line, Quoted(text) + " is no time of the form " +
                                 (layout.time.pattern ? Quoted(layout.time.pattern->Text())
                                                      : DateFormName(layout.time.form)));
    }
}

void RowParser::PendingAreBad() {
    if (pendingText.count > 0) {
        // A table goes on behind a text: another gauge, a change of datum. Nobody but the user can
        // tell.
        for (const long line : pendingText.firstLines)
            bad.Add(line, Quoted(firstPendingText) + " stands between rows and is none");
        pendingText = {};
    }
    for (const long line : pendingBlank)
        bad.Add(line, "is blank: without a column of times it cannot be told whether a value is "
                      "missing there; if so say --missing \"\"");
    pendingBlank.clear();
}

bool RowParser::HasFields(const TableRecord& record, std::size_t count) {
    const std::vector<std::size_t>& columns = layout.months.empty() ? layout.items : layout.months;
    const std::size_t last = *std::max_element(columns.begin(), columns.end());
    const bool isShifted = layout.delimiter == kBlanks && count < layout.columns.size();
    if (isShifted) {
        // Between blanks a missing field leaves no trace, and those behind it move up.
        bad.Add(record.line, "has " + std::to_string(count) + " fields where the others have " +
                                 std::to_string(layout.columns.size()));
        return false;
    }
    // Cut lines and rows of another table end too early as well.
    if (count <= last && !values.IsEmptyGiven()) {
        bad.Add(record.line, "ends before column " + ColumnTitle(layout, last) +
                                 "; if the value is missing there say --missing \"\"");
        return false;
    }
    return true;
}

/// A field too many, and whole numbers in the item's and the next one: between commas "10,5" may be
/// one number, and between blanks "1 234". The value read would be the first part alone.
bool RowParser::HasDigitsTooMany(const TableRecord& record,
                                 const std::vector<std::string_view>& fields) {
    std::size_t count = fields.size();
    while (count > layout.columns.size() && fields[count - 1].empty())
        --count;
    if (layout.isDecimalGiven || count <= layout.columns.size() || !IsDigits(fields[count - 1]))
        return false;
    for (const std::size_t item : layout.items) {
        if (!IsWholeNumber(fields[item]) || !IsDigits(fields[item + 1]))
            continue;
        bad.Add(record.line, "has " + std::to_string(count) + " fields where the table has " +
                                 std::to_string(layout.columns.size()) + ": " +
                                 Quoted(std::string(fields[item]) + layout.delimiter +
                                        std::string(fields[item + 1])) +
                                 " may be one number; write it without the " +
                                 DelimiterName(layout.delimiter) + ", or say --decimal " +
                                 layout.decimal + " if it is two");
        return true;
    }
    return false;
}

void RowParser::CheckOffset(long line) {
    std::optional<long>& first = time.HadOffset() ? firstWithOffset : firstWithoutOffset;
    if (!first)
        first = line;
    rowsWithHour24 += time.HadHour24() ? 1 : 0;
}

void RowParser::TakeRow(const TableRecord& record, const std::vector<std::string_view>& fields) {
    Millis moment = 0;
    const TimeResult timeResult = ReadTime(fields, &moment);
    if (timeResult == TimeResult::Bad) {
        TakeRowWithoutTime(record, fields);
        return;
    }
    ++report->rowsRead;
    PendingAreBad();
    if (timeResult == TimeResult::Incomplete) {
        report->Dropped(DropReason::IncompleteDate).Add(record.line);
        return;
    }
    if (timeResult == TimeResult::FirstOfMonth)
        withoutDay.Add(record.line);
    CheckOffset(record.line);
    if (!HasFields(record, fields.size()))
        return;
    if (fields.size() > layout.columns.size() && HasDigitsTooMany(record, fields))
        return;
    const std::size_t before = samples->Count();
    if (layout.months.empty())
        TakeSample(record.line, moment, fields, layout.items);
    for (std::size_t month = 0; month < layout.months.size(); ++month)
        TakeSample(record.line, *Advance(moment, {static_cast<int>(month), 0}, month > 0 ? 1 : 0),
                   fields, {layout.months[month]});
    if (samples->Count() > before)
        groups.Add(record.line, moment, fields);
}

void RowParser::TakeSample(long line, Millis moment, const std::vector<std::string_view>& fields,
                           const std::vector<std::size_t>& columns) {
    ValueResult result = ValueResult::Taken;
    for (std::size_t i = 0; i < columns.size(); ++i) {
        const std::size_t column = columns[i];
        // A row that ends early has nothing there, as the user has said.
        const std::string_view field = column < fields.size() ? fields[column] : std::string_view();
        result = std::max(result, values.Read(line, column, field, &row[i]));
    }
    if (result == ValueResult::Missing)
        report->Dropped(DropReason::MissingValue).Add(line);
    if (result != ValueResult::Taken)
        return;
    samples->times.push_back(moment);
    samples->lines.push_back(static_cast<std::uint32_t>(line));
    for (std::size_t i = 0; i < row.size(); ++i)
        samples->values[i].push_back(row[i]);
}

Status RowParser::Finish(const std::string& source) {
    if (!bad.IsEmpty())
        return bad.AsFault(source);
    const Status verdict = values.DecimalVerdict();
    if (!verdict)
        return Status::InputFault(source + ": " + verdict.Text());
    if (Status status = groups.Check(source); !status)
        return status;
    if (pendingText.count > 0)
        for (const long line : pendingText.firstLines)
            report->Dropped(DropReason::Footer).Add(line);
    if (pendingText.count > 0)
        report->Dropped(DropReason::Footer).count = pendingText.count;
    // Rows in UTC and rows in an unknown local time do not make one series.
    if (firstWithOffset && firstWithoutOffset)
        return Status::InputFault(source + ": line " + std::to_string(*firstWithoutOffset) +
                                  ": the time has no offset from UTC, and the one in line " +
                                  std::to_string(*firstWithOffset) + " has");
    if (firstWithOffset)
        report->notes.emplace_back("times have an offset from UTC; they are stored as UTC");
    if (withoutDay.count > 0)
        report->notes.push_back("dates without a day are taken as the first of their month: line " +
                                LineList(withoutDay.firstLines, withoutDay.count));
    if (rowsWithHour24 > 0)
        report->notes.emplace_back("hour 24 is 00:00 of the next day");
    return Status::Ok();
}

} // namespace

Status ReadRows(TextSource& source, const TableLayout& layout, const MissingRules& missing,
                TableSamples* samples, ImportReport* report) {
    RecordReader reader(source, layout.encoding, layout.delimiter);
    RowParser parser(layout, missing, samples, report);
    TableRecord record;
    FieldList fields;
    ReadResult result = reader.SkipLines(layout.dataLine - 1);
    while (result == ReadResult::Found) {
        result = reader.ReadLine(&record);
        if (result != ReadResult::Found || parser.PassOver(record))
            continue;
        result = reader.Split(&record, &fields);
        if (result == ReadResult::Found)
            parser.TakeRow(record, fields.All());
    }
    return result == ReadResult::Failed ? reader.Error() : parser.Finish(source.Name());
}

} // namespace ryn
