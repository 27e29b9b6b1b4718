#pragma once

#include "stats/resampled_quantiles.h"

#include <cstddef>
#include <vector>

namespace ryn::stats {

/// Mean and sum of squared deviations of weighted values, updated by each value (Welford 1962; West
/// 1979): nothing is stored, and nothing cancels.
struct Spread {
    double count = 0; ///< sum of weights
    double mean = 0;
    double squares = 0; ///< sum of weight (value - mean)^2

    /// A value that is not finite is left out.
    void Add(double value, double weight);
};

/// Whether resampled quantiles at return periods are stored, which a percentile interval needs and
/// mean and deviation do not.
enum class Replicates { Dropped, Kept };

/// The quantiles of many resamples of one series, each held as its difference to the estimate of
/// the full sample: a bias far smaller than the quantile keeps its digits.
class QuantileTally {
  public:
    /// Keeps `requests`, whose lists must live as long.
    QuantileTally(const Distribution& fitted, const SeriesFrame& frame,
                  const QuantileRequests& requests, Replicates replicates);

    /// A resample that stands for `weight` equal ones, with the rate that belongs to it.
    void Add(const Distribution& resample, const SeriesFrame& frame, std::size_t weight);

    /// What a method makes of the differences; the estimate is there already.
    using Summary = void (*)(ResampledQuantile& quantile, const Spread& differences);

    /// NaN instead of the summary for quantiles with fewer than `needed` resamples, at least one.
    /// Brings the replicates out of their order.
    ResampledQuantiles Results(std::size_t asked, std::size_t needed, Summary summary);

  private:
    struct Entry {
        double estimate;
        Spread differences;
        std::vector<double> replicates; ///< each of weight 1
    };

    static std::vector<ResampledQuantile> Summarised(std::vector<Entry>& entries,
                                                     std::size_t needed, Summary summary);

    QuantileRequests requests;
    Replicates policy;
    std::vector<Entry> atPeriods;
    std::vector<Entry> atProbabilities;
    std::size_t kept = 0;
};

} // namespace ryn::stats
