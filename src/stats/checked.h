#pragma once

#include "stats/fit_outcome.h"
#include "stats/parameter.h"

#include <cmath>
#include <optional>

namespace ryn::stats {

/// Whether a distribution's scale has all its digits. Values next to the smallest of all doubles
/// can leave one with a few bits, which are no estimate.
template <class D>
bool HasFullScale(const D& distribution) {
    for (const Parameter& parameter : distribution.Parameters()) {
        if (parameter.symbol == "alpha" && !std::isnormal(parameter.value)) {
            return false;
        }
    }
    return true;
}

/// The check after every estimation: what a distribution's Make refuses is InvalidParameters.
template <class D>
Outcome<D> Checked(const std::optional<D>& made) {
    if (made && HasFullScale(*made)) {
        return *made;
    }
    return FitFailure{FitFault::InvalidParameters};
}

/// Failure C06 with its number.
inline FitFailure SkewnessOutOfRange(double skewness) {
    return {FitFault::SkewnessOutOfRange, {skewness, 0}};
}

/// Whether a distribution can have this L-skewness. A sample of equal values but one has exactly 1,
/// and rounding makes a little less of it.
inline bool IsLSkewness(double lSkewness) {
    return std::fabs(lSkewness) < 1 - 1e-12;
}

/// Whether a variable that takes no negative values can have this L-Cv. Exceedances that are 0 but
/// for one have exactly 1, likewise.
inline bool IsLCv(double lCv) {
    return lCv > 0 && lCv < 1 - 1e-12;
}

/// Failure C08 with its numbers: L-Cv and L-skewness of the sample.
inline FitFailure LMomentsOutOfRange(double lCv, double lSkewness) {
    return {FitFault::LMomentsOutOfRange, {lCv, lSkewness}};
}

} // namespace ryn::stats
