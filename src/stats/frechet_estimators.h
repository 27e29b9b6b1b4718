#pragma once

#include "stats/fit_outcome.h"
#include "stats/frechet.h"
#include "stats/sample_statistics.h"

namespace ryn::stats {

/// kappa > 2 from the coefficient of variation, alpha from the mean (Rao and Hamed 2000). The
/// sample is expected to hold positive values only.
/// Fails: ValuesNotPositive (mean), NoConvergence (coefficient of variation below 1.3e-9).
Outcome<Frechet> FrechetFromMoments(const CentralMoments& moments);

} // namespace ryn::stats
