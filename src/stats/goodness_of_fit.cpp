#include "stats/goodness_of_fit.h"

#include <boost/math/special_functions/gamma.hpp>

#include <algorithm>
#include <cmath>
#include <limits>
#include <numbers>

namespace ryn::stats {

namespace {

constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();

// Many classes see fine differences and few have the counts that the limit distribution needs:
// Moore's growth with n^0.4, five values a class, and at least one degree of freedom.
std::size_t ClassCount(std::size_t count, std::size_t parameterCount) {
    const auto byMoore =
        static_cast<std::size_t>(std::ceil(2 * std::pow(static_cast<double>(count), 0.4)));
    return std::max(std::min(count / 5, byMoore), parameterCount + 2);
}

// F is 0 or 1 outside the support. In this order min and max also turn NaN into a class.
void CountValues(const Distribution& d, std::span<const double> values,
                 std::vector<ChiSquaredClass>& classes) {
    const auto k = static_cast<double>(classes.size());
    std::visit(
        [&](const auto& family) {
            for (const double x : values) {
                const double j = std::min(k - 1, std::max(0.0, k * Cdf(family, x)));
                ++classes[static_cast<std::size_t>(j)].observed;
            }
        },
        d);
}

std::vector<ChiSquaredClass> EmptyClasses(const Distribution& d, std::size_t count) {
    std::vector<ChiSquaredClass> classes(count);
    const auto k = static_cast<double>(count);
    for (std::size_t j = 0; j < count; ++j) {
        classes[j].lower = j == 0 ? Support(d).lower : classes[j - 1].upper;
        classes[j].upper = Quantile(d, static_cast<double>(j + 1) / k);
    }
    return classes;
}

// Q(df/2, x/2) is the survival function of chi-squared.
double ChiSquaredSurvival(std::size_t degreesOfFreedom, double x) {
    return boost::math::gamma_q(static_cast<double>(degreesOfFreedom) / 2, x / 2);
}

struct Step {
    double distance = -1;
    double empirical = 0;
};

// The step function of the sample jumps at the i-th value, so that each has two distances to F.
Step LargerStep(double f, double before, double after) {
    return after - f > f - before ? Step{after - f, after} : Step{f - before, before};
}

} // namespace

ChiSquaredTest ChiSquaredTestOf(const Distribution& d, std::span<const double> values) {
    const std::size_t p = EstimatedParameters(d).size();
    ChiSquaredTest test;
    test.classes = EmptyClasses(d, ClassCount(values.size(), p));
    CountValues(d, values, test.classes);
    const std::size_t k = test.classes.size();
    test.expected = static_cast<double>(values.size()) / static_cast<double>(k);
    test.degreesOfFreedom = k - 1 - p;
    for (ChiSquaredClass& c : test.classes) {
        const double difference = static_cast<double>(c.observed) - test.expected;
        c.contribution = difference * difference / test.expected;
        test.statistic += c.contribution;
    }
    // With less than one value expected in a class the limit distribution says nothing.
    if (values.size() < k) {
        test.statistic = kNaN;
    }
    test.level =
        values.size() < k ? kNaN : 100 * ChiSquaredSurvival(test.degreesOfFreedom, test.statistic);
    return test;
}

KolmogorovSmirnovTest KolmogorovSmirnovTestOf(const Distribution& d,
                                              std::span<const double> sorted) {
    if (sorted.empty()) {
        return {kNaN, kNaN, 0, kNaN, kNaN, kNaN};
    }
    const auto n = static_cast<double>(sorted.size());
    KolmogorovSmirnovTest test;
    test.statistic = -1;
    for (std::size_t i = 0; i < sorted.size(); ++i) {
        const double f = Cdf(d, sorted[i]);
        const auto below = static_cast<double>(i);
        const Step step = LargerStep(f, below / n, (below + 1) / n);
        if (step.distance > test.statistic) {
            test = {step.distance, 0, i + 1, sorted[i], f, step.empirical};
        }
    }
    // Stephens (1970): so modified, D has the limit distribution for all n from about five.
    const double root = std::sqrt(n);
    test.level = 100 * KolmogorovSurvival((root + 0.12 + 0.11 / root) * test.statistic);
    return test;
}

// Two forms of the same function: the alternating sum converges fast for large x, its transform by
// Jacobi's theta function for small x. At 1.18 either is exact with four terms.
double KolmogorovSurvival(double x) {
    // sum exp(-j^2 pi^2/(8 x^2)) over odd j, and 2 sum (-1)^(j-1) exp(-2 j^2 x^2).
    // Below, the result is 1 to the last digit and pi/x might overflow.
    if (x < 0.05) {
        return 1;
    }
    double sum = 0;
    if (x < 1.18) {
        const double q = -std::numbers::pi * std::numbers::pi / (8 * x * x);
        for (const int j : {1, 3, 5, 7}) {
            sum += std::exp(j * j * q);
        }
        return 1 - std::sqrt(2 * std::numbers::pi) / x * sum;
    }
    for (const int j : {1, 2, 3, 4}) {
        sum += (j % 2 == 1 ? 2 : -2) * std::exp(-2 * j * j * x * x);
    }
    return sum;
}

double AkaikeCriterion(const FittedModel& model) {
    return 2 * static_cast<double>(model.parameters.size()) - 2 * model.logLikelihood;
}

} // namespace ryn::stats
