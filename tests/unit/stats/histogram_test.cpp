#include "stats/fit.h"
#include "stats/histogram.h"
#include "stats/quantile_curve.h"

#include "unit/stats/named_combinations.h"
#include "unit/stats/reference_files.h"

#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

#include <algorithm>
#include <cmath>
#include <limits>
#include <numeric>
#include <vector>

namespace ryn::stats {
namespace {

using testing::FrameOf;
using testing::HalfUnit;
using testing::Named;
using testing::ReferenceSeries;
using Counts = std::vector<std::size_t>;

TEST(Histogram, HasRoundIntervalsFromARoundStartOrTheThreshold) {
    const auto annual = *HistogramOf(ReferenceSeries("portpirie"), {});
    EXPECT_NEAR(annual.start, 3.4, 1e-12);
    EXPECT_EQ(annual.step, 0.2);
    EXPECT_EQ(annual.counts, (Counts{1, 14, 23, 14, 10, 2, 1}));
    EXPECT_NEAR(annual.densities[1], 1.07692, HalfUnit(1.07692, 6));
    const auto peaks = *HistogramOf(ReferenceSeries("rain40"), FrameOf("rain40"));
    EXPECT_EQ(peaks.start, 40);
    EXPECT_EQ(peaks.step, 10);
    EXPECT_EQ(peaks.counts, (Counts{27, 11, 1, 2, 3}));
}

TEST(Histogram, StandsBesideTheFittedDensities) {
    const auto values = ReferenceSeries("portpirie");
    const Distribution d = Fit(Named("GEV/LMOM"), {values, {}})->distribution;
    const auto densities = IntervalDensities(d, *HistogramOf(values, {}));
    const double references[] = {0.126941, 1.07073, 1.744, 1.20635, 0.55105, 0.205031, 0.0676267};
    ASSERT_EQ(densities.size(), std::size(references));
    for (std::size_t j = 0; j < densities.size(); ++j) {
        EXPECT_NEAR(densities[j], references[j], HalfUnit(references[j], 6));
    }
}

// Far up the tail a difference of F would be 0.
TEST(Histogram, KeepsTheDigitsOfRareIntervals) {
    const Distribution d = *Exponential::Make({0, 1});
    const Histogram histogram{50, 1, {1, 0}, {1, 0}};
    const auto densities = IntervalDensities(d, histogram);
    const double expected = std::exp(-50) - std::exp(-51);
    EXPECT_NEAR(densities[0], expected, 1e-12 * expected);
}

RC_GTEST_PROP(Histogram, HoldsEveryValueInAFewIntervals, ()) {
    const auto mantissas =
        *rc::gen::nonEmpty(rc::gen::container<std::vector<int>>(rc::gen::inRange(-1000, 1000)));
    const double unit = std::pow(10, *rc::gen::inRange(-300, 300));
    std::vector<double> values;
    values.reserve(mantissas.size());
    for (const int mantissa : mantissas) {
        values.push_back(mantissa * unit);
    }
    const SeriesFrame frame{
        *rc::gen::element(SeriesKind::AnnualMaximum, SeriesKind::PartialDuration), -1000 * unit, 1};
    const auto histogram = HistogramOf(values, frame);
    const auto [low, high] = std::minmax_element(values.begin(), values.end());
    RC_ASSERT(histogram.has_value() == (*low < *high));
    if (!histogram) {
        return;
    }
    const auto& counts = histogram->counts;
    RC_ASSERT(counts.size() <= 1000);
    RC_ASSERT(std::accumulate(counts.begin(), counts.end(), std::size_t{0}) == values.size());
    RC_ASSERT(histogram->start <= *low + 1e-6 * histogram->step);
    RC_ASSERT(histogram->Bound(counts.size()) >= *high);
    RC_ASSERT(counts.back() > 0);
}

TEST(Histogram, NeedsASpreadThatHasAWidth) {
    constexpr double kMax = std::numeric_limits<double>::max();
    const std::vector<std::vector<double>> hopeless = {
        {}, {1}, {2, 2, 2}, {1, std::nan("")}, {1, INFINITY}, {0, 5e-324}};
    for (const auto& values : hopeless) {
        EXPECT_FALSE(HistogramOf(values, {}));
    }
    HistogramOf(std::vector<double>{-kMax, kMax, 0, 1, 2}, {}); // overflows, and must not crash
    EXPECT_TRUE(HistogramOf(std::vector<double>{1, std::nextafter(1, 2)}, {}));
    // A threshold 10^12 intervals below the values.
    const auto far = HistogramOf(std::vector<double>{1, 1 + 1e-12, 1 + 2e-12},
                                 {SeriesKind::PartialDuration, 0, 1});
    ASSERT_TRUE(far);
    EXPECT_LT(far->counts.size(), 10U);
}

TEST(DensityCurve, SpansTheHistogramAndOneIntervalMore) {
    const Histogram histogram{40, 10, Counts(5), std::vector<double>(5)};
    const auto peaks = DensityCurveAbscissae(histogram, SeriesKind::PartialDuration);
    const auto annual = DensityCurveAbscissae(histogram, SeriesKind::AnnualMaximum);
    EXPECT_EQ(peaks.size(), 201U);
    EXPECT_EQ(annual.size(), 201U);
    EXPECT_EQ(peaks.front(), 40);
    EXPECT_EQ(annual.front(), 30);
    EXPECT_EQ(peaks.back(), 100);
    EXPECT_EQ(annual.back(), 100);
}

TEST(DensityCurve, StepsInsideFromAPoleAndIsZeroOutside) {
    const Distribution d = *GeneralisedPareto::Make({0, 1, 2}); // f = (1 - 2x)^-1/2 up to 0.5
    const auto curve = DensityCurve(d, std::vector<double>{-0.1, 0, 0.5, 0.6}, 1);
    EXPECT_EQ(curve[0], 0);
    EXPECT_EQ(curve[1], 1);
    EXPECT_NEAR(curve[2], 10, 1e-9); // at 0.495
    EXPECT_EQ(curve[3], 0);
    const Distribution narrow = *Exponential::Make({0, 1e-9});
    EXPECT_EQ(DensityCurve(narrow, std::vector<double>{0.0}, 1e-12)[0],
              Density(narrow, 0.0));                                    // 1e9, below 1e6/step
    EXPECT_EQ(DensityCurve(narrow, std::vector<double>{0.0}, 1)[0], 0); // 0.005 is far out
}

double GumbelVariate(double probability) {
    return -std::log(-std::log(probability));
}

TEST(QuantileCurve, IsEquidistantOnGumbelPaper) {
    const auto f = QuantileCurveProbabilities({65, 100, {}});
    ASSERT_EQ(f.size(), 100U);
    EXPECT_NEAR(f.front(), 0.25 / 65, 1e-14);
    EXPECT_NEAR(f.back(), 0.999, 1e-14);
    const double step = GumbelVariate(f[1]) - GumbelVariate(f[0]);
    for (std::size_t i = 1; i < f.size(); ++i) {
        EXPECT_NEAR(GumbelVariate(f[i]) - GumbelVariate(f[i - 1]), step, 1e-9);
    }
}

TEST(QuantileCurve, ReachesTheLongestOfPeriodRecordAndAThousandYears) {
    const SeriesFrame peaks{SeriesKind::PartialDuration, 40, 4};
    EXPECT_NEAR(QuantileCurveProbabilities({20, 100, peaks}).back(), 1 - 1 / 4000.0, 1e-14);
    EXPECT_NEAR(QuantileCurveProbabilities({20, 5000, peaks}).back(), 1 - 1 / 40000.0, 1e-14);
    EXPECT_NEAR(QuantileCurveProbabilities({3000, 100, peaks}).back(), 1 - 1 / 30000.0, 1e-14);
}

TEST(QuantileCurve, StaysBetween0And1ForAnyRateAndPeriod) {
    for (const double rate : {5e-324, 1e-9, 1.0, 1e9, 1.7e308}) {
        for (const double period : {0.0, 1e-300, 1e15, 1.7e308}) {
            const SeriesFrame frame{SeriesKind::PartialDuration, 0, rate};
            const auto f = QuantileCurveProbabilities({5, period, frame});
            EXPECT_TRUE(std::is_sorted(f.begin(), f.end()));
            EXPECT_GT(f.front(), 0);
            EXPECT_LT(f.back(), 1);
        }
    }
}

} // namespace
} // namespace ryn::stats
