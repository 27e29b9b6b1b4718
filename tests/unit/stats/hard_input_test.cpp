// Series that no estimator was made for: what is reported still holds, and what does not is
// refused.

#include "stats/fit.h"

#include "support/processor_time.h"
#include "unit/stats/every_combination.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <functional>
#include <limits>
#include <string>
#include <vector>

namespace ryn::stats {
namespace {

using testing::EveryCombination;
using testing::Named;
using testing::NamedCombination;

using Values = std::vector<double>;

// Values that fill the distribution of -ln(1 - u)^power evenly, in an order that is not theirs.
Values Even(std::size_t count, double power) {
    Values values;
    for (std::size_t i = 0; i < count; ++i) {
        const double place = std::fmod(0.618033988749895 * static_cast<double>(i + 1), 1.0);
        values.push_back(std::pow(-std::log1p(-place), power));
    }
    return values;
}

Values Changed(Values values, const std::function<double(double)>& change) {
    std::transform(values.begin(), values.end(), values.begin(), change);
    return values;
}

Values With(Values values, double first) {
    values.front() = first;
    return values;
}

struct HardSeries {
    const char* name;
    Values values;
};

std::vector<HardSeries> HardSeriesOfAllKinds() {
    const Values plain = Even(30, 1);
    const auto narrow = [&](double level) {
        return Changed(plain, [level](double x) { return level * (1 + 1e-8 * x); });
    };
    const auto scaled = [&](double factor) {
        return Changed(plain, [factor](double x) { return factor * (1 + x); });
    };
    Values heavy = Even(12, 15);
    return {
        {"five values", {3, 1, 4, 1.5, 9}},
        {"five values, one apart", {5, 5, 5, 5, 6}},
        {"two levels", {3, 3, 3, 3, 7, 7, 7, 7}},
        {"two levels, most low", {3, 3, 3, 3, 3, 3, 3, 7, 7}},
        {"all equal but a low one", With(Values(20, 3.3), 2.1)},
        {"all equal but a high one", With(Values(20, 3.3), 5.2)},
        {"counts", Changed(plain, [](double x) { return std::floor(3 * x); })},
        {"negative values", Changed(plain, [](double x) { return x - 2; })},
        {"narrow on 1", narrow(1)},
        {"narrow on a thousand", narrow(1e3)},
        {"narrow on a million", narrow(1e6)},
        {"narrow on minus a million", narrow(-1e6)},
        {"tiny", scaled(1e-12)},
        {"huge", scaled(1e12)},
        {"outlier of 1e3", With(plain, 3e3)},
        {"outlier of 1e9", With(plain, 3e9)},
        {"outlier of -1e9", With(plain, -3e9)},
        {"skewed to the left", Changed(plain, [](double x) { return 20 - x; })},
        {"symmetric", {1, 2, 3.5, 5, 6, 7, 8, 9, 10.5, 12, 13}},
        {"40 decades", heavy},
        {"seven digits", Changed(plain, [](double x) { return static_cast<float>(x); })},
        {"many at the threshold", Changed(plain, [](double x) { return std::max(x, 0.6); })},
        {"end of the doubles", scaled(1e307)},
        {"both ends of the doubles", With(scaled(1e307), -1e308)},
        {"denormal", scaled(1e-320)},
        {"next to denormal", scaled(1e-307)},
    };
}

SeriesFrame FrameOf(const NamedCombination& subject, const Values& values, double below) {
    const auto [least, most] = std::minmax_element(values.begin(), values.end());
    return {subject.kind, *least - below * (*most - *least), 1};
}

void ExpectNumbers(const FittedModel& model, const std::string& place) {
    for (const Parameter& parameter : Parameters(model.distribution)) {
        EXPECT_TRUE(std::isfinite(parameter.value)) << place << " " << parameter.symbol;
    }
    EXPECT_FALSE(std::isinf(model.logLikelihood)) << place;
    double previous = -std::numeric_limits<double>::infinity();
    for (const double period : {1.000001, 1.001, 1.1, 2.0, 10.0, 100.0, 1e4, 1e6}) {
        const double quantile = QuantileOfExceedance(model.distribution, 1 / period);
        EXPECT_FALSE(std::isnan(quantile)) << place << " T " << period;
        // A heavy tail may leave the doubles: then for all longer periods too.
        EXPECT_TRUE(quantile >= previous || previous - quantile < 1e-12 * std::abs(previous))
            << place << " T " << period;
        previous = quantile;
    }
}

TEST(HardInput, GivesNumbersOrAReasonForEveryCombination) {
    for (const HardSeries& series : HardSeriesOfAllKinds()) {
        for (const NamedCombination& subject : EveryCombination()) {
            for (const double below : {0.0, 0.05, 10.0}) {
                const std::string place = subject.name + ", " + series.name;
                const SeriesFrame frame = FrameOf(subject, series.values, below);
                const FitResult fit = Fit(subject.combination, {series.values, frame});
                if (fit) {
                    ExpectNumbers(*fit, place);
                } else {
                    EXPECT_FALSE(FailureCode(fit.Failure()).empty()) << place;
                }
            }
        }
    }
}

// A power of 2 as unit changes no digit of the values: the fits are the same but for the unit. So
// nothing is decided by what rounding leaves.
TEST(HardInput, ChangesOnlyTheUnitOfTheFitWithThatOfTheValues) {
    FitScratch scratch;
    for (const HardSeries& series : HardSeriesOfAllKinds()) {
        const double largest =
            std::abs(*std::max_element(series.values.begin(), series.values.end()));
        if (largest > 1e100 || largest < 1e-100) {
            continue;
        }
        for (const double unit : {0x1p-40, 0x1p40}) {
            const Values scaled = Changed(series.values, [unit](double x) { return unit * x; });
            for (const NamedCombination& subject : EveryCombination()) {
                const std::string place = subject.name + ", " + series.name;
                const SeriesFrame frame = FrameOf(subject, series.values, 0.05);
                const SeriesFrame scaledFrame{frame.kind, unit * frame.threshold, 1};
                const auto before =
                    EstimateParameters(subject.combination, {series.values, frame}, scratch);
                const auto after =
                    EstimateParameters(subject.combination, {scaled, scaledFrame}, scratch);
                ASSERT_EQ(static_cast<bool>(before), static_cast<bool>(after)) << place;
                for (const double p : {0.1, 0.5, 0.99}) {
                    const double expected = before ? unit * Quantile(before->distribution, p) : 0;
                    const double found = after ? Quantile(after->distribution, p) : 0;
                    EXPECT_NEAR(found, expected, 1e-9 * std::abs(expected)) << place;
                }
            }
        }
    }
}

struct Case {
    const char* name;
    Values values;
    double threshold; ///< of partial durations; NaN for annual maxima
    const char* code;
};

SeriesFrame FrameOf(const Case& c) {
    return std::isnan(c.threshold) ? SeriesFrame{}
                                   : SeriesFrame{SeriesKind::PartialDuration, c.threshold, 1};
}

// Success with numbers that mean nothing is what these once ended in, in one unit or another.
TEST(HardInput, RefusesWhatRoundingAloneTellsFromTheEdgeOfTheRange) {
    const double maxima = std::numeric_limits<double>::quiet_NaN();
    const Values symmetric =
        Changed({1, 2, 3.5, 5, 6, 7, 8, 9, 10.5, 12, 13}, [](double x) { return 1e-12 * x; });
    const Values oneLarger = With(Values(20, 3.3), 5.2);
    const Values denormal = Changed(Even(30, 1), [](double x) { return 1e-320 * (1 + x); });
    const Case cases[] = {
        {"LN3/MOM/BI", symmetric, maxima, "C07"},    {"LN3/MOM/BII", symmetric, maxima, "C07"},
        {"LN3/MOM/LBQII", symmetric, maxima, "C09"}, {"WEI/LMOM", oneLarger, maxima, "C08"},
        {"P3/LMOM", oneLarger, maxima, "C08"},       {"WEI2/LMOM", oneLarger, 3.3, "C08"},
        {"GP2/LMOM", oneLarger, 3.3, "C08"},         {"GAM/LMOM", oneLarger, 3.3, "C08"},
        {"LN2/LMOM", oneLarger, 3.3, "C08"},         {"GUM/LMOM", denormal, maxima, "C14"},
        {"GEV/ML", denormal, maxima, "C14"},         {"GAM/ML", denormal, 0, "C14"},
    };
    for (const Case& c : cases) {
        const FitResult fit = Fit(Named(c.name), {c.values, FrameOf(c)});
        EXPECT_EQ(fit ? "" : FailureCode(fit.Failure()), c.code) << c.name;
    }
}

// The sign of a skewness that is rounding turned the distribution around.
TEST(HardInput, FitsOnePearsonDistributionToASymmetricSampleInAnyUnit) {
    const Values symmetric = {1, 2, 3.5, 5, 6, 7, 8, 9, 10.5, 12, 13};
    for (const char* name : {"P3/MOM", "P3/LMOM"}) {
        for (const double unit : {1e-12, 0.1, 1.0, 3.7, 1e12}) {
            const auto values = Changed(symmetric, [unit](double x) { return unit * x; });
            const FitResult fit = Fit(Named(name), {values, {}});
            ASSERT_TRUE(fit);
            EXPECT_GT(fit->parameters[1].value, 0) << name << " " << unit;
        }
    }
}

// Gumbel samples moved by one value until the best shape of a GEV is 0: either side of the profile
// can take the summit for the other's.
TEST(HardInput, MeetsAGevMaximumAtTheGumbelShape) {
    for (std::size_t count = 10; count < 60; ++count) {
        Values values = Changed(Even(count, 1), [](double x) { return 14 - std::log(x); });
        double below = 0;
        double above = 0;
        for (double extreme = 15; extreme < 22; extreme += 0.25) {
            const FitResult fit = Fit(Named("GEV/ML"), {With(values, extreme), {}});
            ASSERT_TRUE(fit) << count << " " << extreme;
            (fit->parameters[2].value > 0 ? below : above) = extreme;
            if (above > 0) {
                break;
            }
        }
        for (int i = 0; i < 60 && below > 0; ++i) {
            const double middle = (below + above) / 2;
            const FitResult fit = Fit(Named("GEV/ML"), {With(values, middle), {}});
            ASSERT_TRUE(fit) << count << " " << middle;
            (fit->parameters[2].value > 0 ? below : above) = middle;
        }
    }
}

// Where moving one parameter by that share of the scale leads.
std::vector<Gev> Neighbours(const LocationScaleShape& p, double share) {
    return {*Gev::Make({p.xi + share * p.alpha, p.alpha, p.kappa}),
            *Gev::Make({p.xi, p.alpha * (1 + share), p.kappa}),
            *Gev::Make({p.xi, p.alpha, p.kappa + share})};
}

// The bound comes as close to the other values, against the spread, as the outlier is far away.
TEST(HardInput, ReachesTheHighestLikelihoodBesideAWildOutlier) {
    for (const std::size_t count : {40U, 60U, 80U, 100U, 120U}) {
        for (const double outlier : {3e6, 3e9, 3e10}) {
            const auto values =
                With(Changed(Even(count, 1), [](double x) { return 36 + std::log(x); }), outlier);
            const FitResult fit = Fit(Named("GEV/ML"), {values, {}});
            ASSERT_TRUE(fit) << count << " " << outlier;
            const auto& gev = std::get<Gev>(fit->distribution).Values();
            for (const double share : {-1e-1, -1e-2, -1e-4, 1e-4, 1e-2}) {
                for (const Gev& other : Neighbours(gev, share)) {
                    double height = 0;
                    for (const double x : values) {
                        height += LogDensity(other, x);
                    }
                    EXPECT_LT(height, fit->logLikelihood + 1e-6) << count << " " << outlier;
                }
            }
        }
    }
}

// A profile whose summit, the exponential, has a minimum close by and another summit further off.
TEST(HardInput, DoesNotPassOverTheExponentialLimitOfATruncatedGumbel) {
    Values peaks(15, 0.594);
    peaks.front() = 15 - 14 * 0.594;
    const SeriesFrame frame{SeriesKind::PartialDuration, 0, 1};
    const FitResult gumbel = Fit(Named("TGUM/ML"), {peaks, frame});
    const FitResult exponential = Fit(Named("EXP1/ML"), {peaks, frame});
    ASSERT_TRUE(gumbel && exponential);
    EXPECT_NEAR(gumbel->logLikelihood, exponential->logLikelihood, 1e-6);
}

// Twenty thousand values take hundredths of a second; what grows with the square of the sample
// would take minutes.
TEST(HardInput, TakesTimeInProportionToTheSample) {
    for (const double outlier : {1.0, 1e9}) {
        const Values values =
            With(Changed(Even(20000, 1.3), [](double x) { return 20 + x; }), 20 + outlier);
        for (const NamedCombination& subject : EveryCombination()) {
            const double start = test::ProcessorSeconds();
            const FitResult fit = Fit(subject.combination, {values, {subject.kind, 20, 1}});
            EXPECT_LT(test::ProcessorSeconds() - start, 0.4) << subject.name << " " << !fit;
        }
    }
}

} // namespace
} // namespace ryn::stats
