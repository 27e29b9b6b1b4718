#pragma once

#include "stats/fit_outcome.h"
#include "stats/gumbel.h"
#include "stats/sample_statistics.h"

#include <cstddef>

namespace ryn::stats {

/// Mean and standard deviation (divisor n) of the reduced variates -ln(-ln(i/(n + 1))), i = 1..n,
/// the constants of Gumbel's finite-sample form (Gumbel 1958).
struct GumbelConstants {
    std::size_t count = 0;
    double mean = 0;
    double deviation = 0;
};

GumbelConstants GumbelConstantsFor(std::size_t count);

/// alpha = s sqrt(6)/pi, xi = m - gE alpha with Euler's constant gE (Gumbel 1958).
/// Fails: InvalidParameters.
Outcome<Gumbel> GumbelFromMoments(const CentralMoments& moments);

/// alpha = s/sy, xi = m - ybar alpha with the constants for the sample size.
/// Fails: InvalidParameters.
Outcome<Gumbel> GumbelFromMoments(const CentralMoments& moments, const GumbelConstants& constants);

/// alpha = l2/ln 2, xi = l1 - gE alpha (Hosking 1990). Fails: InvalidParameters.
Outcome<Gumbel> GumbelFromLMoments(const LMoments& moments);

} // namespace ryn::stats
