#include "stats/fit.h"
#include "stats/jackknife.h"

#include "unit/stats/every_combination.h"

#include <boost/math/quadrature/tanh_sinh.hpp>
#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

#include <algorithm>
#include <cmath>
#include <cstddef>
#include <optional>
#include <string>
#include <utility>
#include <vector>

namespace ryn::stats {
namespace {

using testing::AllNames;
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
    for (const char* family : {"GEV", "GUM", "GP", "WEI", "P3"}) {
        subjects.push_back({family + method, kAnnual});
    }
    for (const char* family : {"GP2", "GP3", "EXP1", "EXP2", "WEI2", "WEI3", "GAM", "P3", "LN2"}) {
        subjects.push_back({family + method, peaks});
    }
    return subjects;
}

// Those that the lists by method do not have.
std::vector<Subject> OtherSubjects() {
    std::vector<Subject> subjects = {{"TGUM/ML", {SeriesKind::PartialDuration, 20, 2}}};
    for (const char* name :
         {"LN3/MOM/BI", "LN3/MOM/BII", "LN3/MOM/LBQII", "LN3/ML", "GUM/MOM corr"}) {
        subjects.push_back({name, kAnnual});
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

// Whether the tail is light enough for moments of that order to be integrated: they converge ever
// more slowly towards a shape at which they are infinite.
bool IsLightTailed(const Distribution& d, double heaviest) {
    for (const Parameter& parameter : Parameters(d)) {
        const bool isBounded = parameter.symbol == "sigma" && parameter.value > 1.5;
        if (isBounded || (parameter.symbol == "kappa" && parameter.value < heaviest)) {
            return false;
        }
    }
    return true;
}

RC_GTEST_PROP(LMomentFit, ReproducesTheLMomentsOfTheSample, ()) {
    auto values = Sample(20);
    std::sort(values.begin(), values.end());
    const LMoments sample = LMomentsOfSorted(values);
    RC_PRE(std::abs(sample.LSkewness()) > 1e-4); // Pearson 3 has no less
    auto subjects = Subjects("/LMOM");
    subjects.push_back({"LN2/LMOM", kAnnual});
    for (const Subject& subject : subjects) {
        const auto fit = Estimated(subject, values);
        if (!fit || !IsLightTailed(fit->distribution, -0.7)) {
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
    RC_PRE(std::abs(sample.Skewness()) > 0.001); // Pearson 3 has no less
    auto subjects = Subjects("/MOM");
    subjects.push_back({"LN2/MOM", kAnnual});
    subjects.push_back({"LN3/MOM/BI", kAnnual});
    for (const Subject& subject : subjects) {
        const auto fit = Estimated(subject, values);
        if (!fit || !IsLightTailed(fit->distribution, -0.2)) {
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

// On a level at which the tail is light enough for the variance to be integrated.
RC_GTEST_PROP(MomentFit, OfFrechetReproducesMeanAndVariance, ()) {
    const auto values = Sample(3000);
    const CentralMoments sample = CentralMomentsOf(values);
    const auto fit = Estimated({"FRE/MOM", kAnnual}, values);
    RC_ASSERT(fit);
    const double mean = Mean(fit->distribution, [](double, double x) { return x; });
    RC_ASSERT(std::abs(mean - sample.mean) < 1e-9 * sample.mean);
    const double variance =
        Mean(fit->distribution, [=](double, double x) { return (x - mean) * (x - mean); });
    RC_ASSERT(std::abs(variance - sample.Variance()) < 1e-6 * sample.Variance());
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
    for (const auto& subjects :
         {Subjects("/MOM"), Subjects("/ML"), Subjects("/LMOM"), OtherSubjects()}) {
        for (Subject subject : subjects) {
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

// x -> factor x: the families with a bound at 0, and those of logarithms, follow scale alone.
RC_GTEST_PROP(Fit, OfPositiveValuesFollowsTheirScale, ()) {
    const auto values = Sample(20);
    const double factor = *rc::gen::inRange(1, 1000) / 50.0;
    auto scaled = values;
    for (double& x : scaled) {
        x *= factor;
    }
    for (const char* name : {"FRE/MOM", "LN2/MOM", "LN2/ML", "LN2/LMOM", "LN3/MOM/LBQI",
                             "LP3/MOM/LOG", "LP3/MOM/REAL", "LP3/LMOM", "SQE/ML"}) {
        const auto before = Estimated({name, kAnnual}, values);
        const auto after = Estimated({name, kAnnual}, scaled);
        RC_ASSERT(static_cast<bool>(before) == static_cast<bool>(after));
        for (const double probability : {0.1, 0.5, 0.99}) {
            if (before) {
                const double expected = factor * Quantile(before->distribution, probability);
                RC_ASSERT(std::abs(Quantile(after->distribution, probability) - expected) <
                          1e-7 * std::abs(expected) + 1e-9 * factor);
            }
        }
    }
}

// The jackknife by its definition, with a fit of each shortened sample. Mean and deviation of the
// quantiles at `probability`, or nothing when a sample could not be fitted.
std::optional<ResampledQuantile>
NaiveJackknife(const Subject& subject, const std::vector<double>& values, double probability) {
    std::vector<double> quantiles;
    for (std::size_t i = 0; i < values.size(); ++i) {
        auto rest = values;
        rest.erase(rest.begin() + static_cast<std::ptrdiff_t>(i));
        const auto fit = Estimated(subject, rest);
        if (!fit) {
            return std::nullopt;
        }
        quantiles.push_back(Quantile(fit->distribution, probability));
    }
    const CentralMoments spread = CentralMomentsOf(quantiles);
    const auto n = static_cast<double>(values.size());
    const double estimate = Quantile(Estimated(subject, values)->distribution, probability);
    return ResampledQuantile{estimate, n * estimate - (n - 1) * spread.mean,
                             std::sqrt((n - 1) * spread.m2), (n - 1) * (spread.mean - estimate)};
}

RC_GTEST_PROP(Jackknife, IsThatOfItsDefinitionForEveryCombination, ()) {
    auto values = Sample(20);
    values.resize(std::min<std::size_t>(values.size(), 15));
    const std::vector<double> probabilities = {0.99};
    for (const auto& [name, kind, combination] : testing::EveryCombination()) {
        const Subject subject{name, {kind, kind == SeriesKind::PartialDuration ? 19.0 : 0.0, 2}};
        const auto fit = Estimated(subject, values);
        const auto expected = fit ? NaiveJackknife(subject, values, 0.99) : std::nullopt;
        if (!expected || !std::isfinite(expected->standardDeviation)) {
            continue;
        }
        const auto found = Jackknife(combination, fit->distribution, {values, subject.frame},
                                     {.probabilities = probabilities});
        RC_ASSERT(found.kept == values.size());
        const ResampledQuantile& at = found.atProbabilities[0];
        const double slack = 1e-8 * (expected->standardDeviation + std::abs(expected->estimate));
        RC_ASSERT(std::abs(at.average - expected->average) < slack);
        RC_ASSERT(std::abs(at.standardDeviation - expected->standardDeviation) < slack);
    }
}

RC_GTEST_PROP(LogPearsonThreeFit, IsPearsonThreeOfTheLogarithms, ()) {
    const auto values = Sample(20);
    std::vector<double> logs(values.size());
    std::transform(values.begin(), values.end(), logs.begin(),
                   [](double x) { return std::log(x); });
    for (const auto& [name, ofLogs] :
         {std::pair{"LP3/MOM/LOG", "P3/MOM"}, {"LP3/LMOM", "P3/LMOM"}}) {
        const auto fit = Estimated({name, kAnnual}, values);
        const auto expected = Estimated({ofLogs, kAnnual}, logs);
        RC_ASSERT(fit && expected);
        for (const double p : {0.01, 0.5, 0.99}) {
            RC_ASSERT(std::abs(std::log(Quantile(fit->distribution, p)) -
                               Quantile(expected->distribution, p)) < 1e-9);
        }
    }
}

RC_GTEST_PROP(LogPearsonThreeFit, ReproducesTheMomentsInRealSpace, ()) {
    const auto values = Sample(20);
    const auto real = Estimated({"LP3/MOM/REAL", kAnnual}, values);
    if (real && EstimatedParameters(real->distribution)[1].value < 0.1) {
        const CentralMoments raw = CentralMomentsOf(values);
        const auto power = [&](int r) {
            return Mean(real->distribution,
                        [=](double, double x) { return std::pow(x / raw.mean, r); });
        };
        const double c2 = raw.m2 / raw.mean / raw.mean;
        const double c3 = raw.m3 / raw.mean / raw.mean / raw.mean;
        RC_ASSERT(std::abs(power(1) - 1) < 1e-6);
        RC_ASSERT(std::abs(power(2) - (1 + c2)) < 1e-6 * (1 + c2));
        RC_ASSERT(std::abs(power(3) - (1 + 3 * c2 + c3)) < 1e-6 * (1 + 3 * c2 + c3));
    }
}

RC_GTEST_PROP(Fit, ChangesInNoBitWithTheOrderOfTheSample, ()) {
    const auto values = Sample(20);
    auto reversed = values;
    std::reverse(reversed.begin(), reversed.end());
    for (const std::string& name : AllNames()) {
        for (const SeriesFrame& frame :
             {kAnnual, SeriesFrame{SeriesKind::PartialDuration, 20, 2}}) {
            const FitResult first = Fit(Named(name), {values, frame});
            const FitResult second = Fit(Named(name), {reversed, frame});
            RC_ASSERT(static_cast<bool>(first) == static_cast<bool>(second));
            if (!first) {
                RC_ASSERT(FailureText(first.Failure()) == FailureText(second.Failure()));
                continue;
            }
            for (std::size_t i = 0; i < first->parameters.size(); ++i) {
                RC_ASSERT(first->parameters[i].value == second->parameters[i].value);
            }
            RC_ASSERT(first->logLikelihood == second->logLikelihood ||
                      (std::isnan(first->logLikelihood) && std::isnan(second->logLikelihood)));
        }
    }
}

} // namespace
} // namespace ryn::stats
