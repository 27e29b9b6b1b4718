#pragma once

#include "stats/interval.h"
#include "stats/parameter.h"

#include <optional>

namespace ryn::stats {

/// Generalised extreme value distribution (Jenkinson 1955), with z = (x - xi)/alpha:
///
///     F(x) = exp(-(1 - kappa z)^(1/kappa)),   exp(-exp(-z)) for kappa = 0
///
/// kappa > 0: x <= xi + alpha/kappa; kappa < 0: x >= xi + alpha/kappa (Hosking's sign). All
/// formulas go through y = -ln(1 - kappa z)/kappa, which is smooth through kappa = 0.
/// What the members mean: stats/family.h.
class Gev {
  public:
    /// Nothing unless all three are finite and alpha > 0.
    static std::optional<Gev> Make(const LocationScaleShape& values);

    /// The parameters as they were given to Make.
    const LocationScaleShape& Values() const { return p; }

    Interval Support() const { return support; }
    /// With x finite and in Support().
    double LogDensityInside(double x) const;
    double CdfInside(double x) const;
    double SurvivalInside(double x) const;
    /// With the probability strictly between 0 and 1.
    double QuantileInside(double probability) const;
    double QuantileOfExceedanceInside(double exceedance) const;
    /// y, which is -ln(-ln F).
    double ReducedVariate(double x) const;
    double ReducedVariateOfProbability(double probability) const;
    /// z.
    double StandardVariate(double x) const;
    /// In the order in which results list them.
    ParameterList Parameters() const;

  private:
    explicit Gev(const LocationScaleShape& values);

    LocationScaleShape p;
    double logAlpha;
    Interval support;
};

} // namespace ryn::stats
