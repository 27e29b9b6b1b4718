#include "stats/fit.h"
#include "stats/return_period.h"
#include "stats/shape_functions.h"

#include "unit/stats/named_combinations.h"
#include "unit/stats/reference_files.h"

#include <gtest/gtest.h>

#include <cmath>
#include <optional>
#include <string>
#include <utility>
#include <vector>

namespace ryn::stats {
namespace {

using testing::FrameOf;
using testing::HalfUnit;
using testing::Named;
using testing::ReferenceNumber;
using testing::ReferenceSeries;
using testing::ReferenceTable;

struct Case {
    const char* series;
    const char* combination;
    std::vector<double> parameters;
    std::vector<double> quantiles;       // T = 10, 50, 100 years
    std::optional<double> logLikelihood; // none: values lie outside the support
};

// Seven significant digits from an independent program; confirmed with the R packages lmom 3.2
// (L-moments), EnvStats 3.1.0 (Gumbel by moments; likelihood of the log-normal, gamma and Weibull),
// evd 2.3-6.1 and fitdistrplus 1.1-8 (likelihood), and moments of the fit by scipy 1.10.1. The xi
// of EXP2 is that of tests/reference/stats/fits.R, the 100-year event of floyd that of the
// parameters of tests/reference/stats/likelihood.csv (74553.4171; the program had stopped at
// 74553.41).
const Case kCases[] = {
    {"portpirie",
     "GEV/MOM",
     {3.876911, 0.2058218, 0.07951318},
     {4.301012, 4.567376, 4.669878},
     4.252272},
    {"portpirie",
     "GEV/LMOM",
     {3.873148, 0.2032223, 0.05121192},
     {4.305104, 4.591905, 4.706044},
     4.294953},
    {"portpirie",
     "GEV/ML",
     {3.87475, 0.198044, 0.05010953},
     {4.296212, 4.576651, 4.688404},
     4.339058},
    {"floyd",
     "GEV/ML",
     {2405.068, 2172.559, -0.6901144},
     {14133.93, 45763.26, 74553.42},
     -376.4488},
    {"portpirie", "GUM/ML", {3.869444, 0.1948894}, {4.308016, 4.62989, 4.765964}, 4.217682},
    {"fishkill", "GUM/ML", {2035.553, 1086.777}, {4481.202, 6276.092, 7034.892}, -208.113},
    {"portpirie", "GUM/MOM", {3.872372, 0.1875272}, {4.294377, 4.604091, 4.735025}, 4.101216},
    {"portpirie", "GUM/MOM corr", {3.867829, 0.2037657}, {4.326376, 4.66291, 4.805181}, 4.092206},
    {"portpirie", "GUM/LMOM", {3.868491, 0.1942506}, {4.305626, 4.626445, 4.762072}, 4.21671},
    {"portpirie", "GP/MOM", {3.657554, 0.4529693, 0.4021162}, {4.337744, 4.550385, 4.607217}, {}},
    {"portpirie", "GP/LMOM", {3.641758, 0.5139423, 0.5166902}, {4.333752, 4.504661, 4.54433}, {}},
    {"fishkill",
     "GEV/LMOM",
     {1824.734, 884.0289, -0.3390825},
     {4809.443, 9007.26, 11622.32},
     -205.0719},
    {"rain40", "GP2/MOM", {11.69514, -0.0207683}, {66.51684, 86.55887, 95.39904}, -153.125},
    {"rain40",
     "GP3/MOM",
     {38.96884, 13.82489, 0.06555656},
     {67.47837, 85.74032, 93.0308},
     -156.6406},
    {"rain40", "GP2/LMOM", {11.25404, -0.05770206}, {66.59812, 88.16693, 98.09126}, -153.154},
    {"rain40", "GP3/LMOM", {40.38943, 10.15535, -0.1210344}, {66.19491, 89.78969, 101.4558}, {}},
    {"rain40", "GP2/ML", {11.7833, -0.01341221}, {66.49852, 86.24739, 94.88499}, -153.1242},
    {"rain30", "GP2/ML", {7.440269, -0.1844991}, {65.96078, 92.33603, 106.3415}, -485.0937},
    {"portpirie", "LN2/ML", {1.37968, 0.05894042}, {4.285407, 4.484958, 4.557601}, 2.119604},
    {"portpirie",
     "LN3/ML",
     {3.215958, -0.3160629, 0.3101437},
     {4.300765, 4.594318, 4.715919},
     4.409851},
    {"fishkill",
     "LN3/ML",
     {767.6563, 7.227908, 0.8851557},
     {5050.108, 9250.455, 11565.35},
     -204.5965},
    {"floyd", "LN3/ML", {127.9947, 8.122233, 1.1199}, {14277.61, 33726.16, 45721.04}, -376.522},
    {"fishkill", "SQE/ML", {22.84884, 0.01247866}, {4534.067, 7035.356, 8238.903}, -205.702},
    {"floyd", "SQE/ML", {4.159084, 0.00260533}, {11848.67, 21377.45, 26124.81}, -380.9163},
    {"rain40", "WEI2/ML", {12.00308, 1.011688}, {66.35041, 85.20579, 93.29509}, -153.1221},
    {"rain30", "WEI2/ML", {8.64904, 0.908606}, {63.85427, 81.56925, 89.38825}, -486.1179},
    {"rain40", "GAM/ML", {11.46483, 1.041723}, {66.21326, 84.86667, 92.87888}, -153.1038},
    {"rain30", "GAM/ML", {10.13404, 0.8964054}, {62.82554, 78.79204, 85.69735}, -486.7775},
    {"rain40", "LN2/ML", {1.928684, 1.215266}, {70.72678, 119.8831, 151.7114}, -155.8737},
    {"rain30", "LN2/ML", {1.554042, 1.257353}, {78.92565, 138.8388, 176.6093}, -486.7023},
    {"rain40",
     "LN3/ML",
     {39.16136, 2.137758, 0.9384839},
     {66.09526, 95.49052, 112.1415},
     -153.7011},
    {"pp38", "TGUM/ML", {3.935076, 0.1712178}, {4.341494, 4.623436, 4.742885}, 17.80146},
    {"pp38", "GP2/ML", {0.3604376, 0.3334748}, {4.379329, 4.587627, 4.648143}, 17.34166},
    {"rain40", "EXP1/MOM", {11.94318}, {66.461, 85.68281, 93.96119}, -153.1271},
    {"rain40", "EXP1/ML", {11.94318}, {66.461, 85.68281, 93.96119}, -153.1271},
    {"rain40", "EXP1/LMOM", {11.94318}, {66.461, 85.68281, 93.96119}, -153.1271},
    {"rain40", "EXP2/MOM", {39.74396, 12.19923}, {66.77224, 86.40614, 94.862}, -154.0604},
    {"rain40", "EXP2/LMOM", {39.64519, 12.29799}, {66.8923, 86.68515, 95.20947}, -154.4152},
};

void ExpectDigits(double value, double reference, const std::string& what) {
    EXPECT_NEAR(value, reference, HalfUnit(reference, 7)) << what;
}

class PublishedFit : public ::testing::TestWithParam<Case> {};

TEST_P(PublishedFit, IsMetToEveryDigit) {
    const Case& c = GetParam();
    const Combination combination = Named(c.combination);
    const auto values = ReferenceSeries(c.series);
    const SeriesFrame frame = FrameOf(c.series);
    const FitResult fit = Fit(combination, {values, frame});
    ASSERT_TRUE(fit) << FailureText(fit.Failure());
    ASSERT_EQ(fit->parameters.size(), c.parameters.size());
    const auto symbols = EstimatedSymbols(combination, frame.kind);
    ASSERT_EQ(symbols.size(), c.parameters.size());
    for (std::size_t i = 0; i < c.parameters.size(); ++i) {
        EXPECT_EQ(fit->parameters[i].symbol, symbols[i]);
        ExpectDigits(fit->parameters[i].value, c.parameters[i], std::string(symbols[i]));
    }
    const double periods[] = {10, 50, 100};
    for (std::size_t i = 0; i < 3; ++i) {
        ExpectDigits(QuantileOfPeriod(fit->distribution, periods[i], frame, PeriodMeaning::OfEvent),
                     c.quantiles[i], "quantile");
    }
    if (c.logLikelihood) {
        ExpectDigits(fit->logLikelihood, *c.logLikelihood, "log-likelihood");
        EXPECT_TRUE(fit->warnings.empty());
    } else {
        EXPECT_TRUE(std::isnan(fit->logLikelihood));
        ASSERT_EQ(fit->warnings.size(), 1U);
        EXPECT_EQ(WarningCode(fit->warnings[0]), "W1");
    }
}

std::string CaseName(const ::testing::TestParamInfo<Case>& info) {
    std::string name = std::string(info.param.series) + "_" + info.param.combination;
    for (char& c : name) {
        c = c == '/' || c == ' ' ? '_' : c;
    }
    return name;
}

INSTANTIATE_TEST_SUITE_P(Tables, PublishedFit, ::testing::ValuesIn(kCases), CaseName);

// The same for the families with a table of their own: an independent program to seven digits,
// confirmed with R's lmom 3.2 (L-moments), moments of the fit by scipy and mpmath, or R formulas.
TEST(Fit, MeetsEveryDigitOfThePublishedTable) {
    for (const auto& row : ReferenceTable("published_fits.csv")) {
        SCOPED_TRACE(row[0] + " " + row[1]);
        const auto values = ReferenceSeries(row[0]);
        const SeriesFrame frame = FrameOf(row[0]);
        const FitResult fit = Fit(Named(row[1]), {values, frame});
        ASSERT_TRUE(fit) << FailureText(fit.Failure());
        for (std::size_t i = 0; i < fit->parameters.size(); ++i) {
            ExpectDigits(fit->parameters[i].value, ReferenceNumber(row[2 + i]),
                         std::string(fit->parameters[i].symbol));
        }
        for (const auto& [period, column] : {std::pair{10, 5}, {50, 6}, {100, 7}}) {
            const double quantile =
                QuantileOfPeriod(fit->distribution, period, frame, PeriodMeaning::OfEvent);
            ExpectDigits(quantile, ReferenceNumber(row[static_cast<std::size_t>(column)]), "x");
        }
        const double logLikelihood = ReferenceNumber(row[8]);
        EXPECT_EQ(std::isnan(fit->logLikelihood), std::isnan(logLikelihood));
        if (!std::isnan(logLikelihood)) {
            ExpectDigits(fit->logLikelihood, logLikelihood, "log-likelihood");
        }
    }
}

TEST(Fit, ReadsReturnPeriodsOfTheAnnualMaximum) {
    const auto values = ReferenceSeries("rain40");
    const SeriesFrame frame = FrameOf("rain40");
    const struct {
        const char* combination;
        std::vector<double> quantiles;
    } cases[] = {{"EXP1/MOM", {65.83735, 85.56237, 93.90123}},
                 {"GP2/LMOM", {65.93133, 88.02546, 98.01794}}};
    const double periods[] = {10, 50, 100};
    for (const auto& c : cases) {
        const FitResult fit = Fit(Named(c.combination), {values, frame});
        ASSERT_TRUE(fit);
        for (std::size_t i = 0; i < 3; ++i) {
            ExpectDigits(QuantileOfPeriod(fit->distribution, periods[i], frame,
                                          PeriodMeaning::OfAnnualMaximum),
                         c.quantiles[i], c.combination);
        }
    }
}

// fits.csv solves for the moments and L-moments as integrals over the quantile function, and finds
// the exponential's maximum likelihood by search.
TEST(Fit, AgreesWithFitsThroughNumericalIntegration) {
    for (const auto& row : ReferenceTable("fits.csv")) {
        const std::string place = row[0] + " " + row[1];
        const auto values = ReferenceSeries(row[0]);
        const FitResult fit = Fit(Named(row[1]), {values, FrameOf(row[0])});
        ASSERT_TRUE(fit) << place;
        const double alpha = ReferenceNumber(row[3]);
        const double tolerance = row[1] == "EXP1/ML" ? 1e-7 : 1e-8;
        for (const Parameter& parameter : Parameters(fit->distribution)) {
            const std::size_t column =
                parameter.symbol == "xi" ? 2 : (parameter.symbol == "alpha" ? 3 : 4);
            const double scale = column == 4 ? 1.0 : alpha;
            EXPECT_NEAR(parameter.value, ReferenceNumber(row[column]), tolerance * scale)
                << place << " " << parameter.symbol;
        }
        const double quantile = ReferenceNumber(row[5]);
        EXPECT_NEAR(QuantileOfExceedance(fit->distribution, 0.01), quantile, tolerance * quantile)
            << place;
    }
}

// Gumbel's table of the finite-sample constants.
TEST(GumbelConstants, AreThoseOfGumbelsTable) {
    const struct {
        std::size_t count;
        double mean;
        double deviation;
    } rows[] = {{10, 0.49521, 0.94963},
                {20, 0.52355, 1.06282},
                {50, 0.54854, 1.16066},
                {100, 0.56002, 1.20649}};
    for (const auto& row : rows) {
        const GumbelConstants constants = GumbelConstantsFor(row.count);
        EXPECT_NEAR(constants.mean, row.mean, 5e-6);
        EXPECT_NEAR(constants.deviation, row.deviation, 5e-6);
    }
}

TEST(EstimateFromMoments, IsTheFitOfTheSampleTheyAreOf) {
    const auto values = ReferenceSeries("portpirie");
    FitScratch scratch;
    for (const char* name : {"GEV/MOM", "GUM/MOM", "GUM/MOM corr", "GP/MOM"}) {
        const auto direct = EstimateParameters(Named(name), {values, {}}, scratch);
        const auto summed = EstimateFromMoments(Named(name), {}, CentralMomentsOf(values), scratch);
        ASSERT_TRUE(direct && summed) << name;
        EXPECT_EQ(Quantile(direct->distribution, 0.99), Quantile(summed->distribution, 0.99));
    }
    EXPECT_EQ(EstimateFromMoments(Named("GEV/LMOM"), {}, CentralMomentsOf(values), scratch)
                  .Failure()
                  .fault,
              FitFault::MethodNotOffered);
}

// L-moments of known members, from shapes far beyond where the solver's first guess is good.
TEST(EstimateFromLMoments, FindsGevShapesAcrossTheirWholeRange) {
    for (const double kappa : {-0.99, -0.8, -0.3, -1e-7, 0.0, 1e-7, 0.5, 2.0, 5.0, 15.0}) {
        const double l2 = 3 * std::tgamma(1 + kappa) * GevLScaleFactor(kappa);
        const double l1 = 2 + 3 * GevMeanFactor(kappa);
        const LMoments moments{50, l1, l2, l2 * GevLSkewness(kappa), 0};
        const auto found = EstimateFromLMoments(Named("GEV/LMOM"), {}, moments);
        ASSERT_TRUE(found) << kappa;
        const auto parameters = Parameters(found->distribution);
        // From kappa = 5 on the L-skewness is within 1e-1 of its limit and loses digits of kappa.
        const double slack = 1e-11 * std::exp(std::abs(kappa));
        EXPECT_NEAR(parameters[0].value, 2, slack * 3) << kappa;
        EXPECT_NEAR(parameters[1].value, 3, slack * 3) << kappa;
        EXPECT_NEAR(parameters[2].value, kappa, slack) << kappa;
    }
    const LMoments outside{50, 1, 1, 1.0, 0};
    EXPECT_EQ(EstimateFromLMoments(Named("GEV/LMOM"), {}, outside).Failure().fault,
              FitFault::LMomentsOutOfRange);
}

// The scratch remembers constants of one sample size; another size must not get them.
TEST(FitScratch, NeverShowsInAResult) {
    const auto values = ReferenceSeries("portpirie");
    const FitInput whole{values, {}};
    const FitInput part{std::span(values).first(30), {}};
    FitScratch kept;
    for (const char* name : {"GUM/MOM corr", "GEV/LMOM", "GEV/ML"}) {
        for (const FitInput& input : {whole, part, whole}) {
            const FitResult again = Fit(Named(name), input, kept);
            const FitResult fresh = Fit(Named(name), input);
            ASSERT_TRUE(again && fresh);
            EXPECT_EQ(again->logLikelihood, fresh->logLikelihood);
        }
    }
}

} // namespace
} // namespace ryn::stats
