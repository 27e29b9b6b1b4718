#include "stats/probability_plot.h"

#include <algorithm>
#include <cmath>
#include <cstddef>
#include <limits>

namespace ryn::stats {

namespace {

constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();

double Mean(std::span<const double> values) {
    double sum = 0;
    for (const double x : values) {
        sum += x;
    }
    return sum / static_cast<double>(values.size());
}

// Both lists are monotone, so that their ends tell. The deviations of equal values would not: their
// mean may be off by a rounding, which correlates with anything.
bool HasSpread(std::span<const double> values) {
    return !values.empty() && values.front() != values.back();
}

// Pearson's, by deviations from the means. A term that is not finite makes a sum that is not, and
// so does one whose square overflows; rounding must not leave a correlation above 1.
double Correlation(std::span<const double> x, std::span<const double> y) {
    if (!HasSpread(x) || !HasSpread(y)) {
        return kNaN;
    }
    const double meanX = Mean(x);
    const double meanY = Mean(y);
    double xx = 0;
    double xy = 0;
    double yy = 0;
    for (std::size_t i = 0; i < x.size(); ++i) {
        const double dx = x[i] - meanX;
        const double dy = y[i] - meanY;
        xx += dx * dx;
        xy += dx * dy;
        yy += dy * dy;
    }
    const double r = xy / std::sqrt(xx) / std::sqrt(yy);
    return std::isfinite(r) && std::isfinite(xx + yy) ? std::clamp(r, -1.0, 1.0) : kNaN;
}

// s of the quantile and not of the probability: families define s by x alone.
template <Family D>
double MeanSquaredDifference(const D& d, const ProbabilityPlot& plot) {
    double sum = 0;
    for (std::size_t i = 0; i < plot.observed.size(); ++i) {
        const double difference =
            StandardVariate(d, plot.observed[i]) - StandardVariate(d, plot.quantiles[i]);
        sum += difference * difference;
    }
    return sum / static_cast<double>(plot.observed.size());
}

} // namespace

ProbabilityPlot ProbabilityPlotOf(const Distribution& d, std::span<const double> sorted,
                                  PlottingMethod method) {
    ProbabilityPlot plot{{sorted.begin(), sorted.end()},
                         PlottingPositions(method, sorted.size()),
                         std::vector<double>(sorted.size())};
    std::visit(
        [&](const auto& family) {
            std::transform(plot.positions.begin(), plot.positions.end(), plot.quantiles.begin(),
                           [&](double p) { return Quantile(family, p); });
        },
        d);
    return plot;
}

LeastSquaresCriterion LeastSquaresCriterionOf(const Distribution& d, const ProbabilityPlot& plot) {
    LeastSquaresCriterion result;
    result.lowVariate = StandardVariate(d, Quantile(d, 0.01));
    result.highVariate = StandardVariate(d, Quantile(d, 0.99));
    const double squared =
        std::visit([&](const auto& family) { return MeanSquaredDifference(family, plot); }, d);
    // Infinite variates cancel to NaN or stay infinite; neither is a criterion. An infinite scale,
    // as where the quantile of 0.01 is below all doubles, would make any fit a perfect one.
    const double scale = std::abs(result.highVariate - result.lowVariate);
    const double criterion = std::sqrt(squared) / scale;
    result.criterion = std::isfinite(criterion) && std::isfinite(scale) ? criterion : kNaN;
    return result;
}

double PlotCorrelation(const ProbabilityPlot& plot) {
    return Correlation(plot.observed, plot.quantiles);
}

double ReducedPlotCorrelation(const Distribution& d, const ProbabilityPlot& plot) {
    // u(x) is the model's own formula: through F it would lose the upper tail.
    std::vector<double> observed;
    std::vector<double> expected;
    std::visit(
        [&](const auto& family) {
            for (std::size_t i = 0; i < plot.observed.size(); ++i) {
                observed.push_back(ReducedVariate(family, plot.observed[i]));
                expected.push_back(ReducedVariateOfProbability(family, plot.positions[i]));
            }
        },
        d);
    return Correlation(observed, expected);
}

} // namespace ryn::stats
