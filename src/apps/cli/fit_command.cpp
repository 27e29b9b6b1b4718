#include "apps/cli/fit_command.h"

#include <algorithm>
#include <array>
#include <memory>
#include <ostream>

#include "apps/cli/command_options.h"
#include "apps/cli/fit_analysis.h"
#include "apps/cli/fit_texts.h"
#include "apps/cli/settings.h"
#include "strings/catalogue.h"

namespace ryn::cli {

namespace {

// In the order of FitUncertainty.
constexpr std::array<std::string_view, 3> kUncertaintyNames = {"none", "montecarlo", "jackknife"};

/// Reports of all combinations. A series at fault is told once, and stands in each report.
std::vector<FitReport> FitAll(const FitTask& task, const std::string& seriesFault) {
    std::vector<FitReport> reports;
    for (const NamedFit& fit : task.combinations)
        reports.push_back(seriesFault.empty() ? FitOne(task, fit)
                                              : UnfittedReport(task, fit, seriesFault));
    return reports;
}

/// One object for one combination; for several, asked for by name or all, an array.
void PrintReportsAsJson(const std::vector<FitReport>& reports, Console& console) {
    if (reports.size() == 1) {
        PrintJson(console, JsonOfFit(reports.front()));
        return;
    }
    Json list = Json::array();
    for (const FitReport& report : reports)
        list.push_back(JsonOfFit(report));
    PrintJson(console, list);
}

/// Failures stand among other results; a failure alone is on standard error and nothing else.
void PrintReports(const std::vector<FitReport>& reports, Console& console) {
    bool isFirst = true;
    for (const FitReport& report : reports) {
        console.out << (isFirst ? "" : "\n");
        isFirst = false;
        PrintFit(console.out, report);
    }
}

void ShowFailuresAndWarnings(const std::vector<FitReport>& reports, Console& console) {
    for (const FitReport& report : reports) {
        if (!report.model)
            ShowError(console, report.name + ": " + report.failure);
        else
            for (const std::string& warning : FitWarnings(report))
                ShowWarning(console, report.name + ": " + warning);
    }
}

} // namespace

int RunFit(const FitOptions& options, Console& console) {
    FitTask task;
    if (const int refused = Report(console, MakeFitTask(options, console, &task)))
        return refused;
    const std::string seriesFault = SeriesFault(task);
    const std::vector<FitReport> reports = FitAll(task, seriesFault);
    const bool stands = std::any_of(reports.begin(), reports.end(), [](const FitReport& report) {
        return report.model.has_value();
    });
    if (options.form == OutputForm::Json)
        PrintReportsAsJson(reports, console);
    else if (stands)
        PrintReports(reports, console);
    if (seriesFault.empty())
        ShowFailuresAndWarnings(reports, console);
    else
        ShowError(console, seriesFault);
    return stands ? kExitDone : kExitAnalysis;
}

void AddFitCommand(CommandLine& line) {
    auto options = std::make_shared<FitOptions>();
    CLI::App& command = line.Add({"fit", kTextCliHelpFit, [options](Console& console) {
                                      return RunFit(*options, console);
                                  }});
    AddFileArgument(command, "NAME", kTextCliHelpFitName, &options->names);
    AddFileArgument(command, "VALUES", kTextCliHelpFitValues, &options->values);
    AddIntOption(command, {"--item", "N", kTextCliHelpFitItem}, 1, &options->item);
    AddTextOption(command, {"--periods", "10,50,100", kTextCliHelpFitPeriods}, &options->periods);
    AddChoiceOption(command, {"--uncertainty", "METHOD", kTextCliHelpUncertainty},
                    {kUncertaintyNames, ChoiceNumbers::NotTaken}, [options](int choice) {
                        options->uncertainty = static_cast<FitUncertainty>(choice);
                    });
    AddChoiceOption(command, {"--plotting", "N", kTextCliHelpPlotting},
                    {kPlottingMethodNames, ChoiceNumbers::Taken}, [options](int choice) {
                        options->plotting = static_cast<stats::PlottingMethod>(choice);
                    });
    command.add_flag("--sample-correction", options->sampleCorrection,
                     std::string(Text(kTextCliHelpSampleCorrection)));
    command.add_flag("--pds", options->partialDurations, std::string(Text(kTextCliHelpPds)));
    AddNumberOption(command, {"--rate", "R", kTextCliHelpRate}, &options->rate);
    AddNumberOption(command, {"--threshold", "U", kTextCliHelpThreshold}, &options->threshold);
    command.add_flag_callback(
        "--annual", [options] { options->meaning = stats::PeriodMeaning::OfAnnualMaximum; },
        std::string(Text(kTextCliHelpAnnual)));
    AddJsonOption(command, &options->form);
}

} // namespace ryn::cli
