#include "run/grid_parts.h"

#include <filesystem>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "support/sample_batch.h"

namespace ryn {
namespace {

using test::SampleBatch;
using test::SampleHistory;
using ::testing::AllOf;
using ::testing::HasSubstr;
using ::testing::IsEmpty;
using ::testing::SizeIs;
using State = GridMerge::TileState;

/// 7 by 5 points, of which one is missing and one cannot be analysed.
SampleHistory HistoryOfParts() {
    SampleHistory history;
    history.sizeX = 7;
    history.sizeY = 5;
    const auto good = history.value;
    history.value = [good](int x, int y, int step) {
        if (x == 6 && y == 4)
            return 3.0;
        return x == 2 && y == 2 ? double{test::kMissingCell} : good(x, y, step);
    };
    return history;
}

GridBatchOutcome RunPart(SampleBatch& batch, int number, int count,
                         Scratch scratch = Scratch::Memory) {
    CRynEditDoc document;
    document.UsePorts(batch.ports);
    document.OnOpenDocument(batch.directory.Path("case.RYN"));
    batch.printed.clear();
    return RunGridPart(document, batch.Options(scratch), {number, count});
}

/// A merge as far as its tiles.
struct Merge {
    CRynEditDoc document;
    std::optional<GridMerge> merge;

    Merge(SampleBatch& batch, int count) {
        document.UsePorts(batch.ports);
        document.OnOpenDocument(batch.directory.Path("case.RYN"));
        batch.printed.clear();
        merge.emplace(document, batch.Options(Scratch::Memory), count);
        EXPECT_TRUE(merge->Prepare()) << merge->Outcome().reason.Text();
        merge->TakeTiles();
    }
    GridMerge* operator->() { return &*merge; }
};

TEST(GridParts, GiveTheOutputOfOneProcessToTheBit) {
    SampleBatch whole(HistoryOfParts());
    const GridBatchOutcome one = whole.Run(Scratch::Disk);
    ASSERT_EQ(one.end, BatchEnd::Written);
    const std::string output = whole.directory.Read("out.nc");
    for (const int count : {1, 2, 3, 50}) {
        SampleBatch batch(HistoryOfParts());
        for (int part = count; part >= 1; --part)
            ASSERT_EQ(
                RunPart(batch, part, count, part % 2 == 0 ? Scratch::Disk : Scratch::Memory).end,
                BatchEnd::Written);
        EXPECT_FALSE(batch.directory.Has("caseExtract.RYN"));
        Merge merge(batch, count);
        EXPECT_THAT(merge->TilesIn(State::Missing), IsEmpty());
        const GridBatchOutcome merged = merge->Finish();
        EXPECT_EQ(merged.end, BatchEnd::Written);
        EXPECT_EQ(batch.directory.Read("out.nc"), output) << count;
        EXPECT_EQ(batch.directory.Read("case.res"), whole.directory.Read("case.res"));
        EXPECT_EQ(batch.printed, whole.printed);
        EXPECT_EQ(merged.counts.computed, one.counts.computed);
        EXPECT_EQ(merged.counts.failed, one.counts.failed);
        // Nothing but what one process leaves.
        EXPECT_EQ(batch.directory.EntryCount(), whole.directory.EntryCount());
    }
}

TEST(GridParts, GoOnWhereTheyWereKilled) {
    SampleBatch batch(HistoryOfParts());
    RunPart(batch, 1, 2);
    RunPart(batch, 2, 2);
    const std::string tiles = batch.directory.Path("out.nc.tiles/");
    const auto count =
        static_cast<std::size_t>(std::distance(std::filesystem::directory_iterator(tiles), {}));
    const auto name = [&](int tile) {
        return tiles + std::to_string(tile) + "of" + std::to_string(count);
    };
    const std::string kept = batch.directory.Read("out.nc.tiles/1of" + std::to_string(count));
    std::filesystem::remove(name(1));
    std::filesystem::resize_file(name(2), std::filesystem::file_size(name(2)) / 2);
    {
        Merge merge(batch, 2);
        EXPECT_THAT(merge->TilesIn(State::Missing), testing::ElementsAre(name(1)));
        EXPECT_THAT(merge->TilesIn(State::Unfit), testing::ElementsAre(name(2)));
    }
    EXPECT_EQ(RunPart(batch, 1, 2).end, BatchEnd::Written);
    EXPECT_THAT(batch.printed, AllOf(HasSubstr("tile 1 of " + std::to_string(count) + " written"),
                                     HasSubstr("tile 3 of " + std::to_string(count) + " stands")));
    EXPECT_EQ(batch.directory.Read("out.nc.tiles/1of" + std::to_string(count)), kept);
    Merge merge(batch, 2);
    EXPECT_THAT(merge->TilesIn(State::Taken), SizeIs(count));
}

// Tiles that are read in one go are not lost in one go.
TEST(GridParts, LeaveEachTileWhenItsPointsAreDone) {
    SampleBatch batch(HistoryOfParts());
    CRynEditDoc document;
    document.UsePorts(batch.ports);
    document.OnOpenDocument(batch.directory.Path("case.RYN"));
    GridBatchOptions options = batch.Options(Scratch::Memory);
    options.isStopped = [&batch] { return batch.directory.Has("out.nc.tiles/2of10"); };
    EXPECT_EQ(RunGridPart(document, options, {1, 1}).end, BatchEnd::Stopped);
    EXPECT_TRUE(batch.directory.Has("out.nc.tiles/1of10"));
    EXPECT_FALSE(batch.directory.Has("out.nc.tiles/3of10"));
    EXPECT_EQ(RunPart(batch, 1, 1).end, BatchEnd::Written);
    EXPECT_THAT(batch.printed,
                AllOf(HasSubstr("tile 2 of 10 stands"), HasSubstr("3 of 10 written")));
}

TEST(GridParts, RefuseTilesThatWereMadeFromSomethingElse) {
    SampleBatch batch(HistoryOfParts());
    RunPart(batch, 1, 1);
    const auto isUnfit = [&batch] {
        Merge merge(batch, 1);
        return merge->TilesIn(State::Taken).empty() && !merge->TilesIn(State::Unfit).empty();
    };
    EXPECT_FALSE(isUnfit());
    batch.Edit([](CGlobalKvf& root) { root.Analysis().EvaluatedReturnPeriods = {2, 10, 50}; });
    EXPECT_TRUE(isUnfit());
    batch.Edit([](CGlobalKvf& root) { root.Analysis().EvaluatedReturnPeriods = {2, 10, 100}; });
    EXPECT_FALSE(isUnfit());
    const std::filesystem::path grid = batch.directory.Path("grid.nc");
    std::filesystem::last_write_time(grid, std::filesystem::last_write_time(grid) +
                                               std::chrono::seconds(5));
    EXPECT_TRUE(isUnfit());
}

} // namespace
} // namespace ryn
