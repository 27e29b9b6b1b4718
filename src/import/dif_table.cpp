#include "import/dif_table.h"

#include <algorithm>

#include "base/number_text.h"
#include "import/field_split.h"
#include "import/line_reader.h"
#include "import/number_field.h"
#include "import/table_head.h"
#include "import/table_text.h"

namespace ryn {

namespace {

constexpr std::string_view kStart = "[IDT;*DIF*";
// The format's code for no value, and the quality that goes with it. Interpolated and doubtful
// values have other qualities and are taken, as the archive itself publishes them.
constexpr std::string_view kMissingValue = "999999999";
constexpr std::string_view kMissingQuality = "99";

class DifReader {
  public:
    DifReader(TextSource& textSource, const MissingRules& missingRules, TableSamples* tableSamples,
              ImportReport* importReport)
        : missing(missingRules),
          samples(tableSamples),
          report(importReport),
          encoding(TextEncoding::Utf8),
          source(textSource) {}

    Status Read();

  private:
    Status Fail(std::string_view reason) const {
        return Status::InputFault(source.Name() + ": line " + std::to_string(line) + ": " +
                                  std::string(reason));
    }
    Status TakeBlockName(std::string_view text);
    Status TakeHeader(std::string_view text);
    Status TakePeriod(const FieldList& fields);
    Status TakeValues(std::string_view text);
    Status TakeValue(std::string_view text);
    Status CloseBlock();

    const MissingRules& missing;
    TableSamples* samples;
    ImportReport* report;
    TextEncoding encoding;
    TextSource& source;

    enum class Block { Header, Values };
    Block block = Block::Header;
    long line = 0;
    long headers = 0;
    bool hasPeriod = false;
    Millis first = 0;
    TimeStep step;
    std::int64_t announced = 0;
    std::int64_t taken = 0;
};

/// "19760101" and "2300".
std::optional<Millis> MomentOfFields(std::string_view date, std::string_view clock) {
    TimeParts parts;
    Millis moment = 0;
    if (ParseDate(date, DateForm::Compact, &parts) != TimeResult::Ok ||
        !ParseClock(clock, &parts) || MomentOf(parts, {}, &moment) != TimeResult::Ok)
        return std::nullopt;
    return moment;
}

/// "TYD;19760101;0000;19941231;2300;60;min"
Status DifReader::TakePeriod(const FieldList& fields) {
    if (fields.Size() < 7)
        return Fail("TYD gives no step; values that carry their own times are not read");
    const std::optional<Millis> start = MomentOfFields(fields[1], fields[2]);
    const std::optional<Millis> end = MomentOfFields(fields[3], fields[4]);
    const std::optional<TimeStep> every =
        ParseTimeStep(std::string(fields[5]) + " " + std::string(fields[6]));
    if (!start || !end || *end < *start || !every || every->millis == 0)
        return Fail("TYD gives no period and step that can be read");
    first = *start;
    step = *every;
    // The count is the only check that there is: a value lost in transmission would shift all that
    // follow it by one step.
    announced = (*end - *start) / step.millis + 1;
    taken = 0;
    hasPeriod = true;
    return Status::Ok();
}

Status DifReader::TakeHeader(std::string_view text) {
    FieldList fields;
    if (!fields.Split(text, ';') || fields.Size() < 2)
        return Status::Ok();
    ImportedItem& item = report->items[0];
    if (fields[0] == "TYD")
        return TakePeriod(fields);
    // TE is an equidistant series. The others have layouts of their own, which would be misread.
    if (fields[0] == "TYP" && fields[1] != "TE")
        return Fail("series of type " + std::string(fields[1]) +
                    " carry a time with each value and are not read; only TE is");
    if (fields[0] == "PAR" && fields.Size() > 2)
        item.name = ToUtf8(fields[2], encoding);
    if (fields[0] == "EHD" && fields.Size() > 2)
        item.unit = ToUtf8(fields[2], encoding);
    if (fields[0] == "LOC" && fields.Size() > 2 && report->notes.empty())
        report->notes.push_back("station: " + ToUtf8(fields[2], encoding));
    return Status::Ok();
}

Status DifReader::CloseBlock() {
    if (block == Block::Values && taken != announced)
        return Fail("the values end after " + std::to_string(taken) + " of the " +
                    std::to_string(announced) + " that TYD announces");
    block = Block::Header;
    return Status::Ok();
}

Status DifReader::TakeBlockName(std::string_view text) {
    Status status = CloseBlock();
    if (!status)
        return status;
    // Each series begins with its own description. Several periods of one series share it.
    if (text.substr(0, 4) == "[W3H" && ++headers > 1)
        return Fail("a second series begins; only one is imported at a time");
    if (text.substr(0, 4) == "[WRD") {
        if (!hasPeriod)
            return Fail("values begin without a TYD line before them");
        block = Block::Values;
    }
    return Status::Ok();
}

Status DifReader::TakeValue(std::string_view text) {
    const std::size_t slash = text.find('/');
    const std::string_view number = Trimmed(text.substr(0, slash));
    const std::string_view quality =
        slash == std::string_view::npos ? std::string_view() : Trimmed(text.substr(slash + 1));
    // Missing values count for the time of those behind them.
    const std::optional<Millis> moment = Advance(first, step, taken++);
    const NumberField field = ReadNumber(number, '.');
    ++report->rowsRead;
    const bool isGiven = std::find(missing.numbers.begin(), missing.numbers.end(), field.value) !=
                             missing.numbers.end() &&
                         field.kind == NumberKind::Value;
    if (number == kMissingValue || quality == kMissingQuality || isGiven) {
        report->Dropped(DropReason::MissingValue).Add(line);
        return Status::Ok();
    }
    if (field.kind != NumberKind::Value || !moment || taken > announced)
        return Fail(taken > announced ? "more values than TYD announces"
                                      : Quoted(text) + " is no value with its quality");
    samples->times.push_back(*moment);
    samples->lines.push_back(static_cast<std::uint32_t>(line));
    samples->values[0].push_back(field.value);
    return Status::Ok();
}

Status DifReader::TakeValues(std::string_view text) {
    while (!Trimmed(text).empty()) {
        const std::size_t end = text.find(':');
        Status status = TakeValue(Trimmed(text.substr(0, end)));
        if (!status || end == std::string_view::npos)
            return status;
        text.remove_prefix(end + 1);
    }
    return Status::Ok();
}

Status DifReader::Read() {
    Status status = FindEncoding(source, &encoding);
    if (!status)
        return status;
    report->items.assign(1, {});
    samples->values.resize(1);
    LineReader reader(source, encoding);
    std::string_view text;
    ReadResult result = reader.Read(&text);
    for (; status && result == ReadResult::Found; result = reader.Read(&text)) {
        line = reader.LineNumber();
        text = Trimmed(text);
        if (!text.empty() && text[0] == '[')
            status = TakeBlockName(text);
        else
            status = block == Block::Values ? TakeValues(text) : TakeHeader(text);
    }
    if (status && result == ReadResult::Failed)
        status = reader.Error();
    return status ? CloseBlock() : status;
}

} // namespace

bool IsDif(std::string_view start) {
    return start.substr(0, kStart.size()) == kStart;
}

Status ReadDif(TextSource& source, const ImportSettings& settings, TableSamples* samples,
               ImportReport* report) {
    report->form = "DONAR DIF file";
    return DifReader(source, settings.missing, samples, report).Read();
}

} // namespace ryn
