#pragma once

#include <array>
#include <span>
#include <string_view>

#include "selfcheck/named_combination.h"
#include "selfcheck/reference_series.h"

namespace ryn::selfcheck {

/// A published fit, to seven significant digits.
struct FitCase {
    std::string_view number;
    SeriesId series;
    NamedCombination subject;
    std::array<std::string_view, 3> parameters; ///< in the order of results; may be fewer
    std::array<std::string_view, 3> quantiles;  ///< of 10, 50 and 100 years
    std::string_view logLikelihood;             ///< "none": a value lies outside the support
    std::string_view source;
};

std::span<const FitCase> AnnualMaximumFits();
std::span<const FitCase> PartialDurationFits();

} // namespace ryn::selfcheck
