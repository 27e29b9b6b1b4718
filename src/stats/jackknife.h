#pragma once

#include "stats/combination.h"
#include "stats/distribution.h"
#include "stats/estimate.h"
#include "stats/resampled_quantiles.h"

namespace ryn::stats {

/// Jackknife (Quenouille 1956; Tukey 1958; Miller 1974): the sample without each of its n values in
/// turn, fitted in the same way as `fitted` was to the full sample. With the n quantiles est_i,
/// their mean bar and the estimate est of the full sample
///
///     average             n est - (n - 1) bar
///     standard deviation  sqrt((n - 1)/n sum (est_i - bar)^2)
///     bias                (n - 1) (bar - est)
///
/// The rate of a partial duration series stays as it is. Deletions that cannot be fitted are left
/// out, and the number of the others takes the place of n (values outside the support of the fit do
/// not count as such); the same for a quantile that is not finite. With fewer than 0.9 n there is
/// no average and no deviation; so it is for the smallest sample that can be fitted at all.
///
/// Takes memory in proportion to n. Moments and L-moments follow a deletion in closed form, so that
/// the time is proportional to n as well, but for one sort; other estimators are run again on each
/// shortened sample.
ResampledQuantiles Jackknife(const Combination& combination, const Distribution& fitted,
                             const FitInput& input, const QuantileRequests& requests);

} // namespace ryn::stats
