#include "stats/log_normal_estimators.h"

#include "stats/checked.h"
#include "stats/quiet_policy.h"

#include <boost/math/special_functions/erf.hpp>

#include <algorithm>
#include <cmath>
#include <limits>
#include <vector>

namespace ryn::stats {

namespace {

// Of a sample that is all but symmetric the bound lies so far below that its distance, a million
// times the spread, has swallowed the digits of what is estimated; rounding alone makes as much.
constexpr double kSmallestAsymmetry = 1e-6;

// Mean and deviation of the logarithms as they are: no correction of sigma for the sample size but
// the divisor n - 1. With a largest value far out the bound comes so close to the smallest that
// their distance has more digits than the bound.
Outcome<LogNormal> WithLowerBound(double distance, std::span<const double> ascending) {
    const double smallest = ascending.front();
    const double xi = smallest - distance;
    if (!IsBelow(smallest, distance)) {
        return FitFailure{FitFault::LowerBoundTooHigh, {xi, smallest}};
    }
    std::vector<double> logs(ascending.size());
    std::transform(ascending.begin(), ascending.end(), logs.begin(),
                   [=](double x) { return std::log(x - smallest + distance); });
    const CentralMoments moments = CentralMomentsOf(logs);
    return Checked(LogNormal::Make({xi, moments.mean, moments.StandardDeviation()}));
}

// Of positive values, from their ratios to one of them: the distances of narrow samples to it keep
// their digits.
double GeometricMean(std::span<const double> values) {
    const double middle = values[values.size() / 2];
    double sum = 0;
    for (const double x : values) {
        const double excess = (x - middle) / middle;
        sum += std::abs(excess) < 0.5 ? std::log1p(excess) : std::log(x / middle);
    }
    return middle * std::exp(sum / static_cast<double>(values.size()));
}

double Median(std::span<const double> ascending) {
    const std::size_t half = ascending.size() / 2;
    return ascending.size() % 2 == 1 ? ascending[half]
                                     : (ascending[half - 1] + ascending[half]) / 2;
}

} // namespace

// With y = x - bound, mean exp(mu + sigma^2/2) and squared coefficient of variation
// exp(sigma^2) - 1.
Outcome<LogNormal> LogNormalAboveFromMoments(double lowerBound, const CentralMoments& moments) {
    const double mean = moments.mean - lowerBound;
    if (!(mean > 0)) {
        return FitFailure{FitFault::MeanExceedanceNotPositive};
    }
    const double variance = std::log1p(moments.Variance() / mean / mean);
    return Checked(LogNormal::Make({lowerBound, std::log(mean) - variance / 2, std::sqrt(variance)},
                                   LocationType::Fixed));
}

// L-Cv erf(sigma/2).
Outcome<LogNormal> LogNormalAboveFromLMoments(double lowerBound, const LMoments& moments) {
    const double mean = moments.l1 - lowerBound;
    if (!(mean > 0)) {
        return FitFailure{FitFault::MeanExceedanceNotPositive};
    }
    const double lCv = moments.l2 / mean;
    if (!IsLCv(lCv)) {
        return LMomentsOutOfRange(lCv, moments.LSkewness());
    }
    const double sigma = 2 * boost::math::erf_inv(lCv, QuietPolicy());
    return Checked(LogNormal::Make({lowerBound, std::log(mean) - sigma * sigma / 2, sigma},
                                   LocationType::Fixed));
}

bool IsBelow(double value, double distance) {
    return distance > 2 * std::numeric_limits<double>::epsilon() * std::abs(value);
}

double CorrectedSkewness(const CentralMoments& moments, LogNormalType correction) {
    if (correction != LogNormalType::SkewnessCorrectionII) {
        return moments.Skewness();
    }
    const auto n = static_cast<double>(moments.count);
    const double g1 = moments.BiasedSkewness();
    const double constant = 1.01 + 7.01 / n + 14.66 / (n * n);
    const double slope = 1.69 / n + 74.66 / (n * n);
    // The polynomial was fitted for positive skewness; far below 0 its cube would turn the sign.
    return g1 * (constant + slope * std::max(0.0, g1 * g1 * g1));
}

bool IsCalibrated(std::size_t count, double correctedSkewness) {
    return count >= 20 && count <= 90 && correctedSkewness >= 0.25 && correctedSkewness <= 5;
}

// A log-normal variable with coefficient of variation w about its bound has skewness w^3 + 3w.
// The real root of the cubic is 2 sinh(asinh(g/2)/3), which keeps its digits for small g where
// Cardano's form subtracts.
Outcome<LogNormal> LogNormalFromMoments(const CentralMoments& moments, double correctedSkewness) {
    if (!(correctedSkewness > kSmallestAsymmetry)) {
        return FitFailure{FitFault::SkewnessNotPositive, {correctedSkewness, 0}};
    }
    const double w = 2 * std::sinh(std::asinh(correctedSkewness / 2) / 3);
    const double mean = moments.StandardDeviation() / w; // of x - xi
    const double variance = std::log1p(w * w);
    return Checked(
        LogNormal::Make({moments.mean - mean, std::log(mean) - variance / 2, std::sqrt(variance)}));
}

// Symmetry of a pair a, c about the geometric mean xg in ln(x + b) says (a + b)(c + b) = (xg +
// b)^2. With p = a - xg and q = c - xg the pair's bound -b lies p^2/(p + q) below a.
Outcome<LogNormal> LogNormalByBoundI(std::span<const double> ascending) {
    const std::size_t n = ascending.size();
    const double xg = GeometricMean(ascending);
    const std::size_t pairs = std::max<std::size_t>(1, (n + 5) / 10); // a tenth, rounded
    double sum = 0;
    std::size_t used = 0;
    for (std::size_t i = 0; i < pairs; ++i) {
        const double p = ascending[i] - xg;
        const double q = ascending[n - 1 - i] - xg;
        if (std::abs(p + q) >= 1e-6 * xg) {
            sum += ascending.front() - ascending[i] + p / (p + q) * p;
            ++used;
        }
    }
    if (used == 0) {
        return FitFailure{FitFault::NoConvergence};
    }
    return WithLowerBound(sum / static_cast<double>(used), ascending);
}

// (x1 xn - med^2)/(x1 + xn - 2 med) in distances to the median, whose squares do not cancel, and
// from x1.
Outcome<LogNormal> LogNormalByBoundII(std::span<const double> ascending) {
    const double median = Median(ascending);
    const double below = median - ascending.front();
    const double above = ascending.back() - median;
    if (!(above - below > kSmallestAsymmetry * above)) {
        return FitFailure{FitFault::LowerBoundUndefined};
    }
    return WithLowerBound(below / (above - below) * below, ascending);
}

} // namespace ryn::stats
