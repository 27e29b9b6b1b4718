#pragma once

#include "stats/interval.h"
#include "stats/parameter.h"

#include <optional>

namespace ryn::stats {

/// Weibull distribution for maxima above a lower bound, with z = (x - xi)/alpha:
///
///     F(x) = 1 - exp(-z^kappa),   x >= xi,   kappa > 0
///
/// A GEV of shape 1/kappa turned left for right (Rao and Hamed 2000). With a fixed location, xi is
/// the threshold of the series and not an estimate. What the members mean: stats/family.h.
class Weibull {
  public:
    /// Nothing unless all three are finite, alpha > 0 and kappa > 0.
    static std::optional<Weibull> Make(const LocationScaleShape& values,
                                       LocationType location = LocationType::Estimated);

    /// The parameters as they were given to Make.
    const LocationScaleShape& Values() const { return p; }

    Interval Support() const;
    /// With x finite and in Support(); plus infinity at xi for kappa < 1.
    double LogDensityInside(double x) const;
    double CdfInside(double x) const;
    double SurvivalInside(double x) const;
    /// With the probability strictly between 0 and 1.
    double QuantileInside(double probability) const;
    double QuantileOfExceedanceInside(double exceedance) const;
    /// kappa ln z, which is ln(-ln(1 - F)); minus infinity up to xi.
    double ReducedVariate(double x) const;
    double ReducedVariateOfProbability(double probability) const;
    /// z.
    double StandardVariate(double x) const;
    /// In the order in which results list them.
    ParameterList Parameters() const;

  private:
    Weibull(const LocationScaleShape& values, LocationType location);

    /// z^kappa, which is -ln(1 - F).
    double Hazard(double x) const;

    LocationScaleShape p;
    LocationType locationType;
    double logPeak; ///< ln(kappa/alpha)
};

} // namespace ryn::stats
