#pragma once

#include "stats/profile_maximum.h"

#include <span>

namespace ryn::stats {

/// The likelihood of a GEV as a function of kappa alone, xi and alpha being at their best for it.
///
/// The values are seen from the one at the edge of the support, the largest for an upper bound and
/// the smallest for a lower one. With t = -ln(1 - kappa b d)/kappa their deviations d from it have
/// a Gumbel distribution of scale 1 in t, whose location is had in closed form; ln b is left as the
/// second unknown:
///
///     l/n = ln b - ln mean(exp(-t)) - (1 - kappa) mean(t) - 1
///
/// Since kappa d is not positive, any b > 0 keeps all values inside and 1 - kappa b d never
/// cancels, however close to the values the bound comes.
///
/// At every |kappa| < 1 it has one maximum in ln b. Each evaluation begins where the path of these
/// maxima is to be expected from the last one, so that neighbouring places cost one or two passes
/// over the sample. The path is followed in ln |t| of the edge as seen from the location of a
/// Gumbel fit, which hardly changes with kappa.
class GevProfile {
  public:
    /// `fromEdge` are deviations from the largest value, for kappa >= 0, or from the smallest, for
    /// kappa <= 0, in units of the scale of a Gumbel fit; `edge` is where that value lies from the
    /// location of the fit, in the same units: the path begins at kappa = 0, b = 1. They stay the
    /// caller's.
    GevProfile(std::span<const double> fromEdge, double edge);

    /// |kappa| < 1. No value where b has no best value: with more than half of the values equal to
    /// the smallest, the likelihood of a heavy tail is unbounded.
    ProfilePoint operator()(double kappa);

    /// What xi and alpha come from.
    struct Rest {
        double b;
        double logMeanWeight; ///< ln mean(exp(-t)), minus the location in t
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
        double step;        ///< to the path, in ln |t|; downwards where the pass overflowed
        double scaleSlope;  ///< of ln b, in ln |t|
        double pathSlope;   ///< of ln |t|, in kappa
    };

    Surface SurfaceAt(double b, double kappa) const;
    double ScaleAt(double logT, double kappa) const;
    Sight Look(double logT, double kappa) const;

    std::span<const double> fromEdge;
    double edge;
    double least;         ///< of the deviations
    double lastKappa = 0; ///< where the path was met last
    double lastLogT;
    double pathSlope = 0;
};

} // namespace ryn::stats
