#pragma once

#include "stats/fit_outcome.h"

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
inline FitFailure LMomentsOutOfRange(double lCv, double lSkewness) {
    return {FitFault::LMomentsOutOfRange, {lCv, lSkewness}};
}

} // namespace ryn::stats
