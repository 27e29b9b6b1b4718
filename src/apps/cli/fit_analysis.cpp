#include "apps/cli/fit_analysis.h"

#include <algorithm>
#include <cmath>
#include <functional>
#include <limits>

#include "apps/cli/fit_texts.h"
#include "base/number_text.h"
#include "stats/jackknife.h"
#include "stats/monte_carlo.h"
#include "stats/probability_plot.h"
#include "strings/catalogue.h"

namespace ryn::cli {

namespace {

// No combination is fitted to fewer.
constexpr std::size_t kFewestValues = 5;

bool AreAllEqual(const std::vector<double>& values) {
    return std::adjacent_find(values.begin(), values.end(), std::not_equal_to<>()) == values.end();
}

/// The text of the first value that `isBad` says so of; empty where there is none.
template <typename Predicate, typename... Arguments>
std::string FirstFault(const FitTask& task, Predicate isBad, int textId,
                       const Arguments&... arguments) {
    const auto bad = std::find_if(task.values.begin(), task.values.end(), isBad);
    if (bad == task.values.end())
        return {};
    return FormatText(textId, task.source, bad - task.values.begin() + 1, ShortestText(*bad),
                      arguments...);
}

std::string ThresholdFault(const FitTask& task) {
    if (task.frame.kind != stats::SeriesKind::PartialDuration)
        return {};
    const double threshold = task.frame.threshold;
    // What a value at the threshold may lose when it is stored as a 32-bit float.
    const double lowest = threshold - 1e-6 * std::max(1.0, std::fabs(threshold));
    return FirstFault(
        task, [lowest](double x) { return x < lowest; }, kTextCliSeriesBelowThreshold,
        ShortestText(threshold));
}

stats::ResampledQuantiles EstimatesAlone(const FitTask& task, const stats::Distribution& fitted) {
    constexpr double kNone = std::numeric_limits<double>::quiet_NaN();
    stats::ResampledQuantiles quantiles;
    for (const double period : task.periods)
        quantiles.atPeriods.push_back(
            {stats::QuantileOfPeriod(fitted, period, task.frame, task.meaning), kNone, kNone,
             kNone});
    return quantiles;
}

stats::ResampledQuantiles Quantiles(const FitTask& task, const stats::Combination& combination,
                                    const stats::Distribution& fitted) {
    const stats::QuantileRequests requests{task.periods, task.meaning, {}};
    switch (task.uncertainty) {
    case FitUncertainty::MonteCarlo:
        return stats::MonteCarlo({combination, fitted, task.values.size(), task.frame}, requests);
    case FitUncertainty::Jackknife:
        return stats::Jackknife(combination, fitted, {task.values, task.frame}, requests);
    case FitUncertainty::None:
        break;
    }
    return EstimatesAlone(task, fitted);
}

std::vector<double> Exceedances(const FitTask& task) {
    std::vector<double> exceedances;
    for (const double period : task.periods)
        exceedances.push_back(stats::ExceedanceOfPeriod(period, task.frame, task.meaning));
    return exceedances;
}

FitGoodness GoodnessOf(const FitTask& task, const stats::FittedModel& model) {
    const stats::Distribution& fitted = model.distribution;
    const stats::ProbabilityPlot plot =
        stats::ProbabilityPlotOf(fitted, task.ascending, task.plotting);
    return {stats::ChiSquaredTestOf(fitted, task.ascending),
            stats::KolmogorovSmirnovTestOf(fitted, task.ascending),
            stats::LeastSquaresCriterionOf(fitted, plot).criterion,
            stats::PlotCorrelation(plot),
            stats::ReducedPlotCorrelation(fitted, plot),
            stats::AkaikeCriterion(model)};
}

} // namespace

std::string SeriesFault(const FitTask& task) {
    const std::size_t count = task.values.size();
    if (count < kFewestValues)
        return FormatText(kTextCliSeriesTooShort, task.source, count, kFewestValues);
    std::string fault = FirstFault(
        task, [](double x) { return !std::isfinite(x); }, kTextCliSeriesNotFinite);
    if (fault.empty() && AreAllEqual(task.values))
        fault = FormatText(kTextCliSeriesAllEqual, task.source, count,
                           ShortestText(task.values.front()));
    return fault.empty() ? ThresholdFault(task) : fault;
}

FitReport UnfittedReport(const FitTask& task, const NamedFit& fit, const std::string& failure) {
    FitReport report;
    report.name = fit.name;
    report.count = task.values.size();
    report.unit = task.unit;
    report.failure = failure;
    report.uncertainty = task.uncertainty;
    report.plotting = task.plotting;
    report.sampleCorrection = fit.combination.sampleCorrection;
    return report;
}

FitReport FitOne(const FitTask& task, const NamedFit& fit) {
    FitReport report = UnfittedReport(task, fit, "");
    const stats::FitResult result = stats::Fit(fit.combination, {task.values, task.frame});
    if (!result) {
        report.failure = FitFailureText(result.Failure());
        return report;
    }
    report.model = *result;
    report.periods = task.periods;
    report.exceedances = Exceedances(task);
    report.quantiles = Quantiles(task, fit.combination, result->distribution);
    report.goodness = GoodnessOf(task, *result);
    return report;
}

} // namespace ryn::cli
