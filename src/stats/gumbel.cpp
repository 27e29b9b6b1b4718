#include "stats/gumbel.h"

#include <cmath>

namespace ryn::stats {

std::optional<Gumbel> Gumbel::Make(const LocationScale& values) {
    const bool valid = std::isfinite(values.xi) && std::isfinite(values.alpha) && values.alpha > 0;
    return valid ? std::optional<Gumbel>(Gumbel(values)) : std::nullopt;
}

Gumbel::Gumbel(const LocationScale& values) : p(values), logAlpha(std::log(values.alpha)) {}

// F = exp(-exp(-z)), so f = exp(-z) exp(-exp(-z))/alpha.
double Gumbel::LogDensityInside(double x) const {
    const double z = StandardVariate(x);
    const double hazard = std::exp(-z);
    // Far down the left tail exp(-z) outgrows z, and both may be infinite.
    return std::isinf(hazard) ? -hazard : -logAlpha - z - hazard;
}

double Gumbel::CdfInside(double x) const {
    return std::exp(-std::exp(-StandardVariate(x)));
}

// For large z this is exp(-z) to the last digit, where 1 - F would be 0.
double Gumbel::SurvivalInside(double x) const {
    return -std::expm1(-std::exp(-StandardVariate(x)));
}

// ln F is taken of a given F, or as log1p(-e) of a small exceedance.
double Gumbel::QuantileInside(double probability) const {
    return p.xi - p.alpha * std::log(-std::log(probability));
}

double Gumbel::QuantileOfExceedanceInside(double exceedance) const {
    return p.xi - p.alpha * std::log(-std::log1p(-exceedance));
}

double Gumbel::ReducedVariate(double x) const {
    return StandardVariate(x);
}

double Gumbel::ReducedVariateOfProbability(double probability) const {
    return -std::log(-std::log(probability));
}

double Gumbel::StandardVariate(double x) const {
    return (x - p.xi) / p.alpha;
}

ParameterList Gumbel::Parameters() const {
    return {{"xi", p.xi}, {"alpha", p.alpha}};
}

} // namespace ryn::stats
