#include <gtest/gtest.h>

#include "results/output_settings.h"
#include "strings/language.h"
#include "unit/results/sample_results.h"

namespace ryn {
namespace {

std::string IndependencePage(const COutputSettings& results) {
    CQxTextOcxPlot control;
    results.Independence.FillText(control);
    return control.GetText();
}

std::string StatisticsPage(const COutputSettings& results) {
    CQxTextOcxPlot control;
    results.SampleStats.FillText(control);
    return control.GetText();
}

constexpr const char* kStatisticsOfAms = R"(Sample
Three years

Sample statistics:

  Sample size                     = 3

Ordinary moments:
  Mean      = 6.000
  Variance  = 4.000
  Skewness  = nan
  Kurtosis  = 3.250

Probability weighted moments:
  Beta-0    = 6.000
  Beta-1    = 3.500
  Beta-2    = 2.500
  Beta-3    = 2.000

L-moments:
  L-1         = 6.000
  L-2         = 1.000
  L-Skewness  = 0.125
  L-Kurtosis  = -0.062

Estimated parameters:

)";

TEST(PageText, IndependencePageShowsTheTestsThatWereMade) {
    COutputSettings results;
    test::LoadSampleOutput(results);
    EXPECT_EQ(IndependencePage(results), R"(Sample
Three years

Run test:
Test statistic = -1.25
Accepted at a 6.25% level of significance

Test for shift in mean:
Test statistic = 0.50
Accepted at a 62.50% level of significance
)");
    results.Independence.TestTrend = true;
    results.Independence.RunTest = false;
    results.Independence.TestShift = false;
    EXPECT_EQ(IndependencePage(results), R"(Sample
Three years

Test for trend:
Test statistic = 0.00
Accepted at a 0.00% level of significance

)");
    results.Independence.TestTrend = false;
    EXPECT_EQ(IndependencePage(results), "Sample\nThree years\n\n");
}

TEST(PageText, StatisticsPageShowsThresholdLinesForPartialDurationsOnly) {
    COutputSettings results;
    test::LoadSampleOutput(results);
    results.SampleStats.SelectedItems = {false, false};
    results.SampleStats.bPDS = false;
    EXPECT_EQ(StatisticsPage(results), kStatisticsOfAms);
    results.SampleStats.bPDS = true;
    std::string expected = kStatisticsOfAms;
    expected.insert(expected.find("\n\nOrdinary"), "\n  Threshold level                 = 4.000"
                                                   "\n  Avg. annual No. of exceedances  = 1.500");
    EXPECT_EQ(StatisticsPage(results), expected);
}

TEST(PageText, StatisticsPageListsTheParametersOfSelectedCombinations) {
    COutputSettings results;
    test::LoadSampleOutput(results);
    results.SampleStats.bPDS = false;
    const std::string first = "GUM/LMOM\n  xi = 5.500\n  alpha = 1.250\n\n";
    EXPECT_EQ(StatisticsPage(results), kStatisticsOfAms + first + "GEV/ML\n\n");
    results.SampleStats.SelectedItems = {true}; // shorter than the combinations
    EXPECT_EQ(StatisticsPage(results), kStatisticsOfAms + first);
    results.SampleStats.SelectedItems = {false, true, true, true};
    EXPECT_EQ(StatisticsPage(results), std::string(kStatisticsOfAms) + "GEV/ML\n\n");
}

TEST(PageText, HeadingsOfTwoTestsStayEnglishInJapanese) {
    COutputSettings results;
    test::LoadSampleOutput(results);
    SetLanguage(Language::Japanese);
    const std::string page = IndependencePage(results);
    SetLanguage(Language::English);
    EXPECT_NE(page.find("\nRun test:\n"), std::string::npos);
    EXPECT_EQ(page.find("shift"), std::string::npos);
    EXPECT_NE(page.find("6.25%"), std::string::npos);
}

TEST(PageText, ShowsHeadingsAloneWithoutResults) {
    COutputSettings results; // as a file of display settings leaves it
    results.SetValid(true);
    results.Independence.RunTest = true;
    results.SampleStats.SelectedItems = {true};
    EXPECT_EQ(IndependencePage(results), "\n\n\n");
    EXPECT_EQ(StatisticsPage(results), "\n\n\n");
}

TEST(PageText, IsExportedLineByLine) {
    CQxTextOcxPlot control;
    control.SetText("first\n\nthird \"quoted\"\n");
    const KvfHandle tree = kvfCreate();
    kvfAddTarget(tree.get(), "RynEditorTextOutput");
    control.ExportData(tree.get());
    EXPECT_EQ(kvfText(tree.get()), "RynEditorTextOutput {\n    Line = \"first\"\n    Line = \"\"\n"
                                   "    Line = \"third \\\"quoted\\\"\"\n}\n");
}

} // namespace
} // namespace ryn
