#include "tsq/tsq.h"
#include "unit/grid/grid_fixture.h"

namespace ryn {
namespace {

using test::GridPath;
using test::OpenGrid;
using testing::ElementsAre;

/// A result grid of 3 x 2 cells and one step, as the batch writes it.
std::string ResultGrid(const TsqGridCoordinates& coordinates) {
    const std::string path = GridPath("results");
    TsqHeaderHandle header;
    EXPECT_EQ(tsqHeaderCreate(1, path, "RYNEdit", 1, 2, 1, &header), 0);
    tsqSetDeleteValFloat(header.get(), -1e-30F);
    tsqSetEqCalendarAxis(header.get(), "1990-01-01", "06:00:00", kUnitSecond, 0.0, 3600.0, 0);
    for (int i = 1; i <= 2; ++i) {
        TsqItem* const item = tsqItemD(header.get(), i);
        tsqSetItemInfo(header.get(), item, kItemTypeUndefined, i == 1 ? "Mean" : "Skewness",
                       i == 1 ? UnitOfText("m3/s") : kUnitUndefined, 1);
        tsqSetItemAxisEqD2(item, UnitOfText("degree"), 3, 2, 10.0F, 50.0F, 0.25F, 0.5F);
    }
    EXPECT_EQ(tsqSetGridCoordinates(header.get(), coordinates), 0);
    TsqFileHandle file;
    EXPECT_EQ(tsqFileCreate(path, header.get(), &file), 0);
    const float mean[] = {1, 2, 3, 4, std::nanf(""), 6};
    const float skewness[] = {0, 0, 1, 1, 2, 2};
    EXPECT_EQ(tsqWriteItemTimeStep(header.get(), file.get(), 0.0, mean), 0);
    EXPECT_EQ(tsqWriteItemTimeStep(header.get(), file.get(), 0.0, skewness), 0);
    EXPECT_EQ(tsqFileClose(header.get(), &file), 0);
    tsqHeaderDestroy(&header);
    return path;
}

TEST(GridOfResults, OpensAsAGridAgain) {
    OpenGrid grid(ResultGrid({}));
    ASSERT_EQ(grid.header.Items(), 2);
    EXPECT_EQ(grid.header.DynamicItem(1).GetName(), "Mean");
    EXPECT_EQ(grid.header.DynamicItem(1).GetUnitTag(), UnitOfText("m3/s"));
    EXPECT_EQ(grid.header.X0(), 10.0F);
    EXPECT_EQ(grid.header.DY(), 0.5F);
    EXPECT_THAT(grid.Dates(), ElementsAre("1990-01-01 06:00:00"));
    EXPECT_EQ(grid.header.DeleteValue(), -1e-30F);
    EXPECT_EQ(grid.At(1, 1, 0), -1e-30F);
    EXPECT_EQ(grid.At(2, 1, 0), 6.0F);
    EXPECT_EQ(grid.At(2, 0, 0, 2), 1.0F);
}

TEST(GridOfResults, KeepsTheCoordinatesOfAGridThatRanByPlaceNumber) {
    TsqGridCoordinates given;
    given.x = {"rlon", "degrees", "grid_longitude", {-1.0, 0.5, 1.0}};
    given.y = {"rlat", "degrees", "grid_latitude", {2.0, 3.0}};
    given.longitudes = {1, 2, 3, 4, 5, 6};
    given.latitudes = {50, 50, 50, 51, 51, 51};
    OpenGrid grid(ResultGrid(given));
    EXPECT_TRUE(grid.header.RunsByIndex());
    GridCoordinates read;
    EXPECT_EQ(grid.engine.ReadCoordinates(&read), kGridOk);
    EXPECT_EQ(read.x.name, "rlon");
    EXPECT_EQ(read.y.standardName, "grid_latitude");
    EXPECT_EQ(read.x.values, given.x.values);
    EXPECT_EQ(read.longitudes, given.longitudes);
    EXPECT_EQ(read.latitudes, given.latitudes);
}

} // namespace
} // namespace ryn
