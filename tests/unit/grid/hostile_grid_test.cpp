#include <filesystem>
#include <fstream>

#include "base/file_access.h"
#include "unit/grid/grid_fixture.h"

namespace ryn {
namespace {

using test::GridPath;
using test::GridRefusal;
using test::NetcdfSample;
using test::SampleGrid;

std::string BytesOf(const std::string& path) {
    std::string bytes;
    EXPECT_TRUE(ReadWholeFile(path, std::size_t{1} << 24, &bytes).IsOk());
    return bytes;
}

std::string WithBytes(const std::string& name, const std::string& bytes) {
    const std::string path = GridPath(name);
    std::filesystem::remove(path);
    std::ofstream(path, std::ios::binary) << bytes;
    return path;
}

/// Opens and reads all there is; true when all of it could be read.
bool ReadsAll(const std::string& path) {
    CGridEditEngine engine;
    if (engine.OpenFile(path, true) != kGridOk)
        return false;
    const CGridEditHeaderInfo header = engine.QueryHeaderInfo();
    GridCoordinates coordinates;
    bool all = engine.ReadCoordinates(&coordinates) == kGridOk;
    engine.Describe();
    for (int item = 1; item <= header.Items(); ++item) {
        GridSummary summary;
        all = engine.Summarise(item, 0, &summary) == kGridOk && all;
        CGridEditSlice slice;
        slice.Initilize(header, 0);
        slice.SetItem(item);
        all = engine.GetSlice(slice) == kGridOk && all;
    }
    return all;
}

TEST(HostileGrid, CutAtAnyByteIsRefused) {
    const std::string bytes = BytesOf(SampleGrid().Write("whole"));
    for (std::size_t length = 0; length < bytes.size(); ++length)
        GridRefusal(WithBytes("cut", bytes.substr(0, length)));
}

TEST(HostileGrid, WithAnyByteChangedIsReadOrRefused) {
    for (const int mode : {0, NC_64BIT_DATA}) {
        SampleGrid sample;
        sample.mode = mode;
        const std::string bytes = BytesOf(sample.Write("whole"));
        int readable = 0;
        for (std::size_t place = 4; place < bytes.size(); ++place)
            for (const char mask : {'\x01', '\x80', '\xff'}) {
                std::string changed = bytes;
                changed[place] = static_cast<char>(changed[place] ^ mask);
                readable += ReadsAll(WithBytes("changed", changed)) ? 1 : 0;
            }
        EXPECT_GT(readable, 0);
    }
}

TEST(HostileGrid, WithMoreValuesThanItCanHoldAllocatesNone) {
    NetcdfSample file(GridPath("lying"), NC_NETCDF4);
    file.Dimension("time", 2).Dimension("y", 100000).Dimension("x", 100000);
    file.Variable("time", NC_INT, {"time"}).Text("time", "units", "days since 2000-01-01");
    file.Variable("q", NC_FLOAT, {"time", "y", "x"}).Chunks("q", {1, 1000, 1000});
    file.Values("time", {0, 1});
    CGridEditEngine engine;
    ASSERT_EQ(engine.OpenFile(file.Finish(), true), kGridOk) << engine.LastError().Text();
    CGridEditSlice slice;
    slice.Initilize(engine.QueryHeaderInfo(), 0);
    EXPECT_EQ(engine.GetSlice(slice), kGridNotRead);
    EXPECT_THAT(engine.LastError().Text(), testing::HasSubstr("than the file can hold"));
    GridSummary summary;
    EXPECT_EQ(engine.Summarise(1, 0, &summary), kGridNotRead);
    std::vector<GridTile> tiles;
    EXPECT_EQ(engine.PlanTiles({1, 0, 0, 100000, 0, 100000, 0, 2}, 1 << 20, &tiles),
              kGridBadRequest);
}

TEST(HostileGrid, WithAnAxisLongerThanItselfIsRefused) {
    NetcdfSample file(GridPath("long_axis"), NC_NETCDF4);
    file.Dimension("time", 1).Dimension("lat", 2).Dimension("lon", 2000000000);
    file.Variable("time", NC_INT, {"time"}).Text("time", "units", "days since 2000-01-01");
    file.Variable("lat", NC_DOUBLE, {"lat"});
    file.Variable("lon", NC_DOUBLE, {"lon"}).Chunks("lon", {1000});
    file.Variable("q", NC_FLOAT, {"time", "lat", "lon"}).Chunks("q", {1, 1, 1000});
    file.Values("time", {0}).Values("lat", {1, 2});
    EXPECT_EQ(GridRefusal(file.Finish()), "\"lon\" counts more values than the file can hold");
}

TEST(HostileGrid, WithAChunkLargerThanItCanHoldIsRefused) {
    NetcdfSample file(GridPath("large_chunk"), NC_NETCDF4);
    file.Dimension("time", NC_UNLIMITED).Dimension("lat", 2).Dimension("lon", 2);
    file.Variable("time", NC_INT, {"time"}).Text("time", "units", "days since 2000-01-01");
    file.Chunks("time", {1}).Variable("q", NC_FLOAT, {"time", "lat", "lon"});
    file.Chunks("q", {100000000, 2, 2}).Values("time", {0, 1});
    EXPECT_EQ(GridRefusal(file.Finish()), "\"q\" has chunks larger than the file can hold");
}

TEST(HostileGrid, WithNamesOfSeveralLinesGivesOneLine) {
    NetcdfSample file(GridPath("odd_names"));
    file.Dimension("time", 1).Dimension("a\"b", 2);
    file.Variable("time", NC_INT, {"time"}).Text("time", "units", "days since 2000-01-01");
    file.Variable("q\"r", NC_FLOAT, {"time", "a\"b"}).Values("time", {0});
    GridRefusal(file.Finish());
}

} // namespace
} // namespace ryn
