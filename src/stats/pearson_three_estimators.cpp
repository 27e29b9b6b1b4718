#include "stats/pearson_three_estimators.h"

#include "stats/checked.h"
#include "stats/gamma_l_moments.h"
#include "stats/root.h"

#include <cmath>

namespace ryn::stats {

namespace {

// Without skewness the distribution is normal, with infinite kappa. What rounding leaves of a
// symmetric sample has no sign of its own, else a change of unit could turn the fit around.
double AwayFromZero(double skewness, double smallest) {
    constexpr double kRounding = 1e-7;
    return std::abs(skewness) < smallest ? (skewness < -kRounding ? -smallest : smallest)
                                         : skewness;
}

} // namespace

// Mean xi + kappa alpha, variance kappa alpha^2, skewness 2/sqrt(kappa) with the sign of alpha.
Outcome<PearsonThree> PearsonThreeFromMoments(const CentralMoments& moments) {
    const double g = AwayFromZero(moments.Skewness(), 0.001);
    const double s = moments.StandardDeviation();
    return Checked(PearsonThree::Make({moments.mean - 2 * s / g, s * g / 2, 4 / (g * g)}));
}

// Both equations are solved in ln kappa for the logarithm of the left side, which falls like
// -ln(kappa)/2 for large kappa.

Outcome<PearsonThree> PearsonThreeFromLMoments(const LMoments& moments) {
    const FitFailure outside = LMomentsOutOfRange(moments.LCv(), moments.LSkewness());
    const double t3 = AwayFromZero(moments.LSkewness(), 1e-4);
    const double size = std::abs(t3);
    if (!IsLSkewness(t3)) {
        return outside;
    }
    const auto excess = [size](double logKappa) {
        return std::log(GammaLSkewness(std::exp(logKappa)) / size);
    };
    const auto logKappa =
        RootNear(excess, {-12, 17}, std::log(GammaShapeNearLSkewness(size)), 1e-4);
    if (!logKappa) {
        return outside;
    }
    const double kappa = std::exp(*logKappa);
    const double alpha = std::copysign(moments.l2 / GammaLScale(kappa), t3);
    return Checked(PearsonThree::Make({moments.l1 - kappa * alpha, alpha, kappa}));
}

Outcome<PearsonThree> GammaAboveFromMoments(double threshold, const CentralMoments& moments) {
    const double mean = moments.mean - threshold;
    if (!(mean > 0)) {
        return FitFailure{FitFault::MeanExceedanceNotPositive};
    }
    const double alpha = moments.Variance() / mean;
    return Checked(PearsonThree::Make({threshold, alpha, mean / alpha}, LocationType::Fixed));
}

Outcome<PearsonThree> GammaAboveFromLMoments(double threshold, const LMoments& moments) {
    const double mean = moments.l1 - threshold;
    if (!(mean > 0)) {
        return FitFailure{FitFault::MeanExceedanceNotPositive};
    }
    const double lCv = moments.l2 / mean;
    const FitFailure outside = LMomentsOutOfRange(lCv, moments.LSkewness());
    if (!IsLCv(lCv)) {
        return outside;
    }
    const auto excess = [lCv](double logKappa) {
        return std::log(GammaLCv(std::exp(logKappa)) / lCv);
    };
    const auto logKappa = RootNear(excess, {-20, 25}, std::log(GammaShapeNearLCv(lCv)), 1e-3);
    if (!logKappa) {
        return outside;
    }
    const double kappa = std::exp(*logKappa);
    return Checked(PearsonThree::Make({threshold, mean / kappa, kappa}, LocationType::Fixed));
}

} // namespace ryn::stats
