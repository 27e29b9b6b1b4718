#pragma once

#include "stats/exponential.h"
#include "stats/family.h"
#include "stats/frechet.h"
#include "stats/generalised_pareto.h"
#include "stats/gev.h"
#include "stats/gumbel.h"
#include "stats/log_normal.h"
#include "stats/log_pearson_three.h"
#include "stats/pearson_three.h"
#include "stats/square_root_exponential.h"
#include "stats/truncated_gumbel.h"
#include "stats/weibull.h"

#include <cstddef>
#include <variant>

namespace ryn::stats {

/// Any of the distributions, as a value. The functions of stats/family.h exist for it under the
/// same names and with the same meaning; a loop over many values of one distribution does better to
/// std::visit once and call them inside.
using Distribution =
    std::variant<Gev, Gumbel, Weibull, Frechet, GeneralisedPareto, PearsonThree, LogPearsonThree,
                 LogNormal, Exponential, SquareRootExponential, TruncatedGumbel>;

Interval Support(const Distribution& d);
double LogDensity(const Distribution& d, double x);
double Density(const Distribution& d, double x);
double Cdf(const Distribution& d, double x);
double Survival(const Distribution& d, double x);
double Quantile(const Distribution& d, double probability);
double QuantileOfExceedance(const Distribution& d, double exceedance);
double ReducedVariate(const Distribution& d, double x);
double ReducedVariateOfProbability(const Distribution& d, double probability);
double StandardVariate(const Distribution& d, double x);
ParameterList Parameters(const Distribution& d);

/// The parameters that were estimated, in the order in which results list them; their number is
/// the p of the information criteria and of the minimum sample size.
ParameterList EstimatedParameters(const Distribution& d);

} // namespace ryn::stats
