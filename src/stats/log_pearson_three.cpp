#include "stats/log_pearson_three.h"

#include <algorithm>
#include <cmath>
#include <limits>

namespace ryn::stats {

namespace {

// A bound in logarithms may lie beyond all doubles; below, 0 takes its place and is left out, since
// it has no logarithm.
Interval SupportOf(const LocationScaleShape& p) {
    Interval support;
    const double bound = std::exp(p.xi);
    support.lower = p.alpha > 0 ? bound : 0;
    support.lowerEnd = support.lower > 0 ? End::Included : End::Excluded;
    if (p.alpha < 0) {
        support.upper = bound;
    }
    return support;
}

} // namespace

std::optional<LogPearsonThree> LogPearsonThree::Make(const LocationScaleShape& values) {
    const auto ofLogarithm = PearsonThree::Make(values);
    const Interval support = SupportOf(values);
    const bool valid = ofLogarithm && support.lower < support.upper;
    return valid ? std::optional<LogPearsonThree>(LogPearsonThree(*ofLogarithm, support))
                 : std::nullopt;
}

LogPearsonThree::LogPearsonThree(const PearsonThree& pearson, const Interval& range)
    : ofLogarithm(pearson),
      support(range) {}

double LogPearsonThree::Logarithm(double x) const {
    const double xi = Values().xi;
    const double log = std::log(x);
    return Values().alpha > 0 ? std::max(log, xi) : std::min(log, xi);
}

// d(ln x)/dx = 1/x.
double LogPearsonThree::LogDensityInside(double x) const {
    return ofLogarithm.LogDensityInside(Logarithm(x)) - std::log(x);
}

double LogPearsonThree::CdfInside(double x) const {
    return ofLogarithm.CdfInside(Logarithm(x));
}

double LogPearsonThree::SurvivalInside(double x) const {
    return ofLogarithm.SurvivalInside(Logarithm(x));
}

double LogPearsonThree::QuantileInside(double probability) const {
    return std::exp(ofLogarithm.QuantileInside(probability));
}

double LogPearsonThree::QuantileOfExceedanceInside(double exceedance) const {
    return std::exp(ofLogarithm.QuantileOfExceedanceInside(exceedance));
}

double LogPearsonThree::ReducedVariate(double x) const {
    return StandardVariate(x);
}

double LogPearsonThree::ReducedVariateOfProbability(double probability) const {
    return ofLogarithm.ReducedVariateOfProbability(probability);
}

double LogPearsonThree::StandardVariate(double x) const {
    return ofLogarithm.StandardVariate(x <= 0 ? -std::numeric_limits<double>::infinity()
                                              : std::log(x));
}

ParameterList LogPearsonThree::Parameters() const {
    return ofLogarithm.Parameters();
}

} // namespace ryn::stats
