#pragma once

#include "stats/interval.h"
#include "stats/parameter.h"

#include <optional>

namespace ryn::stats {

/// Frechet distribution with lower bound 0 (Gumbel 1958; Rao and Hamed 2000):
///
///     F(x) = exp(-(x/alpha)^-kappa),   x > 0,   kappa > 0
///
/// The logarithm of x is Gumbel distributed. What the members mean: stats/family.h.
class Frechet {
  public:
    /// Nothing unless both are finite, alpha > 0 and kappa > 0.
    static std::optional<Frechet> Make(const ScaleShape& values);

    /// The parameters as they were given to Make.
    const ScaleShape& Values() const { return p; }

    Interval Support() const;
    /// With x finite and in Support().
    double LogDensityInside(double x) const;
    double CdfInside(double x) const;
    double SurvivalInside(double x) const;
    /// With the probability strictly between 0 and 1.
    double QuantileInside(double probability) const;
    double QuantileOfExceedanceInside(double exceedance) const;
    /// kappa ln(x/alpha), which is -ln(-ln F); minus infinity up to 0.
    double ReducedVariate(double x) const;
    double ReducedVariateOfProbability(double probability) const;
    /// The same.
    double StandardVariate(double x) const;
    /// In the order in which results list them.
    ParameterList Parameters() const;

  private:
    explicit Frechet(const ScaleShape& values);

    /// (x/alpha)^-kappa, which is -ln F.
    double Hazard(double x) const;

    ScaleShape p;
    double logPeak; ///< ln(kappa/alpha)
};

} // namespace ryn::stats
