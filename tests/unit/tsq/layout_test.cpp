#include <string>

#include <gtest/gtest.h>

#include "unit/tsq/series_fixture.h"

namespace ryn {
namespace {

std::string Dump(const std::string& path, const std::string& options) {
    return test::Output("ncdump " + options + " -n x " + path);
}

// What docs/formats/tsq.md shows.
TEST(Layout, ASeriesFileIsAPlainCfFile) {
    const std::string path = test::PathOf("layout_series.tsq0");
    TsqHeaderHandle header = test::NewHeader(2, "Maxau");
    tsqSetAppTitle(header.get(), "Extreme values");
    tsqSetItemInfo(header.get(), tsqItemD(header.get(), 1), 102, "Discharge, daily",
                   UnitOfText("m3/s"), kTsqDataTypeFloat);
    tsqSetItemInfo(header.get(), tsqItemD(header.get(), 2), kItemTypeUndefined,
                   "\xe6\xb5\x81\xe9\x87\x8f", UnitOfText("boxes"), kTsqDataTypeFloat);
    tsqSetNeqCalendarAxis(header.get(), "1990-01-03", "06:00:00", kUnitSecond, 0.0, 2);
    ASSERT_EQ(test::Write(path, header.get(), {{0.0, {1.5F, 1}}, {86400.0, {2.5F, 2}}}), 0);
    EXPECT_EQ(Dump(path, "-k"), "64-bit offset\n");
    EXPECT_EQ(Dump(path, ""), R"(netcdf x {
dimensions:
	time = 2 ;
variables:
	double time(time) ;
		time:standard_name = "time" ;
		time:units = "seconds since 1990-01-03 06:00:00" ;
		time:calendar = "proleptic_gregorian" ;
		time:axis = "T" ;
		time:ryn_axis = 4 ;
		time:ryn_unit = 1400 ;
		time:ryn_start = 0. ;
		time:ryn_index = 2 ;
	float Discharge_daily(time) ;
		Discharge_daily:long_name = "Discharge, daily" ;
		Discharge_daily:units = "m3/s" ;
		Discharge_daily:ryn_type = 102 ;
		Discharge_daily:ryn_unit = 1700 ;
		Discharge_daily:ryn_value_type = 0 ;
		Discharge_daily:ryn_reference = 0.f, 0.f, 0.f ;
		Discharge_daily:ryn_orientation = 0.f, 0.f, 0.f ;
	float item_2(time) ;
		item_2:long_name = "流量" ;
		item_2:units = "boxes" ;
		item_2:ryn_type = 999 ;
		item_2:ryn_value_type = 0 ;
		item_2:ryn_reference = 0.f, 0.f, 0.f ;
		item_2:ryn_orientation = 0.f, 0.f, 0.f ;

// global attributes:
		:Conventions = "CF-1.8" ;
		:title = "Maxau" ;
		:ryn_format = 1 ;
		:ryn_file_type = 4 ;
		:ryn_statistics_kind = 1 ;
		:ryn_application = "RYNEditor" ;
		:ryn_application_version = 100 ;
		:ryn_application_title = "Extreme values" ;
		:ryn_data_type = 0 ;
		:ryn_delete_value_float = 0.f ;
		:ryn_delete_value_double = 0. ;
data:

 time = 0, 86400 ;

 Discharge_daily = 1.5, 2.5 ;

 item_2 = 1, 2 ;
}
)");
    EXPECT_NE(Dump(path, "-t").find("time = \"1990-01-03 06\", \"1990-01-04 06\""),
              std::string::npos);
}

TEST(Layout, OtherProgramsSeeTheStartOffsetInTheTimes) {
    const std::string path = test::PathOf("layout_start.tsq0");
    TsqHeaderHandle header = test::NewHeader(1);
    tsqSetEqCalendarAxis(header.get(), "2000-01-01", "00:00:00", kUnitHour, 1.5, 0.5, 0);
    ASSERT_EQ(test::Write(path, header.get(), {{0, {1}}, {0, {2}}}), 0);
    const std::string dump = Dump(path, "-t");
    EXPECT_NE(dump.find("time = \"2000-01-01 01:30\", \"2000-01-01 02\""), std::string::npos)
        << dump;
    EXPECT_NE(dump.find("time:units = \"hours since 2000-01-01 00:00:00\""), std::string::npos);
}

TEST(Layout, ARelativeAxisIsNoDurationToOthers) {
    const std::string path = test::PathOf("layout_relative.tsq0");
    TsqHeaderHandle header = test::NewHeader(1);
    tsqSetNeqTimeAxis(header.get(), kUnitSecond, 0.0, 2);
    ASSERT_EQ(test::Write(path, header.get(), {{0, {1}}}), 0);
    const std::string dump = Dump(path, "-h");
    EXPECT_NE(dump.find("time:units = \"s\" ;"), std::string::npos);
    EXPECT_NE(dump.find("time:long_name = \"time from 1900-01-01 00:00:00\" ;"), std::string::npos);
}

/// A file with one step of a plane of 2 by 2.
std::string PlaneFile(const std::string& name, int axesUnit, const TsqGridCoordinates* given) {
    const std::string path = test::PathOf(name);
    TsqHeaderHandle header = test::NewHeader(2);
    tsqSetDeleteValFloat(header.get(), -99.0F);
    tsqSetEqCalendarAxis(header.get(), "2000-01-01", "00:00:00", kUnitSecond, 0.0, 3600.0, 0);
    if (given != nullptr)
        tsqSetGridCoordinates(header.get(), *given);
    for (int i = 1; i <= 2; ++i)
        tsqSetItemAxisEqD2(tsqItemD(header.get(), i), axesUnit, 2, 2, 7.1F, 50.0F, 0.1F, -0.25F);
    TsqFileHandle file;
    if (tsqFileCreate(path, header.get(), &file) != 0)
        return "";
    const float plane[4] = {1, 2, std::nanf(""), 4};
    for (int i = 1; i <= 2; ++i)
        tsqWriteItemTimeStep(header.get(), file.get(), 0.0, plane);
    EXPECT_EQ(tsqFileClose(header.get(), &file), 0);
    return path;
}

TEST(Layout, AGeographicPlaneHasLongitudesAndLatitudes) {
    const std::string dump =
        Dump(PlaneFile("layout_lonlat.tsq0", UnitOfText("degree"), nullptr), "");
    for (const char* const part :
         {"float Item_1(time, lat, lon) ;", "lat:units = \"degrees_north\" ;",
          "lon:standard_name = \"longitude\" ;", "lon:axis = \"X\" ;", " lon = 7.1, 7.2 ;",
          " lat = 50, 49.75 ;", "Item_2:_FillValue = -99.f ;", "  1, 2,\n  _, 4 ;"})
        EXPECT_NE(dump.find(part), std::string::npos) << part << dump;
}

TEST(Layout, APlaneOfMetresHasProjectedCoordinates) {
    const std::string dump = Dump(PlaneFile("layout_xy.tsq0", UnitOfText("m"), nullptr), "-h");
    for (const char* const part : {"float Item_1(time, y, x) ;", "x:units = \"m\" ;",
                                   "y:standard_name = \"projection_y_coordinate\" ;"})
        EXPECT_NE(dump.find(part), std::string::npos) << part << dump;
}

TEST(Layout, APlaneRunByIndexCarriesItsRealCoordinates) {
    TsqGridCoordinates given;
    given.x = {"rlon", "degrees", "grid_longitude", {-1.5, 0.25}};
    given.longitudes = {7, 8, 7.5, 8.5};
    given.latitudes = {50, 50.5, 51, 51.5};
    const std::string dump = Dump(PlaneFile("layout_given.tsq0", kUnitUndefined, &given), "");
    for (const char* const part :
         {"float Item_1(time, y, rlon) ;", "rlon:standard_name = \"grid_longitude\" ;",
          " rlon = -1.5, 0.25 ;", "Item_2:coordinates = \"longitude latitude\" ;",
          "double latitude(y, rlon) ;", " longitude =\n  7, 8,\n  7.5, 8.5 ;"})
        EXPECT_NE(dump.find(part), std::string::npos) << part << dump;
    given.latitudes.pop_back();
    EXPECT_EQ(PlaneFile("layout_wrong.tsq0", kUnitUndefined, &given), "");
}

} // namespace
} // namespace ryn
