#include "run/grid_batch.h"

#include <climits>
#include <filesystem>
#include <set>
#include <sys/resource.h>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "run/batch_lines.h"
#include "run/extract_command.h"
#include "run/result_layout.h"
#include "support/sample_batch.h"
#include "support/sample_series.h"

namespace ryn {
namespace {

using test::kMissingCell;
using test::ResultFile;
using test::SampleBatch;
using test::SampleHistory;
using ::testing::ElementsAre;
using ::testing::HasSubstr;

std::set<std::string> NamesIn(const std::filesystem::path& directory) {
    std::set<std::string> names;
    for (const auto& entry : std::filesystem::directory_iterator(directory))
        names.insert(entry.path().filename());
    return names;
}

/// The values of a series file; its title tells where it was while the batch ran.
std::vector<double> ValuesIn(const std::string& path) {
    CTsqValues series;
    EXPECT_TRUE(series.ReadSeries(path, 0)) << path;
    std::vector<double> values;
    for (const STSItem& sample : series.samples)
        values.push_back(sample.value);
    return values;
}

/// One point missing from the start, one later, one all equal, three good.
SampleHistory MixedHistory() {
    SampleHistory history;
    const auto good = history.value;
    history.value = [good](int x, int y, int step) {
        if (x == 0 && y == 1)
            return 7.0;
        const bool isMissing = (x == 1 && y == 0) || (x == 2 && y == 1 && step % 50 == 7);
        return isMissing ? double{kMissingCell} : good(x, y, step);
    };
    return history;
}

TEST(GridBatch, LeavesTheSameOnDiskAndInMemory) {
    SampleBatch batch(MixedHistory());
    batch.Edit([](CGlobalKvf& root) { root.GridInput().SaveEVS = true; });
    std::set<std::string> names;
    std::string output, results, log, lines;
    std::vector<double> kept;
    for (const Scratch scratch : {Scratch::Disk, Scratch::Memory}) {
        const GridBatchOutcome outcome = batch.Run(scratch);
        ASSERT_EQ(outcome.end, BatchEnd::Written) << outcome.reason.Text();
        EXPECT_EQ(outcome.counts.points, 6);
        EXPECT_EQ(outcome.counts.active, 5);
        EXPECT_EQ(outcome.counts.computed, 5);
        EXPECT_EQ(outcome.counts.failed, 1);
        EXPECT_EQ(outcome.counts.withMissing, 1);
        const auto& directory = batch.directory;
        if (scratch == Scratch::Disk) {
            names = NamesIn(directory.Root());
            output = directory.Read("out.nc");
            results = directory.Read("case.res");
            log = directory.Read("Rynout1.txt") + directory.Read("Rynout2.txt");
            kept = ValuesIn(directory.Path("ExtremeValueSeries/out_2_1.tsq0"));
            lines = batch.printed;
            for (const std::string& name : names)
                if (name != "case.RYN" && name != "grid.nc")
                    std::filesystem::remove_all(directory.Root() / name);
            continue;
        }
        EXPECT_EQ(NamesIn(directory.Root()), names);
        EXPECT_EQ(directory.Read("out.nc"), output);
        EXPECT_EQ(directory.Read("case.res"), results);
        EXPECT_EQ(directory.Read("Rynout1.txt") + directory.Read("Rynout2.txt"), log);
        EXPECT_EQ(ValuesIn(directory.Path("ExtremeValueSeries/out_2_1.tsq0")), kept);
        EXPECT_EQ(batch.printed, lines);
    }
    EXPECT_EQ(lines, "Created: 5 TS-files. Remaining: 0\n");
    EXPECT_THAT(names, ElementsAre("ExtremeValueSeries", "Ryn.log", "Rynout1.txt", "Rynout2.txt",
                                   "case.RYN", "case.res", "caseExtract.RYN", "grid.nc", "out.nc"));
    EXPECT_EQ(NamesIn(batch.directory.Root() / "ExtremeValueSeries").size(), 5U);
    EXPECT_THAT(batch.directory.Read("caseExtract.RYN"), HasSubstr("RYNTsq0_5_"));
    EXPECT_TRUE(batch.ports.messages.empty());
}

// The result file is written before a point is run, so that a first good point leaves the old one.
TEST(GridBatch, LeavesTheResultsBeforeTheLastPointWhereOnlyThatIsGood) {
    SampleHistory history;
    const auto good = history.value;
    history.value = [good](int x, int y, int step) {
        return x == 2 && y == 1 ? good(x, y, step) : 7.0;
    };
    SampleBatch batch(history);
    const auto& directory = batch.directory;
    ASSERT_EQ(batch.Run(Scratch::Disk).end, BatchEnd::Written);
    EXPECT_FALSE(directory.Has("case.res"));
    ASSERT_EQ(batch.Run(Scratch::Memory).end, BatchEnd::Written);
    EXPECT_FALSE(directory.Has("case.res"));

    SampleHistory().Write(directory.Path("grid.nc"));
    ASSERT_EQ(batch.Run(Scratch::Memory).end, BatchEnd::Written);
    const std::string before = directory.Read("case.res");
    history.Write(directory.Path("grid.nc"));
    for (const Scratch scratch : {Scratch::Disk, Scratch::Memory}) {
        ASSERT_EQ(batch.Run(scratch).end, BatchEnd::Written);
        EXPECT_EQ(directory.Read("case.res"), before);
    }
}

TEST(GridBatch, NamesItemsAndLeavesHolesWhereNoPointIsGood) {
    SampleBatch batch(MixedHistory());
    ASSERT_EQ(batch.Run(Scratch::Memory).end, BatchEnd::Written);
    ResultFile file(batch.directory.Path("out.nc"));
    EXPECT_THAT(
        file.Names(),
        ElementsAre(
            "Mean", "Standard deviation", "Skewness", "Kurtosis", "L-Cv", "L-Skewness",
            "L-Kurtosis", "GEV - xi", "GEV - alpha", "GEV - kappa", "Gumbel - xi", "Gumbel - alpha",
            "Gumbel - ", "GEV - Kolmogorov-Smirnov Statistic", "GEV - Log-Likelihood Statistic",
            "Gumbel - Kolmogorov-Smirnov Statistic", "Gumbel - Log-Likelihood Statistic",
            "GEV - Estimated quantile 2.00 years", "GEV - Estimated quantile 10.00 years",
            "GEV - Estimated quantile 100.00 years", "Gumbel - Estimated quantile 2.00 years",
            "Gumbel - Estimated quantile 10.00 years", "Gumbel - Estimated quantile 100.00 years"));
    EXPECT_EQ(file.header.DeleteValue(), kMissingCell);
    EXPECT_EQ(file.header.TimeStepPast(), 1);
    EXPECT_EQ(file.header.GetStartTime().Format("%Y-%m-%d %H:%M:%S"), "1990-01-01 06:00:00");
    const CQxArray2D<float> quantile = file.Item(20);
    EXPECT_EQ(quantile(1, 0), kMissingCell); // not active
    EXPECT_EQ(quantile(0, 1), kMissingCell); // status 1
    EXPECT_GT(quantile(0, 0), 20.0F);
    EXPECT_GT(quantile(2, 1), 20.0F);             // missing later: data
    EXPECT_EQ(file.Item(13)(0, 0), kMissingCell); // the Gumbel has no third parameter
    EXPECT_EQ(file.header.DynamicItem(20).GetUnitTag(), file.header.DynamicItem(1).GetUnitTag());
    EXPECT_EQ(file.header.DynamicItem(3).GetItemTag(), 999);
}

/// A point's numbers by the commands that a user gives for one series.
std::vector<float> ByHand(SampleBatch& batch, const SampleHistory& history, int x, int y) {
    const auto& directory = batch.directory;
    CRynEditDoc document;
    document.OnOpenDocument(directory.Path("case.RYN"));
    CGlobalKvf& root = document.GetGlobalKvf();
    test::Samples samples;
    for (int t = 0; t < history.steps; ++t)
        samples.push_back({test::At("1990-01-01 06:00:00") + COleDateTimeSpan(30.0 * t),
                           history.value(x, y, t), 0});
    root.BasicInput().InputFileName = directory.Path("hand.tsq0");
    root.BasicInput().InputItem = 1;
    root.BasicInput().OutputFileName = directory.Path("handEvs.tsq0");
    EXPECT_TRUE(test::WriteDataFile(root.BasicInput().InputFileName, samples));
    EXPECT_TRUE(ExtractSeriesOf(root).status);
    root.BasicInput().Extracted = true;
    const double rate = root.BasicInput().AvgAnNum;
    root.DefineEVS().SyncFromExtraction(root.BasicInput());
    root.DefineEVS().AvgAnNum = rate;
    document.OnSaveDocument(directory.Path("hand.RYN"));
    const RunOutcome outcome = RunAnalysis(document);
    return outcome.end == RunEnd::Succeeded
               ? PointResults(document.Results(), ResultLayout::Of(root), kMissingCell)
               : std::vector<float>();
}

void ExpectEveryPointAsByHand(SampleBatch& batch, const SampleHistory& history) {
    ASSERT_EQ(batch.Run(Scratch::Memory).end, BatchEnd::Written);
    ResultFile file(batch.directory.Path("out.nc"));
    for (int x = 0; x < history.sizeX; ++x)
        for (int y = 0; y < history.sizeY; ++y) {
            std::vector<float> row;
            for (int item = 1; item <= file.header.Items(); ++item)
                row.push_back(file.Item(item)(x, y));
            EXPECT_EQ(row, ByHand(batch, history, x, y)) << x << ", " << y;
        }
}

TEST(GridBatch, GivesEachPointTheNumbersOfItsOwnSeries) {
    SampleBatch batch{SampleHistory()};
    ExpectEveryPointAsByHand(batch, SampleHistory());
}

// A point with too few peaks changes threshold and rate, which the next one must not inherit.
TEST(GridBatch, LeavesNoTraceOfAPointInTheNext) {
    SampleHistory history;
    const auto good = history.value;
    history.value = [good](int x, int y, int step) {
        const bool isFlat = x == 1 && step % 25 != 3;
        return isFlat ? 2.0 + 0.001 * step : good(x, y, step);
    };
    SampleBatch batch(history);
    batch.Edit([](CGlobalKvf& root) {
        CBasicInputKvf& basic = root.BasicInput();
        basic.SelectionMethod = root.DefineEVS().SelectionMethod = kSelectPartialDurations;
        basic.PdsDataType = kPartialDurationsByNumber;
        basic.AvgAnNum = 2.0;
        basic.RecordLength = 12.3;
        basic.InterTime = 40.0;
        basic.InterLevelSpecified = false;
        root.Distributions().Combinations.clear();
        SampleBatch::AddCombination(root, "GP", kGeneralisedPareto, kMoments);
    });
    ExpectEveryPointAsByHand(batch, history);
    EXPECT_EQ(batch.Run(Scratch::Disk).counts.withFewerPeaks, 2);
}

TEST(GridBatch, StepsOverPointsAndKeepsTheirCells) {
    SampleHistory history;
    history.sizeX = 8;
    history.sizeY = 3;
    SampleBatch batch(history);
    batch.Edit([](CGlobalKvf& root) {
        root.GridInput().X_Range_And_Interval = {2, 7, 2};
        root.GridInput().Y_Range_And_Interval = {1, 2, 1};
        root.GridInput().SaveEVS = true;
    });
    for (const Scratch scratch : {Scratch::Disk, Scratch::Memory}) {
        ASSERT_EQ(batch.Run(scratch).counts.points, 6);
        ResultFile file(batch.directory.Path("out.nc"));
        const CQxArray2D<float> mean = file.Item(1);
        ASSERT_EQ(mean.SizeX(), 6);
        ASSERT_EQ(mean.SizeY(), 2);
        for (int i = 0; i < 6; ++i)
            EXPECT_EQ(mean(i, 1) == kMissingCell, i % 2 == 1) << i;
        EXPECT_FLOAT_EQ(file.header.X0(), 5.5F);
        EXPECT_FLOAT_EQ(file.header.Y0(), 40.25F);
        EXPECT_FLOAT_EQ(file.header.DX(), 0.25F);
        EXPECT_THAT(NamesIn(batch.directory.Root() / "ExtremeValueSeries"),
                    ElementsAre("out_0_0.tsq0", "out_0_1.tsq0", "out_2_0.tsq0", "out_2_1.tsq0",
                                "out_4_0.tsq0", "out_4_1.tsq0"));
    }
}

TEST(GridBatch, TakesOnePointWhereTheStepIsBeyondTheRange) {
    SampleBatch batch;
    batch.Edit([](CGlobalKvf& root) {
        root.GridInput().X_Range_And_Interval = {1, 2, INT_MAX};
        root.GridInput().Y_Range_And_Interval = {1, 1, INT_MAX};
    });
    for (const Scratch scratch : {Scratch::Disk, Scratch::Memory}) {
        const GridBatchOutcome outcome = batch.Run(scratch);
        ASSERT_EQ(outcome.end, BatchEnd::Written) << outcome.reason.Text();
        EXPECT_EQ(outcome.counts.computed, 1);
        EXPECT_EQ(ResultFile(batch.directory.Path("out.nc")).header.SizeX(), 2);
    }
}

TEST(GridBatch, RefusesWhatCannotBeRunWithOneLine) {
    struct Refusal {
        std::function<void(CTsq2InputKvf&)> change;
        const char* text;
    };
    const std::vector<Refusal> refusals = {
        {[](auto& in) { in.X_Range_And_Interval.step = 0; }, "X_Range_And_Interval has the step 0"},
        {[](auto& in) { in.Y_Range_And_Interval.step = -1; }, "Y_Range_And_Interval has the step"},
        {[](auto& in) { in.X_Range_And_Interval.last = 3; },
         "from 0 to 3, and the grid from 0 to 2"},
        {[](auto& in) { in.Y_Range_And_Interval.first = -1; }, "it must begin at 0"},
        {[](auto& in) {
             in.X_Range_And_Interval = {2, 1, 1};
         },
         "not go backward"},
        {[](auto& in) { in.Time_Range_And_Interval.last = 150; }, "Time_Range_And_Interval goes"},
        {[](auto& in) { in.Time_Range_And_Interval.first = -1; }, "Time_Range_And_Interval goes"},
        {[](auto& in) { in.Tsq2ItemNo = 0; }, "there is no item 0; the grid has 1"},
        {[](auto& in) { in.Tsq2ItemNo = 2; }, "there is no item 2"},
        {[](auto& in) { in.Tsq2InputFile = ""; }, "no file under Tsq2InputFile"},
        {[](auto& in) { in.Tsq2InputFile = "none.nc"; }, "none.nc"},
        {[](auto& in) { in.Tsq2OutputFile = ""; }, "no file under Tsq2OutputFile"},
        {[](auto& in) { in.Tsq2OutputFile = "./grid.nc"; }, "another file of the analysis"},
        {[](auto& in) { in.Tsq2OutputFile = "case.RYN"; }, "another file of the analysis"},
        {[](auto& in) { in.Tsq2OutputFile = "caseExtract.RYN"; }, "another file of the analysis"},
        {[](auto& in) { in.Tsq2OutputFile = "case.res"; }, "another file of the analysis"},
        {[](auto& in) { in.Tsq2OutputFile = "none/out.nc"; }, "none"},
    };
    for (const Refusal& refusal : refusals) {
        SampleBatch batch;
        batch.Edit([&](CGlobalKvf& root) { refusal.change(root.GridInput()); });
        for (const Scratch scratch : {Scratch::Disk, Scratch::Memory}) {
            const GridBatchOutcome outcome = batch.Run(scratch);
            EXPECT_EQ(outcome.end, BatchEnd::Refused) << refusal.text;
            EXPECT_THAT(outcome.reason.Text(), HasSubstr(refusal.text));
            EXPECT_EQ(outcome.reason.Text().find('\n'), std::string::npos);
            EXPECT_EQ(batch.printed, "");
            EXPECT_EQ(batch.directory.EntryCount(), 2U);
        }
    }
    for (const char* const own : {"grid.nc", "case.RYN"}) {
        SampleBatch linked;
        const std::string before = linked.directory.Read(own);
        std::filesystem::create_symlink(own, linked.directory.Path("caseExtract.RYN"));
        EXPECT_EQ(linked.Run(Scratch::Disk).end, BatchEnd::Refused);
        EXPECT_EQ(linked.directory.Read(own), before);
    }
    SampleBatch unused;
    unused.Edit([](CGlobalKvf& root) { root.GridInput().UseTsq2Input = false; });
    EXPECT_EQ(unused.Run(Scratch::Disk).end, BatchEnd::NotWanted);
    SampleBatch batch;
    GridBatchOptions options = batch.Options(Scratch::Memory);
    options.memory = 1;
    EXPECT_THAT(batch.Run(options).reason.Text(), HasSubstr("MiB are allowed"));
}

/// The real engine, but for a series with a value that it cannot stand.
void FailAtTheMark(const KvfHandle* input, KvfHandle* output, std::int32_t* status) {
    RYNENGINE(input, output, status);
    if (kvfText(input->get()).find("12345.0f") != std::string::npos) {
        *output = kvfCreate();
        *status = 3;
    }
}

TEST(GridBatch, EndsAtStatusThreeWithoutOutput) {
    SampleHistory history;
    const auto good = history.value;
    history.value = [good](int x, int y, int step) {
        return x == 1 && y == 1 && step == 77 ? 12345.0 : good(x, y, step);
    };
    for (const Scratch scratch : {Scratch::Disk, Scratch::Memory}) {
        SampleBatch batch(history);
        batch.Edit([](CGlobalKvf& root) { root.GridInput().SaveEVS = true; });
        GridBatchOptions options = batch.Options(scratch);
        options.engines = {FailAtTheMark, FailAtTheMark};
        const GridBatchOutcome outcome = batch.Run(options);
        EXPECT_EQ(outcome.end, BatchEnd::SetUpFailed);
        EXPECT_EQ(outcome.counts.computed, 4);
        EXPECT_THAT(batch.ports.viewedFiles, ElementsAre(batch.directory.Path("Ryn.log")));
        EXPECT_TRUE(batch.ports.questions.empty());
        EXPECT_THAT(NamesIn(batch.directory.Root()),
                    ElementsAre("ExtremeValueSeries", "Ryn.log", "Rynout1.txt", "Rynout2.txt",
                                "case.RYN", "case.res", "caseExtract.RYN", "grid.nc"));
        EXPECT_EQ(NamesIn(batch.directory.Root() / "ExtremeValueSeries").size(), 4U);
        EXPECT_THAT(batch.directory.Read("caseExtract.RYN"), HasSubstr("RYNTsq0_3_"));
    }
}

TEST(GridBatch, WritesNothingWhereNoPointIsGood) {
    SampleHistory history;
    history.value = [](int, int, int) { return 4.0; };
    SampleBatch batch(history);
    EXPECT_EQ(batch.Run(Scratch::Memory).end, BatchEnd::NothingGood);
    EXPECT_THAT(batch.printed, HasSubstr("No output file: none of the 6 points"));
    EXPECT_FALSE(batch.directory.Has("out.nc"));
}

TEST(GridBatch, ReadsTheGridOnceForEachChunkOfOpenFiles) {
    struct rlimit before {};
    ASSERT_EQ(::getrlimit(RLIMIT_NOFILE, &before), 0);
    struct rlimit few = before;
    few.rlim_cur = 64;
    SampleHistory history;
    history.sizeX = 10;
    history.sizeY = 12;
    const auto good = history.value;
    history.value = [good](int x, int y, int step) {
        return x == 0 && y < 2 ? double{kMissingCell} : good(x, y, step);
    };
    SampleBatch batch(history);
    for (const Scratch scratch : {Scratch::Disk, Scratch::Memory}) {
        ASSERT_EQ(::setrlimit(RLIMIT_NOFILE, &few), 0);
        const GridBatchOutcome outcome = batch.Run(scratch);
        ASSERT_EQ(::setrlimit(RLIMIT_NOFILE, &before), 0);
        ASSERT_EQ(outcome.end, BatchEnd::Written) << outcome.reason.Text();
        EXPECT_EQ(batch.printed, "Created: 49 TS-files. Remaining: 69\n"
                                 "Created: 100 TS-files. Remaining: 18\n"
                                 "Created: 118 TS-files. Remaining: 0\n");
    }
}

TEST(GridBatch, TakesItsFilesAwayWhenItIsStopped) {
    for (const int afterCalls : {0, 20, 155}) { // at once, in the series, in the points
        SampleBatch batch;
        GridBatchOptions options = batch.Options(Scratch::Disk);
        int calls = 0;
        options.isStopped = [&] { return calls++ >= afterCalls; };
        EXPECT_EQ(batch.Run(options).end, BatchEnd::Stopped);
        EXPECT_FALSE(batch.directory.Has("out.nc"));
        for (const std::string& name : NamesIn(batch.directory.Root()))
            EXPECT_EQ(name.find("RYNTsq0"), std::string::npos) << name;
    }
}

TEST(GridBatch, EndsWhereAFileOfAPointCannotBeWritten) {
    SampleBatch batch;
    batch.Edit([](CGlobalKvf& root) { root.GridInput().SaveEVS = true; });
    batch.directory.Write("ExtremeValueSeries", "a file where the directory should be");
    for (const Scratch scratch : {Scratch::Disk, Scratch::Memory}) {
        const GridBatchOutcome outcome = batch.Run(scratch);
        EXPECT_EQ(outcome.end, BatchEnd::Failed);
        EXPECT_EQ(outcome.reason.Kind(), Fault::System);
        EXPECT_THAT(outcome.reason.Text(), HasSubstr("ExtremeValueSeries"));
        EXPECT_FALSE(batch.directory.Has("out.nc"));
    }
}

TEST(GridBatch, RunsAParameterFileFromItsName) {
    SampleBatch batch;
    testing::internal::CaptureStdout();
    RynTsq2Analysis(batch.directory.Path("case.ryn"));
    EXPECT_EQ(testing::internal::GetCapturedStdout(), "Created: 6 TS-files. Remaining: 0\n");
    EXPECT_TRUE(batch.directory.Has("out.nc"));
    RynTsq2Analysis(batch.directory.Path("none.ryn")); // nothing to do, and nothing to say
}

TEST(BatchLines, TellOfEach200thPointThatDidNotFail) {
    std::vector<bool> active(1000, true);
    active[0] = false;
    for (const bool isBackward : {false, true}) {
        std::string printed;
        ComputationLines lines(active, [&](const std::string& line) { printed += line; });
        for (int i = 1; i < 1000; ++i) {
            const int point = isBackward ? 1000 - i : i;
            lines.Computed(point, point != 400); // the 400th active one
        }
        EXPECT_EQ(printed, "RYN computation no.200  Elapsed: 0 min.  Remaining: 0 min.\n"
                           "RYN computation no.600  Elapsed: 0 min.  Remaining: 0 min.\n"
                           "RYN computation no.800  Elapsed: 0 min.  Remaining: 0 min.\n");
    }
    EXPECT_EQ(WholeMinutes(89.6 / 86400.0), 1);
    EXPECT_EQ(WholeMinutes(119.6 / 86400.0), 2);
    EXPECT_EQ(WholeMinutes(-119.6 / 86400.0), -2);
}

TEST(ResultLayout, CountsItems) {
    ResultLayout layout;
    layout.combinations = 2;
    layout.statistics = 2;
    layout.returnPeriods = 3;
    EXPECT_EQ(layout.Items(), 23);
    layout.withUncertainty = true;
    EXPECT_EQ(layout.Items(), 35);
    SampleBatch batch;
    batch.Edit([](CGlobalKvf& root) { root.GridInput().UncertaintyCal = true; });
    ASSERT_EQ(batch.Run(Scratch::Memory).end, BatchEnd::Written);
    const std::vector<std::string> names = ResultFile(batch.directory.Path("out.nc")).Names();
    ASSERT_EQ(names.size(), 35U);
    EXPECT_EQ(names[17], "GEV - Estimated quantile 2.00 years");
    EXPECT_EQ(names[20], "GEV - Average quantile 2.00 years");
    EXPECT_EQ(names[23], "GEV - Standard deviation 2.00 years");
    EXPECT_EQ(names[34], "Gumbel - Standard deviation 100.00 years");
}

} // namespace
} // namespace ryn
