#include "apps/cli/fit_task.h"

#include <algorithm>
#include <cmath>
#include <istream>
#include <iterator>

#include "apps/cli/case_arguments.h"
#include "apps/cli/input_file.h"
#include "apps/cli/number_column.h"
#include "apps/cli/setting_value.h"
#include "base/file_access.h"
#include "base/number_text.h"
#include "params/combination_name.h"
#include "series/tsq_values.h"
#include "stats/sample_statistics.h"
#include "strings/catalogue.h"
#include "units/units.h"

namespace ryn::cli {

namespace {

constexpr const char* kUsualPeriods = "2,5,10,20,50,100";
constexpr const char* kAllNames = "all";
constexpr std::size_t kLargestText = std::size_t{1} << 28; // bytes

stats::Combination CombinationOf(const DieCombination& settings) {
    return {static_cast<stats::DistributionType>(settings.DistributionType),
            static_cast<stats::EstimationMethod>(settings.EstimationMethod),
            static_cast<stats::LocationType>(settings.EstimateLocationType),
            static_cast<stats::LogPearsonType>(settings.LogPearsonType),
            static_cast<stats::LogNormalType>(settings.LogNormalType),
            settings.SampleCorrection};
}

Status BadValue(const std::string& option, const std::string& text, int expectedTextId) {
    return Status::InputFault(
        FormatText(kTextCliBadValue, option, text, std::string(Text(expectedTextId))));
}

int SelectionMethodOf(const FitOptions& options) {
    return options.partialDurations ? 1 : 0;
}

/// The parts between commas, empty ones too.
std::vector<std::string> PartsOf(const std::string& text) {
    std::vector<std::string> parts;
    std::size_t begin = 0;
    for (std::size_t comma = text.find(','); comma != std::string::npos;
         comma = text.find(',', begin)) {
        parts.push_back(text.substr(begin, comma - begin));
        begin = comma + 1;
    }
    parts.push_back(text.substr(begin));
    return parts;
}

Status AddCombination(const std::string& name, const FitOptions& options, FitTask* task) {
    DieCombination found;
    if (Status known = FindCombination({name, SelectionMethodOf(options), "--pds"}, &found); !known)
        return known;
    const std::vector<NamedFit>& present = task->combinations;
    if (std::any_of(present.begin(), present.end(),
                    [&found](const NamedFit& other) { return other.name == found.ItemName; }))
        return Status::InputFault(FormatText(kTextCliNamedTwice, found.ItemName));
    task->combinations.push_back({found.ItemName, CombinationOf(found)});
    return Status::Ok();
}

Status AddCombinations(const FitOptions& options, FitTask* task) {
    const std::vector<std::string> names = options.names == kAllNames
                                               ? GeneratedNames(SelectionMethodOf(options))
                                               : PartsOf(options.names);
    if (std::find(names.begin(), names.end(), "") != names.end())
        return BadValue("NAME", options.names, kTextCliExpectNames);
    for (const std::string& name : names)
        if (Status added = AddCombination(name, options, task); !added)
            return added;
    return Status::Ok();
}

bool KnowsSampleCorrection(const stats::Combination& combination) {
    return combination.distribution == stats::DistributionType::Gumbel &&
           combination.method == stats::EstimationMethod::Moments;
}

/// An option that changes nothing would pass for one that did.
Status CorrectForSampleSize(const FitOptions& options, FitTask* task) {
    if (!options.sampleCorrection)
        return Status::Ok();
    const auto fit = std::find_if(
        task->combinations.begin(), task->combinations.end(),
        [](const NamedFit& candidate) { return KnowsSampleCorrection(candidate.combination); });
    if (fit == task->combinations.end())
        return Status::InputFault(std::string(Text(kTextCliNoSampleCorrection)));
    fit->combination.sampleCorrection = true;
    return Status::Ok();
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

/// The period of an event that is certain. With Poisson arrivals a year has an event at all with
/// probability 1 - exp(-rate).
double ShortestPeriod(const FitTask& task) {
    if (task.frame.kind == stats::SeriesKind::AnnualMaximum)
        return 1.0;
    return task.meaning == stats::PeriodMeaning::OfAnnualMaximum
               ? -1.0 / std::expm1(-task.frame.rate)
               : 1.0 / task.frame.rate;
}

Status ReadPeriods(const FitOptions& options, FitTask* task) {
    const std::string text = options.periods.value_or(kUsualPeriods);
    const std::optional<std::vector<double>> numbers = ParseNumberList(text);
    if (!numbers)
        return BadValue("--periods", text, kTextCliExpectNumbers);
    for (const double period : *numbers)
        if (std::isnan(stats::ExceedanceOfPeriod(period, task->frame, task->meaning)))
            return Status::InputFault(FormatText(kTextCliPeriodTooSmall, ShortestText(period),
                                                 ShortestText(ShortestPeriod(*task))));
    task->periods = *numbers;
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

Status ReadTextValues(const FitOptions& options, Console& console, FitTask* task) {
    std::string text;
    if (options.values == "-")
        text.assign(std::istreambuf_iterator<char>(console.in), {});
    else if (Status read = ReadWholeFile(options.values, kLargestText, &text); !read)
        return read;
    NumberColumn column;
    if (Status read = ReadNumberColumn(text, task->source, &column); !read)
        return read;
    if (!column.heading.empty())
        ShowNote(console, FormatText(kTextCliHeadingPassed, task->source, column.heading));
    task->values = std::move(column.values);
    return Status::Ok();
}

Status ReadValues(const FitOptions& options, Console& console, FitTask* task) {
    const bool fromInput = options.values == "-";
    task->source = fromInput ? std::string(Text(kTextCliStandardInput)) : options.values;
    if (fromInput)
        return ReadTextValues(options, console, task);
    if (Status readable = TestReadable(options.values); !readable)
        return readable;
    return KindOfFile(options.values) == FileKind::DataFile
               ? ReadSeriesValues(options, task)
               : ReadTextValues(options, console, task);
}

} // namespace

Status MakeFitTask(const FitOptions& options, Console& console, FitTask* task) {
    task->meaning = options.meaning;
    task->uncertainty = options.uncertainty;
    task->plotting = options.plotting;
    Status status = AddCombinations(options, task);
    if (status)
        status = CorrectForSampleSize(options, task);
    if (status)
        status = FrameOf(options, &task->frame);
    if (status)
        status = ReadPeriods(options, task);
    if (status)
        status = ReadValues(options, console, task);
    task->ascending = task->values;
    stats::SortAscending(task->ascending);
    return status;
}

} // namespace ryn::cli
