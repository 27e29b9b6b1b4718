#pragma once

#include "stats/fixed_list.h"
#include "stats/profile_maximum.h"

#include <optional>
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
    /// How near to the path an evaluation ends: at a step in ln |t| below `largest` whose square is
    /// less than `share` of the slope in kappa.
    struct Closeness {
        double largest;
        double share;
    };

    /// `fromEdge` are deviations from the largest value, for kappa >= 0, or from the smallest, for
    /// kappa <= 0, in units of the scale of a Gumbel fit; `edge` is where that value lies from the
    /// location of the fit, in the same units: the path begins at kappa = 0, b = 1. They stay the
    /// caller's.
    GevProfile(std::span<const double> fromEdge, double edge, const Closeness& closeness);

    /// |kappa| < 1. No value where b has no best value: with more than half of the values equal to
    /// the smallest, the likelihood of a heavy tail is unbounded.
    ProfilePoint operator()(double kappa);

    /// What xi and alpha come from.
    struct Maximum {
        double kappa;
        double b;
        double logMeanWeight; ///< ln mean(exp(-t)), minus the location in t
    };
    /// The maximum in both unknowns next to `kappa`, by Newton's method: the end is a step below
    /// 2e-7 in kappa and ln b, which is still taken. Nothing where it goes astray.
    std::optional<Maximum> MaximumNear(double kappa);
    /// The path at `kappa`, for a maximum that is known closely.
    Maximum PathAt(double kappa);

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
        double weightB; ///< minus the derivatives of logMeanWeight
        double weightKappa;
    };
    /// Where the path is, as far as one pass over the sample tells.
    struct Sight {
        ProfilePoint point; ///< exact to second order in the step
        double step;        ///< to the path, in ln |t|; downwards where the pass overflowed
        double scaleSlope;  ///< of ln b, in ln |t|
        double pathSlope;   ///< of ln |t|, in kappa
    };

    /// A place on the path, with its slope there.
    struct PathPoint {
        double kappa = 0;
        double logT = 0;
        double slope = 0; ///< of logT, in kappa
    };

    double ExpectedLogT(double kappa) const;
    void GoBackTo(double kappa);
    std::optional<Maximum> MaximumFrom(double kappa) const;
    Surface SurfaceAt(double b, double kappa) const;
    double ScaleAt(double logT, double kappa) const;
    Sight Look(double logT, double kappa) const;

    std::span<const double> fromEdge;
    double edge;
    double least; ///< of the deviations
    Closeness closeness;
    PathPoint last;                ///< where the path was met last
    FixedList<PathPoint, 64> path; ///< where it was met before, as far as there is room
};

} // namespace ryn::stats
