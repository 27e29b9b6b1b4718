#pragma once

#include "stats/exponential.h"
#include "stats/fit_outcome.h"
#include "stats/sample_statistics.h"

namespace ryn::stats {

/// Above `threshold`: alpha = mean exceedance, by moments, L-moments and maximum likelihood alike
/// (Shane and Lynn 1964). Fails: MeanExceedanceNotPositive.
Outcome<Exponential> ExponentialAbove(double threshold, double meanOfValues);

/// alpha = s, xi = m - s. Fails: InvalidParameters.
Outcome<Exponential> ExponentialFromMoments(const CentralMoments& moments);

/// alpha = 2 l2, xi = l1 - alpha (Hosking 1990). Fails: InvalidParameters.
Outcome<Exponential> ExponentialFromLMoments(const LMoments& moments);

} // namespace ryn::stats
