#include "import/import_report.h"

#include <algorithm>

#include "base/number_text.h"
#include "import/field_split.h"
#include "import/table_text.h"

namespace ryn {

namespace {

// Every line begins with a fixed word and a colon, so that scripts can pick what they need, and is
// whole in itself, so that a dialog can show it alone.
using Lines = std::vector<std::string>;

std::string Joined(const std::vector<std::string>& texts) {
    std::string joined;
    for (const std::string& text : texts)
        joined += (joined.empty() ? "" : ", ") + text;
    return joined;
}

std::string Times(long count) {
    return count == 1 ? "once" : std::to_string(count) + " times";
}

/// The columns in the order in which they are read, and the form of the date among them.
std::string FormOfTime(const TableLayout& layout) {
    const TimeLayout& time = layout.time;
    if (time.source == TimeSource::StartAndStep)
        return "time: from --start and --step";
    std::vector<std::string> titles;
    for (const TimeColumn& column : time.columns)
        titles.push_back(ColumnTitle(layout, column.column));
    std::string text = (titles.size() == 1 ? "time: column " : "time: columns ") + Joined(titles);
    if (time.source == TimeSource::Pattern)
        return text + ", as " + Quoted(time.pattern->Text());
    const bool hasDate = time.columns[0].role == TimeRole::Date;
    return hasDate ? text + ", " + DateFormName(time.form) : text;
}

void AddLayout(const TableLayout& layout, Lines* lines) {
    // What was guessed comes first: a wrong guess explains all that follows.
    std::string text = EncodingName(layout.encoding) + ", " +
                       std::to_string(layout.columns.size()) +
                       (layout.columns.size() == 1 ? " column" : " columns");
    if (layout.columns.size() > 1)
        text += " parted by " + DelimiterName(layout.delimiter);
    if (layout.decimal == ',')
        text += ", decimal comma";
    text +=
        layout.nameLine > 0 ? ", names in line " + std::to_string(layout.nameLine) : ", no names";
    if (layout.unitLine > 0)
        text += ", units in line " + std::to_string(layout.unitLine);
    lines->push_back(text + ", rows from line " + std::to_string(layout.dataLine));
    lines->push_back(FormOfTime(layout));
}

/// A unit that is unknown is told as well, since an analysis without one cannot be compared.
void AddItems(const ImportReport& report, Lines* lines) {
    for (const ImportedItem& item : report.items) {
        std::string text = "item: " + Quoted(item.name);
        if (!item.column.empty())
            text += (report.form == "table" ? " from column " : " from item ") + item.column;
        text += item.unit.empty() ? ", no unit known (--unit gives one)" : ", unit " + item.unit;
        lines->push_back(text);
    }
    if (!report.otherItems.empty())
        lines->push_back("could be chosen with --item: " + Joined(report.otherItems));
}

/// With the reason where a number was taken for a code, and the way to have it otherwise.
void AddMissing(const ImportReport& report, Lines* lines) {
    // Codes that were announced but never occur are told too: a user may have expected them.
    for (const OccurredText& code : report.missing) {
        const std::string name = code.text.empty() ? "empty" : Quoted(code.text);
        lines->push_back("missing: " + name + ", " + Times(code.count) +
                         (code.origin.empty() ? "" : " (" + code.origin + ")"));
    }
    for (const OccurredText& mark : report.marks)
        lines->push_back("mark: " + Quoted(mark.text) + " behind values, " + Times(mark.count) +
                         "; the values are taken (--missing " + Quoted(mark.text) +
                         " leaves them out)");
}

std::string ReasonText(DropReason reason) {
    switch (reason) {
    case DropReason::MissingValue:
        return "with a missing value";
    case DropReason::IncompleteDate:
        return "with a date that lacks its month";
    case DropReason::EmptyRow:
        return "without content";
    case DropReason::Divider:
        return "that only divide";
    case DropReason::RepeatedHeader:
        return "that repeat the header";
    case DropReason::Footer:
        return "of text behind the last row";
    case DropReason::Duplicate:
        return "of a time that another row has, merged with it";
    }
    return {};
}

std::string SpanText(const ImportReport& report) {
    const auto text = [&report](Millis time) {
        return report.isRelative ? ShortestText(static_cast<double>(time) /
                                                static_cast<double>(kMillisPerSecond)) +
                                       " s"
                                 : MomentText(time);
    };
    if (report.samples == 1)
        return text(report.first);
    std::string span = text(report.first) + " to " + text(report.last);
    if (report.equalStep)
        return span + ", every " +
               ShortestText(static_cast<double>(*report.equalStep) /
                            static_cast<double>(kMillisPerSecond)) +
               " s";
    return span + ", steps differ";
}

} // namespace

void DroppedRows::Add(long line) {
    ++count;
    // Rows do not come in the order of their lines: codes are found after the words for missing
    // values.
    if (firstLines.size() == kMostLines && line >= firstLines.back())
        return;
    firstLines.insert(std::upper_bound(firstLines.begin(), firstLines.end(), line), line);
    if (firstLines.size() > kMostLines)
        firstLines.pop_back();
}

DroppedRows& ImportReport::Dropped(DropReason reason) {
    for (DroppedRows& rows : dropped)
        if (rows.reason == reason)
            return rows;
    dropped.push_back({reason, 0, {}});
    return dropped.back();
}

std::string LineList(const std::vector<long>& lines, long count) {
    std::string text;
    for (const long line : lines)
        text += (text.empty() ? "" : ", ") + std::to_string(line);
    const long more = count - static_cast<long>(lines.size());
    return more > 0 ? text + " and " + std::to_string(more) + " more" : text;
}

std::vector<std::string> ReportLines(const ImportReport& report) {
    Lines lines = {report.source + ": " + report.form};
    if (report.form == "table" && !report.items.empty())
        AddLayout(report.layout, &lines);
    AddItems(report, &lines);
    AddMissing(report, &lines);
    for (const std::string& note : report.notes)
        lines.push_back("note: " + note);
    lines.push_back("rows read: " + std::to_string(report.rowsRead));
    for (const DroppedRows& rows : report.dropped)
        lines.push_back("left out: " + std::to_string(rows.count) + " " + ReasonText(rows.reason) +
                        " (line " + LineList(rows.firstLines, rows.count) + ")");
    // Without samples nothing was written, and the fault says why.
    if (report.samples > 0)
        lines.push_back("written: " + std::to_string(report.samples) +
                        (report.samples == 1 ? " sample, " : " samples, ") + SpanText(report));
    return lines;
}

} // namespace ryn
