#include "results/result_file.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "support/temporary_directory.h"
#include "unit/results/sample_results.h"

namespace ryn {
namespace {

using test::kSampleOutput;
using test::OutputText;
using test::SettingsText;
using test::TemporaryDirectory;
using ::testing::HasSubstr;

constexpr Durability kUnflushed = Durability::Unflushed;
const std::string kGraphs = "Graphs {\n    Look {\n        Width = 2.5\n    }\n}\n";
const std::string kHistogram = "Histogram {\n    Colour = 7\n}\n";

/// A model as a document of two kept plots has it.
void Prepare(COutputSettings& results) {
    test::LoadSampleOutput(results);
    results.GraphsKvf = test::TreeOf(kGraphs);
    results.HistogramKvf = test::TreeOf(kHistogram);
}

TEST(ResultFile, ARunWritesResultsAndSettings) {
    const TemporaryDirectory directory;
    COutputSettings results;
    Prepare(results);
    directory.Write("a.res", "whatever stood here");
    EXPECT_TRUE(WriteResultsOfRun(results, directory.Path("a.res"), kUnflushed));
    EXPECT_EQ(directory.Read("a.res"), kSampleOutput + SettingsText(results));
}

TEST(ResultFile, ADocumentWritesTheKeptPlotsToo) {
    const TemporaryDirectory directory;
    COutputSettings results;
    Prepare(results);
    const std::string path = directory.Path("a.res");
    const std::string both = kSampleOutput + SettingsText(results);
    for (int save = 0; save < 2; ++save) {
        EXPECT_TRUE(WriteResultsOfDocument(results, path, "", kUnflushed));
        EXPECT_EQ(directory.Read("a.res"), both + kGraphs + kHistogram);
    }
    kvfClose(&results.GraphsKvf);
    EXPECT_TRUE(WriteResultsOfDocument(results, path, "", kUnflushed));
    EXPECT_EQ(directory.Read("a.res"), both + kHistogram);
}

TEST(ResultFile, OpensAsItWasSaved) {
    const TemporaryDirectory directory;
    COutputSettings saved;
    Prepare(saved);
    saved.Histogram.SelectedItems = {false, true};
    saved.PlottingPos.Precision = 5;
    const std::string path = directory.Path("a.res");
    EXPECT_TRUE(WriteResultsOfDocument(saved, path, "", kUnflushed));
    const std::string bytes = directory.Read("a.res");
    COutputSettings opened;
    EXPECT_TRUE(ReadResultFile(opened, path, ""));
    EXPECT_TRUE(opened.IsValid());
    EXPECT_EQ(kvfText(opened.GraphsKvf.get()), kGraphs);
    EXPECT_TRUE(WriteResultsOfDocument(opened, path, "", kUnflushed));
    EXPECT_EQ(directory.Read("a.res"), bytes);
}

TEST(ResultFile, OpensWithOneOfItsTargetsMissing) {
    const TemporaryDirectory directory;
    COutputSettings source;
    Prepare(source);
    source.PlottingPos.Precision = 5;
    const std::string settings = SettingsText(source);
    COutputSettings withoutSettings;
    EXPECT_TRUE(ReadResultFile(withoutSettings, directory.Write("a.res", kSampleOutput), ""));
    EXPECT_EQ(OutputText(withoutSettings), kSampleOutput);
    EXPECT_EQ(withoutSettings.PlottingPos.Precision, 3);
    COutputSettings withoutOutput;
    EXPECT_TRUE(ReadResultFile(withoutOutput, directory.Write("b.res", settings), ""));
    EXPECT_TRUE(withoutOutput.IsValid());
    EXPECT_TRUE(withoutOutput.ItemNames.empty());
    EXPECT_EQ(withoutOutput.PlottingPos.Precision, 5);
    CQxTextOcxPlot control;
    withoutOutput.SampleStats.FillText(control);
    EXPECT_EQ(control.GetText(), "\n\n\n"); // headings, and no numbers
    COutputSettings neither;
    EXPECT_TRUE(ReadResultFile(neither, directory.Write("c.res", kGraphs), ""));
    EXPECT_FALSE(neither.IsValid());
    EXPECT_EQ(kvfText(neither.GraphsKvf.get()), kGraphs);
}

TEST(ResultFile, CutAnywhereOpensOrTellsWhyNot) {
    const TemporaryDirectory directory;
    COutputSettings source;
    Prepare(source);
    const std::string whole = kSampleOutput + SettingsText(source) + kGraphs + kHistogram;
    int refused = 0;
    for (std::size_t length = 0; length < whole.size(); length += 7) {
        COutputSettings results;
        const std::string path = directory.Write("a.res", whole.substr(0, length));
        if (const Status read = ReadResultFile(results, path, ""); !read) {
            ++refused;
            EXPECT_THAT(read.Text(), HasSubstr("a.res"));
            EXPECT_FALSE(results.IsValid());
        }
    }
    EXPECT_GT(refused, 500); // nearly every cut leaves something open
    COutputSettings results;
    EXPECT_FALSE(ReadResultFile(results, directory.Path("missing.res"), ""));
}

TEST(ResultFile, ThatCannotBeWrittenKeepsTheOldOne) {
    const TemporaryDirectory directory;
    COutputSettings results;
    Prepare(results);
    const std::string path = directory.Path("no/such/a.res");
    EXPECT_THAT(WriteResultsOfRun(results, path, kUnflushed).Text(), HasSubstr("a.res"));
    EXPECT_THAT(WriteResultsOfDocument(results, path, "", kUnflushed).Text(), HasSubstr("a.res"));
}

} // namespace
} // namespace ryn
