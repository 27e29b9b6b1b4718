#include "stats/exceedances.h"

#include <algorithm>
#include <cmath>

namespace ryn::stats {

Outcome<Exceedances> ExceedancesOf(std::span<const double> values, double threshold,
                                   ZeroExceedances zeros, std::vector<double>& buffer) {
    // One comparison decides what stays: every exceedance, or every positive one.
    const double least = zeros == ZeroExceedances::Kept ? -1.0 : 0.0;
    buffer.clear();
    double sum = 0;
    double largest = 0;
    for (const double x : values) {
        const double y = x > threshold ? x - threshold : 0.0;
        sum += std::isfinite(x) ? y : x; // NaN and minus infinity compare as if below
        largest = std::max(largest, y);
        if (y > least) {
            buffer.push_back(y);
        }
    }
    const double mean = sum / static_cast<double>(buffer.size());
    // Before the sign of the sum, since a NaN is not positive either.
    if (!std::isfinite(sum)) {
        return FitFailure{FitFault::InvalidParameters};
    }
    if (!(sum > 0)) {
        return FitFailure{FitFault::MeanExceedanceNotPositive};
    }
    if (10 * buffer.size() < 9 * values.size()) {
        return FitFailure{FitFault::ValuesAtThreshold};
    }
    // Divided at the end: the unit is the mean of what stays, so that the mean of the result is 1.
    for (double& y : buffer) {
        y /= mean;
    }
    return Exceedances{buffer, largest / mean, mean};
}

} // namespace ryn::stats
