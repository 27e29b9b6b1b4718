#pragma once

#include "stats/combination.h"
#include "stats/distribution.h"

#include <cstddef>
#include <optional>
#include <span>
#include <vector>

namespace ryn::stats {

/// Equal intervals over a sample. Bars are densities, so that they share an axis with the density
/// curves: their areas add up to 1.
struct Histogram {
    double start = 0;                ///< lower end of the first interval, in the unit of the values
    double step = 0;                 ///< width, 1, 2, 2.5 or 5 times a power of ten; > 0
    std::vector<std::size_t> counts; ///< values in each interval; at least one interval
    std::vector<double> densities;   ///< counts over (n step), in one over the unit of the values

    /// Lower end of interval `index` (from 0), and the upper end of the last for its number.
    double Bound(std::size_t index) const { return start + static_cast<double>(index) * step; }
};

/// As many intervals as Sturges (1926) has, widened to a round width; the first begins at a
/// multiple of the width, or at the threshold of a partial duration series. Where the threshold
/// lies so far below the values that there would be more than a thousand intervals, these begin as
/// for annual maxima.
///
/// Nothing for no values, for values that are not finite, and for a spread that has no width: all
/// values equal, or a range at either end of what a double holds.
std::optional<Histogram> HistogramOf(std::span<const double> values, const SeriesFrame& frame);

/// The mean density of `d` over each interval, (F(upper) - F(lower))/step: what the fitted
/// distribution expects of the bars.
std::vector<double> IntervalDensities(const Distribution& d, const Histogram& histogram);

/// 201 equidistant abscissae for the density curves of all combinations, from one interval before
/// the histogram (partial durations: from its start) to one after it.
std::vector<double> DensityCurveAbscissae(const Histogram& histogram, SeriesKind kind);

/// f at each abscissa. Where f is infinite or above 1e6/step, as beside a pole at an end of the
/// support, it is taken 0.005 step further inside and at most 1e6/step, so that a curve can be
/// drawn. `step` is the histogram's.
std::vector<double> DensityCurve(const Distribution& d, std::span<const double> abscissae,
                                 double step);

} // namespace ryn::stats
