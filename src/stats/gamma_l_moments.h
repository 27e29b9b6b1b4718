#pragma once

namespace ryn::stats {

// L-moments of the gamma distribution with scale 1 and shape kappa > 0 (Hosking 1990).

/// l2 = Gamma(kappa + 1/2)/(sqrt(pi) Gamma(kappa)).
double GammaLScale(double kappa);

/// L-Cv, l2/kappa: falls from 1 at kappa = 0 to 0.
double GammaLCv(double kappa);

/// L-skewness, 6 I(1/3; kappa, 2 kappa) - 3 with the regularised incomplete beta function: falls
/// from 1 at kappa = 0 to 0. Relative error below 1e-13.
double GammaLSkewness(double kappa);

/// A shape with about that L-Cv, 0 < lCv < 1, from which to solve for it; Hosking (1990).
double GammaShapeNearLCv(double lCv);

/// A shape with about that L-skewness, 0 < lSkewness < 1; Hosking (1990).
double GammaShapeNearLSkewness(double lSkewness);

} // namespace ryn::stats
