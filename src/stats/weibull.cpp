#include "stats/weibull.h"

#include <cmath>
#include <limits>

namespace ryn::stats {

std::optional<Weibull> Weibull::Make(const LocationScaleShape& values, LocationType location) {
    const bool valid = std::isfinite(values.xi) && std::isfinite(values.alpha) &&
                       std::isfinite(values.kappa) && values.alpha > 0 && values.kappa > 0;
    return valid ? std::optional<Weibull>(Weibull(values, location)) : std::nullopt;
}

Weibull::Weibull(const LocationScaleShape& values, LocationType location)
    : p(values),
      locationType(location),
      logPeak(std::log(values.kappa) - std::log(values.alpha)) {}

Interval Weibull::Support() const {
    Interval support;
    support.lower = p.xi;
    return support;
}

double Weibull::Hazard(double x) const {
    return std::pow(StandardVariate(x), p.kappa);
}

// f = (kappa/alpha) z^(kappa-1) exp(-z^kappa).
double Weibull::LogDensityInside(double x) const {
    const double hazard = Hazard(x);
    if (std::isinf(hazard)) {
        return -hazard; // ln z is lost beside it, and may be infinite itself
    }
    // Without the power of z, whose logarithm is infinite at xi.
    return p.kappa == 1 ? logPeak - hazard
                        : logPeak + (p.kappa - 1) * std::log(StandardVariate(x)) - hazard;
}

// Just above xi, F is z^kappa to the last digit, where 1 - exp(-z^kappa) would have lost most.
double Weibull::CdfInside(double x) const {
    return -std::expm1(-Hazard(x));
}

double Weibull::SurvivalInside(double x) const {
    return std::exp(-Hazard(x));
}

// z^kappa is -ln e: of a given exceedance, or as log1p(-F) where F is small and e close to 1.
double Weibull::QuantileInside(double probability) const {
    return p.xi + p.alpha * std::pow(-std::log1p(-probability), 1 / p.kappa);
}

double Weibull::QuantileOfExceedanceInside(double exceedance) const {
    return p.xi + p.alpha * std::pow(-std::log(exceedance), 1 / p.kappa);
}

double Weibull::ReducedVariate(double x) const {
    const double z = StandardVariate(x);
    return z <= 0 ? -std::numeric_limits<double>::infinity() : p.kappa * std::log(z);
}

double Weibull::ReducedVariateOfProbability(double probability) const {
    return std::log(-std::log1p(-probability));
}

double Weibull::StandardVariate(double x) const {
    return (x - p.xi) / p.alpha;
}

ParameterList Weibull::Parameters() const {
    return {{"xi", p.xi, locationType == LocationType::Estimated},
            {"alpha", p.alpha},
            {"kappa", p.kappa}};
}

} // namespace ryn::stats
