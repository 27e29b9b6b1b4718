#include "stats/frechet_estimators.h"

#include "stats/checked.h"
#include "stats/root.h"
#include "stats/shape_functions.h"

#include <cmath>

namespace ryn::stats {

// x/alpha is the power -h = -1/kappa of an exponential variable: mean Gamma(1 - h), and squared
// coefficient of variation Gamma(1 - 2h)/Gamma(1 - h)^2 - 1, which exists for h < 1/2.
Outcome<Frechet> FrechetFromMoments(const CentralMoments& moments) {
    if (!(moments.mean > 0)) {
        return FitFailure{FitFault::ValuesNotPositive};
    }
    const double target = std::log1p(moments.Variance() / (moments.mean * moments.mean));
    // The variance is infinite at h = 1/2; the factor takes the pole out of the solver's way.
    const auto excess = [target](double h) { return (0.5 - h) * (LogPowerSpread(-h) - target); };
    const auto h = Root(excess, {1e-9, 0.5 - 1e-12});
    if (!h) {
        return FitFailure{FitFault::NoConvergence};
    }
    return Checked(Frechet::Make({moments.mean / std::tgamma(1 - *h), 1 / *h}));
}

} // namespace ryn::stats
