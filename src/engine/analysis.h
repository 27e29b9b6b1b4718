#pragma once

#include <cstddef>
#include <optional>
#include <string>
#include <vector>

#include "engine/engine_input.h"
#include "stats/fit.h"
#include "stats/goodness_of_fit.h"
#include "stats/histogram.h"
#include "stats/homogeneity_tests.h"
#include "stats/probability_plot.h"
#include "stats/resampled_quantiles.h"
#include "stats/sample_statistics.h"

namespace ryn {

/// What is found of the series alone, and what all combinations share.
struct SeriesResults {
    stats::SampleStatistics statistics;
    std::optional<stats::RunTest> run; ///< where asked for; its score says whether it was made
    std::optional<stats::TrendTest> trend;
    std::optional<stats::ShiftTest> shift;
    stats::Histogram histogram;
    std::vector<double> ascending;   ///< the values
    std::vector<std::size_t> places; ///< in the series, from 1, of each of them
    /// The return periods asked for, with NaN in the place of one that has no event: not finite, or
    /// no longer than the shortest, which an event recurs in for certain.
    std::vector<double> periods;
    std::vector<double> exceedances;    ///< probability of each period's event within the series
    std::vector<double> curveAbscissae; ///< of the density curves, in the unit of the values
    std::vector<double> curveProbabilities; ///< non-exceedance, of the quantile curves
};

/// Nothing where the values are too close together for a histogram. `input` has no SeriesFaults.
std::optional<SeriesResults> AnalyseSeries(const EngineInput& input);

/// Measures of one fit; only those asked for mean something, and all are NaN where the fit failed.
struct FitMeasures {
    stats::ChiSquaredTest chiSquared;
    stats::KolmogorovSmirnovTest kolmogorovSmirnov;
    stats::LeastSquaresCriterion leastSquares;
    double correlation = 0;
    double reducedCorrelation = 0;
    double logLikelihood = 0;
};

/// What is found of one combination. Lists have their full length whatever happened: where the fit
/// failed, or a number is not finite, they hold NaN.
struct CombinationResults {
    std::string name;
    stats::SymbolList symbols; ///< of the parameters, known without a fit
    stats::FitResult fit;
    FitMeasures measures;
    std::vector<double> intervalDensities; ///< for each interval of the histogram
    std::vector<double> densityCurve;      ///< at SeriesResults::curveAbscissae
    stats::ResampledQuantiles quantiles;   ///< at the periods and the curve's probabilities
};

/// One combination with its observations beside the fitted quantiles, which only the report wants:
/// as long as the series, and not kept.
struct CombinationAnalysis {
    CombinationResults results;
    stats::ProbabilityPlot plot; ///< empty where the fit failed
};

CombinationAnalysis AnalyseCombination(const EngineInput& input, const SeriesResults& series,
                                       const NamedCombination& combination);

} // namespace ryn
