#pragma once

#include "stats/fit_outcome.h"
#include "stats/pearson_three.h"
#include "stats/sample_statistics.h"

namespace ryn::stats {

/// Three parameters in closed form from mean, s and sample skewness (Bobee and Ashkar 1991). A
/// skewness within 0.001 of 0 counts as 0.001 with its sign (plus within 1e-7), which moves the
/// 100-year event by less than 0.001 s. Fails: InvalidParameters.
Outcome<PearsonThree> PearsonThreeFromMoments(const CentralMoments& moments);

/// Three parameters from l1, l2 and L-skewness (Hosking and Wallis 1997); an L-skewness within 1e-4
/// of 0 counts as 1e-4 with its sign (plus within 1e-7). Fails: LMomentsOutOfRange,
/// InvalidParameters.
Outcome<PearsonThree> PearsonThreeFromLMoments(const LMoments& moments);

/// The gamma distribution above `threshold`: alpha = s^2/my, kappa = my^2/s^2 with the mean
/// exceedance my (Bobee and Ashkar 1991). Fails: MeanExceedanceNotPositive, InvalidParameters.
Outcome<PearsonThree> GammaAboveFromMoments(double threshold, const CentralMoments& moments);

/// The gamma distribution above `threshold`, kappa from the L-Cv of the exceedances (Hosking 1990).
/// Fails: MeanExceedanceNotPositive, LMomentsOutOfRange, InvalidParameters.
Outcome<PearsonThree> GammaAboveFromLMoments(double threshold, const LMoments& moments);

} // namespace ryn::stats
