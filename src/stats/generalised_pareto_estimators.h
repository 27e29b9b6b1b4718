#pragma once

#include "stats/fit_outcome.h"
#include "stats/generalised_pareto.h"
#include "stats/sample_statistics.h"

namespace ryn::stats {

/// Three parameters: kappa from the sample skewness, between -1/3 and 100 (Hosking and Wallis
/// 1987; Stedinger et al. 1993). Fails: SkewnessOutOfRange, InvalidParameters.
Outcome<GeneralisedPareto> ParetoFromMoments(const CentralMoments& moments);

/// Three parameters in closed form (Hosking and Wallis 1997).
/// Fails: LMomentsOutOfRange, InvalidParameters.
Outcome<GeneralisedPareto> ParetoFromLMoments(const LMoments& moments);

/// Two parameters above `threshold` (Hosking and Wallis 1987).
/// Fails: MeanExceedanceNotPositive, InvalidParameters.
Outcome<GeneralisedPareto> ParetoAboveFromMoments(double threshold, const CentralMoments& moments);

/// Two parameters above `threshold` (Hosking and Wallis 1987).
/// Fails: MeanExceedanceNotPositive, LMomentsOutOfRange, InvalidParameters.
Outcome<GeneralisedPareto> ParetoAboveFromLMoments(double threshold, const LMoments& moments);

} // namespace ryn::stats
