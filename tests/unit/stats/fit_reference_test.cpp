#include "stats/fit.h"
#include "stats/shape_functions.h"

#include "unit/stats/named_combinations.h"
#include "unit/stats/reference_files.h"

#include <gtest/gtest.h>

#include <cmath>
#include <string>
#include <utility>
#include <vector>

namespace ryn::stats {
namespace {

using testing::FrameOf;
using testing::Named;
using testing::ReferenceNumber;
using testing::ReferenceSeries;
using testing::ReferenceTable;

// Seven published digits of every fit are the matter of src/selfcheck.
TEST(Fit, ListsItsParametersUnderTheSymbolsKnownBeforehand) {
    for (const auto& [series, name] : {std::pair{"portpirie", "GEV/ML"},
                                       {"portpirie", "LN2/MOM"},
                                       {"fishkill", "SQE/ML"},
                                       {"rain40", "GP2/LMOM"},
                                       {"rain40", "EXP2/MOM"}}) {
        const SeriesFrame frame = FrameOf(series);
        const FitResult fit = Fit(Named(name), {ReferenceSeries(series), frame});
        ASSERT_TRUE(fit) << FailureText(fit.Failure());
        const auto symbols = EstimatedSymbols(Named(name), frame.kind);
        ASSERT_EQ(fit->parameters.size(), symbols.size()) << name;
        for (std::size_t i = 0; i < symbols.size(); ++i) {
            EXPECT_EQ(fit->parameters[i].symbol, symbols[i]) << name;
        }
    }
}

// A fit that leaves a value outside its support stands, with a warning and without likelihood.
TEST(Fit, WarnsOfValuesOutsideItsSupport) {
    for (const char* name : {"GP/MOM", "GP/LMOM"}) {
        const FitResult fit = Fit(Named(name), {ReferenceSeries("portpirie"), {}});
        ASSERT_TRUE(fit) << FailureText(fit.Failure());
        EXPECT_TRUE(std::isnan(fit->logLikelihood)) << name;
        ASSERT_EQ(fit->warnings.size(), 1U) << name;
        EXPECT_EQ(WarningCode(fit->warnings[0]), "W1");
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
