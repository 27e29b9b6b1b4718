#pragma once

#include "stats/fit_outcome.h"

#include <cmath>
#include <limits>
#include <optional>

namespace ryn::stats {

/// The check after every estimation: what a distribution's Make refuses is InvalidParameters.
template <class D>
Outcome<D> Checked(const std::optional<D>& made) {
    if (made) {
        return *made;
    }
    return FitFailure{FitFault::InvalidParameters};
}

/// Failure C06 with its number.
inline FitFailure SkewnessOutOfRange(double skewness) {
    return {FitFault::SkewnessOutOfRange, {skewness, 0}};
}

/// Failure C08 with its numbers: L-Cv and L-skewness of the sample.
/// Whether a distribution can have this L-skewness. A sample of equal values but one has exactly 1,
/// and rounding makes a little less of it.
inline bool IsLSkewness(double lSkewness) {
    return std::fabs(lSkewness) < 1 - 1e-12;
}

inline FitFailure LMomentsOutOfRange(double lCv, double lSkewness) {
    return {FitFault::LMomentsOutOfRange, {lCv, lSkewness}};
}

} // namespace ryn::stats
