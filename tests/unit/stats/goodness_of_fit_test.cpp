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
using testing::HalfUnit;
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

struct Case {
    std::string series, combination;
    PlottingMethod method;
    double chiSquared;
    std::size_t classes, degreesOfFreedom;
    double chiSquaredLevel, distance, distanceLevel, criterion, correlation, reducedCorrelation;
};

// R 4.2.2: ks.test, cut, cor and the density functions of evd 2.3-6.1; an independent program for
// the Weibull positions.
const Case kCases[] = {
    {"portpirie", "GEV/LMOM", PlottingMethod::Cunnane, 2.86154, 11, 7, 89.751, 0.0646524, 94.156,
     0.0156744, 0.99713, 0.9968724},
    {"portpirie", "GUM/LMOM", PlottingMethod::Cunnane, 2.52308, 11, 8, 96.065, 0.0713762, 88.351,
     0.0184273, 0.9958665, 0.9958665},
    {"rain40", "GP2/LMOM", PlottingMethod::Cunnane, 4, 8, 5, 54.942, 0.0790566, 93.69, 0.0416106,
     0.979142, 0.9819002},
    {"rain40", "EXP1/MOM", PlottingMethod::Cunnane, 4.72727, 8, 6, 57.924, 0.0922689, 83.007,
     0.0448075, 0.9804969, 0.9804969},
    {"portpirie", "GEV/LMOM", PlottingMethod::Weibull, 2.86154, 11, 7, 89.751, 0.0646524, 94.156,
     0.0178265, 0.9972112, 0.9969279},
};

TEST(GoodnessOfFit, MeetsIndependentPrograms) {
    for (const Case& c : kCases) {
        SCOPED_TRACE(c.series + " " + c.combination);
        const Distribution d = Fitted(c.combination, c.series).distribution;
        const auto sorted = SortedSeries(c.series);
        const ChiSquaredTest chi = ChiSquaredTestOf(d, sorted);
        EXPECT_NEAR(chi.statistic, c.chiSquared, 5e-6);
        EXPECT_EQ(chi.classes.size(), c.classes);
        EXPECT_EQ(chi.degreesOfFreedom, c.degreesOfFreedom);
        EXPECT_NEAR(chi.level, c.chiSquaredLevel, 5e-4);
        const KolmogorovSmirnovTest ks = KolmogorovSmirnovTestOf(d, sorted);
        EXPECT_NEAR(ks.statistic, c.distance, HalfUnit(c.distance, 6));
        EXPECT_NEAR(ks.level, c.distanceLevel, 5e-4);
        EXPECT_EQ(std::abs(ks.cdf - ks.empirical), ks.statistic);
        EXPECT_EQ(sorted[ks.rank - 1], ks.at);
        const ProbabilityPlot plot = ProbabilityPlotOf(d, sorted, c.method);
        EXPECT_NEAR(LeastSquaresCriterionOf(d, plot).criterion, c.criterion,
                    HalfUnit(c.criterion, 6));
        EXPECT_NEAR(PlotCorrelation(plot), c.correlation, 5.1e-8);
        EXPECT_NEAR(ReducedPlotCorrelation(d, plot), c.reducedCorrelation, 5.1e-8);
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

TEST(PlottingPosition, IsThatOfEachFormula) {
    const auto values = SortedSeries("fishkill");
    const double references[][2] = {{0.04, 0.2},
                                    {0.02083333, 0.1875},
                                    {0.02321725, 0.1890547},
                                    {0.0257732, 0.1907216},
                                    {0.02479339, 0.1900826}};
    for (const PlottingMethod method : kPlottingMethods) {
        const auto& reference = references[static_cast<std::size_t>(method)];
        const auto positions = PlottingPositions(method, values.size());
        EXPECT_NEAR(positions[0], reference[0], HalfUnit(reference[0], 7));
        EXPECT_NEAR(positions[4], reference[1], HalfUnit(reference[1], 7));
        EXPECT_NEAR(positions[4] + positions[19], 1, 1e-15);
    }
}

} // namespace
} // namespace ryn::stats
