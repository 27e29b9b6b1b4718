#pragma once

#include "stats/combination.h"
#include "stats/distribution.h"
#include "stats/fit_outcome.h"
#include "stats/gumbel_estimators.h"
#include "stats/likelihood_estimators.h"
#include "stats/sample_statistics.h"

#include <span>
#include <vector>

namespace ryn::stats {

/// Whether the values of a sample are known to ascend; it spares the L-moments their sorted copy.
enum class ValueOrder { AsObserved, Ascending };

/// A sample to fit.
struct FitInput {
    std::span<const double> values; ///< finite; stays the caller's
    SeriesFrame frame;
    ValueOrder order = ValueOrder::AsObserved;
};

/// An estimated distribution, not yet held against the sample.
struct Estimate {
    Distribution distribution;
    WarningList warnings;
};

/// What refits by the thousand keep between calls: buffers, and constants that depend on the
/// sample size alone. Never shows in a result; one for each thread.
struct FitScratch {
    std::vector<double> sorted;
    std::vector<double> logarithms;
    GumbelConstants gumbel;
    LikelihoodBuffer likelihood;
};

/// What an estimator needs to know of a sample. Moments and L-moments, of the values or of their
/// natural logarithms, follow the deletion of a value in closed form, so that the jackknife need
/// not go through the sample again.
enum class EstimationBasis { Moments, LMoments, LogMoments, LogLMoments, Values };

EstimationBasis BasisOf(const Combination& combination);

/// Estimates the parameters and checks nothing but the parameters: the step that resampling
/// repeats, since there an estimate that leaves values outside its support still counts.
/// Failures: DistributionNotOffered, MethodNotOffered, TooFewValues, those of the
/// method, InvalidParameters.
Outcome<Estimate> EstimateParameters(const Combination& combination, const FitInput& input,
                                     FitScratch& scratch);

/// The same from moments that the caller has, as when a value is deleted from the sums in closed
/// form: those of the values or of their logarithms, as the basis says. Whether all values are
/// positive where they must be, the caller knows. Fails as MethodNotOffered for a combination with
/// another basis.
Outcome<Estimate> EstimateFromMoments(const Combination& combination, const SeriesFrame& frame,
                                      const CentralMoments& moments, FitScratch& scratch);

/// The same from L-moments, likewise.
Outcome<Estimate> EstimateFromLMoments(const Combination& combination, const SeriesFrame& frame,
                                       const LMoments& moments);

} // namespace ryn::stats
