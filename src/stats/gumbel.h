#pragma once

#include "stats/interval.h"
#include "stats/parameter.h"

#include <optional>

namespace ryn::stats {

/// Gumbel distribution (Gumbel 1958), with z = (x - xi)/alpha:
///
///     F(x) = exp(-exp(-z)),   all x
///
/// What the members mean: stats/family.h.
class Gumbel {
  public:
    /// Nothing unless both are finite and alpha > 0.
    static std::optional<Gumbel> Make(const LocationScale& values);

    /// The parameters as they were given to Make.
    const LocationScale& Values() const { return p; }

    Interval Support() const { return {}; }
    /// With x finite and in Support().
    double LogDensityInside(double x) const;
    double CdfInside(double x) const;
    double SurvivalInside(double x) const;
    /// With the probability strictly between 0 and 1.
    double QuantileInside(double probability) const;
    double QuantileOfExceedanceInside(double exceedance) const;
    /// z, which is -ln(-ln F).
    double ReducedVariate(double x) const;
    double ReducedVariateOfProbability(double probability) const;
    /// z.
    double StandardVariate(double x) const;
    /// In the order in which results list them.
    ParameterList Parameters() const;

  private:
    explicit Gumbel(const LocationScale& values);

    LocationScale p;
    double logAlpha;
};

} // namespace ryn::stats
