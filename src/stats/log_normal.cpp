#include "stats/log_normal.h"

#include "stats/normal_functions.h"

#include <cmath>
#include <limits>
#include <numbers>

namespace ryn::stats {

std::optional<LogNormal> LogNormal::Make(const LowerBoundMeanDeviation& values,
                                         LocationType location) {
    const bool valid = std::isfinite(values.xi) && std::isfinite(values.mu) &&
                       std::isfinite(values.sigma) && values.sigma > 0;
    return valid ? std::optional<LogNormal>(LogNormal(values, location)) : std::nullopt;
}

LogNormal::LogNormal(const LowerBoundMeanDeviation& values, LocationType location)
    : p(values),
      locationType(location),
      logNorm(std::log(values.sigma) + 0.5 * std::log(2 * std::numbers::pi)) {}

Interval LogNormal::Support() const {
    Interval support;
    support.lower = p.xi;
    support.lowerEnd = End::Excluded;
    return support;
}

// f = exp(-w^2/2)/(sigma sqrt(2 pi) (x - xi)).
double LogNormal::LogDensityInside(double x) const {
    const double w = StandardVariate(x);
    return -w * w / 2 - std::log(x - p.xi) - logNorm;
}

// Each tail is a complementary error function, which is accurate where it is small.
double LogNormal::CdfInside(double x) const {
    return NormalCdf(StandardVariate(x));
}

double LogNormal::SurvivalInside(double x) const {
    return NormalCdf(-StandardVariate(x));
}

double LogNormal::QuantileInside(double probability) const {
    return p.xi + std::exp(p.mu + p.sigma * NormalQuantile(probability));
}

double LogNormal::QuantileOfExceedanceInside(double exceedance) const {
    return p.xi + std::exp(p.mu - p.sigma * NormalQuantile(exceedance));
}

double LogNormal::ReducedVariate(double x) const {
    return StandardVariate(x);
}

double LogNormal::ReducedVariateOfProbability(double probability) const {
    return NormalQuantile(probability);
}

double LogNormal::StandardVariate(double x) const {
    return x <= p.xi ? -std::numeric_limits<double>::infinity()
                     : (std::log(x - p.xi) - p.mu) / p.sigma;
}

ParameterList LogNormal::Parameters() const {
    return {
        {"xi", p.xi, locationType == LocationType::Estimated}, {"mu", p.mu}, {"sigma", p.sigma}};
}

} // namespace ryn::stats
