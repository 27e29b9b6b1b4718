#include <iterator>
#include <set>

#include "apps/cli/fit_report.h"
#include "apps/cli/fit_texts.h"
#include "command_fixture.h"
#include "params/combination_name.h"
#include "strings/language.h"

namespace ryn::cli {
namespace {

using testing::ElementsAre;
using FitCommand = CommandTest;

// Gumbel by L-moments in closed form: alpha = l2 / ln 2, xi = l1 - 0.5772 alpha. For 1, 2, 3, 4, 5
// the mean is 3 and l2 = 2 b1 - b0 = 1.
constexpr double kAlpha = 1.4426950408889634;
constexpr double kXi = 3.0 - 0.57721566490153286 * kAlpha;

std::vector<std::string> KeysOf(const nlohmann::ordered_json& object) {
    std::vector<std::string> keys;
    for (const auto& member : object.items())
        keys.push_back(member.key());
    return keys;
}

/// The words of a table, whose columns are as wide as their headings.
std::vector<std::string> Words(const std::string& text) {
    std::istringstream stream(text);
    return {std::istream_iterator<std::string>(stream), {}};
}

TEST_F(FitCommand, FitsAColumnOfNumbers) {
    files.Write("v.txt", "# made by hand\nlevel\n3\n1 \n5\t# remark\n2;\n\n4 # last\n");
    ASSERT_EQ(Run({"fit", "gum/lmom", "v.txt", "--json", "--periods", "10,1000"}), 0) << err;
    EXPECT_EQ(err, "ryn: note: v.txt: the first line is taken as a heading: level\n");
    const auto fit = Json();
    EXPECT_THAT(KeysOf(fit),
                ElementsAre("name", "n", "unit", "failed", "parameters", "logLikelihood",
                            "quantiles", "goodness", "uncertainty", "sampleCorrection"));
    EXPECT_EQ(fit["name"], "GUM/LMOM");
    EXPECT_EQ(fit["n"], 5);
    EXPECT_TRUE(fit["failed"].is_null());
    EXPECT_EQ(fit["parameters"][0]["symbol"], "xi");
    EXPECT_NEAR(fit["parameters"][0]["estimate"], kXi, 1e-12);
    EXPECT_NEAR(fit["parameters"][1]["estimate"], kAlpha, 1e-12);
    const auto quantile = fit["quantiles"][1];
    EXPECT_THAT(KeysOf(quantile), ElementsAre("period", "probability", "estimate", "average",
                                              "standardDeviation", "bias"));
    EXPECT_EQ(quantile["period"], 1000.0);
    EXPECT_EQ(quantile["probability"], 0.001);
    EXPECT_NEAR(quantile["estimate"], kXi - kAlpha * std::log(-std::log1p(-0.001)), 1e-9);
    EXPECT_TRUE(quantile["average"].is_null());
    EXPECT_TRUE(quantile["standardDeviation"].is_null());
    EXPECT_TRUE(quantile["bias"].is_null());
    EXPECT_EQ(fit["uncertainty"].dump(), R"({"method":"none","resamples":0,"failed":0})");
    EXPECT_EQ(fit["sampleCorrection"], false);
}

TEST_F(FitCommand, GivesTheSameForAFileForStandardInputAndForASeries) {
    files.Write("v.txt", "3\n1\n5\n2\n4\n");
    WriteYearly("s.tsq0", {3, 1, 5, 2, 4});
    ASSERT_EQ(Run({"fit", "GEV/LMOM", "v.txt"}), 0) << err;
    const std::string expected = out;
    ASSERT_EQ(Run({"fit", "GEV/LMOM", "-"}, "3\n1\n5\n2\n4\n"), 0) << err;
    EXPECT_EQ(out, expected);
    ASSERT_EQ(Run({"fit", "GEV/LMOM", "s.tsq0"}), 0) << err;
    const std::size_t unit = out.find(" [m3/s]");
    ASSERT_NE(unit, std::string::npos) << out;
    EXPECT_EQ(Words(out.erase(unit, 7)), Words(expected));
    ASSERT_EQ(Run({"fit", "GEV/LMOM", "s.tsq0", "--json"}), 0) << err;
    EXPECT_EQ(Json()["unit"], "m3/s");
}

TEST_F(FitCommand, PrintsTablesForPeople) {
    ASSERT_EQ(Run({"fit", "GUM/LMOM", "-", "--periods", "2,100"}, "1\n2\n3\n4\n5\n"), 0) << err;
    EXPECT_EQ(out,
              "GUM/LMOM fitted to 5 values\n"
              "\n"
              "xi     2.16725\n"
              "alpha  1.44270\n"
              "\n"
              "chi-squared          0.600000  level 43.86 %, classes: 4, degrees of freedom: 1\n"
              "Kolmogorov-Smirnov   0.170376  level 99.61 %\n"
              "SLSC                0.0399401  Weibull plotting positions\n"
              "PPCC I               0.993104  Weibull plotting positions\n"
              "PPCC II              0.993104  Weibull plotting positions\n"
              "log-likelihood       -9.06995\n"
              "AIC                   22.1399\n"
              "\n"
              "return period [years]  exceedance probability  estimate\n"
              "                    2                  0.5000    2.6960\n"
              "                  100                  0.0100    8.8039\n");
}

TEST_F(FitCommand, CountsReturnPeriodsOfPartialDurationsByTheRate) {
    const std::string values = "10.5\n12\n11\n15\n10.2\n13\n";
    ASSERT_EQ(Run({"fit", "EXP1/LMOM", "-", "--pds", "--rate", "2", "--threshold", "10",
                   "--periods", "0.75,50", "--json"},
                  values),
              0)
        << err;
    // The scale of an exponential distribution is the mean exceedance: 11.7 / 6.
    EXPECT_NEAR(Json()["parameters"][0]["estimate"], 11.7 / 6.0, 1e-12);
    EXPECT_NEAR(Json()["quantiles"][1]["probability"], 0.01, 1e-15);
    EXPECT_NEAR(Json()["quantiles"][1]["estimate"], 10.0 + 11.7 / 6.0 * std::log(100.0), 1e-9);
    EXPECT_EQ(Run({"fit", "EXP1/LMOM", "-", "--pds", "--rate", "2", "--threshold", "10",
                   "--periods", "0.5"},
                  values),
              1);
    EXPECT_EQ(err, "ryn: return period 0.5 must be greater than 0.5 years\n");
}

TEST_F(FitCommand, RefusesPeriodsThatNoAnnualMaximumHas) {
    const std::vector<std::string> command{"fit",      "EXP1/LMOM", "-",           "--pds",
                                           "--rate",   "2",         "--threshold", "10",
                                           "--annual", "--periods", "1.1"};
    EXPECT_EQ(Run(command, "10.5\n12\n11\n15\n10.2\n13\n"), 1);
    // 1/(1 - exp(-2)): the part of the years that have an event at all.
    EXPECT_EQ(err, "ryn: return period 1.1 must be greater than 1.1565176427496657 years\n");
}

/// Peaks above 10; their mean exceedance is 13.2/7.
const std::string kPeaks = "10.5\n12\n11\n15\n10.2\n13\n11.5\n";

TEST_F(FitCommand, ReadsPeriodsOfTheAnnualMaximum) {
    const std::vector<std::string> command{"fit",   "EXP1/LMOM", "-", "--json",
                                           "--pds", "--rate",    "2", "--threshold",
                                           "10",    "--periods", "50"};
    std::vector<std::string> annual = command;
    annual.push_back("--annual");
    ASSERT_EQ(Run(annual, kPeaks), 0) << err;
    const double exceedance = -std::log1p(-0.02) / 2;
    EXPECT_NEAR(Json()["quantiles"][0]["probability"], exceedance, 1e-15);
    EXPECT_NEAR(Json()["quantiles"][0]["estimate"], 10.0 - 13.2 / 7 * std::log(exceedance), 1e-9);
    ASSERT_EQ(Run({"fit", "GUM/MOM", "-", "--json"}, kPeaks), 0) << err;
    const std::string plain = out;
    ASSERT_EQ(Run({"fit", "GUM/MOM", "-", "--json", "--annual"}, kPeaks), 0) << err;
    EXPECT_EQ(out, plain); // the years of annual maxima are those of their events
}

// Jackknife of an exponential with a fixed location: linear in the mean, so without bias.
TEST_F(FitCommand, EstimatesTheUncertaintyThatIsAskedFor) {
    const std::vector<std::string> command{"fit",    "EXP1/MOM",  "-",      "--pds",
                                           "--rate", "1",         "--json", "--threshold",
                                           "10",     "--periods", "100",    "--uncertainty"};
    const auto with = [&command](const std::string& method) {
        std::vector<std::string> whole = command;
        whole.push_back(method);
        return whole;
    };
    ASSERT_EQ(Run(with("jackknife"), kPeaks), 0) << err;
    const auto jackknife = Json()["quantiles"][0];
    EXPECT_NEAR(jackknife["average"], jackknife["estimate"].get<double>(), 1e-10);
    EXPECT_NEAR(jackknife["bias"], 0.0, 1e-10);
    EXPECT_GT(jackknife["standardDeviation"], 1.0);
    EXPECT_EQ(Json()["uncertainty"].dump(), R"({"method":"jackknife","resamples":7,"failed":0})");
    ASSERT_EQ(Run(with("MonteCarlo"), kPeaks), 0) << err;
    const auto simulated = Json()["quantiles"][0];
    EXPECT_NEAR(simulated["bias"],
                simulated["average"].get<double>() - simulated["estimate"].get<double>(), 1e-10);
    EXPECT_EQ(Json()["uncertainty"]["resamples"], 1000);
    ASSERT_EQ(Run(with("none"), kPeaks), 0) << err;
    EXPECT_TRUE(Json()["quantiles"][0]["average"].is_null());
}

// Without its odd value the sample has no spread, and eight of nine deletions are not enough.
TEST_F(FitCommand, WarnsWhereTooFewResamplesCanBeFitted) {
    ASSERT_EQ(
        Run({"fit", "GUM/MOM", "-", "--uncertainty", "jackknife"}, "1\n1\n1\n1\n1\n1\n1\n1\n7\n"),
        0);
    EXPECT_EQ(err, "ryn: warning: GUM/MOM: no uncertainty: only 8 of 9 resamples could be fitted, "
                   "9 are needed\n");
    EXPECT_NE(out.find("jackknife: 9 resamples, 1 of them failed\n"), std::string::npos);
    EXPECT_NE(out.find(" -\n"), std::string::npos);
}

TEST_F(FitCommand, TellsHowWellItFits) {
    const std::string series = std::string(RYN_SOURCE_DIR) + "/tests/reference/stats/series/";
    ASSERT_EQ(Run({"fit", "GEV/LMOM", series + "portpirie.txt", "--json", "--plotting", "Cunnane"}),
              0)
        << err;
    const auto goodness = Json()["goodness"];
    EXPECT_THAT(KeysOf(goodness),
                ElementsAre("chiSquared", "kolmogorovSmirnov", "plottingPositions", "slsc", "ppcc1",
                            "ppcc2", "logLikelihood", "aic"));
    EXPECT_NEAR(goodness["chiSquared"]["statistic"], 2.86154, 5e-6);
    EXPECT_EQ(goodness["chiSquared"]["classes"], 11);
    EXPECT_EQ(goodness["chiSquared"]["degreesOfFreedom"], 7);
    EXPECT_NEAR(goodness["chiSquared"]["level"], 89.751, 5e-4);
    EXPECT_NEAR(goodness["kolmogorovSmirnov"]["statistic"], 0.0646524, 5e-8);
    EXPECT_NEAR(goodness["kolmogorovSmirnov"]["level"], 94.156, 5e-4);
    EXPECT_EQ(goodness["plottingPositions"], "Cunnane");
    EXPECT_NEAR(goodness["slsc"], 0.0156744, 5e-8);
    EXPECT_NEAR(goodness["ppcc1"], 0.99713, 5e-7);
    EXPECT_NEAR(goodness["ppcc2"], 0.9968724, 5e-8);
    EXPECT_NEAR(goodness["aic"], 6.0 - 2.0 * 4.294953, 2e-6);
    ASSERT_EQ(Run({"fit", "GEV/LMOM", series + "portpirie.txt", "--json"}), 0) << err;
    EXPECT_EQ(Json()["goodness"]["plottingPositions"], "Weibull");
    EXPECT_NEAR(Json()["goodness"]["slsc"], 0.0178265, 5e-8);
    ASSERT_EQ(Run({"fit", "GEV/LMOM", series + "portpirie.txt", "--json", "--plotting", "4"}), 0);
    EXPECT_EQ(Json()["goodness"], goodness);
}

TEST_F(FitCommand, FitsSeveralCombinationsInTheirOrder) {
    const std::string values = "3\n1\n5\n2\n4\n";
    ASSERT_EQ(Run({"fit", "gev/lmom,GUM/MOM", "-", "--json"}, values), 0) << err;
    ASSERT_TRUE(Json().is_array());
    EXPECT_EQ(Json()[0]["name"], "GEV/LMOM");
    EXPECT_EQ(Json()[1]["name"], "GUM/MOM");
    const auto second = Json()[1];
    ASSERT_EQ(Run({"fit", "GUM/MOM", "-", "--json"}, values), 0) << err;
    EXPECT_EQ(Json(), second);
    ASSERT_EQ(Run({"fit", "GUM/MOM", "-"}, values), 0) << err;
    const std::string block = out;
    ASSERT_EQ(Run({"fit", "GUM/MOM,GEV/LMOM", "-"}, values), 0) << err;
    EXPECT_EQ(out.rfind(block + "\nGEV/LMOM fitted to 5 values\n", 0), 0U) << out;
    ASSERT_EQ(Run({"fit", "all", "-", "--json"}, "3\n1.2\n5\n2\n4.4\n9\n2.5\n"), 0);
    EXPECT_EQ(Json().size(), GeneratedNames(0).size());
    EXPECT_EQ(Json()[0]["name"], "GEV/MOM");
}

TEST_F(FitCommand, CorrectsGumbelForTheSampleSize) {
    ASSERT_EQ(Run({"fit", "GEV/MOM,GUM/MOM,GUM/ML", "-", "--json", "--sample-correction"},
                  "3\n1\n5\n2\n4\n"),
              0)
        << err;
    EXPECT_EQ(Json()[0]["sampleCorrection"], false);
    EXPECT_EQ(Json()[1]["sampleCorrection"], true);
    EXPECT_EQ(Json()[2]["sampleCorrection"], false);
    // Gumbel (1958): mean 0.4588 and deviation 0.7928 of the reduced variate for five values.
    const double alpha = std::sqrt(2.5) / 0.79278;
    EXPECT_NEAR(Json()[1]["parameters"][1]["estimate"], alpha, 2e-4);
    EXPECT_NEAR(Json()[1]["parameters"][0]["estimate"], 3.0 - 0.45879 * alpha, 2e-4);
}

// Log-Pearson 3 takes positive values alone.
TEST_F(FitCommand, LetsTheOthersStandWhereOneFails) {
    const std::string values = "0\n2\n3\n5\n4\n9\n";
    const std::string reason = "C04: all values must be greater than 0";
    ASSERT_EQ(Run({"fit", "LP3/LMOM,GUM/MOM", "-", "--json"}, values), 0);
    EXPECT_EQ(err, "ryn: LP3/LMOM: " + reason + "\n");
    EXPECT_EQ(Json()[0]["failed"], reason);
    EXPECT_EQ(Json()[0]["goodness"].dump(), "{}");
    EXPECT_EQ(Json()[0]["quantiles"].dump(), "[]");
    EXPECT_TRUE(Json()[1]["failed"].is_null());
    ASSERT_EQ(Run({"fit", "LP3/LMOM,GUM/MOM", "-"}, values), 0);
    EXPECT_EQ(out.rfind("LP3/LMOM failed: " + reason + "\n\nGUM/MOM fitted to 6 values\n", 0), 0U);
    EXPECT_EQ(Run({"fit", "LP3/LMOM,LP3/MOM/LOG", "-"}, values), 2);
    EXPECT_EQ(out, "");
    EXPECT_EQ(err, "ryn: LP3/LMOM: " + reason + "\nryn: LP3/MOM/LOG: " + reason + "\n");
}

TEST_F(FitCommand, ExitsWithTwoWhenTheFitFails) {
    ASSERT_EQ(Run({"fit", "LP3/LMOM", "-", "--json"}, "0\n2\n3\n5\n4\n9\n"), 2);
    EXPECT_EQ(Json()["parameters"].dump(), "[]");
    EXPECT_EQ(Json()["quantiles"].dump(), "[]");
    EXPECT_TRUE(Json()["logLikelihood"].is_null());
    EXPECT_EQ(err, "ryn: LP3/LMOM: " + Json()["failed"].get<std::string>() + "\n");
    EXPECT_EQ(Run({"fit", "LP3/LMOM", "-", "--lang", "ja"}, "0\n2\n3\n5\n4\n9\n"), 2);
    EXPECT_EQ(err, "ryn: LP3/LMOM: C04: すべての値が 0 より大きくなければなりません\n");
    SetLanguage(Language::English);
}

// By the rules of an analysis, and told once however many are to be fitted.
TEST_F(FitCommand, RefusesASeriesThatCannotBeAnalysed) {
    const auto fit = [this](const std::string& values) {
        const int code = Run(
            {"fit", "EXP1/MOM,GP2/ML", "-", "--pds", "--rate", "1", "--threshold", "7", "--json"},
            values);
        for (const auto& report : code == 2 ? Json() : nlohmann::ordered_json::array())
            EXPECT_EQ("ryn: " + report["failed"].get<std::string>() + "\n", err);
        return code;
    };
    EXPECT_EQ(fit("8\n9\n8.5\n"), 2);
    EXPECT_EQ(err, "ryn: standard input: the series has 3 value(s); at least 5 are needed\n");
    EXPECT_EQ(fit("8\n8\n8\n8\n8\n"), 2);
    EXPECT_EQ(err, "ryn: standard input: all 5 values of the series are equal (8)\n");
    EXPECT_EQ(fit("8\n9\n6.9\n6\n8\n"), 2);
    EXPECT_EQ(err, "ryn: standard input: value 3 of the series is 6.9, below the threshold 7\n");
    EXPECT_EQ(fit("8\n9\n6.999999\n6.9999931\n8.5\n"), 0); // a threshold stored as a float
    EXPECT_EQ(err.find("threshold"), std::string::npos);
    EXPECT_EQ(Run({"fit", "GEV/LMOM", "-"}, "7\n7\n7\n"), 2);
    EXPECT_EQ(out, "");
}

TEST(FitTexts, SayTheSameAsTheLogAndEachInJapaneseToo) {
    using stats::FitFault;
    std::set<std::string> japanese;
    constexpr int kLast = static_cast<int>(FitFault::MeanExceedanceNotPositive);
    for (int fault = 1; fault <= kLast; ++fault) {
        stats::FitFailure failure{static_cast<FitFault>(fault), {12.3456, 7.0}};
        for (const auto kind :
             {stats::SeriesKind::AnnualMaximum, stats::SeriesKind::PartialDuration}) {
            failure.kind = kind;
            SetLanguage(Language::English);
            EXPECT_EQ(FitFailureText(failure),
                      stats::FailureCode(failure) + ": " + stats::FailureText(failure));
            SetLanguage(Language::Japanese);
            japanese.insert(FitFailureText(failure));
        }
    }
    EXPECT_EQ(japanese.size(), static_cast<std::size_t>(kLast) + 1);
    SetLanguage(Language::English);
    for (const auto kind : {stats::FitWarningKind::ValuesOutsideSupport,
                            stats::FitWarningKind::SkewnessCorrectionRange,
                            stats::FitWarningKind::ReducedToExponential})
        EXPECT_EQ(FitWarningText({kind, 3}), stats::WarningText({kind, 3}));
}

TEST_F(FitCommand, RefusesWhatIsNoColumnOfNumbers) {
    const std::pair<std::string, std::string> kTexts[] = {
        {"", "standard input: there are no numbers"},
        {"a\nb\n", "standard input: line 2: \"b\" is no number"},
        {"1\nnan\n", "standard input: line 2: \"nan\" is no number"},
        {"1\n2x\n", "standard input: line 2: \"2x\" is no number"},
        {"1\n1e400\n", "standard input: line 2: \"1e400\" is no number"},
        {"12,5\n-13,25\n", "standard input: every line reads \"digits,digits\", which is a decimal "
                           "comma or two columns; give one column with decimal points"},
        {"Year Level\n1923 4.03\n1924 3.83\n",
         "standard input: line 2 has several columns, and a first column is often the year; give "
         "the values alone, or import the table and fit its data file"},
    };
    for (const auto& [text, message] : kTexts) {
        EXPECT_EQ(Run({"fit", "GUM/MOM", "-"}, text), 1) << text;
        EXPECT_EQ(err, "ryn: " + message + "\n");
    }
}

TEST(DecimalsFor, ShowSignificantDigits) {
    EXPECT_EQ(DecimalsFor(123.4, 5), 2);
    EXPECT_EQ(DecimalsFor(-0.01, 3), 4);
    EXPECT_EQ(DecimalsFor(1e9, 5), 0);
    EXPECT_EQ(DecimalsFor(1e-300, 5), 12);
    EXPECT_EQ(DecimalsFor(0.0, 5), 0);
}

} // namespace
} // namespace ryn::cli
