#pragma once

#include "stats/interval.h"
#include "stats/parameter.h"
#include "stats/pearson_three.h"

#include <optional>

namespace ryn::stats {

/// Log-Pearson 3: the natural logarithm of x is Pearson 3 distributed (Bobee 1975; IACWD 1982).
/// The parameters are those of ln x; x > 0, and x >= exp(xi) for alpha > 0, x <= exp(xi) for
/// alpha < 0. What the members mean: stats/family.h.
class LogPearsonThree {
  public:
    /// Nothing unless PearsonThree takes the parameters and some double lies in the support.
    static std::optional<LogPearsonThree> Make(const LocationScaleShape& values);

    /// The parameters as they were given to Make.
    const LocationScaleShape& Values() const { return ofLogarithm.Values(); }

    Interval Support() const { return support; }
    /// With x finite and in Support(); plus infinity at exp(xi) for kappa < 1.
    double LogDensityInside(double x) const;
    double CdfInside(double x) const;
    double SurvivalInside(double x) const;
    /// With the probability strictly between 0 and 1.
    double QuantileInside(double probability) const;
    double QuantileOfExceedanceInside(double exceedance) const;
    /// z = (ln x - xi)/alpha; for alpha < 0 it falls as F rises. Infinite up to 0.
    double ReducedVariate(double x) const;
    double ReducedVariateOfProbability(double probability) const;
    /// z.
    double StandardVariate(double x) const;
    /// In the order in which results list them.
    ParameterList Parameters() const;

  private:
    LogPearsonThree(const PearsonThree& ofLogarithm, const Interval& support);

    /// ln x, on the right side of xi even where exp(xi) was rounded.
    double Logarithm(double x) const;

    PearsonThree ofLogarithm;
    Interval support;
};

} // namespace ryn::stats
