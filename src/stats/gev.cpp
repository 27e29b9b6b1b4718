#include "stats/gev.h"

#include "stats/shape_functions.h"

#include <cmath>

namespace ryn::stats {

namespace {

// 1 - kappa z must not be negative: the bound lies at z = 1/kappa, above for kappa > 0 and below
// for kappa < 0. A shape that counts as 0 has no bound, though alpha/kappa would be a number.
Interval SupportOf(const LocationScaleShape& p) {
    Interval support;
    if (IsExponentialLimit(p.kappa)) {
        return support;
    }
    (p.kappa > 0 ? support.upper : support.lower) = p.xi + p.alpha / p.kappa;
    return support;
}

} // namespace

std::optional<Gev> Gev::Make(const LocationScaleShape& values) {
    const bool valid = std::isfinite(values.xi) && std::isfinite(values.alpha) &&
                       std::isfinite(values.kappa) && values.alpha > 0;
    return valid ? std::optional<Gev>(Gev(values)) : std::nullopt;
}

Gev::Gev(const LocationScaleShape& values)
    : p(values),
      logAlpha(std::log(values.alpha)),
      support(SupportOf(values)) {}

// With y = -ln(1 - kappa z)/kappa the distribution function is exp(-exp(-y)), and
// dy/dx = exp(kappa y)/alpha. So ln f = -exp(-y) - y + ln(dy/dx)
//                                     = -ln alpha - (1 - kappa) y - exp(-y).
double Gev::LogDensityInside(double x) const {
    const double y = ReducedVariate(x);
    const double hazard = std::exp(-y);
    // Far down the left tail exp(-y) outgrows the term in y, which may be infinite as well.
    if (std::isinf(hazard)) {
        return -hazard;
    }
    return -logAlpha - DensitySlopeTerm(y, p.kappa) - hazard;
}

double Gev::CdfInside(double x) const {
    return std::exp(-std::exp(-ReducedVariate(x)));
}

// For large y this is exp(-y) to the last digit, where 1 - F would be 0.
double Gev::SurvivalInside(double x) const {
    return -std::expm1(-std::exp(-ReducedVariate(x)));
}

// F = exp(-exp(-y)) solved for y; the two forms differ only in how ln F is had: of a given F, or as
// log1p(-e) of a small exceedance.
double Gev::QuantileInside(double probability) const {
    return p.xi + p.alpha * StandardOfReduced(-std::log(-std::log(probability)), p.kappa);
}

double Gev::QuantileOfExceedanceInside(double exceedance) const {
    return p.xi + p.alpha * StandardOfReduced(-std::log(-std::log1p(-exceedance)), p.kappa);
}

double Gev::ReducedVariate(double x) const {
    return ReducedOfStandard(StandardVariate(x), p.kappa);
}

double Gev::ReducedVariateOfProbability(double probability) const {
    return -std::log(-std::log(probability));
}

double Gev::StandardVariate(double x) const {
    return (x - p.xi) / p.alpha;
}

ParameterList Gev::Parameters() const {
    return {{"xi", p.xi}, {"alpha", p.alpha}, {"kappa", p.kappa}};
}

} // namespace ryn::stats
