#include "stats/truncated_gumbel.h"

#include <cmath>
#include <limits>

namespace ryn::stats {

// In all that follows c = exp(-z(xi0)) and y = (x - xi0)/alpha, so that exp(-z) = c exp(-y).

std::optional<TruncatedGumbel> TruncatedGumbel::Make(const LocationScale& values,
                                                     double threshold) {
    const bool valid = std::isfinite(values.xi) && std::isfinite(values.alpha) &&
                       values.alpha > 0 && std::isfinite(threshold) &&
                       std::abs((values.xi - threshold) / values.alpha) <= 690;
    return valid ? std::optional<TruncatedGumbel>(TruncatedGumbel(values, threshold))
                 : std::nullopt;
}

TruncatedGumbel::TruncatedGumbel(const LocationScale& values, double truncation)
    : p(values),
      threshold(truncation),
      cut(std::exp((values.xi - truncation) / values.alpha)),
      kept(-std::expm1(-cut)),
      logScale(std::log(values.alpha) + std::log(kept)) {}

Interval TruncatedGumbel::Support() const {
    Interval support;
    support.lower = threshold;
    return support;
}

double TruncatedGumbel::LogDensityInside(double x) const {
    const double z = StandardVariate(x);
    return -z - cut * std::exp(-(x - threshold) / p.alpha) - logScale;
}

// With G = exp(-exp(-z)), G - G(xi0) = -G expm1(c expm1(-y)) keeps its digits down to y = 0.
double TruncatedGumbel::CdfInside(double x) const {
    const double y = (x - threshold) / p.alpha;
    return -std::exp(-cut * std::exp(-y)) * std::expm1(cut * std::expm1(-y)) / kept;
}

double TruncatedGumbel::SurvivalInside(double x) const {
    const double y = (x - threshold) / p.alpha;
    return -std::expm1(-cut * std::exp(-y)) / kept;
}

// G = G0 + F S0 with G0 = exp(-c), S0 = 1 - G0. Near the threshold, where F S0/G0 is small, the
// solution for y keeps its digits as
//     y = -ln(-ln(G)/c) = -log1p(-log1p(F S0/G0)/c)
// while for a threshold far down the left tail S0/G0 = expm1(c) overflows.
double TruncatedGumbel::ExceedanceOfLower(double probability) const {
    if (probability > 0.5) {
        return ExceedanceOfUpper(1 - probability);
    }
    const double gain = probability * std::expm1(cut);
    if (gain < 1) {
        return -std::log1p(-std::log1p(gain) / cut);
    }
    return -std::log(-std::log(std::exp(-cut) + probability * kept) / cut);
}

double TruncatedGumbel::ExceedanceOfUpper(double exceedance) const {
    return exceedance > 0.5 ? ExceedanceOfLower(1 - exceedance)
                            : -std::log(-std::log1p(-exceedance * kept) / cut);
}

double TruncatedGumbel::QuantileInside(double probability) const {
    return threshold + p.alpha * ExceedanceOfLower(probability);
}

double TruncatedGumbel::QuantileOfExceedanceInside(double exceedance) const {
    return threshold + p.alpha * ExceedanceOfUpper(exceedance);
}

double TruncatedGumbel::ReducedVariate(double x) const {
    return StandardVariate(x);
}

double TruncatedGumbel::ReducedVariateOfProbability(double probability) const {
    return (threshold - p.xi) / p.alpha + ExceedanceOfLower(probability);
}

double TruncatedGumbel::StandardVariate(double x) const {
    return (x - p.xi) / p.alpha;
}

ParameterList TruncatedGumbel::Parameters() const {
    return {{"xi", p.xi}, {"alpha", p.alpha}};
}

} // namespace ryn::stats
