#pragma once

#include "stats/interval.h"
#include "stats/parameter.h"

#include <optional>

namespace ryn::stats {

/// Square-root exponential type distribution of the maximum (Etoh, Murota and Nakanishi 1986),
/// made for rainfall totals; with r = sqrt(b x):
///
///     F(x) = exp(-a (1 + r) exp(-r)),   x >= 0,   a > 0, b > 0
///
/// The value 0 has a probability of its own, F(0) = exp(-a): quantiles up to it are 0. What the
/// members mean: stats/family.h.
class SquareRootExponential {
  public:
    /// Nothing unless both are finite and > 0.
    static std::optional<SquareRootExponential> Make(const SquareRootParameters& values);

    /// The parameters as they were given to Make.
    const SquareRootParameters& Values() const { return p; }

    Interval Support() const;
    /// With x finite and in Support(); of the values above 0.
    double LogDensityInside(double x) const;
    double CdfInside(double x) const;
    double SurvivalInside(double x) const;
    /// With the probability strictly between 0 and 1.
    double QuantileInside(double probability) const;
    double QuantileOfExceedanceInside(double exceedance) const;
    /// r - ln(a (1 + r)), which is -ln(-ln F); minus infinity below 0.
    double ReducedVariate(double x) const;
    double ReducedVariateOfProbability(double probability) const;
    /// b x.
    double StandardVariate(double x) const;
    /// In the order in which results list them.
    ParameterList Parameters() const;

  private:
    explicit SquareRootExponential(const SquareRootParameters& values);

    double Root(double x) const;
    /// a (1 + r) exp(-r), which is -ln F.
    double Hazard(double r) const;
    double QuantileOfHazard(double hazard) const;

    SquareRootParameters p;
    double logPeak; ///< ln(a b/2)
};

} // namespace ryn::stats
