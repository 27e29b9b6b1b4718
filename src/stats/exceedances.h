#pragma once

#include "stats/fit_outcome.h"

#include <span>
#include <vector>

namespace ryn::stats {

/// Whether values equal to the threshold, which have no logarithm as exceedances, stay in a sample.
enum class ZeroExceedances { Kept, LeftOut };

/// Exceedances of a threshold in units of their mean.
struct Exceedances {
    std::span<const double> values; ///< none negative, mean 1; in the buffer that was given
    double largest = 0;
    double mean = 0; ///< the unit
};

/// What rounding left below the threshold counts as equal to it. Leaves out at most a tenth of the
/// values. Fails: MeanExceedanceNotPositive, ValuesAtThreshold, InvalidParameters (not finite).
Outcome<Exceedances> ExceedancesOf(std::span<const double> values, double threshold,
                                   ZeroExceedances zeros, std::vector<double>& buffer);

} // namespace ryn::stats
