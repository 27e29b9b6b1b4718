#include "engine/analysis.h"

#include <algorithm>
#include <cmath>
#include <limits>
#include <numeric>

#include "stats/jackknife.h"
#include "stats/monte_carlo.h"
#include "stats/quantile_curve.h"

namespace ryn {

namespace {

using stats::ResampledQuantile;
using stats::ResampledQuantiles;

constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();

/// Infinite numbers, such as the 10^300-year event of a heavy tail, are none that a page or a plot
/// could show.
double FiniteOrNaN(double value) {
    return std::isfinite(value) ? value : kNaN;
}

void MakeFiniteOrNaN(std::vector<double>& values) {
    std::transform(values.begin(), values.end(), values.begin(), FiniteOrNaN);
}

void MakeFiniteOrNaN(std::vector<ResampledQuantile>& quantiles) {
    for (ResampledQuantile& quantile : quantiles)
        for (double ResampledQuantile::*const member :
             {&ResampledQuantile::estimate, &ResampledQuantile::average,
              &ResampledQuantile::standardDeviation, &ResampledQuantile::bias,
              &ResampledQuantile::lower, &ResampledQuantile::upper})
            quantile.*member = FiniteOrNaN(quantile.*member);
}

// In time order: all but the last depend on it.
void RunTests(const EngineInput& input, SeriesResults& series) {
    if (input.tests.run)
        series.run = stats::RunTestOf(input.values);
    if (input.tests.trend)
        series.trend = stats::TrendTestOf(input.values);
    if (input.tests.shift)
        series.shift = stats::ShiftTestOf(input.values, input.sampleNumbers);
}

// Equal values in the order in which they were observed.
void Sort(const EngineInput& input, SeriesResults& series) {
    series.places.resize(input.values.size());
    std::iota(series.places.begin(), series.places.end(), std::size_t{1});
    std::stable_sort(series.places.begin(), series.places.end(), [&](std::size_t a, std::size_t b) {
        return input.values[a - 1] < input.values[b - 1];
    });
    for (const std::size_t place : series.places)
        series.ascending.push_back(input.values[place - 1]);
}

// One longer than all time has an event only where the distribution has an upper bound, and one
// that is no number has none.
void FindEvents(const EngineInput& input, SeriesResults& series) {
    for (const double period : input.periods) {
        const double exceedance =
            std::isfinite(period) ? stats::ExceedanceOfPeriod(period, input.frame, input.meaning)
                                  : kNaN;
        series.exceedances.push_back(exceedance);
        series.periods.push_back(std::isnan(exceedance) ? kNaN : period);
    }
}

// The curves go beyond it; a period without an event must not stretch them.
double LongestPeriod(const SeriesResults& series) {
    double longest = 0;
    for (const double period : series.periods)
        longest = std::fmax(longest, period); // passes over NaN
    return longest;
}

ResampledQuantile EstimateAlone(double estimate) {
    return {estimate, kNaN, kNaN, kNaN};
}

// The counts of resamples stay 0, by which warnings and report know that there were none.
ResampledQuantiles EstimatesAlone(const stats::Distribution& fitted, const SeriesResults& series) {
    ResampledQuantiles quantiles;
    for (const double exceedance : series.exceedances)
        quantiles.atPeriods.push_back(
            EstimateAlone(stats::QuantileOfExceedance(fitted, exceedance)));
    for (const double probability : series.curveProbabilities)
        quantiles.atProbabilities.push_back(EstimateAlone(stats::Quantile(fitted, probability)));
    return quantiles;
}

// Sorted once for all combinations.
stats::FitInput Ascending(const EngineInput& input, const SeriesResults& series) {
    return {series.ascending, input.frame, stats::ValueOrder::Ascending};
}

// In one pass for table and curves: the resamples are the same, and refitting them is nearly all of
// the time.
ResampledQuantiles Quantiles(const EngineInput& input, const SeriesResults& series,
                             const stats::Combination& combination,
                             const stats::Distribution& fitted) {
    const stats::QuantileRequests requests{series.periods, input.meaning,
                                           series.curveProbabilities};
    switch (input.uncertainty) {
    case UncertaintyMethod::MonteCarlo:
        return stats::MonteCarlo({combination, fitted, input.values.size(), input.frame}, requests);
    case UncertaintyMethod::Jackknife:
        return stats::Jackknife(combination, fitted, Ascending(input, series), requests);
    case UncertaintyMethod::None:
        break;
    }
    return EstimatesAlone(fitted, series);
}

// The log-likelihood comes with the fit and costs nothing; it is written where it was asked for.
FitMeasures Measures(const FitMeasureRequests& asked, const SeriesResults& series,
                     const stats::FittedModel& model, const stats::ProbabilityPlot& plot) {
    const stats::Distribution& fitted = model.distribution;
    FitMeasures measures;
    if (asked.chiSquared)
        measures.chiSquared = stats::ChiSquaredTestOf(fitted, series.ascending);
    if (asked.kolmogorovSmirnov)
        measures.kolmogorovSmirnov = stats::KolmogorovSmirnovTestOf(fitted, series.ascending);
    if (asked.leastSquares)
        measures.leastSquares = stats::LeastSquaresCriterionOf(fitted, plot);
    if (asked.correlation)
        measures.correlation = stats::PlotCorrelation(plot);
    if (asked.reducedCorrelation)
        measures.reducedCorrelation = stats::ReducedPlotCorrelation(fitted, plot);
    measures.logLikelihood = model.logLikelihood;
    return measures;
}

// Everything that follows from a fit that stands.
void Evaluate(const EngineInput& input, const SeriesResults& series,
              const stats::Combination& combination, CombinationAnalysis& analysis) {
    CombinationResults& results = analysis.results;
    const stats::FittedModel& model = *results.fit;
    const stats::Distribution& fitted = model.distribution;
    analysis.plot = stats::ProbabilityPlotOf(fitted, series.ascending, input.plotting);
    results.measures = Measures(input.measures, series, model, analysis.plot);
    results.intervalDensities = stats::IntervalDensities(fitted, series.histogram);
    results.densityCurve =
        stats::DensityCurve(fitted, series.curveAbscissae, series.histogram.step);
    results.quantiles = Quantiles(input, series, combination, fitted);
    MakeFiniteOrNaN(results.intervalDensities);
    MakeFiniteOrNaN(results.densityCurve);
    MakeFiniteOrNaN(results.quantiles.atPeriods);
    MakeFiniteOrNaN(results.quantiles.atProbabilities);
}

// Full lists and no short ones: what is read by position in one combination must stand at the same
// position in all.
void FillWithNaN(const SeriesResults& series, CombinationResults& results) {
    FitMeasures& measures = results.measures;
    measures.chiSquared.statistic = measures.chiSquared.level = kNaN;
    measures.kolmogorovSmirnov.statistic = measures.kolmogorovSmirnov.level = kNaN;
    measures.leastSquares = {kNaN, kNaN, kNaN};
    measures.correlation = measures.reducedCorrelation = measures.logLikelihood = kNaN;
    results.intervalDensities.assign(series.histogram.counts.size(), kNaN);
    results.densityCurve.assign(series.curveAbscissae.size(), kNaN);
    results.quantiles.atPeriods.assign(series.periods.size(), EstimateAlone(kNaN));
    results.quantiles.atProbabilities.assign(series.curveProbabilities.size(), EstimateAlone(kNaN));
}

} // namespace

std::optional<SeriesResults> AnalyseSeries(const EngineInput& input) {
    auto histogram = stats::HistogramOf(input.values, input.frame);
    if (!histogram)
        return std::nullopt;
    SeriesResults series;
    series.histogram = std::move(*histogram);
    series.statistics = stats::SampleStatisticsOf(input.values);
    Sort(input, series);
    RunTests(input, series);
    FindEvents(input, series);
    series.curveAbscissae = stats::DensityCurveAbscissae(series.histogram, input.frame.kind);
    // Common to all combinations, so that their curves can be compared point by point.
    series.curveProbabilities = stats::QuantileCurveProbabilities(
        {input.values.size(), LongestPeriod(series), input.frame});
    return series;
}

CombinationAnalysis AnalyseCombination(const EngineInput& input, const SeriesResults& series,
                                       const NamedCombination& combination) {
    const stats::Combination& asked = combination.combination;
    CombinationAnalysis analysis{{combination.name,
                                  stats::EstimatedSymbols(asked, input.frame.kind),
                                  stats::Fit(asked, Ascending(input, series)),
                                  {},
                                  {},
                                  {},
                                  {}},
                                 {}};
    if (analysis.results.fit)
        Evaluate(input, series, asked, analysis);
    else
        FillWithNaN(series, analysis.results);
    return analysis;
}

} // namespace ryn
