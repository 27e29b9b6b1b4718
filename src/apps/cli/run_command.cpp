#include "apps/cli/run_command.h"

#include <algorithm>
#include <cmath>
#include <memory>
#include <ostream>
#include <vector>

#include "apps/cli/case_file.h"
#include "apps/cli/command_options.h"
#include "apps/cli/engine_log.h"
#include "apps/cli/finding_lines.h"
#include "apps/cli/json_output.h"
#include "apps/cli/plain_text.h"
#include "apps/cli/text_table.h"
#include "base/number_text.h"
#include "results/number_rule.h"
#include "run/run_command.h"
#include "strings/catalogue.h"

namespace ryn::cli {

namespace {

/// A row of the table: a name and one cell for each return period.
void AddValues(TextTable& table, const std::string& name, const DoubleList& values,
               const COutputSettings& results) {
    std::vector<std::string> row{name};
    for (const double value : values)
        row.push_back(std::isnan(value) ? std::string(Text(kTextCliNotComputed))
                                        : NumberText(value, results.Quantiles.Precision));
    table.AddRow(row);
}

bool IsComputed(const DoubleList& values) {
    return std::any_of(values.begin(), values.end(), [](double v) { return std::isfinite(v); });
}

void PrintQuantiles(const COutputSettings& results, std::ostream& out) {
    std::vector<Alignment> alignments(results.ReturnPeriods.size() + 1, Alignment::Right);
    alignments.front() = Alignment::Left;
    TextTable table(alignments);
    std::vector<std::string> heading{std::string(Text(kTextReturnPeriodYears))};
    for (const double period : results.ReturnPeriods)
        heading.push_back(ShortestText(period));
    table.AddRow(heading);
    const std::vector<SEQItem>& items = results.Quantiles.Items();
    for (std::size_t i = 0; i < std::min(items.size(), results.ItemNames.size()); ++i) {
        AddValues(table, results.ItemNames[i], items[i].TyearEvent, results);
        if (IsComputed(items[i].StdTyearEvent))
            AddValues(table, "  " + std::string(Text(kTextStandardDeviation)),
                      items[i].StdTyearEvent, results);
    }
    table.Print(out);
}

void PrintResults(CaseFile& file, const RunOutcome& outcome, Console& console) {
    const COutputSettings& results = file.Document().Results();
    console.out << FormatText(kTextCliRunWritten, PlainLine(file.Root().DefineEVS().OutputFileName),
                              results.SampleStats.SampleSize, results.ItemNames.size())
                << '\n';
    if (results.ReturnPeriods.empty())
        ShowNote(console, Text(kTextCliRunNoPeriods));
    else if (!results.ItemNames.empty())
        PrintQuantiles(results, console.out);
    if (outcome.engineStatus != 0)
        ShowWarning(console, FormatText(kTextCliRunWarnings, outcome.logFile));
}

Json JsonOfQuantiles(const SEQItem& item, const DoubleList& periods) {
    Json list = Json::array();
    const std::size_t count = std::min({periods.size(), item.TyearEvent.size(),
                                        item.AvgTyearEvent.size(), item.StdTyearEvent.size()});
    for (std::size_t i = 0; i < count; ++i)
        list.push_back({{"period", JsonOf(periods[i])},
                        {"estimate", JsonOf(item.TyearEvent[i])},
                        {"average", JsonOf(item.AvgTyearEvent[i])},
                        {"standardDeviation", JsonOf(item.StdTyearEvent[i])}});
    return list;
}

Json JsonOfRun(CaseFile& file, const RunOutcome& outcome) {
    const COutputSettings& results = file.Document().Results();
    Json combinations = Json::array();
    const std::vector<SEQItem>& items = results.Quantiles.Items();
    for (std::size_t i = 0; i < std::min(items.size(), results.ItemNames.size()); ++i)
        combinations.push_back({{"name", results.ItemNames[i]},
                                {"quantiles", JsonOfQuantiles(items[i], results.ReturnPeriods)}});
    return {
        {"status", outcome.engineStatus}, {"resultFile", file.Root().DefineEVS().OutputFileName},
        {"logFile", outcome.logFile},     {"count", results.SampleStats.SampleSize},
        {"unit", results.Unit},           {"combinations", std::move(combinations)}};
}

/// What stopped the run, as an exit code; its message was shown already.
int ExitCodeOf(const RunOutcome& outcome) {
    switch (outcome.end) {
    case RunEnd::Succeeded:
        return kExitDone;
    case RunEnd::Findings:
        return kExitInput;
    case RunEnd::OutputUnwritable:
        return outcome.reason.Kind() == Fault::Input ? kExitInput : kExitSystem;
    case RunEnd::EngineFailed:
        return kExitAnalysis;
    case RunEnd::SaveFailed:
    case RunEnd::ResultsUnwritten:
        break;
    }
    return kExitSystem;
}

/// The messages of the command stay general where a window shows the rest; here it is said.
void ShowDetail(CaseFile& file, const RunOutcome& outcome, Console& console) {
    if (outcome.end == RunEnd::Findings) {
        CMessageList findings;
        file.Root().DefineEVS().Check(findings, 1);
        file.Root().Analysis().Check(findings, 1);
        file.Root().Distributions().Check(findings, 1);
        PrintFindings(findings, file.Document(), console.err);
    }
    if (outcome.end == RunEnd::OutputUnwritable)
        ShowError(console, outcome.reason.Text());
    if (outcome.end == RunEnd::EngineFailed && !outcome.reason) // the series, if not the file
        ShowError(console, outcome.reason.Text());
}

} // namespace

int RunRun(const RunOptions& options, Console& console) {
    // The run's one question is whether to show the log, which here is always shown.
    CaseFile file(console, Consent::Given);
    if (const int refused = file.Open(options.file))
        return refused;
    const EngineLogWatch watch;
    const RunOutcome outcome = RunAnalysis(file.Document());
    const bool hasLog = watch.HasSeen(outcome.logFile);
    ShowDetail(file, outcome, console);
    if (outcome.end == RunEnd::EngineFailed)
        ShowEngineLog(outcome.logFile, hasLog, console);
    // What was computed is shown also where the result file could not be written.
    if (outcome.end != RunEnd::Succeeded && outcome.end != RunEnd::ResultsUnwritten)
        return ExitCodeOf(outcome);
    if (!hasLog)
        ShowWarning(console, FormatText(kTextCliLogUnwritten, outcome.logFile));
    if (options.form == OutputForm::Json)
        PrintJson(console, JsonOfRun(file, outcome));
    else
        PrintResults(file, outcome, console);
    return ExitCodeOf(outcome);
}

void AddRunCommand(CommandLine& line) {
    auto options = std::make_shared<RunOptions>();
    CLI::App& command = line.Add({"run", kTextCliHelpRun, [options](Console& console) {
                                      return RunRun(*options, console);
                                  }});
    AddCaseFileArgument(command, &options->file);
    AddJsonOption(command, &options->form);
}

} // namespace ryn::cli
