#pragma once

namespace ryn::stats {

/// Phi(w), the standard normal distribution function; accurate down to its smallest values.
/// 1 - Phi(w) is NormalCdf(-w).
double NormalCdf(double w);

/// w with Phi(w) = `probability`: minus and plus infinity for 0 and 1, NaN outside.
double NormalQuantile(double probability);

} // namespace ryn::stats
