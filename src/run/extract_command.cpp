#include "run/extract_command.h"

#include <string>
#include <utility>

#include "base/file_access.h"
#include "strings/catalogue.h"

namespace ryn {

namespace {

ExtractionResult Refused(int messageId, Status status) {
    return {std::move(status), messageId, {}};
}

/// A refusal by one of the system's own texts, with the file that it is about.
ExtractionResult Refused(int messageId, const std::string& detail) {
    return Refused(messageId, Status::InputFault(std::string(Text(messageId)) + detail));
}

/// What stands in the way before the output file is touched.
ExtractionResult TestInput(const CBasicInputKvf& basic) {
    if (basic.InputFileName.empty() || basic.OutputFileName.empty())
        return Refused(kTextExtractionNameMissing, "");
    if (!CanOpenForReading(basic.InputFileName))
        return Refused(kTextExtractionInputUnreadable, ": " + basic.InputFileName);
    if (IsSameFile(basic.InputFileName, basic.OutputFileName))
        return Refused(kTextExtractionOverInput, ": " + basic.OutputFileName);
    if (!NeededDatesAreValid(basic))
        return Refused(basic.IncludeSeasonalAnalysis ? kTextInvalidSeason : kTextInvalidYearStart,
                       "");
    return {};
}

ExtractionResult Prepare(CGlobalKvf& root) {
    const CBasicInputKvf& basic = root.BasicInput();
    if (ExtractionResult refused = TestInput(basic); !refused.status)
        return refused;
    // Read before the output is emptied: a bad input must not cost the old series.
    if (!root.Values().ReadSeries(basic.InputFileName, ItemIndex(basic.InputItem))) {
        const Status& reason = root.Values().ReadError();
        const std::string text = FormatText(kTextExtractionInputBad, reason.Text());
        return Refused(0, reason.Kind() == Fault::System ? Status::SystemFault(text)
                                                         : Status::InputFault(text));
    }
    if (const Status emptied = EmptyFile(basic.OutputFileName); !emptied)
        return Refused(kTextExtractionOutputUnwritable,
                       Status::SystemFault(std::string(Text(kTextExtractionOutputUnwritable)) +
                                           ": " + emptied.Text()));
    return {};
}

} // namespace

ExtractionResult ExtractSeriesOf(CGlobalKvf& root) {
    CTsqValues& values = root.Values();
    ExtractionResult result = Prepare(root);
    if (result.status) {
        result.report = values.ExtractSeries(root.BasicInput().OutputFileName, root.BasicInput(),
                                             /*silent=*/false);
        if (!result.report.written)
            result.status = Status::SystemFault(
                FormatText(kTextExtractionWriteFailed, result.report.written.Text()));
    }
    values.ClearSeries();
    return result;
}

} // namespace ryn
