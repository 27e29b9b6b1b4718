#include "stats/generalised_pareto_estimators.h"

#include "stats/checked.h"
#include "stats/root.h"

#include <cmath>

namespace ryn::stats {

// A Pareto has mean xi + alpha/(1+k), variance alpha^2/((1+k)^2 (1+2k)) and the skewness below,
// which falls from infinity at k = -1/3: the skewness gives k, then the variance alpha, then the
// mean xi.
Outcome<GeneralisedPareto> ParetoFromMoments(const CentralMoments& moments) {
    const double skewness = moments.Skewness();
    // 2 (1-k) sqrt(1+2k)/(1+3k) = G1, multiplied by 1 + 3k > 0 to take the pole away.
    const auto excess = [skewness](double k) {
        return 2 * (1 - k) * std::sqrt(1 + 2 * k) - skewness * (1 + 3 * k);
    };
    const auto kappa = Root(excess, {-1.0 / 3 + 1e-10, 100});
    if (!kappa) {
        return SkewnessOutOfRange(skewness);
    }
    const double alpha = moments.StandardDeviation() * (1 + *kappa) * std::sqrt(1 + 2 * *kappa);
    const double xi = moments.mean - alpha / (1 + *kappa);
    return Checked(GeneralisedPareto::Make({xi, alpha, *kappa}));
}

// A Pareto has the L-moments (Hosking and Wallis 1987)
//     l1 = xi + alpha/(1+k),   l2 = alpha/((1+k)(2+k)),   t3 = (1-k)/(3+k)
// and the three solve in closed form.
Outcome<GeneralisedPareto> ParetoFromLMoments(const LMoments& moments) {
    const double t3 = moments.LSkewness();
    if (!IsLSkewness(t3)) {
        return LMomentsOutOfRange(moments.LCv(), t3);
    }
    const double kappa = (1 - 3 * t3) / (1 + t3);
    const double alpha = (1 + kappa) * (2 + kappa) * moments.l2;
    const double xi = moments.l1 - (2 + kappa) * moments.l2;
    return Checked(GeneralisedPareto::Make({xi, alpha, kappa}));
}

// With xi known the squared ratio of mean exceedance and standard deviation is 1 + 2k.
Outcome<GeneralisedPareto> ParetoAboveFromMoments(double threshold, const CentralMoments& moments) {
    const double mean = moments.mean - threshold;
    if (!(mean > 0)) {
        return FitFailure{FitFault::MeanExceedanceNotPositive};
    }
    const double ratio = mean * mean / moments.Variance();
    return Checked(GeneralisedPareto::Make({threshold, mean * (ratio + 1) / 2, (ratio - 1) / 2},
                                           LocationType::Fixed));
}

// With xi known the L-Cv of the exceedances is 1/(2+k). It lies between 0 and 1 for every variable
// that takes no negative values; a sample with values below the threshold can leave that range.
Outcome<GeneralisedPareto> ParetoAboveFromLMoments(double threshold, const LMoments& moments) {
    const double mean = moments.l1 - threshold;
    if (!(mean > 0)) {
        return FitFailure{FitFault::MeanExceedanceNotPositive};
    }
    const double lCv = moments.l2 / mean;
    if (!IsLCv(lCv)) {
        return LMomentsOutOfRange(lCv, moments.LSkewness());
    }
    const double kappa = 1 / lCv - 2;
    return Checked(
        GeneralisedPareto::Make({threshold, (1 + kappa) * mean, kappa}, LocationType::Fixed));
}

} // namespace ryn::stats
