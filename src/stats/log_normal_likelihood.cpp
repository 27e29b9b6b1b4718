#include "stats/checked.h"
#include "stats/exceedances.h"
#include "stats/likelihood_estimators.h"
#include "stats/log_normal_estimators.h"
#include "stats/profile_maximum.h"
#include "stats/sample_statistics.h"

#include <algorithm>
#include <cmath>

namespace ryn::stats {

namespace {

struct MeanAndDeviation {
    double mean;
    double deviation; // divisor n
};

MeanAndDeviation OfLogarithms(LikelihoodBuffer& values) {
    for (double& y : values) {
        y = std::log(y);
    }
    const CentralMoments moments = CentralMomentsOf(values);
    return {moments.mean, std::sqrt(moments.m2)};
}

// The lower bound xi lies exp(t) below the smallest value, in standard deviations of the sample.
// With mu and sigma^2 = V, mean and variance of ln(x - xi), at their best for it,
//     l/n = -ln(V)/2 - mean ln(x - xi)
// but for constants. Logarithms are taken relative to the smallest value's: with d the deviations
// from that value and w = d exp(-t), ln(x - xi) = t + ln(1 + w), and z = w/(1 + w) is minus the
// derivative of ln(1 + w) in t; far below the sample all digits are in these.
class LowerBoundProfile {
  public:
    explicit LowerBoundProfile(std::span<const double> deviationsFromSmallest)
        : deviations(deviationsFromSmallest) {}

    /// Moments of ln(x - xi), in units of the deviations.
    MeanAndDeviation At(double t) const {
        const Sums s = SumsAt(t);
        return {t + s.l, std::sqrt(s.ll - s.l * s.l)};
    }

    ProfilePoint operator()(double t) const {
        const Sums s = SumsAt(t);
        const double variance = s.ll - s.l * s.l;
        const double covariance = s.lz - s.l * s.z;
        // V' = -2 cov(ln, z), V'' = 2 var(z) + 2 cov(ln, z - z^2).
        const double first = -2 * covariance / variance;
        const double second = 2 * (s.zz - s.z * s.z + covariance - (s.lzz - s.l * s.zz)) / variance;
        return {-std::log(variance) / 2 - t - s.l, -first / 2 - 1 + s.z,
                -(second - first * first) / 2 - (s.z - s.zz)};
    }

  private:
    /// Means of l = ln(1 + w), z and their products.
    struct Sums {
        double l = 0, ll = 0, z = 0, zz = 0, lz = 0, lzz = 0;
    };

    Sums SumsAt(double t) const {
        const double scale = std::exp(-t);
        Sums s;
        for (const double d : deviations) {
            const double w = d * scale;
            const double l = std::log1p(w);
            const double z = w / (1 + w);
            s.l += l;
            s.ll += l * l;
            s.z += z;
            s.zz += z * z;
            s.lz += l * z;
            s.lzz += l * z * z;
        }
        const auto n = static_cast<double>(deviations.size());
        return {s.l / n, s.ll / n, s.z / n, s.zz / n, s.lz / n, s.lzz / n};
    }

    std::span<const double> deviations;
};

} // namespace

Outcome<LogNormal> MostLikelyLogNormalAbove(double lowerBound, std::span<const double> values,
                                            LikelihoodBuffer& buffer) {
    const auto above = ExceedancesOf(values, lowerBound, ZeroExceedances::LeftOut, buffer);
    if (!above) {
        return above.Failure();
    }
    const auto [mean, deviation] = OfLogarithms(buffer);
    if (!(deviation > 0)) {
        return FitFailure{FitFault::NoInteriorMaximum};
    }
    return Checked(LogNormal::Make({lowerBound, mean + std::log(above->mean), deviation},
                                   LocationType::Fixed));
}

// Towards the smallest value the likelihood grows without limit and downwards it goes to that of a
// normal distribution: of both ends nothing is made.
Outcome<LogNormal> MostLikelyLogNormal(std::span<const double> values, LikelihoodBuffer& buffer) {
    const double smallest = *std::min_element(values.begin(), values.end());
    const double unit = CentralMomentsOf(values).StandardDeviation();
    if (!std::isfinite(unit)) {
        return FitFailure{FitFault::InvalidParameters};
    }
    if (!(unit > 0)) {
        return FitFailure{FitFault::NoInteriorMaximum};
    }
    buffer.clear();
    for (const double x : values) {
        buffer.push_back((x - smallest) / unit);
    }
    const LowerBoundProfile profile(buffer);
    PeakSearch search;
    search.Walk(profile, std::log(1e-4), std::log(1e3), 24);
    if (!search.Highest()) {
        return FitFailure{FitFault::NoInteriorMaximum};
    }
    const double t = search.Highest()->place;
    const double distance = unit * std::exp(t);
    const double xi = smallest - distance;
    if (!IsBelow(smallest, distance)) {
        return FitFailure{FitFault::LowerBoundTooHigh, {xi, smallest}};
    }
    const auto [mean, deviation] = profile.At(t);
    return Checked(LogNormal::Make({xi, mean + std::log(unit), deviation}));
}

} // namespace ryn::stats
