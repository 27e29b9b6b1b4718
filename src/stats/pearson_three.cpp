#include "stats/pearson_three.h"

#include <cmath>

namespace ryn::stats {

std::optional<PearsonThree> PearsonThree::Make(const LocationScaleShape& values,
                                               LocationType location) {
    const bool valid = std::isfinite(values.xi) && std::isfinite(values.alpha) &&
                       std::isfinite(values.kappa) && values.alpha != 0 && values.kappa > 0;
    return valid ? std::optional<PearsonThree>(PearsonThree(values, location)) : std::nullopt;
}

PearsonThree::PearsonThree(const LocationScaleShape& values, LocationType location)
    : p(values),
      locationType(location),
      gamma(values.kappa),
      logScale(std::log(std::abs(values.alpha))) {}

Interval PearsonThree::Support() const {
    Interval support;
    (p.alpha > 0 ? support.lower : support.upper) = p.xi;
    return support;
}

double PearsonThree::LogDensityInside(double x) const {
    return gamma.LogDensity(StandardVariate(x)) - logScale;
}

double PearsonThree::CdfInside(double x) const {
    const double z = StandardVariate(x);
    return p.alpha > 0 ? gamma.Lower(z) : gamma.Upper(z);
}

double PearsonThree::SurvivalInside(double x) const {
    const double z = StandardVariate(x);
    return p.alpha > 0 ? gamma.Upper(z) : gamma.Lower(z);
}

double PearsonThree::QuantileInside(double probability) const {
    return p.xi + p.alpha * ReducedVariateOfProbability(probability);
}

double PearsonThree::QuantileOfExceedanceInside(double exceedance) const {
    return p.xi + p.alpha * (p.alpha > 0 ? gamma.InverseOfUpper(exceedance)
                                         : gamma.InverseOfLower(exceedance));
}

double PearsonThree::ReducedVariate(double x) const {
    return StandardVariate(x);
}

double PearsonThree::ReducedVariateOfProbability(double probability) const {
    return p.alpha > 0 ? gamma.InverseOfLower(probability) : gamma.InverseOfUpper(probability);
}

double PearsonThree::StandardVariate(double x) const {
    return (x - p.xi) / p.alpha;
}

ParameterList PearsonThree::Parameters() const {
    return {{"xi", p.xi, locationType == LocationType::Estimated},
            {"alpha", p.alpha},
            {"kappa", p.kappa}};
}

} // namespace ryn::stats
