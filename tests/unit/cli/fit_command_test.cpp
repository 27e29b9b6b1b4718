#include <iterator>
#include <set>

#include "apps/cli/fit_report.h"
#include "apps/cli/fit_texts.h"
#include "command_fixture.h"
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
    EXPECT_THAT(KeysOf(fit), ElementsAre("name", "n", "unit", "failed", "parameters",
                                         "logLikelihood", "quantiles", "goodness"));
    EXPECT_EQ(fit["name"], "GUM/LMOM");
    EXPECT_EQ(fit["n"], 5);
    EXPECT_TRUE(fit["failed"].is_null());
    EXPECT_EQ(fit["parameters"][0]["symbol"], "xi");
    EXPECT_NEAR(fit["parameters"][0]["estimate"], kXi, 1e-12);
    EXPECT_NEAR(fit["parameters"][1]["estimate"], kAlpha, 1e-12);
    const auto quantile = fit["quantiles"][1];
    EXPECT_THAT(KeysOf(quantile),
                ElementsAre("period", "probability", "estimate", "average", "standardDeviation"));
    EXPECT_EQ(quantile["period"], 1000.0);
    EXPECT_EQ(quantile["probability"], 0.001);
    EXPECT_NEAR(quantile["estimate"], kXi - kAlpha * std::log(-std::log1p(-0.001)), 1e-9);
    EXPECT_TRUE(quantile["average"].is_null());
    EXPECT_TRUE(quantile["standardDeviation"].is_null());
    EXPECT_EQ(fit["goodness"].dump(), "{}");
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

TEST_F(FitCommand, PrintsATableForPeople) {
    ASSERT_EQ(Run({"fit", "GUM/LMOM", "-", "--periods", "2,100"}, "1\n2\n3\n4\n5\n"), 0) << err;
    EXPECT_EQ(out, "GUM/LMOM fitted to 5 values\n"
                   "\n"
                   "xi               2.16725\n"
                   "alpha            1.44270\n"
                   "log-likelihood  -9.06995\n"
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

TEST_F(FitCommand, ExitsWithTwoWhenTheFitFails) {
    ASSERT_EQ(Run({"fit", "GEV/LMOM", "-", "--json"}, "7\n7\n7\n7\n7\n7\n"), 2);
    EXPECT_EQ(Json()["failed"], "C08: all 6 values are equal (7)");
    EXPECT_EQ(Json()["parameters"].dump(), "[]");
    EXPECT_EQ(Json()["quantiles"].dump(), "[]");
    EXPECT_TRUE(Json()["logLikelihood"].is_null());
    EXPECT_EQ(err, "ryn: GEV/LMOM: " + Json()["failed"].get<std::string>() + "\n");
    EXPECT_EQ(Run({"fit", "GEV/LMOM", "-"}, "7\n7\n7\n"), 2);
    EXPECT_EQ(out, "");
    EXPECT_EQ(err, "ryn: GEV/LMOM: C03: too few values: 3, at least 5 are needed\n");
    EXPECT_EQ(Run({"fit", "GEV/LMOM", "-", "--lang", "ja"}, "7\n7\n7\n"), 2);
    EXPECT_EQ(err, "ryn: GEV/LMOM: C03: 値が少なすぎます（3 個）。少なくとも 5 個が必要です\n");
    SetLanguage(Language::English);
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
            EXPECT_EQ(FitFailureText(failure, {}),
                      stats::FailureCode(failure) + ": " + stats::FailureText(failure));
            SetLanguage(Language::Japanese);
            japanese.insert(FitFailureText(failure, {}));
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
