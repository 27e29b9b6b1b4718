#include "stats/log_pearson_three_estimators.h"

#include "stats/checked.h"
#include "stats/pearson_three_estimators.h"
#include "stats/root.h"

#include <algorithm>
#include <cmath>

namespace ryn::stats {

namespace {

Outcome<LogPearsonThree> OfLogarithm(const Outcome<PearsonThree>& fitted) {
    if (!fitted) {
        return fitted.Failure();
    }
    return Checked(LogPearsonThree::Make(fitted->Values()));
}

// r ln(1 - alpha) - ln(1 - r alpha): the logarithm of the r-th moment over the r-th power of the
// mean, for kappa = 1. Around 0 the sum over j >= 2 of (r^j - r) alpha^j/j, since the terms of
// first order cancel.
double MomentExcess(double r, double alpha) {
    if (std::abs(alpha) >= 1e-3) {
        return r * std::log1p(-alpha) - std::log1p(-r * alpha);
    }
    double sum = 0;
    double power = alpha;
    double powerOfR = r;
    for (int j = 2; j <= 13; ++j) {
        power *= alpha;
        powerOfR *= r;
        sum += (powerOfR - r) * power / j;
    }
    return sum;
}

// 3 at alpha = 0, where both are 0.
double ExcessRatio(double alpha) {
    return alpha == 0 ? 3.0 : MomentExcess(3, alpha) / MomentExcess(2, alpha);
}

} // namespace

Outcome<LogPearsonThree> LogPearsonThreeFromLogMoments(const CentralMoments& ofLogarithms) {
    return OfLogarithm(PearsonThreeFromMoments(ofLogarithms));
}

Outcome<LogPearsonThree> LogPearsonThreeFromLogLMoments(const LMoments& ofLogarithms) {
    return OfLogarithm(PearsonThreeFromLMoments(ofLogarithms));
}

// The r-th moment about 0 is exp(r xi) (1 - r alpha)^-kappa. In ratios to powers of the mean xi
// drops out, and they follow from central moments without loss:
//     mu_2/m^2 = 1 + M_2/m^2,   mu_3/m^3 = 1 + 3 M_2/m^2 + M_3/m^3
Outcome<LogPearsonThree> LogPearsonThreeFromMoments(const CentralMoments& moments) {
    const double m = moments.mean;
    if (!(m > 0)) {
        return FitFailure{FitFault::ValuesNotPositive};
    }
    const double c2 = moments.m2 / m / m;
    const double second = std::log1p(c2);
    const double third = std::log1p(3 * c2 + moments.m3 / m / m / m);
    // In v = -ln(1 - 3 alpha) the ratio grows like v towards the pole at alpha = 1/3, and the long
    // way down to -1000 is short.
    const auto alphaOf = [](double v) { return -std::expm1(-v) / 3; };
    const double target = third / second;
    const auto excess = [&](double v) { return ExcessRatio(alphaOf(v)) - target; };
    const auto v = Root(excess, {-std::log1p(3000), -std::log(3e-13)});
    if (!v) {
        return SkewnessOutOfRange(moments.Skewness());
    }
    double alpha = alphaOf(*v);
    // kappa is all but second/alpha^2. Narrow samples have small alphas of their own.
    const double smallest = std::min(1e-6, 1e-5 * std::sqrt(second));
    if (std::abs(alpha) < smallest) {
        alpha = alpha < 0 ? -smallest : smallest;
    }
    const double kappa = second / MomentExcess(2, alpha);
    return Checked(LogPearsonThree::Make({std::log(m) + kappa * std::log1p(-alpha), alpha, kappa}));
}

} // namespace ryn::stats
