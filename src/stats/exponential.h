#pragma once

#include "stats/interval.h"
#include "stats/parameter.h"

#include <optional>

namespace ryn::stats {

/// Exponential distribution, with z = (x - xi)/alpha:
///
///     F(x) = 1 - exp(-z),   x >= xi
///
/// With a fixed location, xi is the threshold of the series and not an estimate (Shane and Lynn
/// 1964; Stedinger et al. 1993). What the members mean: stats/family.h.
class Exponential {
  public:
    /// Nothing unless both are finite and alpha > 0.
    static std::optional<Exponential> Make(const LocationScale& values,
                                           LocationType location = LocationType::Estimated);

    /// The parameters as they were given to Make.
    const LocationScale& Values() const { return p; }

    Interval Support() const;
    /// With x finite and in Support().
    double LogDensityInside(double x) const;
    double CdfInside(double x) const;
    double SurvivalInside(double x) const;
    /// With the probability strictly between 0 and 1.
    double QuantileInside(double probability) const;
    double QuantileOfExceedanceInside(double exceedance) const;
    /// z, which is -ln(1 - F); negative below xi.
    double ReducedVariate(double x) const;
    double ReducedVariateOfProbability(double probability) const;
    /// z.
    double StandardVariate(double x) const;
    /// In the order in which results list them.
    ParameterList Parameters() const;

  private:
    Exponential(const LocationScale& values, LocationType location);

    LocationScale p;
    LocationType locationType;
    double logAlpha;
};

} // namespace ryn::stats
