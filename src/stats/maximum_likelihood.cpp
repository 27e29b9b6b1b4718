#include "stats/maximum_likelihood.h"

#include "stats/likelihood_estimators.h"

namespace ryn::stats {

namespace {

// Every estimator gives its own family; here they become one type.
template <class D>
Outcome<Estimate> AsEstimate(const Outcome<D>& fitted) {
    if (!fitted) {
        return fitted.Failure();
    }
    return Estimate{*fitted, {}};
}

} // namespace

Outcome<Estimate> EstimateByLikelihood(const Combination& combination, const FitInput& input,
                                       FitScratch& scratch) {
    const double threshold = input.frame.threshold;
    switch (combination.distribution) {
    case DistributionType::Gev:
        return AsEstimate(MostLikelyGev(input.values, scratch.likelihood));
    case DistributionType::Gumbel:
        return AsEstimate(MostLikelyGumbel(input.values, scratch.likelihood));
    case DistributionType::GeneralisedPareto:
        return AsEstimate(MostLikelyParetoAbove(threshold, input.values, scratch.likelihood));
    default:
        return FitFailure{FitFault::NotAvailable};
    }
}

} // namespace ryn::stats
