#pragma once

#include <cmath>
#include <limits>

namespace ryn::stats {

/// Whether an end of an interval belongs to it.
enum class End { Included, Excluded };

/// The range of values that a distribution can take. Infinite ends are never part of it.
struct Interval {
    double lower = -std::numeric_limits<double>::infinity();
    double upper = std::numeric_limits<double>::infinity();
    End lowerEnd = End::Included;
    End upperEnd = End::Included;

    /// False for NaN and for the infinities.
    bool Contains(double x) const {
        const bool aboveLower = lowerEnd == End::Included ? x >= lower : x > lower;
        const bool belowUpper = upperEnd == End::Included ? x <= upper : x < upper;
        return aboveLower && belowUpper && std::isfinite(x);
    }
};

} // namespace ryn::stats
