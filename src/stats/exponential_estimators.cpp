#include "stats/exponential_estimators.h"

#include "stats/checked.h"

namespace ryn::stats {

// The mean exceedance is the first moment, the first L-moment and the only sufficient statistic, so
// that the three methods agree.
Outcome<Exponential> ExponentialAbove(double threshold, double meanOfValues) {
    const double alpha = meanOfValues - threshold;
    if (!(alpha > 0)) {
        return FitFailure{FitFault::MeanExceedanceNotPositive};
    }
    return Checked(Exponential::Make({threshold, alpha}, LocationType::Fixed));
}

// Mean xi + alpha and standard deviation alpha.
Outcome<Exponential> ExponentialFromMoments(const CentralMoments& moments) {
    const double alpha = moments.StandardDeviation();
    return Checked(Exponential::Make({moments.mean - alpha, alpha}));
}

// l1 = xi + alpha and l2 = alpha/2.
Outcome<Exponential> ExponentialFromLMoments(const LMoments& moments) {
    const double alpha = 2 * moments.l2;
    return Checked(Exponential::Make({moments.l1 - alpha, alpha}));
}

} // namespace ryn::stats
