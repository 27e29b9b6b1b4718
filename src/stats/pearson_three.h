#pragma once

#include "stats/interval.h"
#include "stats/parameter.h"
#include "stats/standard_gamma.h"

#include <optional>

namespace ryn::stats {

/// Pearson's third distribution, the gamma distribution with a location (Bobee and Ashkar 1991),
/// with z = (x - xi)/alpha, kappa > 0 and the regularised incomplete gamma functions P and Q:
///
///     alpha > 0: F(x) = P(kappa, z),  x >= xi        alpha < 0: F(x) = Q(kappa, z),  x <= xi
///
/// The skewness is 2/sqrt(kappa) with the sign of alpha. With a fixed location, xi is the threshold
/// of the series and not an estimate. What the members mean: stats/family.h.
class PearsonThree {
  public:
    /// Nothing unless all three are finite, alpha is not 0 and kappa > 0.
    static std::optional<PearsonThree> Make(const LocationScaleShape& values,
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
    /// z, the quantile of the gamma distribution; for alpha < 0 it falls as F rises.
    double ReducedVariate(double x) const;
    double ReducedVariateOfProbability(double probability) const;
    /// z.
    double StandardVariate(double x) const;
    /// In the order in which results list them.
    ParameterList Parameters() const;

  private:
    PearsonThree(const LocationScaleShape& values, LocationType location);

    LocationScaleShape p;
    LocationType locationType;
    StandardGamma gamma;
    double logScale; ///< ln |alpha|
};

} // namespace ryn::stats
