#include "stats/gumbel_estimators.h"

#include "stats/checked.h"

#include <cmath>
#include <numbers>

namespace ryn::stats {

GumbelConstants GumbelConstantsFor(std::size_t count) {
    const auto n = static_cast<double>(count);
    const auto reduced = [n](std::size_t i) {
        return -std::log(-std::log(static_cast<double>(i) / (n + 1)));
    };
    double sum = 0;
    double squares = 0;
    for (std::size_t i = 1; i <= count; ++i) {
        const double y = reduced(i);
        sum += y;
        squares += y * y;
    }
    // Mean 0.5 and deviation 1: the squares need no second pass.
    const double mean = sum / n;
    return {count, mean, std::sqrt(squares / n - mean * mean)};
}

// A Gumbel variable has mean xi + gE alpha and standard deviation alpha pi/sqrt(6), those of the
// whole population of reduced variates.
Outcome<Gumbel> GumbelFromMoments(const CentralMoments& moments) {
    const double alpha = moments.StandardDeviation() * std::sqrt(6.0) / std::numbers::pi;
    return Checked(Gumbel::Make({moments.mean - std::numbers::egamma * alpha, alpha}));
}

// The same with mean and deviation of n reduced variates at the Weibull plotting positions, which
// spread less than the population: the corrected alpha is the larger.
Outcome<Gumbel> GumbelFromMoments(const CentralMoments& moments, const GumbelConstants& constants) {
    const double alpha = moments.StandardDeviation() / constants.deviation;
    return Checked(Gumbel::Make({moments.mean - constants.mean * alpha, alpha}));
}

// l1 = xi + gE alpha and l2 = alpha ln 2.
Outcome<Gumbel> GumbelFromLMoments(const LMoments& moments) {
    const double alpha = moments.l2 / std::numbers::ln2;
    return Checked(Gumbel::Make({moments.l1 - std::numbers::egamma * alpha, alpha}));
}

} // namespace ryn::stats
