#include "stats/shape_functions.h"

#include "stats/quiet_policy.h"

#include <boost/math/special_functions/gamma.hpp>

#include <array>
#include <cmath>
#include <limits>
#include <numbers>

namespace ryn::stats {

namespace {

// Below this the direct forms of A, B and SK lose digits and their power series are used; nine
// terms leave 3e-14 at the seam.
constexpr double kSeriesRange = 0.01;

using Coefficients = std::array<double, 9>;

// Coefficients of kappa^0, kappa^1, ...
constexpr Coefficients kVarianceSeries = {
    1.644934066848226,  -4.303077228549152, 11.71833917721888,
    -26.53141916464012, 57.67611285960975,  -120.6254077476928,
    247.6584004198113,  -502.6498106178061, 1013.655309009762};
constexpr Coefficients kMeanSeries = {0.5772156649015329,  -0.9890559953279726, 0.9074790760808863,
                                      -0.9817280868344002, 0.9819950689031452,  -0.9931491146212762,
                                      0.9960017604424315,  -0.9981056937831734, 0.9990252676219993};
constexpr Coefficients kSkewnessSeries = {
    1.139547099404649,  -5.966612412667091, 12.27978665898371,
    -36.22426785110784, 106.0770959239481,  -315.5488266136003,
    942.558777978009,   -2821.494420424721, 8454.64662899483};

double Series(const Coefficients& coefficients, double kappa) {
    double sum = 0;
    for (auto c = coefficients.rbegin(); c != coefficients.rend(); ++c) {
        sum = sum * kappa + *c;
    }
    return sum;
}

// Gamma(1 + x) - 1 without the loss of the leading 1; poles and overflow give NaN or infinity.
double GammaMinusOne(double x) {
    return boost::math::tgamma1pm1(x, QuietPolicy());
}

// Gamma(1 + 2k) - Gamma(1 + k)^2 with both written as 1 + something small.
double GammaVariance(double g1, double g2) {
    return g2 - 2 * g1 - g1 * g1;
}

} // namespace

bool IsExponentialLimit(double kappa) {
    return std::abs(kappa) < 1e-14;
}

double ReducedOfStandard(double z, double kappa) {
    if (IsExponentialLimit(kappa)) {
        return z;
    }
    const double t = -kappa * z;
    // At the bound and past it: log1p would give NaN for a t that rounding put below -1.
    if (t <= -1) {
        return std::copysign(std::numeric_limits<double>::infinity(), kappa);
    }
    return -std::log1p(t) / kappa;
}

double StandardOfReduced(double y, double kappa) {
    return IsExponentialLimit(kappa) ? y : -std::expm1(-kappa * y) / kappa;
}

double DensitySlopeTerm(double y, double kappa) {
    // At the upper bound y is infinite, and the density there is 1/alpha for kappa = 1.
    return kappa == 1 ? 0.0 : (1 - kappa) * y;
}

// Dividing a difference of order kappa^2 between terms of order kappa loses the factor kappa in
// digits: two at the seam, and none to speak of beyond kappa = 0.1.
double GevVarianceFactor(double kappa) {
    if (std::abs(kappa) < kSeriesRange) {
        return Series(kVarianceSeries, kappa);
    }
    return GammaVariance(GammaMinusOne(kappa), GammaMinusOne(2 * kappa)) / (kappa * kappa);
}

double GevMeanFactor(double kappa) {
    return std::abs(kappa) < kSeriesRange ? Series(kMeanSeries, kappa)
                                          : -GammaMinusOne(kappa) / kappa;
}

// Here a difference of order kappa^3 is left of terms of order kappa: four digits at the seam,
// where the plain form in Gamma itself would lose six.
double GevSkewness(double kappa) {
    if (std::abs(kappa) < kSeriesRange) {
        return Series(kSkewnessSeries, kappa);
    }
    const double g1 = GammaMinusOne(kappa);
    const double g2 = GammaMinusOne(2 * kappa);
    const double g3 = GammaMinusOne(3 * kappa);
    // -Gamma(1+3k) + 3 Gamma(1+k) Gamma(1+2k) - 2 Gamma(1+k)^3 with the ones cancelled by hand.
    const double third = -g3 + 3 * g2 - 3 * g1 + 3 * g1 * g2 - 6 * g1 * g1 - 2 * g1 * g1 * g1;
    return std::copysign(1.0, kappa) * third / std::pow(GammaVariance(g1, g2), 1.5);
}

double GevLSkewness(double kappa) {
    if (IsExponentialLimit(kappa)) {
        return 2 * std::log(3.0) / std::numbers::ln2 - 3;
    }
    return 2 * std::expm1(-kappa * std::log(3.0)) / std::expm1(-kappa * std::numbers::ln2) - 3;
}

// Hosking, Wallis and Wood's approximation.
double GevShapeNear(double lSkewness) {
    const double c = 2 / (3 + lSkewness) - std::numbers::ln2 / std::log(3.0);
    return (7.8590 + 2.9554 * c) * c;
}

double GevLScaleFactor(double kappa) {
    return IsExponentialLimit(kappa) ? std::numbers::ln2
                                     : -std::expm1(-kappa * std::numbers::ln2) / kappa;
}

// Around 0 through the variance factor, in which the leading ones have cancelled; Gamma itself
// overflows far above and has a pole near -1/2, where its logarithm does not care.
double LogPowerSpread(double h) {
    if (std::abs(h) > 0.25) {
        return boost::math::lgamma(1 + 2 * h, QuietPolicy()) -
               2 * boost::math::lgamma(1 + h, QuietPolicy());
    }
    const double mean = std::tgamma(1 + h);
    return std::log1p(h * h * GevVarianceFactor(h) / (mean * mean));
}

} // namespace ryn::stats
