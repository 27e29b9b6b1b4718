#pragma once

namespace ryn::stats {

// The regularised incomplete gamma functions for k > 0 and z >= 0, plus infinity included; NaN
// outside. The relative error of each is below 2e-14 down to values of 1e-12, and grows slowly
// beyond. The cost does not grow with k: samples of little skewness lead to k in the millions.

/// P(k, z), the integral of t^(k-1) e^-t/Gamma(k) from 0 to z.
double LowerGamma(double k, double z);

/// Q(k, z) = 1 - P(k, z), by its own formula.
double UpperGamma(double k, double z);

} // namespace ryn::stats
