#include "stats/generalised_pareto.h"

#include "stats/shape_functions.h"

#include <cmath>

namespace ryn::stats {

namespace {

// 1 - kappa z must not be negative: only kappa > 0 sets an upper bound, at z = 1/kappa.
Interval SupportOf(const LocationScaleShape& p) {
    Interval support;
    support.lower = p.xi;
    if (p.kappa > 0 && !IsExponentialLimit(p.kappa)) {
        support.upper = p.xi + p.alpha / p.kappa;
    }
    return support;
}

} // namespace

std::optional<GeneralisedPareto> GeneralisedPareto::Make(const LocationScaleShape& values,
                                                         LocationType location) {
    const bool valid = std::isfinite(values.xi) && std::isfinite(values.alpha) &&
                       std::isfinite(values.kappa) && values.alpha > 0;
    return valid ? std::optional<GeneralisedPareto>(GeneralisedPareto(values, location))
                 : std::nullopt;
}

GeneralisedPareto::GeneralisedPareto(const LocationScaleShape& values, LocationType location)
    : p(values),
      locationType(location),
      logAlpha(std::log(values.alpha)),
      support(SupportOf(values)) {}

// With y = -ln(1 - kappa z)/kappa the survival function is exp(-y), and dy/dx = exp(kappa y)/alpha.
// So ln f = -y + ln(dy/dx) = -ln alpha - (1 - kappa) y.
double GeneralisedPareto::LogDensityInside(double x) const {
    return -logAlpha - DensitySlopeTerm(ReducedVariate(x), p.kappa);
}

double GeneralisedPareto::CdfInside(double x) const {
    return -std::expm1(-ReducedVariate(x));
}

double GeneralisedPareto::SurvivalInside(double x) const {
    return std::exp(-ReducedVariate(x));
}

// y is -ln e: of a given exceedance, or as log1p(-F) where F is small and e close to 1.
double GeneralisedPareto::QuantileInside(double probability) const {
    return p.xi + p.alpha * StandardOfReduced(-std::log1p(-probability), p.kappa);
}

double GeneralisedPareto::QuantileOfExceedanceInside(double exceedance) const {
    return p.xi + p.alpha * StandardOfReduced(-std::log(exceedance), p.kappa);
}

double GeneralisedPareto::ReducedVariate(double x) const {
    return ReducedOfStandard(StandardVariate(x), p.kappa);
}

double GeneralisedPareto::ReducedVariateOfProbability(double probability) const {
    return -std::log1p(-probability);
}

double GeneralisedPareto::StandardVariate(double x) const {
    return (x - p.xi) / p.alpha;
}

ParameterList GeneralisedPareto::Parameters() const {
    return {{"xi", p.xi, locationType == LocationType::Estimated},
            {"alpha", p.alpha},
            {"kappa", p.kappa}};
}

} // namespace ryn::stats
