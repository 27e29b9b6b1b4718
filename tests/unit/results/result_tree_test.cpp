#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "results/output_settings.h"
#include "unit/results/sample_results.h"

namespace ryn {
namespace {

using test::kSampleOutput;
using test::OutputText;
using test::TargetOf;
using test::TreeOf;
using ::testing::ElementsAre;
using ::testing::IsEmpty;

/// The model of a changed sample.
void LoadChanged(COutputSettings& results, const std::string& from, const std::string& to) {
    std::string text = kSampleOutput;
    const std::size_t place = text.find(from);
    ASSERT_NE(place, std::string::npos) << from;
    text.replace(place, from.size(), to);
    const KvfHandle tree = TreeOf(text);
    ASSERT_NE(tree, nullptr);
    results.LoadOutput(TargetOf(tree), "");
}

TEST(ResultTree, IsWrittenAsItWasRead) {
    COutputSettings results;
    test::LoadSampleOutput(results);
    EXPECT_TRUE(results.IsValid());
    EXPECT_EQ(OutputText(results), kSampleOutput);
}

TEST(ResultTree, HoldsNonExceedanceProbabilities) {
    COutputSettings results;
    test::LoadSampleOutput(results);
    ASSERT_EQ(results.Probability.PlottingPositions().size(), 2U);
    EXPECT_THAT(results.Probability.PlottingPositions()[1].Probabilities,
                ElementsAre(0.875, 0.5, 0.125));
    EXPECT_THAT(results.Probability.Curves()[0].StdTyearEvent, ElementsAre(0.25, 0.75));
}

TEST(ResultTree, StatisticFlagsComeFromTheFirstAndTheLastCombination) {
    COutputSettings results;
    test::LoadSampleOutput(results);
    const CEstimateQuantileSettings& quantiles = results.Quantiles; // of the first
    EXPECT_TRUE(quantiles.ChiSquared && quantiles.LeastSquares && quantiles.LogLikelihood);
    EXPECT_FALSE(quantiles.KolmogorovSmirnov || quantiles.PPCC || quantiles.PPCC2);
    const CGoodnessOfFitSettings& fit = results.GoodnessOfFit; // of the last
    EXPECT_TRUE(fit.KolmogorovSmirnov && fit.SLSC);
    EXPECT_FALSE(fit.ChiSquared || fit.PPCC || fit.PPCC2 || fit.LogLikelihood);
    const CIndependenceHomSettings& tests = results.Independence;
    EXPECT_TRUE(tests.RunTest && tests.TestShift && !tests.TestTrend);
}

TEST(ResultTree, WithoutCombinationsIsValidAndKeepsTheFlags) {
    const KvfHandle tree = TreeOf("RYNoutput { Settings { Title = \"T\" } }");
    COutputSettings results;
    results.Quantiles.PPCC = true;
    results.LoadOutput(TargetOf(tree), "");
    EXPECT_TRUE(results.IsValid());
    EXPECT_EQ(results.Title, "T");
    EXPECT_THAT(results.ItemNames, IsEmpty());
    EXPECT_TRUE(results.Quantiles.PPCC);
}

TEST(ResultTree, ClearDropsResultsAndKeepsChoices) {
    COutputSettings results;
    test::LoadSampleOutput(results);
    results.HistogramKvf = kvfCreate();
    results.Quantiles.Precision = 7;
    results.Probability.ProbabilityPaper = 2;
    results.Clear();
    EXPECT_FALSE(results.IsValid());
    EXPECT_THAT(results.ItemNames, IsEmpty());
    EXPECT_THAT(results.ReturnPeriods, IsEmpty());
    EXPECT_THAT(results.Quantiles.Items(), IsEmpty());
    EXPECT_THAT(results.Frequency.Densities(), IsEmpty());
    EXPECT_THAT(results.Histogram.Estimated(), IsEmpty());
    EXPECT_THAT(results.Probability.SelectedItems, IsEmpty());
    EXPECT_EQ(results.Quantiles.Precision, 7);
    EXPECT_EQ(results.Probability.ProbabilityPaper, 2);
    EXPECT_NE(results.HistogramKvf, nullptr);
    test::LoadSampleOutput(results); // nothing of the first load is left
    EXPECT_EQ(OutputText(results), kSampleOutput);
}

TEST(ResultTree, CountsThatLieAreTakenDownToWhatIsThere) {
    const char* const lies[][2] = {
        {"Nobs = 3", "Nobs = 2147483647"},
        {"NoIntHistogram = 2", "NoIntHistogram = 2000000000"},
        {"NoItemPDFPlot = 2", "NoItemPDFPlot = 77"},
        {"NoItemProbabilityPlot = 2", "NoItemProbabilityPlot = 1000000"},
        {"NoReturnPeriods = 2", "NoReturnPeriods = 2147483647"},
    };
    for (const auto& [honest, lie] : lies) {
        COutputSettings results;
        LoadChanged(results, honest, lie);
        EXPECT_EQ(OutputText(results), kSampleOutput) << lie;
    }
    COutputSettings negative;
    LoadChanged(negative, "Nobs = 3", "Nobs = -1");
    EXPECT_EQ(negative.Probability.Nobs, 0);
    COutputSettings missing;
    LoadChanged(missing, "XobsSort", "Elsewhere");
    EXPECT_EQ(missing.Probability.Nobs, 0);
}

TEST(ResultTree, OddContentIsReadAsFarAsItGoes) {
    const char* const odd[][2] = {
        {"XobsSort = 8.0, 6.0, 4.0", "XobsSort = \"a\", true, file(\"b\")"},
        {"ItemName = \"GUM/LMOM\"", "ItemName = 7"},
        {"Item2 {\n            ItemName", "Item9 {\n            ItemName"},
        {"PDFTable", "Elsewhere"},
        {"SampleStatistics", "Elsewhere"},
        {"TyearEvent = 6.0, 9.5", "TyearEvent = 6.0"},
        {"SampleSize = 3", "SampleSize = 3.5"},
    };
    for (const auto& [from, to] : odd) {
        COutputSettings results;
        LoadChanged(results, from, to);
        EXPECT_TRUE(results.IsValid());
        // What was read is written and read again as the same.
        const std::string once = OutputText(results);
        const KvfHandle tree = TreeOf(once);
        COutputSettings again;
        again.LoadOutput(TargetOf(tree), "");
        EXPECT_EQ(OutputText(again), once) << to;
        CQxTextOcxPlot control;
        results.SampleStats.FillText(control);
    }
}

} // namespace
} // namespace ryn
