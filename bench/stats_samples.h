#pragma once

#include "stats/combination.h"

#include <cstddef>
#include <string>
#include <vector>

namespace ryn::stats::bench {

/// A combination under the name that results show, with a kind of series that offers it.
struct NamedCombination {
    std::string name;
    Combination combination;
    SeriesKind kind = SeriesKind::AnnualMaximum;
};

/// "AMS" or "PDS", as benchmarks are named.
std::string KindName(SeriesKind kind);

/// All that annual maxima are offered, without the correction for sample size.
std::vector<NamedCombination> AnnualMaximumCombinations();

/// What partial durations are offered besides: the combinations of equal name and equal estimator
/// in both kinds of series (log-Pearson 3, log-normal) are left to the annual maxima.
std::vector<NamedCombination> PartialDurationCombinations();

/// Both lists.
std::vector<NamedCombination> AllCombinations();

/// Values with the frame that they came in.
struct Sample {
    std::vector<double> values; ///< in time order
    SeriesFrame frame;
};

/// The first `count` values of a real series: annual maximum sea levels at Port Pirie (65 values),
/// or the 152 peaks of a rainfall record of 48 years.
Sample RealSample(SeriesKind kind, std::size_t count);

/// Values drawn from a GEV or generalised Pareto distribution like those of the real series, the
/// same on every machine; a longer sample goes on where a shorter one ends.
Sample DrawnSample(SeriesKind kind, std::size_t count);

} // namespace ryn::stats::bench
