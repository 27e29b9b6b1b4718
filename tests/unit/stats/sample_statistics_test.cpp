#include "stats/sample_statistics.h"

#include "unit/stats/reference_files.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <array>
#include <cmath>
#include <limits>

namespace ryn::stats {
namespace {

using testing::ReferenceSeries;

std::array<double, 12> AsRow(const SampleStatistics& s) {
    return {s.mean,        s.variance,    s.skewness, s.kurtosis, s.weighted.b0, s.weighted.b1,
            s.weighted.b2, s.weighted.b3, s.l1,       s.l2,       s.lSkewness,   s.lKurtosis};
}

TEST(SampleStatistics, AreNaNWhereTheSampleIsTooSmall) {
    const double values[] = {3, 1, 2, 5};
    const auto count = [&](std::size_t n) {
        return SampleStatisticsOf(std::span(values).first(n));
    };
    for (const double value : AsRow(count(0))) {
        EXPECT_TRUE(std::isnan(value));
    }
    EXPECT_EQ(count(1).mean, 3);
    EXPECT_TRUE(std::isnan(count(1).variance));
    EXPECT_TRUE(std::isnan(count(1).l2));
    EXPECT_EQ(count(2).variance, 2);
    EXPECT_EQ(count(2).l2, 1);
    EXPECT_TRUE(std::isnan(count(2).skewness));
    EXPECT_TRUE(std::isnan(count(2).weighted.b2));
    EXPECT_TRUE(std::isnan(count(2).lSkewness));
    EXPECT_EQ(count(3).skewness, 0);
    EXPECT_EQ(count(3).lSkewness, 0);
    EXPECT_TRUE(std::isnan(count(3).kurtosis));
    EXPECT_TRUE(std::isnan(count(3).weighted.b3));
    EXPECT_TRUE(std::isnan(count(3).lKurtosis));
    EXPECT_FALSE(std::isnan(count(4).kurtosis));
    EXPECT_FALSE(std::isnan(count(4).lKurtosis));
}

TEST(SampleStatistics, OfEqualValuesHaveNoSpreadAndNoShape) {
    const std::vector<double> values(7, 0.1);
    const SampleStatistics s = SampleStatisticsOf(values);
    EXPECT_EQ(s.mean, 0.1);
    EXPECT_EQ(s.variance, 0);
    EXPECT_EQ(s.l2, 0);
    EXPECT_TRUE(std::isnan(s.skewness));
    EXPECT_TRUE(std::isnan(s.lSkewness));
}

TEST(SampleStatistics, OfASampleWithNaNAreNaN) {
    const double nan = std::numeric_limits<double>::quiet_NaN();
    const std::vector<double> values = {1, nan, 0, 2, nan, 5};
    for (const double value : AsRow(SampleStatisticsOf(values))) {
        EXPECT_TRUE(std::isnan(value));
    }
}

TEST(SortAscending, PutsNaNLast) {
    const double nan = std::numeric_limits<double>::quiet_NaN();
    std::vector<double> values = {3, nan, -1, 7, nan, 2, nan, 5};
    SortAscending(values);
    EXPECT_TRUE(std::is_sorted(values.begin(), values.begin() + 5));
    EXPECT_EQ(values[0], -1);
    EXPECT_EQ(values[4], 7);
    EXPECT_TRUE(std::isnan(values[5]) && std::isnan(values[6]) && std::isnan(values[7]));
}

// Sea levels above a distant datum: the spread is 1e-8 of the level, and both scales of spread have
// to keep the digits that the values still have (about seven).
TEST(SampleStatistics, KeepTheirDigitsAtAHighLevel) {
    auto values = ReferenceSeries("portpirie");
    const SampleStatistics low = SampleStatisticsOf(values);
    for (double& x : values) {
        x += 4e7;
    }
    const SampleStatistics high = SampleStatisticsOf(values);
    EXPECT_NEAR(high.variance / low.variance, 1, 1e-6);
    EXPECT_NEAR(high.skewness / low.skewness, 1, 1e-6);
    EXPECT_NEAR(high.l2 / low.l2, 1, 1e-6);
    EXPECT_NEAR(high.lSkewness / low.lSkewness, 1, 1e-6);
}

} // namespace
} // namespace ryn::stats
