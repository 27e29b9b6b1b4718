#include "unit/grid/grid_fixture.h"

#include "units/units.h"

namespace ryn {
namespace {

using test::CellValue;
using test::GridPath;
using test::GridRefusal;
using test::NetcdfSample;
using test::OpenGrid;
using test::SampleGrid;
using testing::ElementsAre;
using testing::HasSubstr;

void ExpectCells(OpenGrid* grid) {
    for (int step = 0; step < grid->header.TimeStepPast(); ++step) {
        const CQxArray2D<float> plane = grid->Plane(step);
        for (int y = 0; y < 3; ++y)
            for (int x = 0; x < 4; ++x)
                ASSERT_EQ(plane(x, y), CellValue(x, y, step)) << x << " " << y << " " << step;
    }
}

TEST(GridAxes, AreReadInAnyOrderAndFormat) {
    const std::vector<std::vector<std::string>> orders = {{"time", "lat", "lon"},
                                                          {"time", "lon", "lat"},
                                                          {"lat", "lon", "time"},
                                                          {"lon", "lat", "time"},
                                                          {"lat", "time", "lon"}};
    for (const int mode : {0, NC_64BIT_OFFSET, NC_64BIT_DATA, NC_NETCDF4})
        for (const auto& order : orders) {
            SampleGrid sample;
            sample.mode = mode;
            sample.order = order;
            OpenGrid grid(sample.Write("order"));
            EXPECT_EQ(grid.header.X0(), 10.0F);
            EXPECT_EQ(grid.header.DX(), 0.5F);
            EXPECT_EQ(grid.header.Y0(), 50.0F);
            EXPECT_EQ(grid.header.DY(), 1.0F);
            EXPECT_EQ(UnitText(grid.header.QtyUnit()), "degree");
            EXPECT_EQ(grid.header.MapProjection(), "latitude_longitude");
            ExpectCells(&grid);
        }
}

TEST(GridAxes, AreTurnedWhereTheyDescend) {
    SampleGrid sample;
    sample.y = {52.0, 51.0, 50.0};
    sample.x = {11.5, 11.0, 10.5, 10.0};
    sample.value = [](int x, int y, int step) { return CellValue(3 - x, 2 - y, step); };
    OpenGrid grid(sample.Write("turned"));
    EXPECT_EQ(grid.header.Y0(), 50.0F);
    EXPECT_EQ(grid.header.DY(), 1.0F);
    EXPECT_EQ(grid.header.DX(), 0.5F);
    ExpectCells(&grid);
    const GridTile part{1, 0, 1, 2, 0, 2, 1, 3};
    const std::vector<float> values = grid.Read(part, 1 << 20);
    for (int i = 0; i < 2; ++i)
        for (int j = 0; j < 2; ++j)
            for (int k = 0; k < 3; ++k)
                EXPECT_EQ(values[static_cast<std::size_t>((i * 2 + j) * 3 + k)],
                          CellValue(1 + i, j, 1 + k));
}

TEST(GridAxes, GoOnPastTheMeridian) {
    SampleGrid sample;
    sample.x = {350, 355, 0, 5};
    OpenGrid grid(sample.Write("meridian"));
    EXPECT_FALSE(grid.header.RunsByIndex());
    EXPECT_EQ(grid.header.X0(), 350.0F);
    EXPECT_EQ(grid.header.DX(), 5.0F);
}

TEST(GridAxes, OfOneCellHaveASpacingOfOne) {
    SampleGrid sample;
    sample.x = {10.0};
    OpenGrid grid(sample.Write("one_column"));
    EXPECT_EQ(grid.header.X0(), 10.0F);
    EXPECT_EQ(grid.header.DX(), 1.0F);
    EXPECT_EQ(grid.At(0, 2, 3), CellValue(0, 2, 3));
}

TEST(GridAxes, RunByPlaceNumberWhereTheyAreIrregular) {
    SampleGrid sample;
    sample.y = {52.0, 50.9, 50.0}; // off by a tenth of a cell, and descending
    sample.value = [](int x, int y, int step) { return CellValue(x, 2 - y, step); };
    OpenGrid grid(sample.Write("irregular"));
    EXPECT_TRUE(grid.header.RunsByIndex());
    EXPECT_EQ(grid.header.X0(), 0.0F);
    EXPECT_EQ(grid.header.DX(), 1.0F);
    EXPECT_EQ(grid.header.Y0(), 0.0F);
    EXPECT_EQ(grid.header.DY(), 1.0F);
    EXPECT_EQ(grid.header.QtyUnit(), kUnitUndefined);
    EXPECT_THAT(grid.header.Notes(), ElementsAre(HasSubstr("place number")));
    ExpectCells(&grid);
    GridCoordinates real;
    EXPECT_EQ(grid.engine.ReadCoordinates(&real), kGridOk);
    EXPECT_THAT(real.y.values, ElementsAre(50.0, 50.9, 52.0));
    EXPECT_THAT(real.x.values, ElementsAre(10.0, 10.5, 11.0, 11.5));
    EXPECT_EQ(real.y.units, "degrees_north");
    EXPECT_TRUE(real.longitudes.empty());
}

TEST(GridAxes, AreRegularWithinTheRoundingOfFloats) {
    SampleGrid sample;
    sample.x = {static_cast<double>(100.1F), static_cast<double>(100.2F),
                static_cast<double>(100.3F), static_cast<double>(100.4F)};
    EXPECT_FALSE(OpenGrid(sample.Write("floats")).header.RunsByIndex());
}

/// Rows and columns with the degrees of each cell, the second row to the north.
std::string CurvilinearGrid(const std::string& name, bool withRotatedAxes) {
    NetcdfSample file(GridPath(name), 0);
    file.Dimension("time", 2).Dimension("row", 2).Dimension("column", 3).Dimension("corner", 4);
    file.Variable("time", NC_DOUBLE, {"time"}).Text("time", "units", "days since 2000-01-01");
    for (const std::string& degrees : {std::string("lon"), std::string("lat")})
        file.Variable(degrees, NC_FLOAT, {"row", "column"})
            .Text(degrees, "units", degrees == "lon" ? "degrees_east" : "degrees_north")
            .Text(degrees, "bounds", degrees + "_corners");
    file.Variable("lat_corners", NC_FLOAT, {"row", "column", "corner"});
    file.Text("lat_corners", "units", "degrees_north");
    if (withRotatedAxes) {
        file.Variable("row", NC_DOUBLE, {"row"}).Text("row", "standard_name", "grid_latitude");
        file.Variable("column", NC_DOUBLE, {"column"});
        file.Text("column", "standard_name", "grid_longitude").Text("column", "units", "degrees");
        file.Variable("pole", NC_INT, {}).Number("pole", "grid_north_pole_latitude", 39.25);
        file.Text("pole", "grid_mapping_name", "rotated_latitude_longitude");
        file.Number("pole", "grid_north_pole_longitude", -162.0);
    }
    file.Variable("q", NC_FLOAT, {"time", "row", "column"}).Text("q", "coordinates", "lon lat");
    file.Text("q", "grid_mapping", "pole");
    file.Values("time", {0, 1}).Values("lon", {1, 2, 3, 4, 5, 6});
    file.Values("lat", {50, 51, 52, 53, 54, 55});
    if (withRotatedAxes)
        file.Values("row", {1, 0}).Values("column", {-1, 0, 1});
    file.Values("q", {0, 1, 2, 10, 11, 12, 100, 101, 102, 110, 111, 112});
    return file.Finish();
}

TEST(GridAxes, RunByPlaceNumberWhereEachCellHasItsOwnDegrees) {
    OpenGrid grid(CurvilinearGrid("cells", false));
    EXPECT_TRUE(grid.header.RunsByIndex());
    EXPECT_EQ(grid.header.SizeX(), 3);
    EXPECT_EQ(grid.header.SizeY(), 2);
    EXPECT_EQ(grid.At(2, 1, 1), 112.0F);
    GridCoordinates real;
    EXPECT_EQ(grid.engine.ReadCoordinates(&real), kGridOk);
    EXPECT_THAT(real.longitudes, ElementsAre(1, 2, 3, 4, 5, 6));
    EXPECT_THAT(real.latitudes, ElementsAre(50, 51, 52, 53, 54, 55));
    EXPECT_TRUE(real.x.values.empty());
}

TEST(GridAxes, OfARotatedPoleRunByPlaceNumberAndTurnTheirCells) {
    OpenGrid grid(CurvilinearGrid("rotated", true));
    EXPECT_TRUE(grid.header.RunsByIndex());
    EXPECT_EQ(grid.header.MapProjection(), "rotated_latitude_longitude");
    EXPECT_EQ(grid.header.Latitude(), 39.25);
    EXPECT_EQ(grid.header.Longitude(), -162.0);
    EXPECT_EQ(grid.At(0, 0, 0), 10.0F); // the rows descend in the file
    GridCoordinates real;
    EXPECT_EQ(grid.engine.ReadCoordinates(&real), kGridOk);
    EXPECT_THAT(real.y.values, ElementsAre(0, 1));
    EXPECT_THAT(real.latitudes, ElementsAre(53, 54, 55, 50, 51, 52));
}

TEST(GridAxes, WithCellsThatMayMoveHaveThoseOfTheFirstStep) {
    NetcdfSample file(GridPath("moving"));
    file.Dimension("Time", 2).Dimension("south_north", 1).Dimension("west_east", 2);
    file.Variable("XTIME", NC_FLOAT, {"Time"});
    file.Text("XTIME", "units", "minutes since 2000-01-01 00:00:00");
    for (const std::string& degrees : {std::string("XLAT"), std::string("XLONG")})
        file.Variable(degrees, NC_FLOAT, {"Time", "south_north", "west_east"})
            .Text(degrees, "units", degrees == "XLAT" ? "degree_north" : "degree_east")
            .Text(degrees, "coordinates", "XLONG XLAT");
    file.Variable("T2", NC_FLOAT, {"Time", "south_north", "west_east"});
    file.Text("T2", "coordinates", "XLONG XLAT XTIME").Values("XTIME", {0, 180});
    file.Values("XLAT", {50, 51, 60, 61}).Values("XLONG", {1, 2, 3, 4});
    file.Values("T2", {280, 281, 290, 291});
    OpenGrid grid(file.Finish());
    ASSERT_EQ(grid.header.Items(), 1);
    EXPECT_EQ(grid.header.DynamicItem(1).GetName(), "T2");
    EXPECT_EQ(grid.header.TimeStep(), 10800.0);
    EXPECT_EQ(grid.At(1, 0, 1), 291.0F);
    GridCoordinates real;
    EXPECT_EQ(grid.engine.ReadCoordinates(&real), kGridOk);
    EXPECT_THAT(real.latitudes, ElementsAre(50, 51));
    EXPECT_THAT(real.longitudes, ElementsAre(1, 2));
}

TEST(GridAxes, OfAProjectionRunInItsLengths) {
    SampleGrid sample;
    sample.xName = "x";
    sample.yName = "y";
    sample.x = {0, 1000, 2000, 3000};
    sample.y = {7000, 6000, 5000};
    sample.order = {"time", "y", "x"};
    sample.define = [](NetcdfSample& file) {
        file.Text("x", "units", "m").Text("y", "units", "metre").Variable("crs", NC_INT, {});
        file.Text("crs", "grid_mapping_name", "lambert_conformal_conic");
        file.Number("crs", "longitude_of_central_meridian", 10.5);
        file.Number("crs", "latitude_of_projection_origin", 52.0);
        file.Text("q", "grid_mapping", "crs");
    };
    OpenGrid grid(sample.Write("projected"));
    EXPECT_FALSE(grid.header.RunsByIndex());
    EXPECT_EQ(grid.header.QtyUnit(), UnitOfText("m"));
    EXPECT_EQ(grid.header.DX(), 1000.0F);
    EXPECT_EQ(grid.header.Y0(), 5000.0F);
    EXPECT_EQ(grid.header.MapProjection(), "lambert_conformal_conic");
    EXPECT_EQ(grid.header.Longitude(), 10.5);
    EXPECT_EQ(grid.header.Latitude(), 52.0);
    EXPECT_EQ(grid.header.Rotation(), 0.0);
}

TEST(GridAxes, OfLevelsAndMembersMakeLayers) {
    NetcdfSample file(GridPath("levels"), NC_NETCDF4);
    file.Dimension("time", 1).Dimension("member", 2).Dimension("lev", 3);
    file.Dimension("y", 1).Dimension("x", 2);
    file.Variable("time", NC_INT, {"time"}).Text("time", "units", "hours since 2000-01-01");
    file.Variable("lev", NC_INT, {"lev"}).Text("lev", "units", "millibars");
    file.Variable("t", NC_FLOAT, {"time", "lev", "y", "x"}).Text("t", "units", "K");
    file.Variable("e", NC_FLOAT, {"member", "time", "lev", "y", "x"});
    file.Values("time", {5}).Values("lev", {850, 500, 200}).Values("t", {0, 1, 10, 11, 20, 21});
    file.Values("e", {0, 1, 10, 11, 20, 21, 100, 101, 110, 111, 120, 121});
    OpenGrid grid(file.Finish());
    EXPECT_EQ(grid.header.DynamicItem(1).Layers(), 3);
    EXPECT_EQ(grid.header.DynamicItem(2).Layers(), 6);
    EXPECT_EQ(grid.header.Z0(), 850.0F);
    EXPECT_EQ(grid.At(1, 0, 0, 1, 2), 21.0F);
    EXPECT_EQ(grid.At(0, 0, 0, 2, 4), 110.0F);
    EXPECT_EQ(grid.engine.Describe().items[1].storage, "member, time, lev, y, x");
}

TEST(GridItems, AreTheVariablesOnTheAxesInFileOrder) {
    SampleGrid sample;
    sample.define = [](NetcdfSample& file) {
        file.Text("q", "units", "m3 s-1").Text("q", "long_name", "River discharge");
        file.Dimension("bnds", 2).Variable("time_bnds", NC_DOUBLE, {"time", "bnds"});
        file.Variable("area", NC_FLOAT, {"lat", "lon"});
        file.Variable("mean", NC_FLOAT, {"time"});
        file.Dimension("lat_u", 3).Variable("u", NC_FLOAT, {"time", "lat_u", "lon"});
        file.Variable("lat_u", NC_FLOAT, {"lat_u"}).Text("lat_u", "axis", "Y");
        file.Variable("t2m", NC_SHORT, {"lon", "lat", "time"}).Text("t2m", "units", "K");
    };
    OpenGrid grid(sample.Write("items"));
    ASSERT_EQ(grid.header.Items(), 2);
    const CGridEditItemInfo item = grid.header.DynamicItem(1);
    EXPECT_EQ(item.GetName(), "River discharge");
    EXPECT_EQ(item.GetUnitTag(), UnitOfText("m3/s"));
    EXPECT_EQ(item.GetItemTag(), ItemTypeOfUnit(UnitOfText("m3/s")));
    EXPECT_EQ(grid.header.DynamicItem(2).GetName(), "t2m");
    EXPECT_EQ(grid.header.DynamicItem(3).GetItemTag(), kItemTypeUndefined);
    EXPECT_THAT(grid.header.Notes(), ElementsAre(HasSubstr("left out: u.")));
}

TEST(GridRefusal, SaysInOneLineWhatIsMissing) {
    SampleGrid noTime;
    noTime.units = "m";
    EXPECT_THAT(GridRefusal(noTime.Write("no_time")), HasSubstr("no time axis"));
    SampleGrid noDate;
    noDate.units = "days";
    EXPECT_THAT(GridRefusal(noDate.Write("no_date")), HasSubstr("counts from no date"));
    SampleGrid backward;
    backward.times = {0, 1, 3, 2, 4};
    EXPECT_THAT(GridRefusal(backward.Write("backward")), HasSubstr("goes back in time at step 4"));
    NetcdfSample stations(GridPath("stations"));
    stations.Dimension("station", 2).Dimension("time", 1);
    stations.Variable("time", NC_INT, {"time"}).Text("time", "units", "days since 2000-1-1");
    stations.Variable("lat", NC_FLOAT, {"station"}).Text("lat", "axis", "Y");
    stations.Variable("lon", NC_FLOAT, {"station"}).Text("lon", "axis", "X");
    stations.Variable("q", NC_FLOAT, {"station", "time"}).Text("q", "coordinates", "lat lon");
    stations.Values("time", {0});
    EXPECT_EQ(GridRefusal(stations.Finish()), "no grid: besides time, \"q\" runs along "
                                              "\"station\", not along two axes of space");
    CGridEditEngine engine;
    EXPECT_EQ(engine.OpenFile(GridPath("missing"), true), kGridNotOpened);
    EXPECT_THAT(engine.LastError().Text(), HasSubstr("No such file"));
    EXPECT_EQ(engine.OpenFile(GridPath("no_time"), false), kGridReadOnly);
    CGridEditSlice slice;
    EXPECT_EQ(engine.GetSlice(slice), kGridNoFile);
}

TEST(GridRefusal, NamesTheItemStepOrPlaceThatTheFileDoesNotHave) {
    OpenGrid grid(SampleGrid().Write("requests"));
    CGridEditSlice slice;
    slice.Initilize(grid.header, 0);
    slice.SetTimeStep(5);
    EXPECT_EQ(grid.engine.GetSlice(slice), kGridBadRequest);
    EXPECT_THAT(grid.engine.LastError().Text(), HasSubstr("time step 5 to 5, but has 0 to 4"));
    EXPECT_EQ(slice.GetArray().Size(), 0U);
    EXPECT_FALSE(slice.CurrentTime().IsValid());
    slice.SetTimeStep(0);
    slice.SetItem(0);
    EXPECT_EQ(grid.engine.GetSlice(slice), kGridBadRequest);
    EXPECT_THAT(grid.engine.LastError().Text(), HasSubstr("no item 0 (1 to 1)"));
    OpenGrid other(SampleGrid().Write("another"));
    slice.Initilize(other.header, 0);
    EXPECT_EQ(grid.engine.GetSlice(slice), kGridBadRequest);
    EXPECT_THAT(grid.engine.LastError().Text(), HasSubstr("not made for this file"));
    slice.Initilize(grid.header, 1);
    EXPECT_EQ(grid.engine.GetSlice(slice), kGridBadRequest);
    slice.Initilize(grid.header, 0);
    EXPECT_EQ(grid.engine.ReturnSlice(slice, true), kGridReadOnly);
    std::vector<float> values(100);
    for (const GridTile& tile :
         {GridTile{1, 0, 3, 2, 0, 1, 0, 5}, GridTile{1, 0, 0, 4, -1, 2, 0, 5},
          GridTile{1, 1, 0, 1, 0, 1, 0, 5}, GridTile{1, 0, 0, 2147483647, 0, 1, 0, 5},
          GridTile{1, 0, 0, 0, 0, 1, 0, 5}})
        EXPECT_EQ(grid.engine.ReadTile(tile, 1 << 20, values), kGridBadRequest);
    EXPECT_EQ(grid.engine.ReadTile(grid.Whole(), 1 << 20, std::span(values).first(59)),
              kGridNotRead);
}

} // namespace
} // namespace ryn
