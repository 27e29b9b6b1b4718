#include "stats/exponential.h"

#include <cmath>

namespace ryn::stats {

std::optional<Exponential> Exponential::Make(const LocationScale& values, LocationType location) {
    const bool valid = std::isfinite(values.xi) && std::isfinite(values.alpha) && values.alpha > 0;
    return valid ? std::optional<Exponential>(Exponential(values, location)) : std::nullopt;
}

Exponential::Exponential(const LocationScale& values, LocationType location)
    : p(values),
      locationType(location),
      logAlpha(std::log(values.alpha)) {}

Interval Exponential::Support() const {
    Interval support;
    support.lower = p.xi;
    return support;
}

double Exponential::LogDensityInside(double x) const {
    return -logAlpha - StandardVariate(x);
}

// Just above xi, F is z to the last digit, where 1 - exp(-z) would have lost most of them.
double Exponential::CdfInside(double x) const {
    return -std::expm1(-StandardVariate(x));
}

double Exponential::SurvivalInside(double x) const {
    return std::exp(-StandardVariate(x));
}

// z is -ln e: of a given exceedance, or as log1p(-F) where F is small and e close to 1.
double Exponential::QuantileInside(double probability) const {
    return p.xi - p.alpha * std::log1p(-probability);
}

double Exponential::QuantileOfExceedanceInside(double exceedance) const {
    return p.xi - p.alpha * std::log(exceedance);
}

double Exponential::ReducedVariate(double x) const {
    return StandardVariate(x);
}

double Exponential::ReducedVariateOfProbability(double probability) const {
    return -std::log1p(-probability);
}

double Exponential::StandardVariate(double x) const {
    return (x - p.xi) / p.alpha;
}

ParameterList Exponential::Parameters() const {
    return {{"xi", p.xi, locationType == LocationType::Estimated}, {"alpha", p.alpha}};
}

} // namespace ryn::stats
