#include "stats/distribution.h"

namespace ryn::stats {

// Inside the lambdas the argument is one of the families, so that the calls below go to the
// function templates of stats/family.h and not back to these.

Interval Support(const Distribution& d) {
    return std::visit([](const auto& family) { return Support(family); }, d);
}

double LogDensity(const Distribution& d, double x) {
    return std::visit([x](const auto& family) { return LogDensity(family, x); }, d);
}

double Density(const Distribution& d, double x) {
    return std::visit([x](const auto& family) { return Density(family, x); }, d);
}

double Cdf(const Distribution& d, double x) {
    return std::visit([x](const auto& family) { return Cdf(family, x); }, d);
}

double Survival(const Distribution& d, double x) {
    return std::visit([x](const auto& family) { return Survival(family, x); }, d);
}

double Quantile(const Distribution& d, double probability) {
    return std::visit([=](const auto& family) { return Quantile(family, probability); }, d);
}

double QuantileOfExceedance(const Distribution& d, double exceedance) {
    return std::visit([=](const auto& family) { return QuantileOfExceedance(family, exceedance); },
                      d);
}

double ReducedVariate(const Distribution& d, double x) {
    return std::visit([x](const auto& family) { return ReducedVariate(family, x); }, d);
}

double ReducedVariateOfProbability(const Distribution& d, double probability) {
    return std::visit(
        [=](const auto& family) { return ReducedVariateOfProbability(family, probability); }, d);
}

double StandardVariate(const Distribution& d, double x) {
    return std::visit([x](const auto& family) { return StandardVariate(family, x); }, d);
}

ParameterList Parameters(const Distribution& d) {
    return std::visit([](const auto& family) { return Parameters(family); }, d);
}

ParameterList EstimatedParameters(const Distribution& d) {
    ParameterList estimated;
    for (const Parameter& parameter : Parameters(d)) {
        if (parameter.estimated) {
            estimated.Add(parameter);
        }
    }
    return estimated;
}

} // namespace ryn::stats
