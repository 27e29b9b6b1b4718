#pragma once

#include "stats/interval.h"
#include "stats/parameter.h"

#include <optional>

namespace ryn::stats {

/// Log-normal distribution (Aitchison and Brown 1957; Kite 1977): ln(x - xi) is normal with mean mu
/// and standard deviation sigma,
///
///     F(x) = Phi(w),   w = (ln(x - xi) - mu)/sigma,   x > xi
///
/// With a fixed location, xi is 0 or the threshold of the series and not an estimate. What the
/// members mean: stats/family.h.
class LogNormal {
  public:
    /// Nothing unless all three are finite and sigma > 0.
    static std::optional<LogNormal> Make(const LowerBoundMeanDeviation& values,
                                         LocationType location = LocationType::Estimated);

    /// The parameters as they were given to Make.
    const LowerBoundMeanDeviation& Values() const { return p; }

    Interval Support() const;
    /// With x finite and in Support().
    double LogDensityInside(double x) const;
    double CdfInside(double x) const;
    double SurvivalInside(double x) const;
    /// With the probability strictly between 0 and 1.
    double QuantileInside(double probability) const;
    double QuantileOfExceedanceInside(double exceedance) const;
    /// w; minus infinity up to xi.
    double ReducedVariate(double x) const;
    double ReducedVariateOfProbability(double probability) const;
    /// w.
    double StandardVariate(double x) const;
    /// In the order in which results list them.
    ParameterList Parameters() const;

  private:
    LogNormal(const LowerBoundMeanDeviation& values, LocationType location);

    LowerBoundMeanDeviation p;
    LocationType locationType;
    double logNorm; ///< ln(sigma sqrt(2 pi))
};

} // namespace ryn::stats
