#pragma once

#include "stats/exponential.h"
#include "stats/fit_outcome.h"
#include "stats/generalised_pareto.h"
#include "stats/gev.h"
#include "stats/gumbel.h"

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

} // namespace ryn::stats
