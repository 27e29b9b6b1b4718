#include "stats/standard_gamma.h"

#include "stats/incomplete_gamma.h"
#include "stats/normal_functions.h"
#include "stats/quiet_policy.h"

#include <boost/math/special_functions/gamma.hpp>
#include <boost/math/special_functions/log1p.hpp>

#include <algorithm>
#include <cmath>
#include <limits>
#include <numbers>

namespace ryn::stats {

namespace {

constexpr double kInfinity = std::numeric_limits<double>::infinity();

// From here on Stirling's formula with four terms of its series is exact to a double.
constexpr double kStirlingFrom = 20;

// ln Gamma(k) less (k - 1/2) ln k - k + ln(2 pi)/2.
double StirlingRemainder(double k) {
    const double r = 1 / (k * k);
    return (1.0 / 12 - r * (1.0 / 360 - r * (1.0 / 1260 - r / 1680))) / k;
}

double Offset(double kappa) {
    return kappa < kStirlingFrom
               ? -boost::math::lgamma(kappa, QuietPolicy())
               : 0.5 * std::log(kappa / (2 * std::numbers::pi)) - StirlingRemainder(kappa);
}

// ln(1 + d) - d for z = k (1 + d); the difference loses its digits near d = 0.
double LogRatioTerm(double z, double k) {
    const double d = (z - k) / k;
    return std::abs(d) < 0.5 ? boost::math::log1pmx(d, QuietPolicy()) : std::log(z / k) - d;
}

} // namespace

StandardGamma::StandardGamma(double shape) : kappa(shape), offset(Offset(shape)) {}

// ln(z^kappa e^-z/Gamma(kappa)). With kappa in the millions the three terms are a million times
// their sum: taken together with Stirling's formula, the large parts cancel by hand.
double StandardGamma::LogKernel(double z) const {
    return kappa < kStirlingFrom ? kappa * std::log(z) - z + offset
                                 : kappa * LogRatioTerm(z, kappa) + offset;
}

double StandardGamma::LogDensity(double z) const {
    if (z == 0) {
        return kappa == 1 ? 0.0 : std::copysign(kInfinity, 1 - kappa);
    }
    return std::isinf(z) ? -z : LogKernel(z) - std::log(z);
}

double StandardGamma::Lower(double z) const {
    return LowerGamma(kappa, z);
}

double StandardGamma::Upper(double z) const {
    return UpperGamma(kappa, z);
}

// Each is solved in the tail that the probability lies in; from 1/2 on the complement is exact.
double StandardGamma::InverseOfLower(double probability) const {
    return probability <= 0.5 ? Solve(Tail::Lower, probability)
                              : Solve(Tail::Upper, 1 - probability);
}

double StandardGamma::InverseOfUpper(double exceedance) const {
    return exceedance <= 0.5 ? Solve(Tail::Upper, exceedance) : Solve(Tail::Lower, 1 - exceedance);
}

// Wilson and Hilferty (1931); for small shapes, where it fails, the first term of the series of P,
// or the leading factor of the asymptotic series of Q where that term no longer counts.
double StandardGamma::Start(Tail tail, double probability) const {
    const double sign = tail == Tail::Lower ? 1 : -1;
    const double w = 1 / (9 * kappa);
    const double root = 1 - w + sign * NormalQuantile(probability) * std::sqrt(w);
    if (kappa >= 0.5 && root > 0.1) {
        return kappa * root * root * root;
    }
    const double below = tail == Tail::Lower ? probability : 1 - probability;
    const double logGamma = boost::math::lgamma(kappa, QuietPolicy());
    const double power = std::exp((std::log(below * kappa) + logGamma) / kappa);
    return tail == Tail::Lower || power < 0.3 ? power
                                              : std::max(0.3, -std::log(probability) - logGamma);
}

// Halley's method for the logarithm of the tail probability as a function of y = ln z. It is
// concave there for both tails, since exp(kappa y - e^y) is log-concave, so that Newton's part
// alone would converge from anywhere.
double StandardGamma::Solve(Tail tail, double probability) const {
    if (!(probability > 0)) {
        return probability < 0 ? std::numeric_limits<double>::quiet_NaN()
                               : (tail == Tail::Lower ? 0.0 : kInfinity);
    }
    const double sign = tail == Tail::Lower ? 1 : -1;
    double z = Start(tail, probability);
    for (int step = 0; step < 100 && z > std::numeric_limits<double>::min(); ++step) {
        const double reached = tail == Tail::Lower ? Lower(z) : Upper(z);
        if (reached == 0) {
            z *= tail == Tail::Lower ? 2 : 0.5; // a start so far out that the tail underflows
            continue;
        }
        const double excess = std::log(reached / probability);
        const double slope = sign * std::exp(LogKernel(z)) / reached;
        const double newton = excess / slope;
        const double bend = 1 - newton * (kappa - z - slope) / 2;
        z *= std::exp(std::clamp(-newton / std::max(bend, 0.5), -2.0, 2.0));
        // The error left is of the order of the third power, and no more comes of rounding.
        if (std::abs(excess) < 1e-6) {
            break;
        }
    }
    return z;
}

} // namespace ryn::stats
