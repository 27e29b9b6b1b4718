#pragma once

#include "stats/combination.h"

#include <cstddef>
#include <vector>

namespace ryn::stats {

/// What the range of the quantile curves depends on.
struct CurveRange {
    std::size_t count = 0;    ///< sample size n
    double longestPeriod = 0; ///< the longest return period asked for, years; 0 for none
    SeriesFrame frame;
};

/// The 100 non-exceedance probabilities of the quantile curves, ascending, all strictly between 0
/// and 1, the same for all combinations of a series: equidistant in the reduced variate of the
/// Gumbel paper, -ln(-ln F), from min(0.01, 0.25/n) to the longest of 1000 years, twice the longest
/// period and ten times the length of the record. For partial durations F is that of an event, and
/// the period T belongs to F = 1 - 1/(rate T).
std::vector<double> QuantileCurveProbabilities(const CurveRange& range);

} // namespace ryn::stats
