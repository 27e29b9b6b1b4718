#include <algorithm>

#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

#include "unit/grid/grid_fixture.h"

namespace ryn {
namespace {

using test::OpenGrid;
using test::SampleGrid;

constexpr std::size_t kPlenty = 1 << 20;

/// 23 x 17 cells and 31 steps, stored in an order and, where given, in chunks.
SampleGrid LargerGrid(const std::vector<std::string>& order,
                      const std::vector<std::size_t>& chunks) {
    SampleGrid sample;
    const auto fillAxis = [](std::vector<double>* axis, int size, double step) {
        axis->clear();
        for (int i = 0; i < size; ++i)
            axis->push_back(10.0 + i * step);
    };
    fillAxis(&sample.x, 23, 0.25);
    fillAxis(&sample.y, 17, -0.5);
    fillAxis(&sample.times, 31, 1.0);
    sample.order = order;
    sample.chunks = chunks;
    sample.mode = chunks.empty() ? 0 : NC_NETCDF4;
    sample.value = [](int x, int y, int step) { return step * 1000.0 + y * 30.0 + x; };
    sample.define = [](test::NetcdfSample& file) { file.Mark("q", "_FillValue", 5011.0); };
    return sample;
}

/// The tile's part of the planes.
std::vector<float> FromPlanes(OpenGrid* grid, const GridTile& tile) {
    std::vector<float> values(tile.Values());
    for (int k = 0; k < tile.countSteps; ++k) {
        const CQxArray2D<float> plane = grid->Plane(tile.firstStep + k);
        for (int i = 0; i < tile.countX; ++i)
            for (int j = 0; j < tile.countY; ++j)
                values[static_cast<std::size_t>((i * tile.countY + j) * tile.countSteps + k)] =
                    plane(tile.firstX + i, tile.firstY + j);
    }
    return values;
}

const std::vector<std::pair<std::vector<std::string>, std::vector<std::size_t>>>& Layouts() {
    static const std::vector<std::pair<std::vector<std::string>, std::vector<std::size_t>>> all = {
        {{"time", "lat", "lon"}, {}},          {{"lat", "lon", "time"}, {}},
        {{"time", "lon", "lat"}, {}},          {{"time", "lat", "lon"}, {31, 4, 5}},
        {{"time", "lat", "lon"}, {1, 17, 23}}, {{"time", "lat", "lon"}, {7, 17, 3}},
        {{"lon", "time", "lat"}, {5, 10, 6}},
    };
    return all;
}

/// Files are written once for all draws.
const std::string& FileOf(std::size_t layout) {
    static std::vector<std::string> paths(Layouts().size());
    if (paths[layout].empty())
        paths[layout] = LargerGrid(Layouts()[layout].first, Layouts()[layout].second)
                            .Write("tiles" + std::to_string(layout));
    return paths[layout];
}

RC_GTEST_PROP(GridTiles, HoldWhatThePlanesHold, ()) {
    OpenGrid grid(FileOf(*rc::gen::inRange<std::size_t>(0, Layouts().size())));
    GridTile tile;
    tile.firstX = *rc::gen::inRange(0, 23);
    tile.countX = *rc::gen::inRange(1, 24 - tile.firstX);
    tile.firstY = *rc::gen::inRange(0, 17);
    tile.countY = *rc::gen::inRange(1, 18 - tile.firstY);
    tile.firstStep = *rc::gen::inRange(0, 31);
    tile.countSteps = *rc::gen::inRange(1, 32 - tile.firstStep);
    const auto limit = static_cast<std::size_t>(*rc::gen::inRange(4, 20000));
    RC_ASSERT(grid.Read(tile, limit) == FromPlanes(&grid, tile));
}

TEST(GridTiles, CoverTheWholeOnceWithinTheirLimit) {
    for (std::size_t layout = 0; layout < Layouts().size(); ++layout)
        for (const std::size_t limit : {std::size_t{200}, std::size_t{5000}, kPlenty}) {
            OpenGrid grid(FileOf(layout));
            GridTile whole = grid.Whole();
            whole.firstX = 2;
            whole.countX = 20;
            CQxArray2D<int> covered(23, 17, 0);
            for (const GridTile& tile : grid.Plan(whole, limit)) {
                EXPECT_LE(tile.Values() * sizeof(float), limit);
                EXPECT_EQ(tile.countSteps, 31);
                for (int x = tile.firstX; x < tile.firstX + tile.countX; ++x)
                    for (int y = tile.firstY; y < tile.firstY + tile.countY; ++y)
                        ++covered(x, y);
            }
            for (int x = 0; x < 23; ++x)
                for (int y = 0; y < 17; ++y)
                    EXPECT_EQ(covered(x, y), x >= 2 && x < 22 ? 1 : 0) << x << " " << y;
        }
}

TEST(GridTiles, EndWhereChunksEnd) {
    OpenGrid grid(FileOf(3)); // chunks of 4 rows and 5 columns; the rows are turned
    for (const GridTile& tile : grid.Plan(grid.Whole(), 31 * 4 * 5 * 4 * 2)) {
        EXPECT_EQ(tile.firstX % 5, 0);
        EXPECT_TRUE(tile.countX % 5 == 0 || tile.firstX + tile.countX == 23);
        const int fileFirst = 17 - tile.firstY - tile.countY;
        EXPECT_EQ(fileFirst % 4, 0);
    }
}

TEST(GridTiles, AreLongRunsOfWhatIsNotChunked) {
    OpenGrid byRows(FileOf(0));
    for (const GridTile& tile : byRows.Plan(byRows.Whole(), 31 * 23 * 4 * 4))
        EXPECT_EQ(tile.countX, 23);
    OpenGrid byColumns(FileOf(2));
    for (const GridTile& tile : byColumns.Plan(byColumns.Whole(), 31 * 17 * 4 * 4))
        EXPECT_EQ(tile.countY, 17);
}

TEST(GridTiles, DivideAPlaneEvenlyWhereItIsNotChunked) {
    for (const std::size_t layout : {std::size_t{0}, std::size_t{1}, std::size_t{2}}) {
        OpenGrid grid(FileOf(layout));
        std::vector<GridTile> tiles;
        ASSERT_EQ(grid.engine.DividePlane(grid.Whole(), 5, &tiles), kGridOk);
        ASSERT_EQ(tiles.size(), 5U);
        std::size_t points = 0;
        for (const GridTile& tile : tiles) {
            points += tile.Points();
            EXPECT_NEAR(static_cast<double>(tile.Points()), 23.0 * 17.0 / 5.0, 23.0);
        }
        EXPECT_EQ(points, std::size_t{23 * 17});
    }
}

TEST(GridTiles, AreRefusedWhereOnePointIsTooLarge) {
    OpenGrid grid(FileOf(0));
    std::vector<GridTile> tiles;
    EXPECT_EQ(grid.engine.PlanTiles(grid.Whole(), 100, &tiles), kGridBadRequest);
    EXPECT_THAT(grid.engine.LastError().Text(),
                testing::HasSubstr("100 bytes, does not hold the 31 steps of one point"));
}

} // namespace
} // namespace ryn
