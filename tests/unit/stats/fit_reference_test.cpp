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
// (L-moments) and EnvStats 3.1.0 (Gumbel by moments), and moments of the fit by scipy 1.10.1. The
// xi of EXP2 is that of tests/reference/stats/fits.R.
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
    for (const char* name : {"GUM/MOM corr", "GEV/LMOM"}) {
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
