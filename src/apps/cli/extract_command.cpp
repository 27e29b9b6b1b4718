#include "apps/cli/extract_command.h"

#include <memory>
#include <ostream>

#include "apps/cli/case_file.h"
#include "apps/cli/command_options.h"
#include "apps/cli/date_text.h"
#include "apps/cli/json_output.h"
#include "apps/cli/plain_text.h"
#include "apps/cli/setting_value.h"
#include "apps/cli/settings.h"
#include "run/extract_command.h"
#include "strings/catalogue.h"

namespace ryn::cli {

namespace {

/// A setting that an extraction gave another value.
struct ChangedSetting {
    std::string name;
    std::string before;
    std::string after;
};

std::vector<std::string> ValuesOf(const std::vector<Setting>& settings) {
    std::vector<std::string> values;
    values.reserve(settings.size());
    for (const Setting& setting : settings)
        values.push_back(ValueText(setting));
    return values;
}

std::vector<ChangedSetting> ChangesSince(const std::vector<std::string>& before,
                                         const std::vector<Setting>& settings) {
    std::vector<ChangedSetting> changes;
    const std::vector<std::string> after = ValuesOf(settings);
    for (std::size_t i = 0; i < settings.size(); ++i)
        if (before[i] != after[i])
            changes.push_back({settings[i].name, before[i], after[i]});
    return changes;
}

void PrintReport(const ExtractionReport& report, const std::vector<ChangedSetting>& changes,
                 const std::string& seriesFile, std::ostream& out) {
    if (report.selected == 0)
        out << FormatText(kTextCliExtractedNone, PlainLine(seriesFile)) << '\n';
    else
        out << FormatText(kTextCliExtracted, PlainLine(seriesFile), report.selected,
                          DateForPeople(report.first), DateForPeople(report.last))
            << '\n';
    if (!report.missingYears.empty())
        out << FormatText(kTextCliMissingYears, YearRanges(report.missingYears)) << '\n';
    for (const ChangedSetting& change : changes)
        out << FormatText(kTextCliChanged, change.name, PlainLine(change.before),
                          PlainLine(change.after))
            << '\n';
}

Json JsonOfReport(const ExtractionReport& report, const std::vector<ChangedSetting>& changes,
                  const std::string& seriesFile) {
    Json changed = Json::array();
    for (const ChangedSetting& change : changes)
        changed.push_back(
            {{"name", change.name}, {"before", change.before}, {"after", change.after}});
    return {{"seriesFile", seriesFile},
            {"count", report.selected},
            {"first", JsonOf(report.first)},
            {"last", JsonOf(report.last)},
            {"missingYears", report.missingYears},
            {"changed", std::move(changed)}};
}

int ReportRefusal(const Status& status, const CaseFile& file, Console& console) {
    ShowError(console, file.ShownName() + ": " + status.Text());
    return status.Kind() == Fault::Input ? kExitInput : kExitSystem;
}

} // namespace

std::string YearRanges(const std::vector<int>& years) {
    std::string text;
    for (std::size_t i = 0; i < years.size();) {
        std::size_t last = i;
        while (last + 1 < years.size() && years[last + 1] == years[last] + 1)
            ++last;
        text += (i == 0 ? "" : ", ") + std::to_string(years[i]);
        if (last > i)
            text += "-" + std::to_string(years[last]);
        i = last + 1;
    }
    return text;
}

int RunExtract(const ExtractOptions& options, Console& console) {
    CaseFile file(console, options.consent);
    if (const int refused = file.Open(options.file))
        return refused;
    const std::vector<Setting> settings = SettingsOf(file.Root());
    const std::vector<std::string> before = ValuesOf(settings);
    const ExtractionResult result = ExtractSeriesOf(file.Root());
    if (!result.status)
        return ReportRefusal(result.status, file, console);
    CBasicInputKvf& basic = file.Root().BasicInput();
    basic.Extracted = true; // so that the series is taken over at once
    file.Root().DefineEVS().SyncFromExtraction(basic);
    const std::vector<ChangedSetting> changes = ChangesSince(before, settings);
    if (options.form == OutputForm::Json) {
        PrintJson(console, JsonOfReport(result.report, changes, basic.OutputFileName));
        return file.SaveQuietly();
    }
    PrintReport(result.report, changes, basic.OutputFileName, console.out);
    return file.Save();
}

void AddExtractCommand(CommandLine& line) {
    auto options = std::make_shared<ExtractOptions>();
    CLI::App& command = line.Add({"extract", kTextCliHelpExtract, [options](Console& console) {
                                      return RunExtract(*options, console);
                                  }});
    AddCaseFileArgument(command, &options->file);
    AddJsonOption(command, &options->form);
    AddConsentOption(command, &options->consent);
}

} // namespace ryn::cli
