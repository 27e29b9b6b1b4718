#include "stats/goodness_of_fit.h"
#include "stats/probability_plot.h"

#include "unit/stats/named_combinations.h"
#include "unit/stats/reference_files.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <limits>
#include <numeric>
#include <string>
#include <vector>

namespace ryn::stats {
namespace {

using testing::FrameOf;
using testing::Named;
using testing::ReferenceSeries;

std::vector<double> SortedSeries(const std::string& name) {
    auto values = ReferenceSeries(name);
    SortAscending(values);
    return values;
}

FittedModel Fitted(const std::string& combination, const std::string& series) {
    return *Fit(Named(combination), {ReferenceSeries(series), FrameOf(series)});
}

// The published measures are the matter of src/selfcheck.
TEST(KolmogorovSmirnovTest, TellsWhereTheDistanceIsLargest) {
    for (const auto& [series, name] :
         {std::pair{"portpirie", "GEV/LMOM"}, {"portpirie", "GUM/LMOM"}, {"rain40", "GP2/LMOM"}}) {
        const Distribution d = Fitted(name, series).distribution;
        const auto sorted = SortedSeries(series);
        const KolmogorovSmirnovTest ks = KolmogorovSmirnovTestOf(d, sorted);
        EXPECT_EQ(std::abs(ks.cdf - ks.empirical), ks.statistic) << name;
        EXPECT_EQ(sorted[ks.rank - 1], ks.at) << name;
        EXPECT_EQ(Cdf(d, ks.at), ks.cdf) << name;
    }
}

// The criterion that divides a sum by the sum's own parameters: 2p - 2 ln L.
TEST(GoodnessOfFit, CountsTheEstimatedParametersForAkaike) {
    EXPECT_NEAR(AkaikeCriterion(Fitted("GEV/LMOM", "portpirie")), 6 - 2 * 4.294953, 1e-6);
    EXPECT_NEAR(AkaikeCriterion(Fitted("EXP1/MOM", "rain40")), 2 + 2 * 153.1271, 1e-4);
}

TEST(ChiSquaredTest, HasClassesThatJoinAndHoldEveryValue) {
    const Distribution d = Fitted("GP2/LMOM", "rain40").distribution;
    auto values = SortedSeries("rain40");
    values.push_back(std::numeric_limits<double>::max());
    values.push_back(-std::numeric_limits<double>::max());
    const ChiSquaredTest test = ChiSquaredTestOf(d, values);
    EXPECT_EQ(test.classes.front().lower, 40);
    EXPECT_EQ(test.classes.back().upper, Support(d).upper);
    std::size_t held = 0;
    for (std::size_t j = 0; j < test.classes.size(); ++j) {
        const ChiSquaredClass& c = test.classes[j];
        held += c.observed;
        EXPECT_TRUE(j == 0 || c.lower == test.classes[j - 1].upper);
        const auto inside = std::count_if(values.begin(), values.end(), [&](double x) {
            return (j == 0 || x >= c.lower) && (x < c.upper || j + 1 == test.classes.size());
        });
        EXPECT_EQ(c.observed, static_cast<std::size_t>(inside)) << j;
    }
    EXPECT_EQ(held, values.size());
}

TEST(GoodnessOfFit, HasNoStatisticWhereTheSampleHasNone) {
    const Distribution d = *Gev::Make({3.9, 0.2, 0.05});
    const std::vector<double> few{3.7, 3.8, 3.9, 4.0};
    EXPECT_TRUE(std::isnan(ChiSquaredTestOf(d, few).statistic)); // five classes
    EXPECT_TRUE(std::isnan(ChiSquaredTestOf(d, few).level));
    EXPECT_TRUE(std::isnan(KolmogorovSmirnovTestOf(d, {}).statistic));
    EXPECT_TRUE(std::isnan(PlotCorrelation(ProbabilityPlotOf(d, {}, PlottingMethod::Blom))));
    // Above the upper bound of 7.9, u is infinite, while s is not.
    const std::vector<double> beyond{3.7, 3.8, 3.9, 4.0, 8.5};
    const ProbabilityPlot plot = ProbabilityPlotOf(d, beyond, PlottingMethod::Hazen);
    EXPECT_TRUE(std::isnan(ReducedPlotCorrelation(d, plot)));
    EXPECT_GT(LeastSquaresCriterionOf(d, plot).criterion, 0.3);
    const std::vector<double> huge{-1.7e308, 0, 1, 2, 1.7e308};
    const ProbabilityPlot far = ProbabilityPlotOf(d, huge, PlottingMethod::Hazen);
    EXPECT_TRUE(std::isnan(LeastSquaresCriterionOf(d, far).criterion));
    EXPECT_TRUE(std::isnan(PlotCorrelation(far)));
}

// So skewed that the quantile of 0.01 is exp(-1200): no double holds it, and its variate is
// infinite.
TEST(GoodnessOfFit, HasNoCriterionOnAnInfiniteScale) {
    const Distribution d = *LogPearsonThree::Make({5.18, -280, 0.35});
    const std::vector<double> sample{0.16, 0.18, 0.96, 1.96, 2.3, 13.3, 155};
    const ProbabilityPlot plot = ProbabilityPlotOf(d, sample, PlottingMethod::Weibull);
    const LeastSquaresCriterion criterion = LeastSquaresCriterionOf(d, plot);
    EXPECT_TRUE(std::isinf(criterion.lowVariate));
    EXPECT_TRUE(std::isnan(criterion.criterion));
}

// A scale far below the location's last digit: all quantiles are one number, whose mean rounds.
TEST(GoodnessOfFit, HasNoCorrelationWithQuantilesThatAreAllEqual) {
    const Distribution d = *Gumbel::Make({9.991785218826323, 1e-20});
    std::vector<double> sample(500);
    std::iota(sample.begin(), sample.end(), 1.0);
    const ProbabilityPlot plot = ProbabilityPlotOf(d, sample, PlottingMethod::Weibull);
    ASSERT_EQ(plot.quantiles.front(), plot.quantiles.back());
    EXPECT_TRUE(std::isnan(PlotCorrelation(plot)));
}

// Values of the limit distribution from its defining sum in 50 digits.
TEST(KolmogorovSurvival, MeetsItsTableAndJoinsItsTwoForms) {
    EXPECT_NEAR(KolmogorovSurvival(0.5), 0.9639452437, 5e-11);
    EXPECT_NEAR(KolmogorovSurvival(1), 0.2699996717, 5e-11);
    EXPECT_NEAR(KolmogorovSurvival(1.36), 0.0494858768, 5e-11);
    EXPECT_NEAR(KolmogorovSurvival(1.18), KolmogorovSurvival(std::nextafter(1.18, 0)), 1e-14);
    EXPECT_EQ(KolmogorovSurvival(0), 1);
    EXPECT_EQ(KolmogorovSurvival(1e-3), 1);
    EXPECT_EQ(KolmogorovSurvival(100), 0);
}

TEST(PlottingPosition, IsSymmetric) {
    for (const PlottingMethod method : kPlottingMethods) {
        const auto positions = PlottingPositions(method, 24);
        EXPECT_NEAR(positions[4] + positions[19], 1, 1e-15);
        EXPECT_EQ(positions[4], PlottingPosition(method, 5, 24));
    }
}

} // namespace
} // namespace ryn::stats
