#include "stats/square_root_exponential.h"

#include "stats/quiet_policy.h"

#include <boost/math/special_functions/log1p.hpp>

#include <cmath>
#include <limits>
#include <numbers>

namespace ryn::stats {

namespace {

// t > 0 with t - ln(1 + t) = `level`, level > 0, by Newton's method on a convex function; two to
// five steps. It is -1 - W(-exp(-1 - level)) with the lower branch of Lambert's W. log1pmx keeps
// the digits of the difference for small t.
double RootOfLevel(double level) {
    double t = level < 1 ? std::sqrt(2 * level) : level + std::log(1 + level + std::log1p(level));
    for (int step = 0; step < 60; ++step) {
        const double excess = -boost::math::log1pmx(t, QuietPolicy()) - level;
        const double change = excess * (1 + t) / t;
        t -= change;
        if (!(std::abs(change) > 1e-14 * t)) {
            break;
        }
    }
    return t;
}

} // namespace

std::optional<SquareRootExponential>
SquareRootExponential::Make(const SquareRootParameters& values) {
    const bool valid =
        std::isfinite(values.a) && std::isfinite(values.b) && values.a > 0 && values.b > 0;
    return valid ? std::optional<SquareRootExponential>(SquareRootExponential(values))
                 : std::nullopt;
}

SquareRootExponential::SquareRootExponential(const SquareRootParameters& values)
    : p(values),
      logPeak(std::log(values.a) + std::log(values.b) - std::numbers::ln2) {}

Interval SquareRootExponential::Support() const {
    Interval support;
    support.lower = 0;
    return support;
}

// Two roots, since b x may overflow.
double SquareRootExponential::Root(double x) const {
    return std::sqrt(p.b) * std::sqrt(x);
}

double SquareRootExponential::Hazard(double r) const {
    return p.a * (1 + r) * std::exp(-r);
}

// dF/dx = F a r exp(-r) dr/dx with dr/dx = b/(2 r): f = (a b/2) exp(-r) F.
double SquareRootExponential::LogDensityInside(double x) const {
    const double r = Root(x);
    return logPeak - r - Hazard(r);
}

double SquareRootExponential::CdfInside(double x) const {
    return std::exp(-Hazard(Root(x)));
}

// For large x this is the hazard itself to the last digit, where 1 - F would be 0.
double SquareRootExponential::SurvivalInside(double x) const {
    return -std::expm1(-Hazard(Root(x)));
}

// (1 + r) exp(-r) = h/a, whose logarithm is -(r - ln(1 + r)).
double SquareRootExponential::QuantileOfHazard(double hazard) const {
    const double level = std::log(p.a) - std::log(hazard);
    if (level <= 0) {
        return 0;
    }
    const double r = RootOfLevel(level);
    return r * r / p.b;
}

// ln F is taken of a given F, or as log1p(-e) of a small exceedance.
double SquareRootExponential::QuantileInside(double probability) const {
    return QuantileOfHazard(-std::log(probability));
}

double SquareRootExponential::QuantileOfExceedanceInside(double exceedance) const {
    return QuantileOfHazard(-std::log1p(-exceedance));
}

double SquareRootExponential::ReducedVariate(double x) const {
    if (x < 0) {
        return -std::numeric_limits<double>::infinity();
    }
    const double r = Root(x);
    return std::isinf(r) ? r : r - std::log1p(r) - std::log(p.a);
}

double SquareRootExponential::ReducedVariateOfProbability(double probability) const {
    return -std::log(-std::log(probability));
}

double SquareRootExponential::StandardVariate(double x) const {
    return p.b * x;
}

ParameterList SquareRootExponential::Parameters() const {
    return {{"a", p.a}, {"b", p.b}};
}

} // namespace ryn::stats
