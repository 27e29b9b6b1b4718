#include "stats/histogram.h"

#include <algorithm>
#include <cmath>
#include <limits>

namespace ryn::stats {

namespace {

// Values at an end of an interval were often put there by decimal rounding: a hair below counts as
// at it.
constexpr double kHair = 1e-9;
constexpr double kMostIntervals = 1000;

// The smallest round number that is not below `width`.
double RoundedUp(double width) {
    const double decade = std::pow(10, std::floor(std::log10(width)));
    for (const double factor : {1.0, 2.0, 2.5, 5.0}) {
        if (factor * decade >= width * (1 - kHair)) {
            return factor * decade;
        }
    }
    return 10 * decade;
}

// Where the range is more than a double holds, the ends are divided one by one.
double StepFor(double smallest, double largest, std::size_t count) {
    const double intervals = std::ceil(1 + std::log2(static_cast<double>(count)));
    const double range = largest - smallest;
    return RoundedUp(std::isfinite(range) ? range / intervals
                                          : largest / intervals - smallest / intervals);
}

// floor((x - start)/step) with the hair, as a double: it may be negative or huge.
double IntervalOf(double x, double start, double step) {
    return std::floor((x - start) / step + kHair);
}

// A threshold is the natural start, since no peak lies below it; but it may be a number from
// another world than the values, and memory for the intervals between must not be asked for.
double StartFor(double smallest, double largest, double step, const SeriesFrame& frame) {
    if (frame.kind == SeriesKind::PartialDuration &&
        IntervalOf(largest, frame.threshold, step) < kMostIntervals) {
        return frame.threshold;
    }
    return step * IntervalOf(smallest, 0, step);
}

// Rounding may put the largest value one interval too high, and a peak may fall short of the
// threshold by its own rounding.
void Count(std::span<const double> values, Histogram& histogram) {
    const auto last = static_cast<double>(histogram.counts.size() - 1);
    for (const double x : values) {
        const double j = std::clamp(IntervalOf(x, histogram.start, histogram.step), 0.0, last);
        ++histogram.counts[static_cast<std::size_t>(j)];
    }
    const double area = static_cast<double>(values.size()) * histogram.step;
    for (const std::size_t count : histogram.counts) {
        histogram.densities.push_back(static_cast<double>(count) / area);
    }
}

// F(upper) - F(lower), from the tail in which the interval lies: far up both F are 1.
template <Family D>
double Probability(const D& d, double lower, double upper) {
    const double below = Cdf(d, lower);
    return below < 0.5 ? Cdf(d, upper) - below : Survival(d, lower) - Survival(d, upper);
}

// Inwards is upwards but beside an upper end of the support.
template <Family D>
double CurveDensity(const D& d, double x, double step) {
    const double highest = 1e6 / step;
    const double density = Density(d, x);
    if (!(density > highest)) {
        return density;
    }
    const double inside = x + 0.005 * step;
    const double shifted = inside < d.Support().upper ? inside : x - 0.005 * step;
    return std::min(Density(d, shifted), highest);
}

} // namespace

std::optional<Histogram> HistogramOf(std::span<const double> values, const SeriesFrame& frame) {
    if (!std::all_of(values.begin(), values.end(), [](double x) { return std::isfinite(x); }) ||
        values.empty()) {
        return std::nullopt;
    }
    const auto [smallest, largest] = std::minmax_element(values.begin(), values.end());
    if (*smallest == *largest) {
        return std::nullopt;
    }
    Histogram histogram;
    histogram.step = StepFor(*smallest, *largest, values.size());
    if (!(histogram.step >= std::numeric_limits<double>::min())) {
        return std::nullopt;
    }
    // A start or an interval that overflowed leaves nothing to draw.
    histogram.start = StartFor(*smallest, *largest, histogram.step, frame);
    const double last = std::max(0.0, IntervalOf(*largest, histogram.start, histogram.step));
    if (!std::isfinite(histogram.start) || !(last < kMostIntervals)) {
        return std::nullopt;
    }
    histogram.counts.resize(static_cast<std::size_t>(last) + 1);
    Count(values, histogram);
    return histogram;
}

std::vector<double> IntervalDensities(const Distribution& d, const Histogram& histogram) {
    std::vector<double> densities;
    for (std::size_t j = 0; j < histogram.counts.size(); ++j) {
        const double probability = std::visit(
            [&](const auto& family) {
                return Probability(family, histogram.Bound(j), histogram.Bound(j + 1));
            },
            d);
        densities.push_back(probability / histogram.step);
    }
    return densities;
}

std::vector<double> DensityCurveAbscissae(const Histogram& histogram, SeriesKind kind) {
    constexpr std::size_t kIntervals = 200;
    const auto count = static_cast<double>(histogram.counts.size());
    // No density lies before the threshold; before the start of annual maxima there may be some.
    const double before = kind == SeriesKind::PartialDuration ? 0 : 1;
    const double first = histogram.start - before * histogram.step;
    const double width = (count + 1 + before) * histogram.step;
    std::vector<double> abscissae;
    for (std::size_t i = 0; i <= kIntervals; ++i) {
        abscissae.push_back(first + width * (static_cast<double>(i) / kIntervals));
    }
    return abscissae;
}

std::vector<double> DensityCurve(const Distribution& d, std::span<const double> abscissae,
                                 double step) {
    std::vector<double> densities;
    densities.reserve(abscissae.size());
    std::visit(
        [&](const auto& family) {
            for (const double x : abscissae) {
                densities.push_back(CurveDensity(family, x, step));
            }
        },
        d);
    return densities;
}

} // namespace ryn::stats
