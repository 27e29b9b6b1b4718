#include "stats/checked.h"
#include "stats/exceedances.h"
#include "stats/likelihood_estimators.h"
#include "stats/profile_maximum.h"

#include <cmath>

namespace ryn::stats {

namespace {

// Sums over the logarithms L of the values' shares of the largest, weighted with exp(k L).
struct WeightedSums {
    double weight = 0;
    double first = 0;
    double second = 0;
};

WeightedSums SumsAt(std::span<const double> logs, double k) {
    WeightedSums sums;
    for (const double log : logs) {
        const double w = std::exp(k * log);
        sums.weight += w;
        sums.first += w * log;
        sums.second += w * log * log;
    }
    return sums;
}

struct LogMoments {
    double mean = 0;
    double deviation = 0;
};

LogMoments LogMomentsOf(std::span<const double> logs) {
    LogMoments moments;
    for (const double log : logs) {
        moments.mean += log / static_cast<double>(logs.size());
    }
    for (const double log : logs) {
        const double d = log - moments.mean;
        moments.deviation += d * d / static_cast<double>(logs.size());
    }
    moments.deviation = std::sqrt(moments.deviation);
    return moments;
}

// With alpha^k = mean(y^k), its best value for a given shape,
//     l/n = ln k - ln mean(y^k) + (k - 1) mean(ln y) - 1
// with one maximum in ln k.
ProfilePoint ProfileAt(std::span<const double> logs, double meanLog, double logK) {
    const double k = std::exp(logK);
    const WeightedSums sums = SumsAt(logs, k);
    const double mean = sums.first / sums.weight;
    const double variance = sums.second / sums.weight - mean * mean;
    const double pull = k * (mean - meanLog);
    const auto n = static_cast<double>(logs.size());
    return {logK - std::log(sums.weight / n) + k * meanLog, 1 - pull, -pull - k * k * variance};
}

} // namespace

// The logarithm of a Weibull variable has the standard deviation pi/(k sqrt 6): the start.
Outcome<Weibull> MostLikelyWeibullAbove(double threshold, std::span<const double> values,
                                        LikelihoodBuffer& buffer) {
    const auto exceedances = ExceedancesOf(values, threshold, ZeroExceedances::LeftOut, buffer);
    if (!exceedances) {
        return exceedances.Failure();
    }
    // Shares of the largest: no power of them overflows, whatever the shape.
    for (double& y : buffer) {
        y = std::log(y / exceedances->largest);
    }
    const auto [meanLog, deviation] = LogMomentsOf(buffer);
    const Bracket domain{std::log(1e-3), std::log(1e3)};
    const double start = std::log(1.2825 / deviation);
    const double mean = meanLog;
    const auto peak =
        PeakInside([&](double logK) { return ProfileAt(buffer, mean, logK); }, domain, start);
    if (!peak) {
        return FitFailure{FitFault::NoInteriorMaximum};
    }
    const double k = std::exp(peak->place);
    const auto n = static_cast<double>(buffer.size());
    // The power mean through its logarithm, since for large k all but the largest value vanish.
    const double alpha = std::exp(std::log(SumsAt(buffer, k).weight / n) / k);
    return Checked(Weibull::Make({threshold, exceedances->mean * exceedances->largest * alpha, k},
                                 LocationType::Fixed));
}

} // namespace ryn::stats
