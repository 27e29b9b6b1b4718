#include "stats/frechet.h"

#include <cmath>
#include <limits>

namespace ryn::stats {

std::optional<Frechet> Frechet::Make(const ScaleShape& values) {
    const bool valid = std::isfinite(values.alpha) && std::isfinite(values.kappa) &&
                       values.alpha > 0 && values.kappa > 0;
    return valid ? std::optional<Frechet>(Frechet(values)) : std::nullopt;
}

Frechet::Frechet(const ScaleShape& values)
    : p(values),
      logPeak(std::log(values.kappa) - std::log(values.alpha)) {}

Interval Frechet::Support() const {
    Interval support;
    support.lower = 0;
    support.lowerEnd = End::Excluded;
    return support;
}

double Frechet::Hazard(double x) const {
    return std::pow(x / p.alpha, -p.kappa);
}

// f = (kappa/alpha) w^(-kappa-1) exp(-w^-kappa) with w = x/alpha.
double Frechet::LogDensityInside(double x) const {
    const double hazard = Hazard(x);
    // Towards 0 the power outgrows the logarithm, and both may be infinite.
    return std::isinf(hazard) ? -hazard : logPeak - (p.kappa + 1) * std::log(x / p.alpha) - hazard;
}

double Frechet::CdfInside(double x) const {
    return std::exp(-Hazard(x));
}

// For large x this is the power itself to the last digit, where 1 - F would be 0.
double Frechet::SurvivalInside(double x) const {
    return -std::expm1(-Hazard(x));
}

// ln F is taken of a given F, or as log1p(-e) of a small exceedance.
double Frechet::QuantileInside(double probability) const {
    return p.alpha * std::pow(-std::log(probability), -1 / p.kappa);
}

double Frechet::QuantileOfExceedanceInside(double exceedance) const {
    return p.alpha * std::pow(-std::log1p(-exceedance), -1 / p.kappa);
}

double Frechet::ReducedVariate(double x) const {
    return x <= 0 ? -std::numeric_limits<double>::infinity() : p.kappa * std::log(x / p.alpha);
}

double Frechet::ReducedVariateOfProbability(double probability) const {
    return -std::log(-std::log(probability));
}

double Frechet::StandardVariate(double x) const {
    return ReducedVariate(x);
}

ParameterList Frechet::Parameters() const {
    return {{"alpha", p.alpha}, {"kappa", p.kappa}};
}

} // namespace ryn::stats
