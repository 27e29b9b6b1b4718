#pragma once

#include "stats/profile_maximum.h"

#include <span>

namespace ryn::stats {

/// The likelihood of a GEV as a function of kappa alone, xi and alpha being at their best for it.
///
/// With t = -ln(1 - kappa b u)/kappa the deviations u have a Gumbel distribution of scale 1 in t,
/// whose location is had in closed form; ln b is left as the second unknown:
///
///     l/n = ln b - ln mean(exp(-t)) - (1 - kappa) mean(t) - 1
///
/// At every |kappa| < 1 it has one maximum in ln b. Each evaluation begins where the path of these
/// maxima is to be expected from the last one, so that neighbouring places cost one or two passes
/// over the sample. The path is followed in ln |t| of the value at the edge of the support, the
/// largest for kappa > 0 and the smallest for kappa < 0: its t hardly changes with kappa, and any
/// t keeps all values inside.
class GevProfile {
  public:
    /// The shapes that one profile is asked for; 0 belongs to both.
    enum class Side { UpperBound, LowerBound };

    /// `deviations` from a place between the smallest and the largest value, in units of the scale
    /// of a Gumbel fit: the path then begins at kappa = 0, b = 1. They stay the caller's.
    GevProfile(std::span<const double> deviations, Side side);

    /// |kappa| < 1. No value where b has no best value: with more than half of the values equal to
    /// the smallest, the likelihood of a heavy tail is unbounded.
    ProfilePoint operator()(double kappa);

    /// What xi and alpha come from.
    struct Rest {
        double b;
        double logMeanWeight; ///< ln mean(exp(-t))
    };
    Rest RestAt(double kappa);

  private:
    /// Value and derivatives in ln b and kappa.
    struct Surface {
        double value;
        double b;
        double kappa;
        double bb;
        double bKappa;
        double kappaKappa;
        double logMeanWeight;
    };
    /// Where the path is, as far as one pass over the sample tells.
    struct Sight {
        ProfilePoint point; ///< exact to second order in the step
        double step;        ///< to the path, in ln |t|; NaN where the pass overflowed
        double pathSlope;   ///< of ln |t|, in kappa
    };

    Surface SurfaceAt(double b, double kappa) const;
    double ScaleAt(double logT, double kappa) const;
    Sight Look(double logT, double kappa) const;

    std::span<const double> deviations;
    double edge;          ///< the value next to the end of the support
    double lastKappa = 0; ///< where the path was met last
    double lastLogT;
    double pathSlope = 0;
};

} // namespace ryn::stats
