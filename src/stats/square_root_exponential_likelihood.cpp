#include "stats/checked.h"
#include "stats/likelihood_estimators.h"
#include "stats/profile_maximum.h"

#include <algorithm>
#include <cmath>

namespace ryn::stats {

namespace {

// Means over the sample of r = sqrt(b x) and of what goes with exp(-r); the exponentials are taken
// relative to that of the smallest r, since b x runs to 1e5 and more.
struct Means {
    double smallest = 0; // r
    double r = 0;
    double first = 0;  // (1 + r) exp(-r)
    double second = 0; // r^2 exp(-r)
    double third = 0;  // (2 r^2 - r^3) exp(-r)
};

Means MeansAt(std::span<const double> roots, double smallestRoot, double scale) {
    Means means;
    means.smallest = smallestRoot * scale;
    for (const double root : roots) {
        const double r = root * scale;
        const double w = std::exp(means.smallest - r);
        means.r += r;
        means.first += (1 + r) * w;
        means.second += r * r * w;
        means.third += (2 - r) * r * r * w;
    }
    const auto n = static_cast<double>(roots.size());
    means.r /= n;
    means.first /= n;
    means.second /= n;
    means.third /= n;
    return means;
}

// ln a = -ln mean((1 + r) exp(-r)), its best value for a given b.
double LogA(const Means& means) {
    return means.smallest - std::log(means.first);
}

// With t = ln(b m), where the mean m is 1 here, l/n = ln a + t - mean(r) but for constants.
ProfilePoint ProfileAt(const Means& means, double t) {
    const double share = means.second / means.first;
    return {LogA(means) + t - means.r, 1 - means.r / 2 + share / 2,
            -means.r / 4 + (means.third / means.first + share * share) / 4};
}

// Etoh, Murota and Nakanishi's likelihood asks for no mean; it is the unit that makes b free of
// one.
double MeanOf(std::span<const double> values) {
    double sum = 0;
    for (const double x : values) {
        sum += x;
    }
    return sum / static_cast<double>(values.size());
}

} // namespace

Outcome<SquareRootExponential> MostLikelySquareRootExponential(std::span<const double> values,
                                                               LikelihoodBuffer& buffer) {
    const double mean = MeanOf(values);
    const double smallest = *std::min_element(values.begin(), values.end());
    if (!std::isfinite(mean)) {
        return FitFailure{FitFault::InvalidParameters};
    }
    if (smallest < 0 || !(mean > 0)) {
        return FitFailure{FitFault::ValuesNotPositive};
    }
    // The roots are taken once; a step in b only scales them.
    buffer.clear();
    for (const double x : values) {
        buffer.push_back(std::sqrt(x / mean));
    }
    const auto meansAt = [&](double t) {
        return MeansAt(buffer, std::sqrt(smallest / mean), std::exp(t / 2));
    };
    PeakSearch search;
    search.Walk([&](double t) { return ProfileAt(meansAt(t), t); }, std::log(1e-3), std::log(1e5),
                12);
    // Narrow samples far from 0 rise on and on with b.
    if (!search.Highest() || search.Highest()->value < search.HighestEnd()) {
        return FitFailure{FitFault::NoInteriorMaximum};
    }
    const double t = search.Highest()->place;
    return Checked(SquareRootExponential::Make({std::exp(LogA(meansAt(t))), std::exp(t) / mean}));
}

} // namespace ryn::stats
