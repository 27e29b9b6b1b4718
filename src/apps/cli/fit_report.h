#pragma once

#include <iosfwd>
#include <optional>
#include <string>
#include <vector>

#include "apps/cli/fit_task.h"
#include "apps/cli/json_output.h"
#include "stats/fit.h"
#include "stats/goodness_of_fit.h"
#include "stats/resampled_quantiles.h"

namespace ryn::cli {

/// Measures of one fit. A number that there is none of is NaN.
struct FitGoodness {
    stats::ChiSquaredTest chiSquared;
    stats::KolmogorovSmirnovTest kolmogorovSmirnov;
    double leastSquares = 0.0;       ///< SLSC
    double correlation = 0.0;        ///< PPCC I
    double reducedCorrelation = 0.0; ///< PPCC II
    double akaike = 0.0;             ///< 2 p - 2 log-likelihood
};

/// What a fit came to. The lists are empty where it failed.
struct FitReport {
    std::string name;
    std::size_t count = 0;
    std::string unit;    ///< of the values; empty where none is known
    std::string failure; ///< empty: fitted
    FitUncertainty uncertainty = FitUncertainty::None;
    stats::PlottingMethod plotting = stats::PlottingMethod::Weibull;
    bool sampleCorrection = false;
    std::optional<stats::FittedModel> model;
    std::vector<double> periods;         ///< years
    std::vector<double> exceedances;     ///< probability that an event of the series exceeds it
    stats::ResampledQuantiles quantiles; ///< at the periods
    std::optional<FitGoodness> goodness;
};

/// Members: name, n, unit, failed (null or the reason), parameters (symbol, estimate),
/// logLikelihood, quantiles (period, probability of exceedance, estimate, average,
/// standardDeviation, bias; the last three are null without uncertainty), goodness, uncertainty
/// (method, resamples, failed), sampleCorrection.
Json JsonOfFit(const FitReport& report);

/// A heading, parameters, goodness of fit and quantiles; of a failure the reason.
void PrintFit(std::ostream& out, const FitReport& report);

/// Decimals that show a value with so many significant digits; 0 to 12.
int DecimalsFor(double value, int significantDigits);

} // namespace ryn::cli
