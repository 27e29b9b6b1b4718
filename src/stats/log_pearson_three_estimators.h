#pragma once

#include "stats/fit_outcome.h"
#include "stats/log_pearson_three.h"
#include "stats/sample_statistics.h"

namespace ryn::stats {

// The sample is expected to hold positive values only.

/// In log space (Bulletin 17B, IACWD 1982, with the station skew): the moments of Pearson 3 on
/// those of ln x. Fails: InvalidParameters.
Outcome<LogPearsonThree> LogPearsonThreeFromLogMoments(const CentralMoments& ofLogarithms);

/// The L-moments of Pearson 3 on those of ln x. Fails: LMomentsOutOfRange, InvalidParameters.
Outcome<LogPearsonThree> LogPearsonThreeFromLogLMoments(const LMoments& ofLogarithms);

/// In real space (Bobee 1975; Kite 1977): from the first three moments of x itself, with alpha
/// between -1000 and 1/3. Fails: ValuesNotPositive (mean), SkewnessOutOfRange, InvalidParameters.
Outcome<LogPearsonThree> LogPearsonThreeFromMoments(const CentralMoments& moments);

} // namespace ryn::stats
