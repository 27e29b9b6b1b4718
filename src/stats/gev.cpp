#include "stats/gev.h"

#include "stats/shape_functions.h"

#include <cmath>

namespace ryn::stats {

namespace {

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

double Gev::SurvivalInside(double x) const {
    return -std::expm1(-std::exp(-ReducedVariate(x)));
}

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
