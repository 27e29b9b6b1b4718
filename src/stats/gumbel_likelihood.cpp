#include "stats/checked.h"
#include "stats/likelihood_estimators.h"
#include "stats/profile_maximum.h"

#include <algorithm>
#include <cmath>

namespace ryn::stats {

namespace {

constexpr FitFailure kNoMaximum{FitFault::NoInteriorMaximum};
constexpr FitFailure kInvalid{FitFault::InvalidParameters};

// Sums over the sample, weighted with exp(-beta d).
struct WeightedSums {
    double weight = 0;
    double first = 0;  // of d
    double second = 0; // of d^2
};

WeightedSums SumsAt(std::span<const double> deviations, double beta) {
    WeightedSums sums;
    for (const double d : deviations) {
        const double w = std::exp(-beta * d);
        sums.weight += w;
        sums.first += w * d;
        sums.second += w * d * d;
    }
    return sums;
}

// For a given beta = 1/alpha the best xi has exp(beta xi) = 1/mean(exp(-beta d)). Left is
//     l/n = ln beta - ln mean(exp(-beta d)) - beta mean(d) - 1
// with one maximum in ln beta; mean(d) = 1 here.
ProfilePoint ProfileAt(std::span<const double> deviations, double logBeta) {
    const double beta = std::exp(logBeta);
    const WeightedSums sums = SumsAt(deviations, beta);
    const double mean = beta * sums.first / sums.weight;
    const double variance = beta * beta * sums.second / sums.weight - mean * mean;
    const auto n = static_cast<double>(deviations.size());
    return {logBeta - std::log(sums.weight / n) - beta - 1, 1 + mean - beta,
            mean - variance - beta};
}

double RootMeanSquare(std::span<const double> deviations) {
    double squares = 0;
    for (const double d : deviations) {
        squares += (d - 1) * (d - 1);
    }
    return std::sqrt(squares / static_cast<double>(deviations.size()));
}

} // namespace

// Deviations from the smallest value keep the exponentials below 1. At beta = 1/mean(d) the profile
// still rises; far above it falls, since the weighted mean goes to the smallest value. The start is
// the estimate by moments.
Outcome<Gumbel> MostLikelyGumbel(std::span<const double> values, LikelihoodBuffer& buffer) {
    const double smallest = *std::min_element(values.begin(), values.end());
    double sum = 0;
    for (const double x : values) {
        sum += x - smallest;
    }
    const double unit = sum / static_cast<double>(values.size());
    if (!std::isfinite(unit)) {
        return kInvalid;
    }
    if (!(unit > 0)) {
        return kNoMaximum;
    }
    buffer.clear();
    for (const double x : values) {
        buffer.push_back((x - smallest) / unit);
    }
    // The deviation of a Gumbel variable is pi/sqrt 6 of its scale.
    const double start = std::max(0.0, std::log(1.2825 / RootMeanSquare(buffer)));
    const auto peak =
        MaximumBetween([&](double logBeta) { return ProfileAt(buffer, logBeta); }, {0, 50}, start);
    if (!peak) {
        return FitFailure{FitFault::NoConvergence};
    }
    const double beta = std::exp(peak->place);
    const double weight = SumsAt(buffer, beta).weight / static_cast<double>(values.size());
    return Checked(Gumbel::Make({smallest - unit * std::log(weight) / beta, unit / beta}));
}

} // namespace ryn::stats
