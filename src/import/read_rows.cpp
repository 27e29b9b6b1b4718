#include "import/read_rows.h"

#include <algorithm>
#include <optional>

#include "import/number_field.h"
#include "import/record_reader.h"
#include "import/table_shape.h"
#include "import/table_text.h"
#include "import/time_reader.h"

namespace ryn {

namespace {

/// The rows that cannot be read: the first one's fault in full, and the lines of the first few.
class BadRows {
  public:
    void Add(long line, const std::string& fault) {
        if (rows.count == 0)
            first = "line " + std::to_string(line) + ": " + fault;
        rows.Add(line);
    }
    bool IsEmpty() const { return rows.count == 0; }
    Status AsFault(const std::string& source) const {
        std::string text = source + ": " + first;
        if (rows.count > 1)
            text += " (" + std::to_string(rows.count) + " rows cannot be read: lines " +
                    LineList(rows.firstLines, rows.count) + ")";
        return Status::InputFault(text);
    }

  private:
    std::string first;
    DroppedRows rows;
};

void CountText(std::string_view text, std::vector<OccurredText>* texts) {
    constexpr std::size_t kMostTexts = 20; // a hostile table may have a new one in each row
    for (OccurredText& known : *texts) {
        if (known.text == text || texts->size() == kMostTexts) {
            ++known.count;
            return;
        }
    }
    texts->push_back({std::string(text), 1, {}});
}

class RowParser {
  public:
    RowParser(const TableLayout& tableLayout, const MissingRules& missingRules,
              TableSamples* tableSamples, ImportReport* importReport)
        : layout(tableLayout),
          missing(missingRules),
          samples(tableSamples),
          report(importReport),
          time(tableLayout.time),
          row(tableLayout.items.size()) {
        samples->values.resize(layout.items.size());
        samples->isRelative = layout.time.isRelative;
        emptyIsMissing =
            std::find(missing.texts.begin(), missing.texts.end(), "") != missing.texts.end();
    }

    /// A line that is no row by its look: blank, a comment, a divider.
    bool PassOver(const TableRecord& record);
    void TakeRow(const TableRecord& record, const std::vector<std::string_view>& fields);
    Status Finish(const std::string& source);

  private:
    enum class ValueResult { Taken, Missing, Bad };

    bool HasTimeColumns() const { return layout.time.source != TimeSource::StartAndStep; }
    TimeResult ReadTime(const std::vector<std::string_view>& fields, Millis* moment);
    void TakeRowWithoutTime(const TableRecord& record, const std::vector<std::string_view>& fields);
    bool IsHeaderAgain(const std::vector<std::string_view>& fields) const;
    bool HasFields(const TableRecord& record, std::size_t count);
    ValueResult ReadValue(long line, std::size_t item, std::string_view field);
    ValueResult Refuse(long line, std::size_t item, std::string_view field, NumberKind kind);
    bool IsGivenCode(std::string_view text) const;
    ValueResult CountMissing(std::string_view text);
    void CheckOffset(long line);
    void PendingAreBad();

