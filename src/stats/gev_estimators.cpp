#include "stats/gev_estimators.h"

#include "stats/checked.h"
#include "stats/root.h"
#include "stats/shape_functions.h"

#include <cmath>

namespace ryn::stats {

// A GEV has mean xi + alpha B(kappa), variance alpha^2 A(kappa) and skewness SK(kappa): the
// skewness gives kappa, then the variance alpha, then the mean xi.
Outcome<Gev> GevFromMoments(const CentralMoments& moments) {
    const double skewness = moments.Skewness();
    // The factor 1 + 3 kappa is positive and takes the pole at kappa = -1/3 out of the way of the
    // interpolating solver.
    const auto excess = [skewness](double kappa) {
        return (1 + 3 * kappa) * (GevSkewness(kappa) - skewness);
    };
    const auto kappa = Root(excess, {-1.0 / 3 + 1e-9, 10});
    if (!kappa) {
        return SkewnessOutOfRange(skewness);
    }
    const double alpha = moments.StandardDeviation() / std::sqrt(GevVarianceFactor(*kappa));
    const double xi = moments.mean - alpha * GevMeanFactor(*kappa);
    return Checked(Gev::Make({xi, alpha, *kappa}));
}

// A GEV has the L-moments (Hosking 1990)
//     l1 = xi + alpha B(kappa)
//     l2 = alpha Gamma(1 + kappa) (1 - 2^-kappa)/kappa
// and an L-skewness that falls from 1 at kappa = -1 to -1, so that every |t3| < 1 has one kappa.
// Its mean is infinite at -1; the bracket ends just above.
Outcome<Gev> GevFromLMoments(const LMoments& moments) {
    const double t3 = moments.LSkewness();
    const FitFailure outside = LMomentsOutOfRange(moments.LCv(), t3);
    if (!IsLSkewness(t3)) {
        return outside;
    }
    const auto excess = [t3](double kappa) { return GevLSkewness(kappa) - t3; };
    const auto kappa = RootNear(excess, {-0.999999, 50}, GevShapeNear(t3), 1e-3);
    if (!kappa) {
        return outside;
    }
    const double alpha = moments.l2 / (std::tgamma(1 + *kappa) * GevLScaleFactor(*kappa));
    const double xi = moments.l1 - alpha * GevMeanFactor(*kappa);
    return Checked(Gev::Make({xi, alpha, *kappa}));
}

} // namespace ryn::stats
