#include "stats/maximum_likelihood.h"

#include "stats/likelihood_estimators.h"

#include <algorithm>

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

Outcome<Estimate> AsEstimate(const Outcome<TruncatedGumbelFit>& fitted) {
    if (!fitted) {
        return fitted.Failure();
    }
    Estimate estimate{fitted->distribution, {}};
    if (fitted->tail == TruncatedTail::Exponential) {
        estimate.warnings.Add({FitWarningKind::ReducedToExponential});
    }
    return estimate;
}

// The lower bound of two parameters is the threshold of a partial duration series, whose zero
// exceedances may be left out, and 0 for annual maxima, which must then all be positive.
Outcome<LogNormal> LogNormalOf(const Combination& combination, const FitInput& input,
                               LikelihoodBuffer& buffer) {
    const SeriesFrame& frame = input.frame;
    if (EffectiveLocation(combination, frame.kind) == LocationType::Estimated) {
        return MostLikelyLogNormal(input.values, buffer);
    }
    if (frame.kind == SeriesKind::PartialDuration) {
        return MostLikelyLogNormalAbove(frame.threshold, input.values, buffer);
    }
    if (*std::min_element(input.values.begin(), input.values.end()) <= 0) {
        return FitFailure{FitFault::ValuesNotPositive};
    }
    return MostLikelyLogNormalAbove(0, input.values, buffer);
}

} // namespace

Outcome<Estimate> EstimateByLikelihood(const Combination& combination, const FitInput& input,
                                       FitScratch& scratch) {
    const auto values = input.values;
    const double threshold = input.frame.threshold;
    LikelihoodBuffer& buffer = scratch.likelihood;
    switch (combination.distribution) {
    case DistributionType::Gev:
        return AsEstimate(MostLikelyGev(values, buffer));
    case DistributionType::Gumbel:
        return AsEstimate(MostLikelyGumbel(values, buffer));
    case DistributionType::GeneralisedPareto:
        return AsEstimate(MostLikelyParetoAbove(threshold, values, buffer));
    case DistributionType::Weibull:
        return AsEstimate(MostLikelyWeibullAbove(threshold, values, buffer));
    case DistributionType::GammaPearson3:
        return AsEstimate(MostLikelyGammaAbove(threshold, values, buffer));
    case DistributionType::LogNormal:
        return AsEstimate(LogNormalOf(combination, input, buffer));
    case DistributionType::SquareRootExponential:
        return AsEstimate(MostLikelySquareRootExponential(values, buffer));
    case DistributionType::TruncatedGumbel:
        return AsEstimate(MostLikelyTruncatedGumbel(threshold, values, buffer));
    // The likelihood of the exponential asks for the mean alone, and the others have none here.
    case DistributionType::Exponential:
    case DistributionType::Frechet:
    case DistributionType::LogPearson3:
        break;
    }
    return FitFailure{FitFault::MethodNotOffered};
}

} // namespace ryn::stats
