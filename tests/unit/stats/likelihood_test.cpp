#include "stats/fit.h"
#include "stats/profile_maximum.h"

#include "unit/stats/likelihood_oracle.h"
#include "unit/stats/named_combinations.h"
#include "unit/stats/reference_files.h"

#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

#include <algorithm>
#include <array>
#include <cmath>
#include <limits>
#include <string>
#include <vector>

namespace ryn::stats {
namespace {

using testing::FrameOf;
using testing::Named;
using testing::ReferenceNumber;
using testing::ReferenceSeries;
using testing::ReferenceTable;

const SeriesFrame kAnnual{};
const SeriesFrame kPeaks{SeriesKind::PartialDuration, 20, 2};

struct Subject {
    const char* name;
    SeriesFrame frame;
};

const Subject kSubjects[] = {
    {"GEV/ML", kAnnual}, {"GUM/ML", kAnnual}, {"LN2/ML", kAnnual}, {"LN3/ML", kAnnual},
    {"SQE/ML", kAnnual}, {"GP2/ML", kPeaks},  {"WEI2/ML", kPeaks}, {"GAM/ML", kPeaks},
    {"LN2/ML", kPeaks},  {"EXP1/ML", kPeaks}, {"TGUM/ML", kPeaks},
};

std::vector<double> EstimatedValues(const Distribution& d) {
    std::vector<double> values;
    for (const Parameter& parameter : EstimatedParameters(d)) {
        values.push_back(parameter.value);
    }
    return values;
}

TEST(MaximumLikelihood, MeetsArithmeticOfFortyDigits) {
    for (const auto& row : ReferenceTable("likelihood.csv")) {
        const std::string place = row[0] + " " + row[1];
        const auto series = ReferenceSeries(row[0]);
        const FitResult fit = Fit(Named(row[1]), {series, FrameOf(row[0])});
        ASSERT_TRUE(fit) << place;
        const auto values = EstimatedValues(fit->distribution);
        for (std::size_t i = 0; i < values.size(); ++i) {
            const double reference = ReferenceNumber(row[2 + i]);
            EXPECT_NEAR(values[i], reference, 2e-12 * std::max(0.1, std::abs(reference)))
                << place << " " << i;
        }
        const double likelihood = ReferenceNumber(row[5]);
        EXPECT_NEAR(fit->logLikelihood, likelihood, 1e-12 * std::abs(likelihood)) << place;
    }
}

// The same family with other parameters.
std::optional<Distribution> With(const Gev&, const std::vector<double>& p) {
    return Gev::Make({p[0], p[1], p[2]});
}
std::optional<Distribution> With(const Gumbel&, const std::vector<double>& p) {
    return Gumbel::Make({p[0], p[1]});
}
std::optional<Distribution> With(const GeneralisedPareto& d, const std::vector<double>& p) {
    return GeneralisedPareto::Make({d.Values().xi, p[0], p[1]}, LocationType::Fixed);
}
std::optional<Distribution> With(const Exponential& d, const std::vector<double>& p) {
    return Exponential::Make({d.Values().xi, p[0]}, LocationType::Fixed);
}
std::optional<Distribution> With(const Weibull& d, const std::vector<double>& p) {
    return Weibull::Make({d.Values().xi, p[0], p[1]}, LocationType::Fixed);
}
std::optional<Distribution> With(const PearsonThree& d, const std::vector<double>& p) {
    return PearsonThree::Make({d.Values().xi, p[0], p[1]}, LocationType::Fixed);
}
std::optional<Distribution> With(const LogNormal& d, const std::vector<double>& p) {
    return p.size() == 3 ? LogNormal::Make({p[0], p[1], p[2]})
                         : LogNormal::Make({d.Values().xi, p[0], p[1]}, LocationType::Fixed);
}
std::optional<Distribution> With(const SquareRootExponential&, const std::vector<double>& p) {
    return SquareRootExponential::Make({p[0], p[1]});
}
std::optional<Distribution> With(const TruncatedGumbel& d, const std::vector<double>& p) {
    return TruncatedGumbel::Make({p[0], p[1]}, d.Threshold());
}
template <class D>
std::optional<Distribution> With(const D&, const std::vector<double>&) {
    return std::nullopt; // no maximum likelihood
}

double LogLikelihood(const Distribution& d, const std::vector<double>& values) {
    double sum = 0;
    for (const double x : values) {
        sum += LogDensity(d, x);
    }
    return sum;
}

// Lists of 5 to 60 values of many shapes, from bounded to heavy-tailed, some of them rounded.
std::vector<double> AnySample() {
    const auto size = *rc::gen::inRange<std::size_t>(5, 60);
    const auto steps = *rc::gen::container<std::vector<int>>(size, rc::gen::inRange(1, 100000));
    const double shape = *rc::gen::inRange(-60, 60) / 100.0 + 0.001;
    const bool rounded = *rc::gen::inRange(0, 4) == 0;
    std::vector<double> values;
    for (const int step : steps) {
        const double x = 20 - 5 * std::expm1(shape * std::log(step / 100001.0)) / shape;
        values.push_back(rounded ? std::ceil(4 * x) / 4 : x);
    }
    return values;
}

// Steps that change every parameter by the same share of its own scale, or of alpha for a location.
std::vector<double> UnitsOf(const ParameterList& parameters) {
    std::vector<double> units;
    for (const Parameter& parameter : parameters) {
        const bool shape = parameter.symbol == "kappa";
        const bool location = parameter.symbol == "xi";
        units.push_back(location ? parameters[1].value : (shape ? 1.0 : parameter.value));
    }
    return units;
}

RC_GTEST_PROP(MaximumLikelihood, StandsOnASummitWithoutSlope, ()) {
    const auto sample = AnySample();
    for (const Subject& subject : kSubjects) {
        const FitResult fit = Fit(Named(subject.name), {sample, subject.frame});
        if (!fit || std::isnan(fit->logLikelihood)) {
            continue;
        }
        const auto units = UnitsOf(fit->parameters);
        const auto values = EstimatedValues(fit->distribution);
        const auto heightAt = [&](const std::vector<double>& shares) {
            auto moved = values;
            for (std::size_t i = 0; i < moved.size(); ++i) {
                moved[i] += shares[i] * units[i];
            }
            const auto d = std::visit([&](const auto& family) { return With(family, moved); },
                                      fit->distribution);
            return d ? LogLikelihood(*d, sample) : -std::numeric_limits<double>::infinity();
        };
        const double slack = 1e-12 * (std::abs(fit->logLikelihood) + 100);
        for (int code = 0; code < 27; ++code) {
            const std::array<int, 3> digits{code % 3 - 1, code / 3 % 3 - 1, code / 9 - 1};
            for (const double size : {1e-2, 1e-3, 1e-5}) {
                std::vector<double> shares;
                for (std::size_t i = 0; i < values.size(); ++i) {
                    shares.push_back(digits[i] * size);
                }
                RC_ASSERT(heightAt(shares) < fit->logLikelihood + slack);
            }
        }
        for (std::size_t i = 0; i < values.size(); ++i) {
            const auto along = [&](double size) {
                std::vector<double> shares(values.size());
                shares[i] = size;
                return heightAt(shares);
            };
            const double slope = (along(1e-6) - along(-1e-6)) / 2e-6;
            const double bend = (along(1e-4) + along(-1e-4) - 2 * fit->logLikelihood) / 1e-8;
            RC_ASSERT(!std::isfinite(bend) || std::abs(slope) < 1e-3 + 1e-6 * std::abs(bend));
        }
    }
}

std::optional<double> SearchedGev(const std::vector<double>& sample) {
    FitScratch scratch;
    const auto start = EstimateParameters(Named("GEV/LMOM"), {sample, kAnnual}, scratch);
    if (!start) {
        return std::nullopt;
    }
    const auto p = EstimatedValues(start->distribution);
    return testing::SearchGev(sample, {p[0], p[1], p[2]});
}

std::optional<double> Searched(const std::string& name, const std::vector<double>& sample) {
    auto exceedances = sample;
    for (double& x : exceedances) {
        x -= kPeaks.threshold;
    }
    if (name == "GEV/ML") {
        return SearchedGev(sample);
    }
    if (name == "LN3/ML") {
        return testing::SearchLogNormal(sample);
    }
    if (name == "SQE/ML") {
        return testing::SearchSquareRootExponential(sample);
    }
    if (name == "GP2/ML") {
        return testing::SearchPareto(exceedances);
    }
    return name == "TGUM/ML" ? testing::SearchTruncatedGumbel(exceedances) : std::nullopt;
}

// A search that ends outside the domain says nothing: the simplex is caught by the unbounded part
// of the likelihood, or passes over it.
RC_GTEST_PROP(MaximumLikelihood, IsNowhereBelowASearchByOtherMeans, ()) {
    const auto sample = AnySample();
    for (const Subject& subject : kSubjects) {
        const auto searched = Searched(subject.name, sample);
        if (searched) {
            const FitResult fit = Fit(Named(subject.name), {sample, subject.frame});
            RC_ASSERT(static_cast<bool>(fit));
            const double slack = 1e-9 * (100 + std::abs(*searched));
            RC_ASSERT(!(fit->logLikelihood < *searched - slack));
        }
    }
}

// mean(exp(-y/my)) = 0.5037 in rain40 and 0.53 in rain30.
TEST(MaximumLikelihood, ReducesATruncatedGumbelWithAHeavyTailToTheExponential) {
    for (const char* name : {"rain40", "rain30"}) {
        const auto series = ReferenceSeries(name);
        const SeriesFrame frame = FrameOf(name);
        const FitResult gumbel = Fit(Named("TGUM/ML"), {series, frame});
        const FitResult exponential = Fit(Named("EXP1/ML"), {series, frame});
        ASSERT_TRUE(gumbel && exponential);
        ASSERT_EQ(gumbel->warnings.size(), 1U);
        EXPECT_EQ(WarningCode(gumbel->warnings[0]), "W3");
        EXPECT_NEAR(gumbel->parameters[1].value, exponential->parameters[0].value, 1e-9);
        for (const double e : {0.5, 0.1, 0.01, 1e-4}) {
            const double expected = QuantileOfExceedance(exponential->distribution, e);
            EXPECT_NEAR(QuantileOfExceedance(gumbel->distribution, e), expected, 1e-7 * expected);
        }
    }
}

// A failure for each reason, with its code.
TEST(MaximumLikelihood, SaysWhyThereIsNoEstimate) {
    const std::vector<double> equal(8, 21.5);
    const std::vector<double> bounded = {20.1, 28, 29, 29.5, 29.8, 29.9, 29.95, 30};
    const std::vector<double> leftSkewed = {21, 27, 28, 29, 29.5, 29.7, 29.8};
    const std::vector<double> tied = {20, 20, 22, 23, 25, 21, 24, 26};
    const std::vector<double> negative = {-1, 2, 3, 4, 5, 6};
    const std::vector<double> withZero = {0, 2, 3, 4, 5, 6};
    const std::vector<double> zeros(6, 0.0);
    const struct {
        const char* name;
        const std::vector<double>& sample;
        SeriesFrame frame;
        const char* code;
    } cases[] = {
        {"GEV/ML", equal, kAnnual, "C11"},      {"GUM/ML", equal, kAnnual, "C11"},
        {"LN2/ML", equal, kAnnual, "C11"},      {"LN3/ML", equal, kAnnual, "C11"},
        {"WEI2/ML", equal, kPeaks, "C11"},      {"GAM/ML", equal, kPeaks, "C11"},
        {"GP2/ML", bounded, kPeaks, "C11"},     {"LN3/ML", leftSkewed, kAnnual, "C11"},
        {"GEV/ML", leftSkewed, kAnnual, "C11"}, {"WEI2/ML", tied, kPeaks, "C05"},
        {"GAM/ML", tied, kPeaks, "C05"},        {"LN2/ML", tied, kPeaks, "C05"},
        {"SQE/ML", negative, kAnnual, "C04"},   {"SQE/ML", zeros, kAnnual, "C04"},
        {"LN2/ML", withZero, kAnnual, "C04"},   {"SQE/ML", withZero, kAnnual, ""},
        {"GP2/ML", negative, kPeaks, "C15"},    {"TGUM/ML", negative, kPeaks, "C15"},
    };
    for (const auto& c : cases) {
        const FitResult fit = Fit(Named(c.name), {c.sample, c.frame});
        EXPECT_EQ(fit ? "" : FailureCode(fit.Failure()), c.code) << c.name << " " << c.sample[0];
    }
}

// The profile rises again as kappa comes to 1. At the maximum and at that end ln L, by arithmetic
// of 50 digits, is -23.1154 and -23.1765 in the first sample, -21.8528 and -21.8109 in the second.
// A grid of 400 theta in equal ratios up to the largest value takes the wrong side in both.
TEST(MaximumLikelihood, TellsAParetoMaximumFromAHigherEndCloseBy) {
    const std::vector<double> inside = {20.4, 21.1, 21.6, 22.6, 23.1, 23.3,
                                        23.7, 24.0, 24.9, 25.7, 28.2};
    const std::vector<double> atEnd = {20.7, 21.1, 21.2, 22.1, 22.5, 22.7, 23.4, 24.3, 28.1, 28.8};
    const FitResult fit = Fit(Named("GP2/ML"), {inside, kPeaks});
    ASSERT_TRUE(fit);
    const auto values = EstimatedValues(fit->distribution);
    EXPECT_NEAR(values[0], 6.17408754298898, 1e-11);
    EXPECT_NEAR(values[1], 0.718961260739076, 1e-12);
    const FitResult refused = Fit(Named("GP2/ML"), {atEnd, kPeaks});
    ASSERT_FALSE(refused);
    EXPECT_EQ(FailureCode(refused.Failure()), "C11");
}

// What is no sample of the distribution at all ends in an estimate or in a failure, never in
// numbers that are none.
TEST(MaximumLikelihood, StandsHostileSamples) {
    std::vector<std::vector<double>> samples = {
        {1, 1, 1, 1, 1, 1, 1, 2},
        {2, 2, 2, 2, 2, 2, 2, 1},
        {1, 2, 3, 4, 5},
        {1, 1, 1, 2, 2, 2},
        {5, 5, 5, 5, 5},
        {0, 0, 0, 1e-300, 1, 1e300},
        {1, 1 + 1e-15, 1, 1 - 1e-15, 1},
        {1, 10, 1e2, 1e4, 1e8, 1e16, 1e32},
        {3, 1e308, -1e308, 4, 5, 6},
        {1e-320, 3e-320, 2e-320, 7e-320, 5e-320},
    };
    for (const double unit : {1e-12, 1.0, 1e12, 1e200}) {
        for (const double offset : {0.0, 1e9 * unit, -1e9 * unit}) {
            std::vector<double>& sample = samples.emplace_back();
            for (const double x : ReferenceSeries("fishkill")) {
                sample.push_back(offset + unit * x);
            }
        }
    }
    for (const auto& sample : samples) {
        const double lowest = *std::min_element(sample.begin(), sample.end());
        for (const Subject& subject : kSubjects) {
            for (const double threshold : {lowest, lowest / 2, 0.0, std::nan("")}) {
                SeriesFrame frame = subject.frame;
                frame.threshold = threshold;
                const FitResult fit = Fit(Named(subject.name), {sample, frame});
                if (fit) {
                    for (const double value : EstimatedValues(fit->distribution)) {
                        EXPECT_TRUE(std::isfinite(value)) << subject.name << " " << sample[0];
                    }
                } else {
                    EXPECT_FALSE(FailureCode(fit.Failure()).empty()) << subject.name;
                }
            }
        }
    }
}

// Both summits of the second profile lie between two neighbouring stations of the walk.
TEST(PeakSearch, FindsTheHigherOfTwoSummits) {
    const auto summits = [](double distance) {
        return [distance](double x) {
            const double a = std::exp(-x * x);
            const double b = 1.2 * std::exp(-(x - distance) * (x - distance));
            return ProfilePoint{a + b, -2 * x * a - 2 * (x - distance) * b,
                                (4 * x * x - 2) * a +
                                    (4 * (x - distance) * (x - distance) - 2) * b};
        };
    };
    for (const double from : {-5.0, -5.3, -5.6}) {
        PeakSearch search;
        search.Walk(summits(4), from, 9, 14);
        ASSERT_TRUE(search.Highest());
        EXPECT_NEAR(search.Highest()->place, 4, 1e-6);
        PeakSearch back;
        back.Walk(summits(4), 9, from, 14);
        EXPECT_NEAR(back.Highest()->place, search.Highest()->place, 1e-12);
    }
    PeakSearch none;
    none.Walk([](double x) { return ProfilePoint{x, 1, 0}; }, 0, 1, 5);
    EXPECT_FALSE(none.Highest());
    EXPECT_EQ(none.HighestEnd(), 1);
}

// Newton's method alone leaves this bracket from most starts; the slope is flat far out.
TEST(MaximumBetween, ClosesTheBracketWhereNewtonsMethodFails) {
    const auto profile = [](double x) {
        return ProfilePoint{-std::sqrt(1 + x * x), -x / std::sqrt(1 + x * x),
                            -1 / std::pow(1 + x * x, 1.5)};
    };
    for (const double start : {-900.0, -1.5, 0.3, 40.0, 999.0}) {
        const auto peak = MaximumBetween(profile, {-1000, 1000}, start);
        ASSERT_TRUE(peak) << start;
        EXPECT_NEAR(peak->place, 0, 1e-15);
    }
    EXPECT_FALSE(PeakInside(profile, {1, 1000}, 30));
    EXPECT_FALSE(MaximumBetween([](double) { return kNoProfile; }, {0, 1}, 0.5));
}

} // namespace
} // namespace ryn::stats