    const TableLayout& layout;
    const MissingRules& missing;
    TableSamples* samples;
    ImportReport* report;
    TimeReader time;
    std::vector<float> row;
    bool emptyIsMissing = false;
    std::int64_t steps = 0;  // rows before this one, for an axis of start and step
    DroppedRows pendingText; // lines of text, which are a footer when no row follows
    std::string firstPendingText;
    std::vector<long> pendingBlank; // blank lines, which may be missing values without time columns
    std::optional<long> firstWithOffset;
    std::optional<long> firstWithoutOffset;
    long rowsWithHour24 = 0;
    BadRows bad;
};

bool RowParser::PassOver(const TableRecord& record) {
    if (Trimmed(record.text).empty()) {
        if (!HasTimeColumns() && pendingBlank.size() < DroppedRows::kMostLines)
            pendingBlank.push_back(record.line);
        if (!HasTimeColumns() && emptyIsMissing) {
            ++steps;
            ++report->rowsRead;
            pendingBlank.clear();
            report->Dropped(DropReason::MissingValue).Add(record.line);
            (void)CountMissing("");
        }
        return true;
    }
    if (CommentMarkSize(record.text, layout.commentMarks) > 0)
        return true;
    if (layout.columns.size() > 1 && IsSeparatorLine(record.text, layout.delimiter)) {
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
    if (std::all_of(fields.begin(), fields.end(), IsMissingWord)) {
        report->Dropped(DropReason::EmptyRow).Add(record.line);
    } else if (IsHeaderAgain(fields)) {
        report->Dropped(DropReason::RepeatedHeader).Add(record.line);
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
    const std::size_t last = *std::max_element(layout.items.begin(), layout.items.end());
    const bool isShifted = layout.delimiter == kBlanks && count < layout.columns.size();
    if (isShifted) {
        // Between blanks a missing field leaves no trace, and those behind it move up.
        bad.Add(record.line, "has " + std::to_string(count) + " fields where the others have " +
                                 std::to_string(layout.columns.size()));
        return false;
    }
    if (count <= last && !emptyIsMissing) {
        bad.Add(record.line, "ends before column " + ColumnTitle(layout, last) +
                                 "; if the value is missing there say --missing \"\"");
        return false;
    }
    return true;
}

bool RowParser::IsGivenCode(std::string_view text) const {
    return std::any_of(missing.texts.begin(), missing.texts.end(), [text](const std::string& code) {
        return Lowercase(code) == Lowercase(text);
    });
}

RowParser::ValueResult RowParser::CountMissing(std::string_view text) {
    CountText(text, &report->missing);
    return ValueResult::Missing;
}

RowParser::ValueResult RowParser::Refuse(long line, std::size_t item, std::string_view field,
                                         NumberKind kind) {
    const std::string place =
        Quoted(field) + " in column " + ColumnTitle(layout, layout.items[item]);
    switch (kind) {
    case NumberKind::NotFinite:
        bad.Add(line, place + " is not finite");
        break;
    case NumberKind::TooLarge:
        bad.Add(line, place + " is too large for a 32-bit number");
        break;
    case NumberKind::Censored:
        bad.Add(line, place + " is a bound and not a value; leave such rows out with --missing \"" +
                          std::string(field.substr(0, 1)) + "\", or edit them");
        break;
    default:
        bad.Add(line, place + " is no number" +
                          (field.find_first_of("0123456789") == std::string_view::npos
                               ? "; if it marks a missing value say so with --missing"
                               : std::string()));
    }
    return ValueResult::Bad;
}

RowParser::ValueResult RowParser::ReadValue(long line, std::size_t item, std::string_view field) {
    const NumberField number = ReadNumber(field, layout.decimal);
    if (number.kind == NumberKind::Missing)
        return CountMissing(field);
    if (!missing.texts.empty()) {
        const bool isNumber = number.kind == NumberKind::Value || number.kind == NumberKind::Marked;
        const bool isCode = isNumber && std::find(missing.numbers.begin(), missing.numbers.end(),
                                                  number.value) != missing.numbers.end();
        if (isCode || IsGivenCode(field))
            return CountMissing(field);
        if (!number.mark.empty() && IsGivenCode(number.mark))
            return CountMissing(number.mark);
    }
    if (number.kind == NumberKind::Marked)
        CountText(number.mark, &report->marks);
    else if (number.kind != NumberKind::Value)
        return Refuse(line, item, field, number.kind);
    row[item] = number.value;
    return ValueResult::Taken;
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
    CheckOffset(record.line);
    if (!HasFields(record, fields.size()))
        return;
    ValueResult result = ValueResult::Taken;
    for (std::size_t i = 0; i < layout.items.size(); ++i) {
        const std::size_t column = layout.items[i];
        const std::string_view field = column < fields.size() ? fields[column] : std::string_view();
        result = std::max(result, ReadValue(record.line, i, field));
    }
    if (result == ValueResult::Missing)
        report->Dropped(DropReason::MissingValue).Add(record.line);
    if (result != ValueResult::Taken)
        return;
    samples->times.push_back(moment);
    samples->lines.push_back(static_cast<std::uint32_t>(record.line));
    for (std::size_t i = 0; i < row.size(); ++i)
        samples->values[i].push_back(row[i]);
}

Status RowParser::Finish(const std::string& source) {
    if (!bad.IsEmpty())
        return bad.AsFault(source);
    if (pendingText.count > 0)
        for (const long line : pendingText.firstLines)
            report->Dropped(DropReason::Footer).Add(line);
    if (pendingText.count > 0)
        report->Dropped(DropReason::Footer).count = pendingText.count;
    if (firstWithOffset && firstWithoutOffset)
        return Status::InputFault(source + ": line " + std::to_string(*firstWithoutOffset) +
                                  ": the time has no offset from UTC, and the one in line " +
                                  std::to_string(*firstWithOffset) + " has");
    if (firstWithOffset)
        report->notes.emplace_back("times have an offset from UTC; they are stored as UTC");
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
