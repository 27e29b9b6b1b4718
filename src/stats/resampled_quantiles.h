#pragma once

#include "stats/return_period.h"

#include <cstddef>
#include <limits>
#include <span>
#include <vector>

namespace ryn::stats {

/// The quantiles whose uncertainty is asked for, all evaluated in one pass over the resamples.
struct QuantileRequests {
    std::span<const double> periods = {}; ///< return periods in years; stay the caller's
    PeriodMeaning meaning = PeriodMeaning::OfEvent;
    std::span<const double> probabilities = {}; ///< non-exceedance F of an event; stay the caller's
};

/// One of them. All but the estimate are NaN where too few resamples have this quantile; all are
/// where the period has none.
struct ResampledQuantile {
    double estimate = 0; ///< of the full sample
    double average = 0;  ///< mean of the resamples (Monte Carlo), or corrected for bias (jackknife)
    double standardDeviation = 0;
    double bias = 0; ///< of the estimate, as the resamples show it
    /// Ends of the 95 % percentile interval (Efron and Tibshirani 1993), which follows the skewness
    /// that estimate and deviation cannot show. Only of Monte Carlo and only at return periods.
    double lower = std::numeric_limits<double>::quiet_NaN();
    double upper = std::numeric_limits<double>::quiet_NaN();
    /// Resamples that have this quantile. Monte Carlo samples of few events a year have none at a
    /// short return period.
    std::size_t used = 0;
};

/// The outcome of a Monte Carlo or jackknife pass.
struct ResampledQuantiles {
    std::vector<ResampledQuantile> atPeriods;       ///< one for each period, in their order
    std::vector<ResampledQuantile> atProbabilities; ///< one for each probability
    std::size_t asked = 0;  ///< resamples: B of Monte Carlo, n of the jackknife
    std::size_t kept = 0;   ///< those that could be fitted
    std::size_t needed = 0; ///< with fewer than these a quantile has no uncertainty

    std::size_t Failed() const { return asked - kept; }
};

} // namespace ryn::stats
