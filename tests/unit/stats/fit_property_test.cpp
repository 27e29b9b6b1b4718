#include "stats/fit.h"

#include "unit/stats/named_combinations.h"

#include <boost/math/quadrature/tanh_sinh.hpp>
#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

#include <algorithm>
#include <cmath>
#include <string>
#include <vector>

namespace ryn::stats {
namespace {

using testing::Named;

const SeriesFrame kAnnual{};

// A sample of 6 to 60 values with two decimals, not all equal, above `threshold`.
std::vector<double> Sample(double threshold) {
    const auto size = *rc::gen::inRange<std::size_t>(6, 60);
    const auto steps = *rc::gen::container<std::vector<int>>(size, rc::gen::inRange(1, 100000));
    std::vector<double> values;
    for (const int step : steps) {
        values.push_back(threshold + step / 100.0);
    }
    RC_PRE(*std::max_element(steps.begin(), steps.end()) >
           *std::min_element(steps.begin(), steps.end()) + 10);
    return values;
}

struct Subject {
    std::string name;
    SeriesFrame frame;
};

std::vector<Subject> Subjects(const std::string& method) {
    const SeriesFrame peaks{SeriesKind::PartialDuration, 20, 2};
    std::vector<Subject> subjects;
    for (const char* family : {"GEV", "GUM", "GP"}) {
        subjects.push_back({family + method, kAnnual});
    }
    for (const char* family : {"GP2", "GP3", "EXP1", "EXP2"}) {
        subjects.push_back({family + method, peaks});
    }
    return subjects;
}

Outcome<Estimate> Estimated(const Subject& subject, const std::vector<double>& values) {
    FitScratch scratch;
    return EstimateParameters(Named(subject.name), {values, subject.frame}, scratch);
}

// The integral of weight(F, x(F)) over F from 0 to 1, each half from its own tail.
template <class Weight>
double Mean(const Distribution& d, Weight weight) {
    static boost::math::quadrature::tanh_sinh<double> quadrature;
    const auto lower = [&](double f) { return weight(f, Quantile(d, f)); };
    const auto upper = [&](double e) { return weight(1 - e, QuantileOfExceedance(d, e)); };
    return quadrature.integrate(lower, 0.0, 0.5) + quadrature.integrate(upper, 0.0, 0.5);
}

double Shape(const Distribution& d) {
    for (const Parameter& parameter : Parameters(d)) {
        if (parameter.symbol == "kappa") {
            return parameter.value;
        }
    }
    return 0;
}

RC_GTEST_PROP(LMomentFit, ReproducesTheLMomentsOfTheSample, ()) {
    auto values = Sample(20);
    std::sort(values.begin(), values.end());
    const LMoments sample = LMomentsOfSorted(values);
    for (const Subject& subject : Subjects("/LMOM")) {
        const auto fit = Estimated(subject, values);
        // The integrals converge ever more slowly towards an infinite mean at kappa = -1.
        if (!fit || Shape(fit->distribution) < -0.7) {
            continue;
        }
        const Distribution& d = fit->distribution;
        const std::size_t p = EstimatedParameters(d).size();
        const double slack = 1e-6 * (sample.l2 + 1e-3 * sample.l1);
        RC_ASSERT(std::abs(Mean(d, [](double, double x) { return x; }) - sample.l1) < slack);
        const auto second = [](double f, double x) { return (2 * f - 1) * x; };
        if (p > 1) {
            RC_ASSERT(std::abs(Mean(d, second) - sample.l2) < slack);
        }
        const auto third = [](double f, double x) { return (6 * f * f - 6 * f + 1) * x; };
        if (p == 3) {
            RC_ASSERT(std::abs(Mean(d, third) - sample.l3) < slack);
        }
    }
}

RC_GTEST_PROP(MomentFit, ReproducesTheMomentsOfTheSample, ()) {
    const auto values = Sample(20);
    const CentralMoments sample = CentralMomentsOf(values);
    const double s = sample.StandardDeviation();
    for (const Subject& subject : Subjects("/MOM")) {
        const auto fit = Estimated(subject, values);
        if (!fit || Shape(fit->distribution) < -0.2) {
            continue;
        }
        const Distribution& d = fit->distribution;
        const std::size_t p = EstimatedParameters(d).size();
        const double mean = Mean(d, [](double, double x) { return x; });
        RC_ASSERT(std::abs(mean - sample.mean) < 1e-6 * (s + 1e-3 * sample.mean));
        const auto power = [&](int r) {
            return Mean(d, [=](double, double x) { return std::pow((x - mean) / s, r); });
        };
        if (p > 1) {
            RC_ASSERT(std::abs(power(2) - 1) < 1e-6);
        }
        if (p == 3) {
            RC_ASSERT(std::abs(power(3) - sample.Skewness()) <
                      1e-5 * (1 + std::abs(sample.Skewness())));
        }
    }
}

// x -> offset + factor x, thresholds alike: the fitted quantiles go along.
RC_GTEST_PROP(Fit, FollowsShiftAndScaleOfTheSample, ()) {
    const auto values = Sample(20);
    const double factor = *rc::gen::inRange(1, 1000) / 50.0;
    const double offset = *rc::gen::inRange(-1000, 1000) / 10.0;
    auto moved = values;
    for (double& x : moved) {
        x = offset + factor * x;
    }
    for (const char* method : {"/MOM", "/ML", "/LMOM"}) {
        for (Subject subject : Subjects(method)) {
            const auto before = Estimated(subject, values);
            subject.frame.threshold = offset + factor * subject.frame.threshold;
            const auto after = Estimated(subject, moved);
            RC_ASSERT(static_cast<bool>(before) == static_cast<bool>(after));
            if (!before) {
                continue;
            }
            for (const double probability : {0.1, 0.5, 0.99}) {
                const double expected =
                    offset + factor * Quantile(before->distribution, probability);
                const double slack = 1e-9 * (std::abs(offset) + std::abs(expected) + 1000 * factor);
                RC_ASSERT(std::abs(Quantile(after->distribution, probability) - expected) < slack);
            }
        }
    }
}

RC_GTEST_PROP(Fit, DoesNotDependOnTheOrderOfTheSample, ()) {
    const auto values = Sample(20);
    auto sorted = values;
    std::sort(sorted.begin(), sorted.end());
    for (const Subject& subject : Subjects("/LMOM")) {
        FitScratch scratch;
        const Combination c = Named(subject.name);
        const auto first = EstimateParameters(c, {values, subject.frame}, scratch);
        const auto second =
            EstimateParameters(c, {sorted, subject.frame, ValueOrder::Ascending}, scratch);
        RC_ASSERT(static_cast<bool>(first) == static_cast<bool>(second));
        RC_ASSERT(!first ||
                  Quantile(first->distribution, 0.99) == Quantile(second->distribution, 0.99));
    }
    for (const char* method : {"/MOM", "/ML"}) {
        for (const Subject& subject : Subjects(method)) {
            const auto first = Estimated(subject, values);
            const auto second = Estimated(subject, sorted);
            RC_ASSERT(static_cast<bool>(first) == static_cast<bool>(second));
            if (first) {
                const double quantile = Quantile(first->distribution, 0.99);
                RC_ASSERT(std::abs(Quantile(second->distribution, 0.99) - quantile) <
                          1e-9 * std::abs(quantile));
            }
        }
    }
}

} // namespace
} // namespace ryn::stats
