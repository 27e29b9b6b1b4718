#pragma once

#include "stats/combination.h"
#include "stats/distribution.h"
#include "stats/estimate.h"
#include "stats/fit_outcome.h"

namespace ryn::stats {

/// A distribution fitted to a sample.
struct FittedModel {
    Distribution distribution;
    /// The estimated parameters, in the order in which results list them; their number is p.
    ParameterList parameters;
    WarningList warnings;
    /// sum ln f(x), of the conditional density for a partial duration series. NaN when a value
    /// lies outside the support or the sum is not finite.
    double logLikelihood = 0;
};

using FitResult = Outcome<FittedModel>;

/// Fits `combination` to a sample: checks the rules, estimates, and holds the estimate against the
/// values. Up to a quarter of the values may lie outside the support (warning W1: moments and
/// L-moments often put a few small values below the estimated lower bound); more are a failure.
///
/// In a partial duration series a value below the threshold by no more than
/// 1e-6 max(1, |threshold|) counts as equal to it, since values that were stored with seven digits
/// fall short of a threshold that was not.
///
/// Permuting the values changes no bit of the result.
FitResult Fit(const Combination& combination, const FitInput& input, FitScratch& scratch);

/// The same without buffers to keep.
FitResult Fit(const Combination& combination, const FitInput& input);

} // namespace ryn::stats
