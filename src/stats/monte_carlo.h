#pragma once

#include "stats/combination.h"
#include "stats/distribution.h"
#include "stats/resampled_quantiles.h"

#include <cstddef>
#include <cstdint>

namespace ryn::stats {

/// The size of the samples drawn for a partial duration series: it varies as the number of events
/// in a record does, or is that of the full sample. For annual maxima it is always the latter.
enum class EventCount { Poisson, Fixed };

/// The results depend on these alone: each call begins the sequence anew, so that neither the other
/// combinations nor the number of workers shows in them.
struct MonteCarloSettings {
    std::size_t samples = 1000; ///< B
    std::uint64_t seed = 12345;
    EventCount events = EventCount::Poisson;
};

/// What samples are drawn from and how they are fitted.
struct MonteCarloSubject {
    Combination combination;
    Distribution fitted;   ///< by that combination, to the full sample
    std::size_t count = 0; ///< size n of the full sample
    SeriesFrame frame;     ///< of the full sample
};

/// Parametric bootstrap (Efron and Tibshirani 1993): B samples drawn from the fitted distribution,
/// each fitted in the same way. Average and standard deviation (divisor B' - 1) are those of the B'
/// quantiles kept, the bias is average less estimate.
///
/// The samples of a partial duration series are of Poisson size with mean n, but large enough to be
/// fitted, and the rate goes along (Rosbjerg 1985; Madsen et al. 1997); it enters the quantiles at
/// return periods and not those at fixed probabilities.
///
/// A sample that cannot be fitted is dropped (values outside the support of its own fit do not
/// count as such), and for a single quantile one where its period has no event or the quantile is
/// not finite. With B' < 0.8 B there is no average and no deviation.
ResampledQuantiles MonteCarlo(const MonteCarloSubject& subject, const QuantileRequests& requests,
                              const MonteCarloSettings& settings = {});

} // namespace ryn::stats
