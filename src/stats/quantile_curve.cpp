#include "stats/quantile_curve.h"

#include <algorithm>
#include <cmath>

namespace ryn::stats {

namespace {

// The largest double below 1, which a period of 10^16 events would otherwise round up to 1.
constexpr double kHighest = 1 - 0x1p-53;

// The exceedance at the upper end, 1/(rate T) of the longest period. Each candidate is taken
// through its own exceedance, since n/rate and then its product with the rate may overflow.
double TopExceedance(const CurveRange& range) {
    const double rate = range.frame.kind == SeriesKind::PartialDuration ? range.frame.rate : 1.0;
    double e = 1 / (10 * static_cast<double>(range.count));
    e = std::min(e, 1 / (1000 * rate));
    e = range.longestPeriod > 0 ? std::min(e, 1 / (2 * range.longestPeriod * rate)) : e;
    return std::clamp(e, 1 - kHighest, 0.5);
}

} // namespace

std::vector<double> QuantileCurveProbabilities(const CurveRange& range) {
    constexpr std::size_t kCount = 100;
    const double low = std::min(0.01, 0.25 / static_cast<double>(range.count));
    // Equidistant where the Gumbel paper is: both tails get their share of the points.
    const double yLow = -std::log(-std::log(low));
    const double yHigh = -std::log(-std::log1p(-TopExceedance(range)));
    std::vector<double> probabilities;
    for (std::size_t i = 0; i < kCount; ++i) {
        const double y = yLow + (yHigh - yLow) * (static_cast<double>(i) / (kCount - 1));
        probabilities.push_back(std::min(std::exp(-std::exp(-y)), kHighest));
    }
    return probabilities;
}

} // namespace ryn::stats
