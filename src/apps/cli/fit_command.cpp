#include "apps/cli/fit_command.h"

#include <iterator>
#include <memory>
#include <ostream>

#include "apps/cli/case_arguments.h"
#include "apps/cli/command_options.h"
#include "apps/cli/fit_report.h"
#include "apps/cli/fit_texts.h"
#include "apps/cli/input_file.h"
#include "apps/cli/number_column.h"
#include "apps/cli/setting_value.h"
#include "base/file_access.h"
#include "base/number_text.h"
#include "series/tsq_values.h"
#include "stats/return_period.h"
#include "strings/catalogue.h"
#include "units/units.h"

namespace ryn::cli {

namespace {

constexpr const char* kUsualPeriods = "2,5,10,20,50,100";
constexpr std::size_t kLargestText = std::size_t{1} << 28; // bytes

/// What is to be fitted.
struct FitTask {
    stats::Combination combination;
    std::string name;
    stats::SeriesFrame frame;
    std::vector<double> periods;
    std::vector<double> values;
    std::string unit; ///< of the values, where a data file tells it
};

stats::Combination CombinationOf(const DieCombination& settings) {
    return {static_cast<stats::DistributionType>(settings.DistributionType),
            static_cast<stats::EstimationMethod>(settings.EstimationMethod),
            static_cast<stats::LocationType>(settings.EstimateLocationType),
            static_cast<stats::LogPearsonType>(settings.LogPearsonType),
            static_cast<stats::LogNormalType>(settings.LogNormalType),
            settings.SampleCorrection};
}

Status FrameOf(const FitOptions& options, stats::SeriesFrame* frame) {
    if (!options.partialDurations)
        return options.rate || options.threshold
                   ? Status::InputFault(std::string(Text(kTextCliRateWithoutPds)))
                   : Status::Ok();
    if (!options.rate || !options.threshold || !(*options.rate > 0.0))
        return Status::InputFault(std::string(Text(kTextCliPdsNeedsRate)));
    *frame = {stats::SeriesKind::PartialDuration, *options.threshold, *options.rate};
    return Status::Ok();
}

Status PeriodsOf(const FitOptions& options, const stats::SeriesFrame& frame,
                 std::vector<double>* periods) {
    const std::string text = options.periods.value_or(kUsualPeriods);
    const std::optional<std::vector<double>> numbers = ParseNumberList(text);
    if (!numbers)
        return Status::InputFault(FormatText(kTextCliBadValue, std::string("--periods"), text,
                                             std::string(Text(kTextCliExpectNumbers))));
    for (const double period : *numbers)
        if (!(stats::ExceedanceOfPeriod(period, frame, stats::PeriodMeaning::OfEvent) > 0.0))
            return Status::InputFault(FormatText(kTextCliPeriodTooSmall, ShortestText(period),
                                                 ShortestText(1.0 / frame.rate)));
    *periods = *numbers;
    return Status::Ok();
}

Status ReadSeriesValues(const FitOptions& options, FitTask* task) {
    CTsqValues series;
    if (!series.ReadSeries(options.values, options.item.value_or(1) - 1))
        return series.ReadError();
    for (const STSItem& sample : series.samples)
        task->values.push_back(sample.value);
    task->unit = UnitText(series.itemUnit);
    return Status::Ok();
}

Status ReadTextValues(const FitOptions& options, Console& console, std::vector<double>* values) {
    std::string text;
    const bool fromInput = options.values == "-";
    const std::string name = fromInput ? std::string(Text(kTextCliStandardInput)) : options.values;
    if (fromInput)
        text.assign(std::istreambuf_iterator<char>(console.in), {});
    else if (Status read = ReadWholeFile(options.values, kLargestText, &text); !read)
        return read;
    NumberColumn column;
    if (Status read = ReadNumberColumn(text, name, &column); !read)
        return read;
    if (!column.heading.empty())
        ShowNote(console, FormatText(kTextCliHeadingPassed, name, column.heading));
    *values = std::move(column.values);
    return Status::Ok();
}

Status ReadValues(const FitOptions& options, Console& console, FitTask* task) {
    if (options.values == "-")
        return ReadTextValues(options, console, &task->values);
    if (Status readable = TestReadable(options.values); !readable)
        return readable;
    return KindOfFile(options.values) == FileKind::DataFile
               ? ReadSeriesValues(options, task)
               : ReadTextValues(options, console, &task->values);
}

Status MakeTask(const FitOptions& options, Console& console, FitTask* task) {
    DieCombination found;
    Status status =
        FindCombination({options.name, options.partialDurations ? 1 : 0, "--pds"}, &found);
    task->combination = CombinationOf(found);
    task->name = found.ItemName;
    if (status)
        status = FrameOf(options, &task->frame);
    if (status)
        status = PeriodsOf(options, task->frame, &task->periods);
    if (status)
        status = ReadValues(options, console, task);
    return status;
}

FitReport FitTaskOf(const FitTask& task) {
    FitReport report;
    report.name = task.name;
    report.count = task.values.size();
    report.unit = task.unit;
    const stats::FitInput input{task.values, task.frame};
    const stats::FitResult result = stats::Fit(task.combination, input);
    if (!result) {
        report.failure = FitFailureText(result.Failure(), task.values);
        return report;
    }
    report.model = *result;
    for (const double period : task.periods)
        report.quantiles.push_back(
            {period, stats::ExceedanceOfPeriod(period, task.frame, stats::PeriodMeaning::OfEvent),
             stats::QuantileOfPeriod(result->distribution, period, task.frame,
                                     stats::PeriodMeaning::OfEvent)});
    return report;
}

} // namespace

int RunFit(const FitOptions& options, Console& console) {
    FitTask task;
    if (const int refused = Report(console, MakeTask(options, console, &task)))
        return refused;
    const FitReport report = FitTaskOf(task);
    if (options.form == OutputForm::Json)
        PrintJson(console, JsonOfFit(report));
    else if (report.model)
        PrintFit(console.out, report);
    if (!report.model) {
        ShowError(console, report.name + ": " + report.failure);
        return kExitAnalysis;
    }
    for (const stats::FitWarning& warning : report.model->warnings)
        ShowWarning(console, report.name + ": " + FitWarningText(warning));
    return kExitDone;
}

void AddFitCommand(CommandLine& line) {
    auto options = std::make_shared<FitOptions>();
    CLI::App& command = line.Add({"fit", kTextCliHelpFit, [options](Console& console) {
                                      return RunFit(*options, console);
                                  }});
    AddFileArgument(command, "NAME", kTextCliHelpFitName, &options->name);
    AddFileArgument(command, "VALUES", kTextCliHelpFitValues, &options->values);
    AddIntOption(command, {"--item", "N", kTextCliHelpFitItem}, 1, &options->item);
    AddTextOption(command, {"--periods", "10,50,100", kTextCliHelpFitPeriods}, &options->periods);
    command.add_flag("--pds", options->partialDurations, std::string(Text(kTextCliHelpPds)));
    AddNumberOption(command, {"--rate", "R", kTextCliHelpRate}, &options->rate);
    AddNumberOption(command, {"--threshold", "U", kTextCliHelpThreshold}, &options->threshold);
    AddJsonOption(command, &options->form);
}

} // namespace ryn::cli
