#include "stats/fit.h"
#include "stats/jackknife.h"
#include "stats/monte_carlo.h"
#include "stats/resampling_draws.h"

#include "unit/stats/named_combinations.h"
#include "unit/stats/reference_files.h"

#include <gtest/gtest.h>

#include <cmath>
#include <string>
#include <vector>

namespace ryn::stats {
namespace {

using testing::FrameOf;
using testing::Named;
using testing::ReferenceSeries;

const std::vector<double> kPeriods{10, 50, 100};

struct Subject {
    Combination combination;
    std::vector<double> values;
    SeriesFrame frame;

    Subject(const std::string& name, const std::string& series)
        : Subject(name, ReferenceSeries(series), FrameOf(series)) {}
    Subject(const std::string& name, std::vector<double> sample, const SeriesFrame& sampleFrame)
        : combination(Named(name)),
          values(std::move(sample)),
          frame(sampleFrame) {}

    Distribution Fitted() const {
        FitScratch scratch;
        return EstimateParameters(combination, {values, frame}, scratch)->distribution;
    }
    ResampledQuantiles Jackknifed(const QuantileRequests& requests) const {
        return Jackknife(combination, Fitted(), {values, frame}, requests);
    }
    ResampledQuantiles Simulated(const QuantileRequests& requests,
                                 const MonteCarloSettings& settings = {}) const {
        return MonteCarlo({combination, Fitted(), values.size(), frame}, requests, settings);
    }
};

// The published averages and deviations are the matter of src/selfcheck.
TEST(Resampling, KeepsEverySampleOfAWellBehavedSeriesAndTellsTheBias) {
    for (const char* name : {"GUM/MOM", "GEV/LMOM"}) {
        const Subject subject(name, "portpirie");
        const auto simulated = subject.Simulated({kPeriods});
        const auto jackknifed = subject.Jackknifed({kPeriods});
        EXPECT_EQ(simulated.kept, 1000U);
        EXPECT_EQ(jackknifed.Failed(), 0U);
        for (std::size_t i = 0; i < kPeriods.size(); ++i) {
            const ResampledQuantile& drawn = simulated.atPeriods[i];
            const ResampledQuantile& left = jackknifed.atPeriods[i];
            EXPECT_NEAR(drawn.bias, drawn.average - drawn.estimate, 1e-12 * drawn.average);
            EXPECT_NEAR(left.bias, left.estimate - left.average, 1e-12 * left.average);
        }
    }
}

// With a fixed location the exponential's quantile is linear in the mean, so that the jackknife
// has no bias to correct and the textbook's deviation.
TEST(Jackknife, IsExactForALinearEstimate) {
    const Subject subject("EXP1/MOM", "rain40");
    const auto result = subject.Jackknifed({kPeriods});
    const double s = CentralMomentsOf(subject.values).StandardDeviation();
    for (std::size_t i = 0; i < kPeriods.size(); ++i) {
        const ResampledQuantile& q = result.atPeriods[i];
        const double deviation = s / std::sqrt(44) * std::log(subject.frame.rate * kPeriods[i]);
        EXPECT_NEAR(q.bias, 0, 1e-11 * q.estimate);
        EXPECT_NEAR(q.standardDeviation, deviation, 1e-12 * deviation);
    }
}

void ExpectSame(const ResampledQuantile& a, const ResampledQuantile& b) {
    EXPECT_EQ(a.estimate, b.estimate);
    EXPECT_EQ(a.average, b.average);
    EXPECT_EQ(a.standardDeviation, b.standardDeviation);
}

// A period is a fixed exceedance where the rate does not vary.
TEST(Resampling, AnswersPeriodsAndProbabilitiesAlikeWhereTheRateIsFixed) {
    const Subject subject("GEV/LMOM", "portpirie");
    const std::vector<double> periods{2, 4};
    const std::vector<double> probabilities{0.5, 0.75};
    const QuantileRequests requests{periods, PeriodMeaning::OfEvent, probabilities};
    for (const auto& result : {subject.Jackknifed(requests), subject.Simulated(requests)}) {
        for (std::size_t i = 0; i < periods.size(); ++i) {
            const auto& a = result.atPeriods[i];
            const auto& b = result.atProbabilities[i];
            EXPECT_NEAR(a.average, b.average, 1e-12 * a.average);
            EXPECT_NEAR(a.standardDeviation, b.standardDeviation, 1e-9 * b.standardDeviation);
        }
    }
}

// The Poisson counts widen quantiles at periods: Var = alpha^2/n (1 + ln^2(rate T)).
TEST(MonteCarlo, LetsTheRateVaryWithTheCountAtPeriodsAlone) {
    const Subject subject("EXP1/MOM", "rain40");
    const std::vector<double> longPeriod{100};
    const std::vector<double> samePlace{1 - 1 / (100 * subject.frame.rate)};
    const QuantileRequests requests{longPeriod, PeriodMeaning::OfEvent, samePlace};
    const auto result = subject.Simulated(requests);
    const auto& period = result.atPeriods[0];
    const auto& place = result.atProbabilities[0];
    const double term = std::log(100 * subject.frame.rate);
    EXPECT_NEAR(period.standardDeviation / place.standardDeviation, std::hypot(1, term) / term,
                0.03);
}

// The mean of n exponential exceedances has a gamma distribution of shape n: its 0.025 and 0.975
// quantiles at n = 44 are 0.726602 and 1.316380 means (base R 4.2).
TEST(MonteCarlo, EnclosesNinetyFivePercentOfTheResamples) {
    const Subject subject("EXP1/MOM", "rain40");
    MonteCarloSettings settings{20'000, 1, EventCount::Fixed};
    const auto result = subject.Simulated({kPeriods}, settings);
    for (const ResampledQuantile& q : result.atPeriods) {
        const double above = q.estimate - 40;
        EXPECT_NEAR((q.lower - 40) / above, 0.726602, 0.01);
        EXPECT_NEAR((q.upper - 40) / above, 1.316380, 0.01);
    }
    settings.samples = 39; // the least and the largest
    const auto few = subject.Simulated({kPeriods}, settings).atPeriods[0];
    EXPECT_LT(few.lower, few.estimate);
    settings.samples = 38;
    EXPECT_TRUE(std::isnan(subject.Simulated({kPeriods}, settings).atPeriods[0].lower));
    EXPECT_TRUE(std::isnan(subject.Jackknifed({kPeriods}).atPeriods[0].upper));
}

// At rate T = 1.02 about half the samples are so small that there is no such event, at 1.3 one in
// twenty.
TEST(MonteCarlo, DropsASampleForTheShortPeriodsThatItLacks) {
    const Subject subject("EXP1/MOM", "rain40");
    const std::vector<double> periods{1.02 / subject.frame.rate, 1.3 / subject.frame.rate};
    const auto result = subject.Simulated({periods});
    EXPECT_EQ(result.kept, 1000U);
    EXPECT_GT(result.atPeriods[0].estimate, 40);
    EXPECT_TRUE(std::isnan(result.atPeriods[0].average));
    EXPECT_GT(result.atPeriods[1].average, 40);
    EXPECT_GT(result.atPeriods[1].standardDeviation, 0);
}

TEST(Resampling, GivesNoNumbersForAPeriodWithoutEvent) {
    const std::vector<double> periods{0.5, 1, -3, 0, std::nan(""), INFINITY, 10};
    for (const char* name : {"GUM/MOM", "EXP1/LMOM"}) {
        const Subject subject(name, *name == 'G' ? "portpirie" : "rain40");
        for (const auto& result : {subject.Jackknifed({periods}), subject.Simulated({periods})}) {
            for (std::size_t i = 0; i + 1 < periods.size(); ++i) {
                EXPECT_FALSE(std::isfinite(result.atPeriods[i].estimate)) << name << periods[i];
                EXPECT_TRUE(std::isnan(result.atPeriods[i].average)) << name << periods[i];
                EXPECT_TRUE(std::isnan(result.atPeriods[i].standardDeviation));
                EXPECT_TRUE(std::isnan(result.atPeriods[i].bias));
            }
            EXPECT_TRUE(std::isfinite(result.atPeriods.back().standardDeviation));
        }
    }
}

TEST(Resampling, StandsRatesOfAnySize) {
    for (const double rate : {5e-324, 1e-12, 1e12, 1.7e308}) {
        Subject subject("GP2/LMOM", "rain40");
        subject.frame.rate = rate;
        const QuantileRequests requests{kPeriods, PeriodMeaning::OfAnnualMaximum, {}};
        for (const auto& result : {subject.Jackknifed(requests), subject.Simulated(requests)}) {
            EXPECT_EQ(result.atPeriods.size(), 3U);
            const bool finite = std::isfinite(result.atPeriods[0].standardDeviation);
            EXPECT_TRUE(rate > 1e300 || finite == (rate == 1e12));
        }
    }
}

TEST(Jackknife, HasNoNumbersForTheSmallestSample) {
    const auto result = Subject("GEV/LMOM", {1, 2, 4, 8, 16}, {}).Jackknifed({kPeriods});
    EXPECT_EQ(result.asked, 5U);
    EXPECT_EQ(result.kept, 0U);
    EXPECT_TRUE(std::isfinite(result.atPeriods[0].estimate));
    EXPECT_TRUE(std::isnan(result.atPeriods[0].average));
}

// Half of all Poisson counts of mean 5 are below the five that a fit needs.
TEST(MonteCarlo, DrawsNoSampleTooSmallToFit) {
    const SeriesFrame frame{SeriesKind::PartialDuration, 0, 1};
    EXPECT_EQ(Subject("EXP1/MOM", {1, 2, 4, 8, 16}, frame).Simulated({kPeriods}).kept, 1000U);
    EXPECT_EQ(Subject("GUM/MOM", {1, 2, 4, 8, 16}, {}).Simulated({kPeriods}).kept, 1000U);
}

// Without its odd value the sample has no spread and no fit; nine of ten deletions are enough.
TEST(Jackknife, LeavesOutDeletionsThatCannotBeFitted) {
    for (const char* name : {"GUM/MOM", "GUM/LMOM"}) {
        std::vector<double> values(10, 0.1);
        values[6] = 0.7;
        const auto ten = Subject(name, values, {}).Jackknifed({kPeriods});
        EXPECT_EQ(ten.kept, 9U);
        EXPECT_NEAR(ten.atPeriods[0].standardDeviation, 0, 1e-12); // nine equal fits
        EXPECT_TRUE(std::isfinite(ten.atPeriods[0].average));
        values.pop_back();
        const auto nine = Subject(name, values, {}).Jackknifed({kPeriods});
        EXPECT_EQ(nine.Failed(), 1U);
        EXPECT_TRUE(std::isnan(nine.atPeriods[0].average));
    }
}

// The exponential is not offered for annual maxima: every refit fails.
TEST(MonteCarlo, HasNoNumbersWhereTheSamplesCannotBeFitted) {
    const Subject subject("GUM/MOM", "portpirie");
    const Distribution fitted = subject.Fitted();
    const auto result = MonteCarlo({Named("EXP1/MOM"), fitted, 65, {}}, {kPeriods});
    EXPECT_EQ(result.asked, 1000U);
    EXPECT_EQ(result.Failed(), 1000U);
    EXPECT_TRUE(std::isnan(result.atPeriods[0].average));
    EXPECT_EQ(result.atPeriods[0].estimate, QuantileOfPeriod(fitted, 10, {}, {}));
}

TEST(Resampling, RepeatsItselfToTheBit) {
    const Subject subject("GEV/LMOM", "portpirie");
    const auto first = subject.Simulated({kPeriods});
    const auto second = subject.Simulated({kPeriods});
    ExpectSame(first.atPeriods[2], second.atPeriods[2]);
    MonteCarloSettings other;
    other.seed = 1;
    EXPECT_NE(subject.Simulated({kPeriods}, other).atPeriods[2].average,
              first.atPeriods[2].average);
}

TEST(Resampling, StandsTheLargestAndSmallestNumbers) {
    for (const double unit : {1e-320, 1e-170, 1e160, 1.7e308 / 50}) {
        std::vector<double> values;
        for (const int step : {3, 7, 1, 9, 30, 12, 5, 14}) {
            values.push_back(step * unit);
        }
        for (const char* name : {"GEV/MOM", "GEV/LMOM", "GP/MOM", "GP/LMOM", "GUM/LMOM"}) {
            const Distribution any = *Gumbel::Make({unit, unit});
            const Subject subject(name, values, {});
            Jackknife(subject.combination, any, {values, {}}, {kPeriods});
            MonteCarlo({subject.combination, any, 8, {}}, {kPeriods}, {});
        }
    }
}

TEST(ResamplingDraws, CountEventsOnBothSidesOfTheNormalApproximation) {
    UniformDraws draws(1);
    for (const double mean : {0.5, 44.0, 699.0, 701.0, 1e6}) {
        double sum = 0;
        double squares = 0;
        for (int i = 0; i < 4000; ++i) {
            const double k = static_cast<double>(PoissonCount(mean, draws.Next())) - mean;
            sum += k / 4000;
            squares += k * k / 4000;
        }
        EXPECT_NEAR(sum, 0, 4 * std::sqrt(mean / 4000));
        EXPECT_NEAR(squares / mean, 1, 0.12);
        EXPECT_GE(PoissonCount(mean, 1 - 0x1p-53), PoissonCount(mean, 0x1p-53));
    }
}

} // namespace
} // namespace ryn::stats
