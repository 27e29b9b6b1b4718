#pragma once

#include "stats/interval.h"
#include "stats/parameter.h"

#include <optional>

namespace ryn::stats {

/// Generalised Pareto distribution (Pickands 1975; Hosking and Wallis 1987), with
/// z = (x - xi)/alpha:
///
///     F(x) = 1 - (1 - kappa z)^(1/kappa),   1 - exp(-z) for kappa = 0
///
/// x >= xi, and x <= xi + alpha/kappa for kappa > 0 (Hosking's sign). With a fixed location, xi is
/// the threshold of the series and not an estimate. What the members mean: stats/family.h.
class GeneralisedPareto {
  public:
    /// Nothing unless all three are finite and alpha > 0.
    static std::optional<GeneralisedPareto> Make(const LocationScaleShape& values,
                                                 LocationType location = LocationType::Estimated);

    /// The parameters as they were given to Make.
    const LocationScaleShape& Values() const { return p; }

    Interval Support() const { return support; }
    /// With x finite and in Support(); plus infinity at the upper end for kappa > 1.
    double LogDensityInside(double x) const;
    double CdfInside(double x) const;
    double SurvivalInside(double x) const;
    /// With the probability strictly between 0 and 1.
    double QuantileInside(double probability) const;
    double QuantileOfExceedanceInside(double exceedance) const;
    /// y = -ln(1 - kappa z)/kappa, which is -ln(1 - F); negative below xi.
    double ReducedVariate(double x) const;
    double ReducedVariateOfProbability(double probability) const;
    /// z.
    double StandardVariate(double x) const;
    /// In the order in which results list them.
    ParameterList Parameters() const;

  private:
    GeneralisedPareto(const LocationScaleShape& values, LocationType location);

    LocationScaleShape p;
    LocationType locationType;
    double logAlpha;
    Interval support;
};

} // namespace ryn::stats
