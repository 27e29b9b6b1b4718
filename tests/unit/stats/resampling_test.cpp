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
using testing::HalfUnit;
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

struct Case {
    std::string series, combination;
    std::vector<double> averages, deviations; // T = 10, 50, 100 years
    EventCount events = EventCount::Poisson;
};

// An independent program with the same generator, to ten digits.
TEST(MonteCarlo, ReproducesEveryDrawAndFit) {
    const Case cases[] = {
        {"portpirie",
         "GUM/MOM",
         {4.290676114, 4.596758011, 4.726155761},
         {0.06358039684, 0.1018617126, 0.1184402655}},
        {"rain40",
         "EXP1/MOM",
         {66.29379321, 85.47787555, 93.74001011},
         {4.514084275, 7.294412706, 8.525401325}},
        {"rain40",
         "EXP1/MOM",
         {66.49608148, 85.74337521, 94.03273342},
         {4.084014466, 7.050725827, 8.328418865},
         EventCount::Fixed},
    };
    for (const Case& c : cases) {
        SCOPED_TRACE(c.combination);
        MonteCarloSettings settings;
        settings.events = c.events;
        const auto result = Subject(c.combination, c.series).Simulated({kPeriods}, settings);
        EXPECT_EQ(result.kept, 1000U);
        for (std::size_t i = 0; i < kPeriods.size(); ++i) {
            const ResampledQuantile& q = result.atPeriods[i];
            EXPECT_NEAR(q.average, c.averages[i], HalfUnit(c.averages[i], 10));
            EXPECT_NEAR(q.standardDeviation, c.deviations[i], HalfUnit(c.deviations[i], 10));
            EXPECT_NEAR(q.bias, q.average - q.estimate, 1e-12 * q.average);
        }
    }
}

// An independent program; the L-moment fits confirmed with the R package lmom 3.2. Its search for
// the GEV's likelihood ended a little early: the hundred-year average, 4.6925694787, is that of
// thirty digits throughout.
TEST(Jackknife, MeetsAnIndependentProgram) {
    const Case cases[] = {
        {"portpirie",
         "GUM/MOM",
         {4.29588, 4.607077, 4.738638},
         {0.05195984, 0.07959854, 0.09179181}},
        {"portpirie",
         "GEV/LMOM",
         {4.306438, 4.590762, 4.701611},
         {0.05373043, 0.1041019, 0.1359985}},
        {"portpirie", "GEV/ML", {4.301042, 4.582578, 4.692569}, {0.05212351, 0.1027011, 0.1348014}},
        {"rain40", "GP2/ML", {66.64625, 87.0805, 95.94092}, {4.00934, 7.652107, 10.34916}},
        {"rain40", "EXP1/MOM", {66.461, 85.68281, 93.96119}, {4.074667, 7.034589, 8.309357}},
        {"rain40", "EXP1/ML", {66.461, 85.68281, 93.96119}, {4.074667, 7.034589, 8.309357}},
        {"floyd", "LP3/MOM/LOG", {14458.16, 36402.36, 49719.7}, {4052.44, 17687.02, 29897.42}},
        {"fishkill", "P3/LMOM", {5294.953, 8760.553, 10281.35}, {1159.446, 2742.643, 3499.667}},
        {"rain40", "GP2/LMOM", {66.81543, 88.16572, 97.5302}, {4.135211, 10.10355, 14.44248}},
    };
    for (const Case& c : cases) {
        SCOPED_TRACE(c.combination);
        const auto result = Subject(c.combination, c.series).Jackknifed({kPeriods});
        EXPECT_EQ(result.Failed(), 0U);
        for (std::size_t i = 0; i < kPeriods.size(); ++i) {
            const ResampledQuantile& q = result.atPeriods[i];
            EXPECT_NEAR(q.average, c.averages[i], HalfUnit(c.averages[i], 7));
            EXPECT_NEAR(q.standardDeviation, c.deviations[i], HalfUnit(c.deviations[i], 7));
            EXPECT_NEAR(q.bias, q.estimate - q.average, 1e-12 * q.average);
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

TEST(ResamplingDraws, AreThoseOfTheReferenceGenerator) {
    UniformDraws draws(12345);
    for (const double u : {0.35762972288842587, 0.40044261704406126, 0.68938331700276845}) {
        EXPECT_EQ(draws.Next(), u);
    }
    UniformDraws again(12345);
    for (const std::size_t count : {41U, 42U, 47U}) {
        EXPECT_EQ(PoissonCount(44, again.Next()), count);
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
