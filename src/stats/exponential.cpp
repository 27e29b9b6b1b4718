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

double Exponential::CdfInside(double x) const {
    return -std::expm1(-StandardVariate(x));
}

double Exponential::SurvivalInside(double x) const {
    return std::exp(-StandardVariate(x));
}

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
