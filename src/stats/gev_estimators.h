#pragma once

#include "stats/fit_outcome.h"
#include "stats/gev.h"
#include "stats/sample_statistics.h"

namespace ryn::stats {

/// kappa from the sample skewness G1, then alpha and xi from s and the mean (Stedinger et al.
/// 1993). kappa lies between -1/3, where the skewness is infinite, and 10.
/// Fails: SkewnessOutOfRange, InvalidParameters.
Outcome<Gev> GevFromMoments(const CentralMoments& moments);

/// Hosking, Wallis and Wood (1985); Hosking and Wallis (1997). kappa lies between -0.999999 and
/// 50. Fails: LMomentsOutOfRange, InvalidParameters.
Outcome<Gev> GevFromLMoments(const LMoments& moments);

} // namespace ryn::stats
