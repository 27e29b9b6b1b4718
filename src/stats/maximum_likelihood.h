#pragma once

#include "stats/estimate.h"

namespace ryn::stats {

/// Estimates by maximum likelihood a combination that is offered for the series, from a sample that
/// is large enough. Fails as the estimators of stats/likelihood_estimators.h do.
Outcome<Estimate> EstimateByLikelihood(const Combination& combination, const FitInput& input,
                                       FitScratch& scratch);

} // namespace ryn::stats
