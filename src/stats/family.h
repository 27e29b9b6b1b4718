#pragma once

#include "stats/interval.h"
#include "stats/parameter.h"

#include <cmath>
#include <concepts>
#include <cstddef>
#include <limits>

namespace ryn::stats {

/// What each probability distribution of this folder is: a small value that holds its parameters,
/// checked when it is made (`Make` gives nothing for parameters that are not valid) and constant
/// from then on. The members named here are the formulas alone: those that end in "Inside" are
/// asked only for a finite x in the support, or for a probability strictly between 0 and 1. All
/// else (ends, infinities, NaN) is decided once for all families by the free functions below,
/// and it is these that callers use.
///
/// Both tails have a formula of their own (through expm1 and log1p) and keep their relative
/// accuracy down to probabilities of 1e-12 and beyond; nothing is one minus something else.
template <class D>
concept Family = requires(const D& d, double v) {
    { d.Support() } -> std::convertible_to<Interval>;
    { d.LogDensityInside(v) } -> std::same_as<double>;
    { d.CdfInside(v) } -> std::same_as<double>;
    { d.SurvivalInside(v) } -> std::same_as<double>;
    { d.QuantileInside(v) } -> std::same_as<double>;
    { d.QuantileOfExceedanceInside(v) } -> std::same_as<double>;
    { d.ReducedVariate(v) } -> std::same_as<double>;
    { d.ReducedVariateOfProbability(v) } -> std::same_as<double>;
    { d.StandardVariate(v) } -> std::same_as<double>;
    { d.Parameters() } -> std::same_as<ParameterList>;
};

/// The values that `d` can take.
template <Family D>
Interval Support(const D& d) {
    return d.Support();
}

/// ln f(x); minus infinity outside the support, plus infinity where the density has a pole at an
/// end of it, NaN for NaN.
template <Family D>
double LogDensity(const D& d, double x) {
    if (d.Support().Contains(x)) {
        return d.LogDensityInside(x);
    }
    return std::isnan(x) ? x : -std::numeric_limits<double>::infinity();
}

/// f(x), in one over the unit of x; 0 outside the support.
template <Family D>
double Density(const D& d, double x) {
    return std::exp(LogDensity(d, x));
}

/// F(x), the probability of a value not above x: 0 below the support, 1 above it.
template <Family D>
double Cdf(const D& d, double x) {
    const Interval support = d.Support();
    if (support.Contains(x)) {
        return d.CdfInside(x);
    }
    return std::isnan(x) ? x : (x <= support.lower ? 0.0 : 1.0);
}

/// 1 - F(x) by its own formula: the exceedance probability of x.
template <Family D>
double Survival(const D& d, double x) {
    const Interval support = d.Support();
    if (support.Contains(x)) {
        return d.SurvivalInside(x);
    }
    return std::isnan(x) ? x : (x <= support.lower ? 1.0 : 0.0);
}

/// x with F(x) = `probability`. The ends of the support for 0 and 1; NaN outside [0, 1].
template <Family D>
double Quantile(const D& d, double probability) {
    if (probability > 0 && probability < 1) {
        return d.QuantileInside(probability);
    }
    if (probability == 0) {
        return d.Support().lower;
    }
    return probability == 1 ? d.Support().upper : std::numeric_limits<double>::quiet_NaN();
}

/// x with 1 - F(x) = `exceedance`: the form for rare events, since 1e-12 is exact here and not
/// as 1 - 1e-12. The ends of the support for 1 and 0; NaN outside [0, 1].
template <Family D>
double QuantileOfExceedance(const D& d, double exceedance) {
    if (exceedance > 0 && exceedance < 1) {
        return d.QuantileOfExceedanceInside(exceedance);
    }
    if (exceedance == 1) {
        return d.Support().lower;
    }
    return exceedance == 0 ? d.Support().upper : std::numeric_limits<double>::quiet_NaN();
}

/// u(x), the abscissa of the paper on which the fitted curve is a straight line (Takara and
/// Takasao 1988), by the model's own formula and never through F. The formula goes on below an
/// estimated lower bound where it is defined there; past a bound at which it diverges it is plus
/// or minus infinity. It rises with x, but for Pearson 3 and log-Pearson 3 with alpha < 0.
template <Family D>
double ReducedVariate(const D& d, double x) {
    return d.ReducedVariate(x);
}

/// u as a function of F; infinite at 0 or 1 where the family's is, NaN outside [0, 1].
template <Family D>
double ReducedVariateOfProbability(const D& d, double probability) {
    if (probability >= 0 && probability <= 1) {
        return d.ReducedVariateOfProbability(probability);
    }
    return std::numeric_limits<double>::quiet_NaN();
}

/// s(x), the standard variate of the standard least-squares criterion (Takara and Takasao 1988):
/// (x - xi)/alpha for most families, and like it not bound to the support.
template <Family D>
double StandardVariate(const D& d, double x) {
    return d.StandardVariate(x);
}

/// All parameters, the given ones too.
template <Family D>
ParameterList Parameters(const D& d) {
    return d.Parameters();
}

} // namespace ryn::stats
