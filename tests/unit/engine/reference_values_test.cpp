#include <gtest/gtest.h>

#include "unit/engine/engine_case.h"

namespace ryn::test {
namespace {

std::string Measure(const char* name) {
    return std::string("DistributionAnalysis/Item1/GoodnessOfFitStatistics/") + name;
}

// Independent programs: R 4.2.2 with lmom 3.2, EnvStats 3.1.0, evd 2.3-6.1, randtests 1.0.2, trend
// 1.1.6 and base R, and one written for the purpose. The engine sees 32-bit floats, which moves a
// statistic by some 1e-7 and a quantile by up to 2e-6.
const struct {
    const char* series;
    std::vector<double> statistics; // mean to kurtosis, b0 to b3, l1, l2, t3, t4
} kStatistics[] = {
    {"portpirie",
     {3.980615, 0.05784649, 0.7279791, 3.40724, 3.980615, 2.05763, 1.397278, 1.061264, 3.980615,
      0.1346442, 0.1374331, 0.1328312}},
    {"floyd",
     {6771.103, 1.36789e+08, 4.74245, 28.7825, 6771.103, 5417.412, 4692.035, 4217.464, 6771.103,
      4063.721, 0.5952284, 0.449362}},
    {"fishkill",
     {2775, 3913557, 2.220253, 7.986548, 2775, 1858.768, 1460.254, 1228.231, 2775, 942.5362,
      0.4073191, 0.304745}},
    {"rain40",
     {51.94318, 148.8211, 1.66097, 5.094483, 51.94318, 29.04609, 20.78795, 16.41577, 51.94318,
      6.148996, 0.3893879, 0.2092633}},
};

TEST(EngineReference, SampleStatistics) {
    const char* const paths[] = {"OrdinaryMoments/Mean",
                                 "OrdinaryMoments/Variance",
                                 "OrdinaryMoments/Skewness",
                                 "OrdinaryMoments/Kurtosis",
                                 "ProbabilityWeightedMoments/Beta_0",
                                 "ProbabilityWeightedMoments/Beta_1",
                                 "ProbabilityWeightedMoments/Beta_2",
                                 "ProbabilityWeightedMoments/Beta_3",
                                 "LMoments/L_1",
                                 "LMoments/L_2",
                                 "LMoments/L_skewness",
                                 "LMoments/L_Kurtosis"};
    for (const auto& c : kStatistics) {
        const EngineRunOf run({c.series, {}});
        for (std::size_t i = 0; i < c.statistics.size(); ++i)
            EXPECT_NEAR(NumberAt(run.Target(), std::string("SampleStatistics/") + paths[i]),
                        c.statistics[i], 2e-6 * c.statistics[i])
                << c.series << " " << paths[i];
    }
}

// Statistics in the order chi-squared and its level, Kolmogorov-Smirnov and its level, SLSC, PPCC I
// and II, log-likelihood.
TEST(EngineReference, GoodnessOfFit) {
    const char* const names[] = {
        "ChiSquaredStatistic",    "ChiSquaredLevel",       "KolmogorovSmirnovStatistic",
        "KolmogorovSmirnovLevel", "SLSCStatistic",         "PPCCStatistic",
        "PPCC2Statistic",         "LogLikelihoodStatistic"};
    const struct {
        const char* series;
        const char* combination;
        int plotting;
        std::vector<double> measures;
    } cases[] = {
        {"portpirie",
         "GEV/LMOM",
         4,
         {2.86154, 89.751, 0.0646524, 94.156, 0.0156744, 0.99713, 0.9968724, 4.294953}},
        {"portpirie",
         "GUM/LMOM",
         4,
         {2.52308, 96.065, 0.0713762, 88.351, 0.0184273, 0.9958665, 0.9958665, 4.21671}},
        {"rain40",
         "GP2/LMOM",
         4,
         {4, 54.942, 0.0790566, 93.69, 0.0416106, 0.979142, 0.9819002, -153.154}},
        {"rain40",
         "EXP1/MOM",
         4,
         {4.72727, 57.924, 0.0922689, 83.007, 0.0448075, 0.9804969, 0.9804969, -153.1271}},
        {"portpirie",
         "GEV/LMOM",
         0,
         {2.86154, 89.751, 0.0646524, 94.156, 0.0178265, 0.9972112, 0.9969279, 4.294953}},
    };
    for (const auto& c : cases) {
        const EngineRunOf run({c.series, {c.combination}, 0, c.plotting});
        for (std::size_t i = 0; i < c.measures.size(); ++i) {
            const double tolerance = i == 1 || i == 3 ? 0.01 : 1e-5 * std::abs(c.measures[i]);
            EXPECT_NEAR(NumberAt(run.Target(), Measure(names[i])), c.measures[i], tolerance)
                << c.series << " " << c.combination << " " << names[i];
        }
    }
}

TEST(EngineReference, IndependenceAndHomogeneity) {
    const struct {
        const char* series;
        int firstSample;
        double run, trend, shift;    // z
        double runP, trendP, shiftP; // levels
    } cases[] = {
        {"nile60", 28, -4.427059, -4.529465, 5.357454, 9.552665e-06, 5.913316e-06, 8.440284e-08},
        {"portpirie", 32, -1.145825, -0.2605811, 0.479153, 0.2518677, 0.7944156, 0.6318298},
        {"floyd", 19, -0.6578363, 1.330656, 0.04214636, 0.5106434, 0.1833022, 0.966382},
    };
    for (const auto& c : cases) {
        EngineCase set{c.series, {}};
        set.firstSample = c.firstSample;
        const EngineRunOf run(set);
        const struct {
            const char* name;
            double z, level;
        } tests[] = {{"RunTest", c.run, c.runP},
                     {"TestForTrend", c.trend, c.trendP},
                     {"TestForShiftInMean", c.shift, c.shiftP}};
        for (const auto& test : tests) {
            const std::string path = std::string("IndependenceHomogeneityTest/") + test.name;
            EXPECT_NEAR(NumberAt(run.Target(), path + "/TestStatistic"), test.z, 1e-6) << path;
            EXPECT_NEAR(NumberAt(run.Target(), path + "/SignificanceLevel"), test.level,
                        1e-6 * test.level)
                << path;
        }
    }
}

// Averages and deviations at 10, 50 and 100 years. Monte Carlo is exact to the generator's last
// draw but for the floats that the fit starts from.
TEST(EngineReference, Uncertainty) {
    const struct {
        const char* series;
        const char* combination;
        int method;
        double averages[3], deviations[3];
    } cases[] = {
        {"portpirie",
         "GUM/MOM",
         0,
         {4.290676114, 4.596758011, 4.726155761},
         {0.06358039684, 0.1018617126, 0.1184402655}},
        {"rain40",
         "EXP1/MOM",
         0,
         {66.29379321, 85.47787555, 93.74001011},
         {4.514084275, 7.294412706, 8.525401325}},
        {"portpirie",
         "GUM/MOM",
         1,
         {4.29588, 4.607077, 4.738638},
         {0.05195984, 0.07959854, 0.09179181}},
        {"portpirie",
         "GEV/LMOM",
         1,
         {4.306438, 4.590762, 4.701611},
         {0.05373043, 0.1041019, 0.1359985}},
        {"rain40", "EXP1/MOM", 1, {66.461, 85.68281, 93.96119}, {4.074667, 7.034589, 8.309357}},
        {"rain40", "GP2/LMOM", 1, {66.81543, 88.16572, 97.5302}, {4.135211, 10.10355, 14.44248}},
    };
    for (const auto& c : cases) {
        const EngineRunOf run({c.series, {c.combination}, c.method});
        const std::string table = "DistributionAnalysis/Item1/TyearEventTable/";
        for (int i = 0; i < 3; ++i) {
            EXPECT_NEAR(NumberAt(run.Target(), table + "AvgTyearEvent", i + 1), c.averages[i],
                        1e-5 * c.averages[i]);
            EXPECT_NEAR(NumberAt(run.Target(), table + "StdTyearEvent", i + 1), c.deviations[i],
                        1e-5 * c.deviations[i])
                << c.series << " " << c.combination << " " << c.method;
        }
    }
}

} // namespace
} // namespace ryn::test
