#pragma once

namespace ryn::stats {

// Functions of the shape kappa that the GEV, the generalised Pareto and (reflected) the Weibull
// distribution share. The sign is Hosking's: kappa > 0 means an upper bound, kappa < 0 a heavy
// tail; it is minus the shape of Coles (2001). A shape closer to 0 than 1e-14 counts as 0.

/// True where kappa is so small that the exponential limit is used.
bool IsExponentialLimit(double kappa);

/// y = -ln(1 - kappa z)/kappa, and z for kappa = 0. Plus infinity for kappa > 0 at and beyond
/// z = 1/kappa, minus infinity for kappa < 0 at and below it.
double ReducedOfStandard(double z, double kappa);

/// z = (1 - exp(-kappa y))/kappa, and y for kappa = 0: the inverse.
double StandardOfReduced(double y, double kappa);

/// (1 - kappa) y for a y that may be infinite: 0 for kappa = 1.
double DensitySlopeTerm(double y, double kappa);

/// A(kappa) = (Gamma(1 + 2 kappa) - Gamma(1 + kappa)^2)/kappa^2: the variance of a GEV with
/// alpha = 1. kappa > -1/2; relative error below 1e-13.
double GevVarianceFactor(double kappa);

/// B(kappa) = (1 - Gamma(1 + kappa))/kappa: the mean of a GEV with xi = 0, alpha = 1. kappa > -1.
double GevMeanFactor(double kappa);

/// SK(kappa): the skewness of a GEV (Jenkinson 1955; Stedinger et al. 1993). kappa > -1/3,
/// decreasing from plus infinity; 1.1395... at 0. Relative error below 1e-11.
double GevSkewness(double kappa);

/// L-skewness of a GEV, 2 (1 - 3^-kappa)/(1 - 2^-kappa) - 3 (Hosking et al. 1985). kappa > -1,
/// decreasing from 1 to -1; 2 ln 3/ln 2 - 3 at 0.
double GevLSkewness(double kappa);

/// A kappa with about that L-skewness, from which to solve for it (Hosking et al. 1985); the error
/// is below 9e-4 for L-skewness between -0.5 and 0.5.
double GevShapeNear(double lSkewness);

/// (1 - 2^-kappa)/kappa, and ln 2 at 0: the second L-moment of a GEV with alpha = 1 over
/// Gamma(1 + kappa).
double GevLScaleFactor(double kappa);

/// ln(1 + v) with v the squared coefficient of variation of the h-th power of a standard
/// exponential variable, ln Gamma(1 + 2h) - 2 ln Gamma(1 + h), h > -1/2: that of a Weibull variable
/// for h > 0, of a Frechet variable for h < 0. Accurate around h = 0, where it vanishes.
double LogPowerSpread(double h);

} // namespace ryn::stats
