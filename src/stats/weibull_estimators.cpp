#include "stats/weibull_estimators.h"

#include "stats/checked.h"
#include "stats/root.h"
#include "stats/shape_functions.h"

#include <cmath>
#include <numbers>

namespace ryn::stats {

// All in h = 1/kappa. (x - xi)/alpha is the h-th power of an exponential variable, a GEV variable
// of shape h turned left for right: mean Gamma(1+h), variance h^2 A(h), skewness -SK(h), second
// L-moment Gamma(1+h) (1 - 2^-h), L-skewness minus that of the GEV.

Outcome<Weibull> WeibullFromMoments(const CentralMoments& moments) {
    const double skewness = moments.Skewness();
    // The inverse hyperbolic sine levels a skewness that reaches 1e5 at h = 10, for the solver.
    const double target = std::asinh(skewness);
    const auto excess = [target](double h) { return std::asinh(-GevSkewness(h)) - target; };
    const auto h = Root(excess, {1e-8, 10});
    if (!h) {
        return SkewnessOutOfRange(skewness);
    }
    const double alpha = moments.StandardDeviation() / (*h * std::sqrt(GevVarianceFactor(*h)));
    const double xi = moments.mean - alpha * std::tgamma(1 + *h);
    return Checked(Weibull::Make({xi, alpha, 1 / *h}));
}

Outcome<Weibull> WeibullFromLMoments(const LMoments& moments) {
    const double t3 = moments.LSkewness();
    if (!IsLSkewness(t3)) {
        return LMomentsOutOfRange(moments.LCv(), t3);
    }
    const auto excess = [t3](double h) { return GevLSkewness(h) + t3; };
    const auto h = RootNear(excess, {1e-9, 100}, GevShapeNear(-t3), 1e-3);
    if (!h) {
        return LMomentsOutOfRange(moments.LCv(), t3);
    }
    const double mean = std::tgamma(1 + *h);
    const double alpha = moments.l2 / (mean * *h * GevLScaleFactor(*h));
    return Checked(Weibull::Make({moments.l1 - alpha * mean, alpha, 1 / *h}));
}

// Solved in ln h, in which the equation is all but linear: near h = 0 the left side goes with h^2.
Outcome<Weibull> WeibullAboveFromMoments(double threshold, const CentralMoments& moments) {
    const double mean = moments.mean - threshold;
    if (!(mean > 0)) {
        return FitFailure{FitFault::MeanExceedanceNotPositive};
    }
    const double variation = moments.StandardDeviation() / mean;
    const double target = std::log(std::log1p(variation * variation));
    const auto excess = [target](double logH) {
        return std::log(LogPowerSpread(std::exp(logH))) - target;
    };
    const auto logH =
        RootNear(excess, {std::log(1e-8), std::log(100.0)}, 1.086 * std::log(variation), 0.1);
    if (!logH) {
        return FitFailure{FitFault::NoConvergence};
    }
    const double h = std::exp(*logH);
    return Checked(
        Weibull::Make({threshold, mean / std::tgamma(1 + h), 1 / h}, LocationType::Fixed));
}

// L-Cv 1 - 2^-h.
Outcome<Weibull> WeibullAboveFromLMoments(double threshold, const LMoments& moments) {
    const double mean = moments.l1 - threshold;
    if (!(mean > 0)) {
        return FitFailure{FitFault::MeanExceedanceNotPositive};
    }
    const double lCv = moments.l2 / mean;
    if (!IsLCv(lCv)) {
        return LMomentsOutOfRange(lCv, moments.LSkewness());
    }
    const double h = -std::log1p(-lCv) / std::numbers::ln2;
    return Checked(
        Weibull::Make({threshold, mean / std::tgamma(1 + h), 1 / h}, LocationType::Fixed));
}

} // namespace ryn::stats
