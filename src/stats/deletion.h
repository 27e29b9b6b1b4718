#pragma once

#include "stats/sample_statistics.h"

#include <cstddef>
#include <span>
#include <vector>

namespace ryn::stats {

// A sample without one of its values, for the jackknife. `index` counts the values of an ascending
// sample from 0. The sample stays the caller's and must live as long.
//
// The closed forms take the deleted value out of sums over the whole sample. Where that value is
// most of such a sum, little but rounding would be left of it: then the rest is gone through
// instead. In a sample of five and more that can happen for one value only, so that the cost of all
// deletions together stays proportional to the sample.

/// Central moments after a deletion. Exact but for rounding; a spread of 0 is exactly 0.
class MomentDeletions {
  public:
    explicit MomentDeletions(std::span<const double> ascending);

    CentralMoments Without(std::size_t index) const;

  private:
    std::span<const double> sorted;
    double center = 0;
    double spread = 0; ///< m2 of the whole sample
    double a1 = 0;     ///< sums of the first to fourth powers of the deviations from `center`
    double a2 = 0;
    double a3 = 0;
    double a4 = 0;
};

/// L-moments after a deletion, likewise.
class LMomentDeletions {
  public:
    explicit LMomentDeletions(std::span<const double> ascending);

    LMoments Without(std::size_t index) const;

  private:
    /// Sums over the values above an index, with the weights by which their ranks enter b1 to b3:
    /// what the deletion takes from each as the rank falls by one.
    struct Above {
        double b1 = 0;
        double b2 = 0;
        double b3 = 0;
    };

    /// From the sums alone, of deviations from `center`.
    LMoments InClosedForm(std::size_t index) const;

    std::span<const double> sorted;
    double center = 0;
    double spread = 0; ///< l2 of the whole sample
    double a0 = 0;     ///< sums of the deviations, weighted as in b0 to b3
    double a1 = 0;
    double a2 = 0;
    double a3 = 0;
    std::vector<Above> above;
};

/// The values that remain, ascending, for estimators that need them all.
class ShortenedSample {
  public:
    explicit ShortenedSample(std::span<const double> ascending);

    /// Valid until the next call. Costs as many steps as `index` is away from the last one.
    std::span<const double> Without(std::size_t index);

  private:
    std::span<const double> sorted;
    std::vector<double> rest;
    std::size_t deleted = 0;
};

} // namespace ryn::stats
