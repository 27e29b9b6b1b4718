#include "stats/return_period.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>

namespace ryn::stats {
namespace {

using enum PeriodMeaning;

const SeriesFrame kAnnual{};
const SeriesFrame kPeaks{SeriesKind::PartialDuration, 40, 44.0 / 48};

TEST(ExceedanceOfPeriod, OfAnAnnualMaximumSeriesIsItsInverse) {
    EXPECT_EQ(ExceedanceOfPeriod(100, kAnnual, OfEvent), 0.01);
    EXPECT_EQ(ExceedanceOfPeriod(100, kAnnual, OfAnnualMaximum), 0.01);
    SeriesFrame rated = kAnnual;
    rated.rate = 3;
    EXPECT_EQ(ExceedanceOfPeriod(100, rated, OfEvent), 0.01);
}

TEST(ExceedanceOfPeriod, OfPeaksTakesTheRateOrTheAnnualMaximum) {
    EXPECT_NEAR(ExceedanceOfPeriod(10, kPeaks, OfEvent), 48.0 / 440, 1e-16);
    EXPECT_NEAR(ExceedanceOfPeriod(1e15, kPeaks, OfAnnualMaximum) * 1e15, 48.0 / 44, 1e-14);
}

TEST(ExceedanceOfPeriod, IsNaNWhereThereIsNoSuchEvent) {
    const double nan = std::numeric_limits<double>::quiet_NaN();
    for (const double period : {1.0, 0.5, 0.0, -5.0, nan}) {
        EXPECT_TRUE(std::isnan(ExceedanceOfPeriod(period, kAnnual, OfEvent))) << period;
        EXPECT_TRUE(std::isnan(ExceedanceOfPeriod(period, kPeaks, OfAnnualMaximum))) << period;
    }
    // The smallest periods are those at which e reaches 1: 1/rate, and 1/(1 - exp(-rate)).
    const double smallest = 48.0 / 44;
    EXPECT_TRUE(std::isnan(ExceedanceOfPeriod(smallest * 0.999, kPeaks, OfEvent)));
    EXPECT_LT(ExceedanceOfPeriod(smallest * 1.001, kPeaks, OfEvent), 1);
    const double smallestYear = -1 / std::expm1(-44.0 / 48);
    EXPECT_TRUE(std::isnan(ExceedanceOfPeriod(smallestYear * 0.999, kPeaks, OfAnnualMaximum)));
    EXPECT_LT(ExceedanceOfPeriod(smallestYear * 1.001, kPeaks, OfAnnualMaximum), 1);
    SeriesFrame rateless = kPeaks;
    for (const double rate : {0.0, -1.0, nan}) {
        rateless.rate = rate;
        EXPECT_TRUE(std::isnan(ExceedanceOfPeriod(100, rateless, OfEvent))) << rate;
        EXPECT_TRUE(std::isnan(ExceedanceOfPeriod(-100, rateless, OfEvent))) << rate;
        EXPECT_TRUE(std::isnan(ExceedanceOfPeriod(100, rateless, OfAnnualMaximum))) << rate;
    }
}

TEST(QuantileOfPeriod, FollowsTheExceedanceAndItsNaN) {
    const Distribution d = Exponential::Make({40, 12}, LocationType::Fixed).value();
    EXPECT_NEAR(QuantileOfPeriod(d, 100, kPeaks, OfEvent), 40 + 12 * std::log(100 * 44.0 / 48),
                1e-12);
    EXPECT_TRUE(std::isnan(QuantileOfPeriod(d, 1, kPeaks, OfEvent)));
    EXPECT_EQ(QuantileOfPeriod(d, std::numeric_limits<double>::infinity(), kPeaks, OfEvent),
              std::numeric_limits<double>::infinity());
}

} // namespace
} // namespace ryn::stats
