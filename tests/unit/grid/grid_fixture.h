#pragma once

#include <functional>
#include <string>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "grid/grid_edit.h"
#include "support/netcdf_sample.h"
#include "support/scratch_directory.h"

namespace ryn::test {

inline std::string GridPath(const std::string& name) {
    return ScratchDirectory() + name + ".nc";
}

/// The value of a cell: tells its place apart from every other.
inline float CellValue(int x, int y, int step) {
    return static_cast<float>(step * 100 + y * 10 + x);
}

/// A grid of 4 x 3 cells and 5 days, of which single traits are changed before it is written.
struct SampleGrid {
    int mode = 0;
    std::string xName = "lon";
    std::string yName = "lat";
    std::vector<double> x = {10.0, 10.5, 11.0, 11.5};
    std::vector<double> y = {50.0, 51.0, 52.0};
    std::vector<double> times = {0, 1, 2, 3, 4};
    std::string units = "days since 2000-02-27";
    std::string calendar = "standard";
    int type = NC_FLOAT;
    std::vector<std::string> order = {"time", "lat", "lon"};
    std::vector<std::size_t> chunks;
    /// More definitions: attributes, other variables.
    std::function<void(NetcdfSample&)> define = [](NetcdfSample&) {};
    std::function<void(NetcdfSample&)> fill = [](NetcdfSample&) {};
    /// The stored number of a cell in places of the file.
    std::function<double(int, int, int)> value = CellValue;

    std::size_t LengthOf(const std::string& name) const {
        return name == "time" ? times.size() : name == xName ? x.size() : y.size();
    }

    /// In the file's order.
    std::vector<double> Stored() const {
        std::vector<double> stored;
        std::size_t place[3] = {};
        for (place[0] = 0; place[0] < LengthOf(order[0]); ++place[0])
            for (place[1] = 0; place[1] < LengthOf(order[1]); ++place[1])
                for (place[2] = 0; place[2] < LengthOf(order[2]); ++place[2]) {
                    int at[3] = {}; // x, y, step
                    for (std::size_t i = 0; i < 3; ++i)
                        at[order[i] == xName   ? 0
                           : order[i] == yName ? 1
                                               : 2] = static_cast<int>(place[i]);
                    stored.push_back(value(at[0], at[1], at[2]));
                }
        return stored;
    }

    std::string Write(const std::string& name) const {
        NetcdfSample file(GridPath(name), mode);
        file.Dimension("time", times.size()).Dimension(yName, y.size()).Dimension(xName, x.size());
        file.Variable("time", NC_DOUBLE, {"time"}).Text("time", "units", units);
        file.Text("time", "calendar", calendar);
        file.Variable(yName, NC_DOUBLE, {yName}).Text(yName, "units", "degrees_north");
        file.Variable(xName, NC_DOUBLE, {xName}).Text(xName, "units", "degrees_east");
        file.Variable("q", type, order);
        if (!chunks.empty())
            file.Chunks("q", chunks);
        define(file);
        file.Values("time", times).Values(yName, y).Values(xName, x).Values("q", Stored());
        fill(file);
        return file.Finish();
    }
};

/// An open grid, read in the ways there are.
class OpenGrid {
  public:
    explicit OpenGrid(const std::string& path) : result(engine.OpenFile(path, true)) {
        EXPECT_EQ(result, kGridOk) << engine.LastError().Text();
        header = engine.QueryHeaderInfo();
    }

    CQxArray2D<float> Plane(int step, int item = 1, int layer = 0) {
        CGridEditSlice slice;
        slice.Initilize(header, 0);
        slice.SetDynamic(true);
        slice.SetItem(item);
        slice.SetLayer(layer);
        slice.SetTimeStep(step);
        EXPECT_EQ(engine.GetSlice(slice), kGridOk) << engine.LastError().Text();
        EXPECT_EQ(engine.ReturnSlice(slice, false), kGridOk);
        EXPECT_EQ(slice.CurrentTime(), header.TimeOfStep(step));
        return slice.GetArray();
    }
    float At(int x, int y, int step, int item = 1, int layer = 0) {
        const CQxArray2D<float> plane = Plane(step, item, layer);
        return plane.Contains(x, y) ? plane(x, y) : std::nanf("");
    }

    GridTile Whole(int item = 1, int layer = 0) const {
        return {item, layer, 0, header.SizeX(), 0, header.SizeY(), 0, header.TimeStepPast()};
    }
    std::vector<GridTile> Plan(const GridTile& whole, std::size_t limit) {
        std::vector<GridTile> tiles;
        EXPECT_EQ(engine.PlanTiles(whole, limit, &tiles), kGridOk) << engine.LastError().Text();
        return tiles;
    }
    std::vector<float> Read(const GridTile& tile, std::size_t limit) {
        std::vector<float> values(tile.Values());
        EXPECT_EQ(engine.ReadTile(tile, limit, values), kGridOk) << engine.LastError().Text();
        return values;
    }

    std::vector<std::string> Dates() const {
        std::vector<std::string> dates;
        for (int step = header.TimeStepFirst(); step < header.TimeStepPast(); ++step)
            dates.push_back(header.TimeOfStep(step).Format("%Y-%m-%d %H:%M:%S"));
        return dates;
    }

    CGridEditEngine engine;
    EGridEditErrors result;
    CGridEditHeaderInfo header;
};

/// The reason why a file is no grid, without its name.
inline std::string GridRefusal(const std::string& path) {
    CGridEditEngine engine;
    EXPECT_EQ(engine.OpenFile(path, true), kGridNotOpened) << path;
    const std::string text = engine.LastError().Text();
    EXPECT_TRUE(text.starts_with(path + ": ")) << text;
    EXPECT_EQ(text.find('\n'), std::string::npos) << text;
    return text.substr(std::min(text.size(), path.size() + 2));
}

} // namespace ryn::test
