#include "stats/checked.h"
#include "stats/exceedances.h"
#include "stats/likelihood_estimators.h"
#include "stats/profile_maximum.h"

#include <boost/math/special_functions/digamma.hpp>
#include <boost/math/special_functions/trigamma.hpp>

#include <cmath>

namespace ryn::stats {

namespace {

// ln k - psi(k), positive, with its derivative. For large k the difference loses all its digits,
// and the asymptotic series takes over; at 20 its next term is 5e-16 of the whole.
struct LogLessDigamma {
    double value;
    double slope;
};

LogLessDigamma LogLessDigammaAt(double k) {
    if (k < 20) {
        return {std::log(k) - boost::math::digamma(k), 1 / k - boost::math::trigamma(k)};
    }
    const double i = 1 / (k * k);
    return {1 / (2 * k) +
                i * (1.0 / 12 - i * (1.0 / 120 - i * (1.0 / 252 - i * (1.0 / 240 - i / 132)))),
            -i / 2 - i / k * (1.0 / 6 - i * (1.0 / 30 - i / 42))};
}

// ln mean(y) - mean(ln y) of values with mean 1, summed from terms that are all positive, so that a
// narrow sample keeps its digits.
double LogMeanLessMeanLog(std::span<const double> values) {
    double sum = 0;
    for (const double y : values) {
        sum += (y - 1) - std::log(y);
    }
    return sum / static_cast<double>(values.size());
}

} // namespace

// With alpha = mean(y)/k, its best value for a given shape, the slope of l/n in ln k is
//     k (ln k - psi(k) - c),  c = ln mean(y) - mean(ln y)
// with one root for c > 0. Thom's (1958) approximation is the start.
Outcome<PearsonThree> MostLikelyGammaAbove(double threshold, std::span<const double> values,
                                           LikelihoodBuffer& buffer) {
    const auto exceedances = ExceedancesOf(values, threshold, ZeroExceedances::LeftOut, buffer);
    if (!exceedances) {
        return exceedances.Failure();
    }
    const double c = LogMeanLessMeanLog(buffer);
    const auto profile = [c](double logK) {
        const double k = std::exp(logK);
        const auto [value, slope] = LogLessDigammaAt(k);
        const double gradient = k * (value - c);
        return ProfilePoint{0, gradient, gradient + k * k * slope};
    };
    const double start = std::log((1 + std::sqrt(1 + 4 * c / 3)) / (4 * c));
    const auto peak = PeakInside(profile, {std::log(1e-6), std::log(1e8)}, start);
    if (!peak) {
        return FitFailure{FitFault::NoInteriorMaximum};
    }
    const double k = std::exp(peak->place);
    return Checked(PearsonThree::Make({threshold, exceedances->mean / k, k}, LocationType::Fixed));
}

} // namespace ryn::stats
