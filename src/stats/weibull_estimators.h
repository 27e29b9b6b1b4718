#pragma once

#include "stats/fit_outcome.h"
#include "stats/sample_statistics.h"
#include "stats/weibull.h"

namespace ryn::stats {

/// Three parameters: 1/kappa from the sample skewness, between 1e-8 and 10 (Rao and Hamed 2000).
/// Fails: SkewnessOutOfRange (from -1.1395 down), InvalidParameters.
Outcome<Weibull> WeibullFromMoments(const CentralMoments& moments);

/// Three parameters: 1/kappa from the L-skewness, between 1e-9 and 100 (Hosking and Wallis 1997).
/// Fails: LMomentsOutOfRange (L-skewness from -0.1699 down), InvalidParameters.
Outcome<Weibull> WeibullFromLMoments(const LMoments& moments);

/// Two parameters above `threshold`: 1/kappa from the coefficient of variation of the exceedances,
/// between 1e-8 and 100 (Rao and Hamed 2000).
/// Fails: MeanExceedanceNotPositive, NoConvergence, InvalidParameters.
Outcome<Weibull> WeibullAboveFromMoments(double threshold, const CentralMoments& moments);

/// Two parameters above `threshold`, in closed form from the L-Cv of the exceedances.
/// Fails: MeanExceedanceNotPositive, LMomentsOutOfRange, InvalidParameters.
Outcome<Weibull> WeibullAboveFromLMoments(double threshold, const LMoments& moments);

} // namespace ryn::stats
