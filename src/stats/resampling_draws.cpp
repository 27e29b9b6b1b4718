#include "stats/resampling_draws.h"

#include <boost/math/special_functions/erf.hpp>

#include <cmath>
#include <numbers>

namespace ryn::stats {

namespace {

// exp(-mean) is still a normal double here, and the sum starts with all its digits.
constexpr double kMostByInversion = 700;

double NormalQuantile(double u) {
    return -std::numbers::sqrt2 * boost::math::erfc_inv(2 * u);
}

} // namespace

std::size_t PoissonCount(double mean, double u) {
    if (mean > kMostByInversion) {
        return static_cast<std::size_t>(
            std::floor(mean + std::sqrt(mean) * NormalQuantile(u) + 0.5));
    }
    // u may exceed the sum of all terms by rounding; the limit on k lies far out in the tail.
    std::size_t k = 0;
    double term = std::exp(-mean);
    double sum = term;
    while (u > sum && static_cast<double>(k) < 10 * mean + 100) {
        ++k;
        term *= mean / static_cast<double>(k);
        sum += term;
    }
    return k;
}

} // namespace ryn::stats
