#include "stats/estimate.h"

#include "stats/exponential_estimators.h"
#include "stats/frechet_estimators.h"
#include "stats/generalised_pareto_estimators.h"
#include "stats/gev_estimators.h"
#include "stats/log_normal_estimators.h"
#include "stats/log_pearson_three_estimators.h"
#include "stats/maximum_likelihood.h"
#include "stats/pearson_three_estimators.h"
#include "stats/weibull_estimators.h"

#include <algorithm>
#include <cmath>
#include <optional>

namespace ryn::stats {

namespace {

constexpr FitFailure kNotOffered{FitFault::MethodNotOffered};

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
        return kNotOffered;
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

// The log-normal's bound where it is not estimated; annual maxima have no threshold.
double FixedBound(const SeriesFrame& frame) {
    return frame.kind == SeriesKind::AnnualMaximum ? 0 : frame.threshold;
}

bool IsByOrderStatistics(const Combination& c) {
    return c.distribution == DistributionType::LogNormal && c.method == EstimationMethod::Moments &&
           c.location == LocationType::Estimated &&
           (c.logNormal == LogNormalType::LowerBoundQuantileI ||
            c.logNormal == LogNormalType::LowerBoundQuantileII);
}

// Estimators that take logarithms of the values, or whose formula takes one of their mean alone but
// means a variable that is never 0 or less.
bool NeedsPositiveValues(const Combination& c, SeriesKind kind) {
    switch (c.distribution) {
    case DistributionType::Frechet:
    case DistributionType::LogPearson3:
        return true;
    case DistributionType::LogNormal:
        break;
    default:
        return false;
    }
    if (IsByOrderStatistics(c)) {
        return c.logNormal == LogNormalType::LowerBoundQuantileI;
    }
    return c.method == EstimationMethod::Moments && c.location == LocationType::Fixed &&
           kind == SeriesKind::AnnualMaximum;
}

bool ArePositive(std::span<const double> values) {
    return std::all_of(values.begin(), values.end(), [](double x) { return x > 0; });
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

Outcome<Estimate> LogNormalByMoments(const Combination& c, const SeriesFrame& frame,
                                     const CentralMoments& moments) {
    if (HasFixedLocation(c, frame)) {
        return AsEstimate(LogNormalAboveFromMoments(FixedBound(frame), moments));
    }
    const double skewness = CorrectedSkewness(moments, c.logNormal);
    const auto fitted = LogNormalFromMoments(moments, skewness);
    if (!fitted) {
        return fitted.Failure();
    }
    Estimate estimate{*fitted, {}};
    if (c.logNormal == LogNormalType::SkewnessCorrectionII &&
        !IsCalibrated(moments.count, skewness)) {
        estimate.warnings.Add({FitWarningKind::SkewnessCorrectionRange});
    }
    return estimate;
}

// A mean of 0 or less is not a mean exceedance where there is no threshold.
Outcome<Estimate> LogNormalByLMoments(const SeriesFrame& frame, const LMoments& moments) {
    if (frame.kind == SeriesKind::AnnualMaximum && !(moments.l1 > 0)) {
        return FitFailure{FitFault::LMomentsOutOfRange, {moments.LCv(), moments.LSkewness()}};
    }
    return AsEstimate(LogNormalAboveFromLMoments(FixedBound(frame), moments));
}

Outcome<Estimate> ByMoments(const Combination& c, const SeriesFrame& frame,
                            const CentralMoments& moments, FitScratch& scratch) {
    const bool fixed = HasFixedLocation(c, frame);
    switch (c.distribution) {
    case DistributionType::Gev:
        return AsEstimate(GevFromMoments(moments));
    case DistributionType::Gumbel:
        return GumbelByMoments(c, moments, scratch);
    case DistributionType::Weibull:
        return AsEstimate(fixed ? WeibullAboveFromMoments(frame.threshold, moments)
                                : WeibullFromMoments(moments));
    case DistributionType::Frechet:
        return AsEstimate(FrechetFromMoments(moments));
    case DistributionType::GammaPearson3:
        return AsEstimate(fixed ? GammaAboveFromMoments(frame.threshold, moments)
                                : PearsonThreeFromMoments(moments));
    case DistributionType::LogPearson3:
        return AsEstimate(c.logPearson == LogPearsonType::RealSpace
                              ? LogPearsonThreeFromMoments(moments)
                              : LogPearsonThreeFromLogMoments(moments));
    case DistributionType::LogNormal:
        return LogNormalByMoments(c, frame, moments);
    case DistributionType::GeneralisedPareto:
        return AsEstimate(fixed ? ParetoAboveFromMoments(frame.threshold, moments)
                                : ParetoFromMoments(moments));
    case DistributionType::Exponential:
        return AsEstimate(fixed ? ExponentialAbove(frame.threshold, moments.mean)
                                : ExponentialFromMoments(moments));
    default:
        return kNotOffered;
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
    case DistributionType::Weibull:
        return AsEstimate(fixed ? WeibullAboveFromLMoments(frame.threshold, moments)
                                : WeibullFromLMoments(moments));
    case DistributionType::GammaPearson3:
        return AsEstimate(fixed ? GammaAboveFromLMoments(frame.threshold, moments)
                                : PearsonThreeFromLMoments(moments));
    case DistributionType::LogPearson3:
        return AsEstimate(LogPearsonThreeFromLogLMoments(moments));
    case DistributionType::LogNormal:
        return LogNormalByLMoments(frame, moments);
    case DistributionType::GeneralisedPareto:
        return AsEstimate(fixed ? ParetoAboveFromLMoments(frame.threshold, moments)
                                : ParetoFromLMoments(moments));
    case DistributionType::Exponential:
        return AsEstimate(fixed ? ExponentialAbove(frame.threshold, moments.l1)
                                : ExponentialFromLMoments(moments));
    default:
        return kNotOffered;
    }
}

// The buffer keeps its memory between calls, so that only the first of many refits allocates.
std::span<const double> Ascending(const FitInput& input, FitScratch& scratch) {
    if (input.order == ValueOrder::Ascending) {
        return input.values;
    }
    scratch.sorted.assign(input.values.begin(), input.values.end());
    SortAscending(scratch.sorted);
    return scratch.sorted;
}

// In the order of the values.
std::span<const double> Logarithms(std::span<const double> values, FitScratch& scratch) {
    scratch.logarithms.resize(values.size());
    std::transform(values.begin(), values.end(), scratch.logarithms.begin(),
                   [](double x) { return std::log(x); });
    return scratch.logarithms;
}

Outcome<Estimate> ByOrderStatistics(const Combination& c, std::span<const double> ascending) {
    return AsEstimate(c.logNormal == LogNormalType::LowerBoundQuantileI
                          ? LogNormalByBoundI(ascending)
                          : LogNormalByBoundII(ascending));
}

} // namespace

EstimationBasis BasisOf(const Combination& combination) {
    const DistributionType distribution = combination.distribution;
    const bool logPearson = distribution == DistributionType::LogPearson3;
    switch (combination.method) {
    case EstimationMethod::Moments:
        if (IsByOrderStatistics(combination)) {
            return EstimationBasis::Values;
        }
        return logPearson && combination.logPearson != LogPearsonType::RealSpace
                   ? EstimationBasis::LogMoments
                   : EstimationBasis::Moments;
    case EstimationMethod::LMoments:
        return logPearson ? EstimationBasis::LogLMoments : EstimationBasis::LMoments;
    case EstimationMethod::MaximumLikelihood:
        break;
    }
    return distribution == DistributionType::Exponential ? EstimationBasis::Moments
                                                         : EstimationBasis::Values;
}

Outcome<Estimate> EstimateParameters(const Combination& combination, const FitInput& input,
                                     FitScratch& scratch) {
    if (const auto refusal = Refusal(combination, input.frame.kind, input.values.size())) {
        return *refusal;
    }
    if (NeedsPositiveValues(combination, input.frame.kind) && !ArePositive(input.values)) {
        return FitFailure{FitFault::ValuesNotPositive};
    }
    if (IsByOrderStatistics(combination)) {
        return ByOrderStatistics(combination, Ascending(input, scratch));
    }
    const auto& [values, frame, order] = input;
    switch (BasisOf(combination)) {
    case EstimationBasis::Moments:
        return ByMoments(combination, frame, CentralMomentsOf(values), scratch);
    case EstimationBasis::LMoments:
        return ByLMoments(combination, frame, LMomentsOfSorted(Ascending(input, scratch)));
    case EstimationBasis::LogMoments:
        return ByMoments(combination, frame, CentralMomentsOf(Logarithms(values, scratch)),
                         scratch);
    case EstimationBasis::LogLMoments:
        return ByLMoments(combination, frame,
                          LMomentsOfSorted(Logarithms(Ascending(input, scratch), scratch)));
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
    const EstimationBasis basis = BasisOf(combination);
    if (basis != EstimationBasis::Moments && basis != EstimationBasis::LogMoments) {
        return FitFailure{FitFault::MethodNotOffered};
    }
    return ByMoments(combination, frame, moments, scratch);
}

Outcome<Estimate> EstimateFromLMoments(const Combination& combination, const SeriesFrame& frame,
                                       const LMoments& moments) {
    if (const auto refusal = Refusal(combination, frame.kind, moments.count)) {
        return *refusal;
    }
    const EstimationBasis basis = BasisOf(combination);
    if (basis != EstimationBasis::LMoments && basis != EstimationBasis::LogLMoments) {
        return FitFailure{FitFault::MethodNotOffered};
    }
    return ByLMoments(combination, frame, moments);
}

} // namespace ryn::stats
