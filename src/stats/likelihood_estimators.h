#pragma once

#include "stats/fit_outcome.h"
#include "stats/generalised_pareto.h"
#include "stats/gev.h"
#include "stats/gumbel.h"
#include "stats/log_normal.h"
#include "stats/pearson_three.h"
#include "stats/square_root_exponential.h"
#include "stats/truncated_gumbel.h"
#include "stats/weibull.h"

#include <span>
#include <vector>

namespace ryn::stats {

/// A buffer that keeps its memory between fits; what is in it means nothing from one to the next.
using LikelihoodBuffer = std::vector<double>;

// Maximum likelihood. Every estimate is the highest maximum inside the domain named, found without
// a start from outside: all unknowns but one are eliminated in closed form or by an equation with
// one root, and what is left is walked from end to end (stats/profile_maximum.h). So an estimate
// depends on the sample alone, and refits need no start. Samples are brought to a scale free of
// units first. Besides what is named, all fail as NoInteriorMaximum for a sample without spread and
// as InvalidParameters for values that are not finite.

/// The likelihood has one maximum (Gumbel 1958). Values need not be in order.
Outcome<Gumbel> MostLikelyGumbel(std::span<const double> values, LikelihoodBuffer& buffer);

/// Prescott and Walden (1980), Coles (2001): the highest local maximum with |kappa| < 0.98; beyond
/// kappa = 1 the likelihood is unbounded, and near it often rises towards that.
/// Fails: NoInteriorMaximum.
Outcome<Gev> MostLikelyGev(std::span<const double> values, LikelihoodBuffer& buffer);

/// Two parameters above `threshold` (Davison 1984; Grimshaw 1993): the highest local maximum with
/// theta = kappa/alpha from -1000 over the mean exceedance to 0.999999 over the largest, and
/// kappa < 1. Fails: MeanExceedanceNotPositive; NoInteriorMaximum also where an end is higher.
Outcome<GeneralisedPareto> MostLikelyParetoAbove(double threshold, std::span<const double> values,
                                                 LikelihoodBuffer& buffer);

// The estimators above a threshold that follow leave out values equal to it, which have no
// logarithm as exceedances; ValuesAtThreshold where that would be more than a tenth.

/// Two parameters above `threshold`; kappa from 1e-3 to 1e3. The
/// likelihood has one maximum. Fails: MeanExceedanceNotPositive, ValuesAtThreshold.
Outcome<Weibull> MostLikelyWeibullAbove(double threshold, std::span<const double> values,
                                        LikelihoodBuffer& buffer);

/// The gamma distribution above `threshold` (Thom 1958); kappa from 1e-6 to 1e8.
/// The likelihood has one maximum. Fails: MeanExceedanceNotPositive, ValuesAtThreshold.
Outcome<PearsonThree> MostLikelyGammaAbove(double threshold, std::span<const double> values,
                                           LikelihoodBuffer& buffer);

/// Mean and standard deviation (divisor n) of ln(x - lowerBound).
/// Fails: MeanExceedanceNotPositive, ValuesAtThreshold.
Outcome<LogNormal> MostLikelyLogNormalAbove(double lowerBound, std::span<const double> values,
                                            LikelihoodBuffer& buffer);

/// Three parameters (Cohen 1951; Calitz 1973; Griffiths 1980). The likelihood is unbounded towards
/// xi = the smallest value; the estimate is the highest local maximum with xi between 1e-4 and 1e3
/// standard deviations of the sample below it. Fails: NoInteriorMaximum, as a sample does that is
/// not skewed to the right; LowerBoundTooHigh where xi rounds to the smallest value.
Outcome<LogNormal> MostLikelyLogNormal(std::span<const double> values, LikelihoodBuffer& buffer);

/// Etoh, Murota and Nakanishi (1986); b from 1e-3 to 1e5 over the mean. Values may be 0, not all.
/// Fails: ValuesNotPositive, NoInteriorMaximum.
Outcome<SquareRootExponential> MostLikelySquareRootExponential(std::span<const double> values,
                                                               LikelihoodBuffer& buffer);

/// What a truncated Gumbel distribution has become. A sample whose tail is at least as heavy as the
/// exponential's has its highest likelihood in that limit, where xi goes to minus infinity.
enum class TruncatedTail { Gumbel, Exponential };

struct TruncatedGumbelFit {
    TruncatedGumbel distribution; ///< xi = threshold - 20 alpha for TruncatedTail::Exponential
    TruncatedTail tail;
};

/// A Gumbel distribution of which only the part above `threshold` is seen; alpha from 0.05 to 20
/// mean exceedances. Fails: MeanExceedanceNotPositive, NoInteriorMaximum.
Outcome<TruncatedGumbelFit> MostLikelyTruncatedGumbel(double threshold,
                                                      std::span<const double> values,
                                                      LikelihoodBuffer& buffer);

} // namespace ryn::stats
