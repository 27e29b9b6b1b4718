#include "stats/estimate.h"

#include "stats/exponential_estimators.h"
#include "stats/generalised_pareto_estimators.h"
#include "stats/gev_estimators.h"
#include "stats/maximum_likelihood.h"

#include <optional>

namespace ryn::stats {

namespace {

constexpr FitFailure kNotAvailable{FitFault::NotAvailable};

// Every estimator gives its own family; here they become one type.
template <class D>
Outcome<Estimate> AsEstimate(const Outcome<D>& fitted) {
    if (!fitted) {
        return fitted.Failure();
    }
    return Estimate{*fitted, {}};
}

// The rules that come before any estimation, in one place for all.
std::optional<FitFailure> Refusal(const Combination& c, SeriesKind kind, std::size_t count) {
    switch (OfferOf(c, kind)) {
    case Offer::DistributionNotOffered:
        return FitFailure{FitFault::DistributionNotOffered, {}, kind};
    case Offer::MethodNotOffered:
        return FitFailure{FitFault::MethodNotOffered};
    case Offer::Offered:
        break;
    }
    const std::size_t needed = MinimumCount(c, kind);
    if (count < needed) {
        return FitFailure{FitFault::TooFewValues,
                          {static_cast<double>(count), static_cast<double>(needed)}};
    }
    return std::nullopt;
}

bool HasFixedLocation(const Combination& c, const SeriesFrame& frame) {
    return EffectiveLocation(c, frame.kind) == LocationType::Fixed;
}

// The constants cost two logarithms a value and change with the sample size alone.
Outcome<Estimate> GumbelByMoments(const Combination& c, const CentralMoments& moments,
                                  FitScratch& scratch) {
    if (!c.sampleCorrection) {
        return AsEstimate(GumbelFromMoments(moments));
    }
    if (scratch.gumbel.count != moments.count) {
        scratch.gumbel = GumbelConstantsFor(moments.count);
    }
    return AsEstimate(GumbelFromMoments(moments, scratch.gumbel));
}

Outcome<Estimate> ByMoments(const Combination& c, const SeriesFrame& frame,
                            const CentralMoments& moments, FitScratch& scratch) {
    const bool fixed = HasFixedLocation(c, frame);
    switch (c.distribution) {
    case DistributionType::Gev:
        return AsEstimate(GevFromMoments(moments));
    case DistributionType::Gumbel:
        return GumbelByMoments(c, moments, scratch);
    case DistributionType::GeneralisedPareto:
        return AsEstimate(fixed ? ParetoAboveFromMoments(frame.threshold, moments)
                                : ParetoFromMoments(moments));
    case DistributionType::Exponential:
        return AsEstimate(fixed ? ExponentialAbove(frame.threshold, moments.mean)
                                : ExponentialFromMoments(moments));
    default:
        return kNotAvailable;
    }
}

Outcome<Estimate> ByLMoments(const Combination& c, const SeriesFrame& frame,
                             const LMoments& moments) {
    const bool fixed = HasFixedLocation(c, frame);
    switch (c.distribution) {
    case DistributionType::Gev:
        return AsEstimate(GevFromLMoments(moments));
    case DistributionType::Gumbel:
        return AsEstimate(GumbelFromLMoments(moments));
    case DistributionType::GeneralisedPareto:
        return AsEstimate(fixed ? ParetoAboveFromLMoments(frame.threshold, moments)
                                : ParetoFromLMoments(moments));
    case DistributionType::Exponential:
        return AsEstimate(fixed ? ExponentialAbove(frame.threshold, moments.l1)
                                : ExponentialFromLMoments(moments));
    default:
        return kNotAvailable;
    }
}

// The buffer keeps its memory between calls, so that only the first of many refits allocates.
LMoments LMomentsOfInput(const FitInput& input, FitScratch& scratch) {
    if (input.order == ValueOrder::Ascending) {
        return LMomentsOfSorted(input.values);
    }
    scratch.sorted.assign(input.values.begin(), input.values.end());
    SortAscending(scratch.sorted);
    return LMomentsOfSorted(scratch.sorted);
}

} // namespace

// The exponential's likelihood asks for the mean alone.
EstimationBasis BasisOf(const Combination& combination) {
    switch (combination.method) {
    case EstimationMethod::Moments:
        return EstimationBasis::Moments;
    case EstimationMethod::LMoments:
        return EstimationBasis::LMoments;
    case EstimationMethod::MaximumLikelihood:
        break;
    }
    return combination.distribution == DistributionType::Exponential ? EstimationBasis::Moments
                                                                     : EstimationBasis::Values;
}

Outcome<Estimate> EstimateParameters(const Combination& combination, const FitInput& input,
                                     FitScratch& scratch) {
    if (const auto refusal = Refusal(combination, input.frame.kind, input.values.size())) {
        return *refusal;
    }
    switch (BasisOf(combination)) {
    case EstimationBasis::Moments:
        return ByMoments(combination, input.frame, CentralMomentsOf(input.values), scratch);
    case EstimationBasis::LMoments:
        return ByLMoments(combination, input.frame, LMomentsOfInput(input, scratch));
    case EstimationBasis::Values:
        break;
    }
    return EstimateByLikelihood(combination, input, scratch);
}

Outcome<Estimate> EstimateFromMoments(const Combination& combination, const SeriesFrame& frame,
                                      const CentralMoments& moments, FitScratch& scratch) {
    if (const auto refusal = Refusal(combination, frame.kind, moments.count)) {
        return *refusal;
    }
    if (BasisOf(combination) != EstimationBasis::Moments) {
        return FitFailure{FitFault::MethodNotOffered};
    }
    return ByMoments(combination, frame, moments, scratch);
}

Outcome<Estimate> EstimateFromLMoments(const Combination& combination, const SeriesFrame& frame,
                                       const LMoments& moments) {
    if (const auto refusal = Refusal(combination, frame.kind, moments.count)) {
        return *refusal;
    }
    if (BasisOf(combination) != EstimationBasis::LMoments) {
        return FitFailure{FitFault::MethodNotOffered};
    }
    return ByLMoments(combination, frame, moments);
}

} // namespace ryn::stats
