#pragma once

#include "stats/interval.h"
#include "stats/parameter.h"

#include <optional>

namespace ryn::stats {

/// The part of a Gumbel distribution above a threshold xi0, with z = (x - xi)/alpha:
///
///     F(x) = 1 - S(x)/S(xi0),   S = 1 - exp(-exp(-z)),   x >= xi0
///
/// xi far below the threshold leaves the exponential distribution with scale alpha. What the
/// members mean: stats/family.h.
class TruncatedGumbel {
  public:
    /// Nothing unless all are finite, alpha > 0 and xi within 690 alpha of the threshold: further
    /// up the threshold cuts nothing off, further down exp((xi - threshold)/alpha) is no number.
    static std::optional<TruncatedGumbel> Make(const LocationScale& values, double threshold);

    /// The parameters as they were given to Make.
    const LocationScale& Values() const { return p; }
    double Threshold() const { return threshold; }

    Interval Support() const;
    /// With x finite and in Support().
    double LogDensityInside(double x) const;
    double CdfInside(double x) const;
    double SurvivalInside(double x) const;
    /// With the probability strictly between 0 and 1.
    double QuantileInside(double probability) const;
    double QuantileOfExceedanceInside(double exceedance) const;
    /// z, below the threshold too.
    double ReducedVariate(double x) const;
    double ReducedVariateOfProbability(double probability) const;
    /// z.
    double StandardVariate(double x) const;
    /// In the order in which results list them; the threshold belongs to the series.
    ParameterList Parameters() const;

  private:
    TruncatedGumbel(const LocationScale& values, double threshold);

    /// (x - xi0)/alpha at a probability, each from its own tail.
    double ExceedanceOfLower(double probability) const;
    double ExceedanceOfUpper(double exceedance) const;

    LocationScale p;
    double threshold;
    double cut;      ///< exp(-z) at the threshold
    double kept;     ///< S at the threshold, the share that is left
    double logScale; ///< ln(alpha S(xi0))
};

} // namespace ryn::stats
