#include "command_fixture.h"
#include "support/netcdf_sample.h"
#include "tsq/tsq.h"
#include "units/units.h"

namespace ryn::cli {
namespace {

using testing::ElementsAre;
using testing::HasSubstr;

class GridFile : public CommandTest {
  protected:
    /// Packed numbers on 3 x 2 cells and four days: latitudes descend, one value in six is missing.
    void WritePacked(const std::string& name, bool hasSeries = false) {
        test::NetcdfSample file(name);
        file.Dimension("time", 4).Dimension("lat", 2).Dimension("lon", 3);
        file.Text("", "title", "a packed grid");
        Time(file, "days since 2000-02-27");
        file.Variable("lat", NC_DOUBLE, {"lat"}).Text("lat", "units", "degrees_north");
        file.Variable("lon", NC_FLOAT, {"lon"}).Text("lon", "units", "degrees_east");
        file.Variable("q", NC_SHORT, {"time", "lat", "lon"}).Text("q", "units", "m3/s");
        file.Text("q", "long_name", "flow").Mark("q", "_FillValue", -999);
        file.Number("q", "scale_factor", 0.5).Number("q", "add_offset", 10.0);
        if (hasSeries)
            file.Variable("index", NC_FLOAT, {"time"});
        file.Values("time", {0, 1, 2, 3}).Values("lat", {51, 50.75}).Values("lon", {5.1, 5.2, 5.3});
        file.Values("q", {0, 1, 2, 3, 4, -999, 6, 7,  8, 9, 10, -999,
                          0, 1, 2, 3, 4, -999, 6, -4, 8, 9, 10, -999});
        if (hasSeries)
            file.Values("index", {1, 2, 3, 4});
        file.Finish();
    }

    void WriteStations(const std::string& name) {
        test::NetcdfSample file(name);
        file.Dimension("station", 2).Dimension("time", 4);
        Time(file, "days since 2000-01-01");
        file.Variable("level", NC_FLOAT, {"station", "time"});
        file.Values("time", {0, 1, 2, 3}).Values("level", {1, 2, 3, 4, 5, 6, 7, 8}).Finish();
    }

    /// Two fields at one moment, as the batch writes its results.
    void WriteResults(const std::string& name) {
        TsqHeaderHandle header;
        ASSERT_EQ(tsqHeaderCreate(1, files.Path(name), "RYNEdit", 1, 1, 1, &header), 0);
        tsqSetDeleteValFloat(header.get(), -1e-30F);
        tsqSetEqCalendarAxis(header.get(), "1990-01-01", "06:00:00", kUnitSecond, 0.0, 3600.0, 0);
        TsqItem* const item = tsqItemD(header.get(), 1);
        tsqSetItemInfo(header.get(), item, kItemTypeUndefined, "Mean", UnitOfText("m"), 1);
        tsqSetItemAxisEqD2(item, UnitOfText("degree"), 2, 2, 10.0F, 50.0F, 0.25F, 0.5F);
        TsqFileHandle file;
        ASSERT_EQ(tsqFileCreate(files.Path(name), header.get(), &file), 0);
        const float mean[] = {1.5F, -1e-30F, 3, 4};
        ASSERT_EQ(tsqWriteItemTimeStep(header.get(), file.get(), 0.0, mean), 0);
        ASSERT_EQ(tsqFileClose(header.get(), &file), 0);
        tsqHeaderDestroy(&header);
    }

    int New(std::vector<std::string> more) {
        more.insert(more.begin(), {"new", "case.ryn"});
        return Run(more);
    }

  private:
    static void Time(test::NetcdfSample& file, const std::string& units) {
        file.Variable("time", NC_INT, {"time"}).Text("time", "units", units);
        file.Text("time", "calendar", "noleap");
    }
};

using InfoOfGrid = GridFile;
using NewOfGrid = GridFile;

TEST_F(InfoOfGrid, TellsAxesTimesAndTheRangeOfEachItem) {
    WritePacked("q.nc");
    ASSERT_EQ(Run({"info", "q.nc"}), 0) << err;
    EXPECT_EQ(out, "q.nc\n"
                   "title         a packed grid\n"
                   "x  lon        3: 5.1 to 5.3 degrees_east, spacing 0.1\n"
                   "y  lat        2: 50.75 to 51 degrees_north, spacing 0.25, descending in the "
                   "file\n"
                   "time steps    4\n"
                   "first         2000-02-27 00:00\n"
                   "last          2000-03-02 00:00\n"
                   "step          1.333 d on average\n"
                   "time units    days since 2000-02-27, calendar noleap\n"
                   "delete value  9.96921e+36\n"
                   "\n"
                   "item 1: flow [m3/s]\n"
                   "variable  q(time, lat, lon)\n"
                   "type      Discharge\n"
                   "values    20\n"
                   "missing   4 (16.67 %)\n"
                   "smallest  8\n"
                   "largest   15\n");
    EXPECT_EQ(err, "");
}

TEST_F(InfoOfGrid, HasStableKeysInJson) {
    WritePacked("q.nc");
    ASSERT_EQ(Run({"info", "q.nc", "--json"}), 0) << err;
    EXPECT_EQ(Json().dump(),
              R"({"title":"a packed grid",)"
              R"("x":{"name":"lon","units":"degrees_east","size":3,"first":5.1,"last":5.3,)"
              R"("spacing":0.1,"turned":false},)"
              R"("y":{"name":"lat","units":"degrees_north","size":2,"first":50.75,"last":51.0,)"
              R"("spacing":0.25,"turned":true},"byIndex":false,"count":4,)"
              R"("first":"2000-02-27T00:00:00","last":"2000-03-02T00:00:00","step":null,)"
              R"("meanStep":115200.0,"timeUnits":"days since 2000-02-27","calendar":"noleap",)"
              R"("deleteValue":9.96921e+36,"notes":[],"items":[{"number":1,"name":"flow",)"
              R"("variable":"q","units":"m3/s","type":"Discharge","layers":1,)"
              R"("storage":"time, lat, lon","values":20,"missing":4,)"
              R"("missingShare":0.16666666666666666,"minimum":8.0,"maximum":15.0}]})");
}

TEST_F(InfoOfGrid, HasNullForWhatIsNotThere) {
    test::NetcdfSample file("bare.nc");
    file.Dimension("time", 1).Dimension("lev", 2).Dimension("y", 2).Dimension("x", 3);
    file.Variable("time", NC_INT, {"time"}).Text("time", "units", "days since 2000-01-01");
    file.Variable("q", NC_FLOAT, {"time", "lev", "y", "x"}).Mark("q", "missing_value", 0);
    file.Values("time", {5}).Values("q", {0, 0, 0, 0, 0, 0, 1, 1, 1, 1, 1, 1}).Finish();
    ASSERT_EQ(Run({"info", "bare.nc", "--json"}), 0) << err;
    const auto grid = Json();
    EXPECT_TRUE(grid["byIndex"]);
    EXPECT_EQ(grid["notes"].size(), 1U);
    for (const char* const pointer : {"/x/first", "/x/last", "/x/spacing", "/y/first", "/step",
                                      "/meanStep", "/items/0/minimum", "/items/0/maximum"})
        EXPECT_TRUE(grid.at(nlohmann::ordered_json::json_pointer(pointer)).is_null()) << pointer;
    ASSERT_EQ(Run({"info", "bare.nc"}), 0) << err;
    EXPECT_THAT(out, HasSubstr("x  x          3, not regular degrees or lengths\n"));
    EXPECT_THAT(out, HasSubstr("\nnote: The axes are not regular"));
    EXPECT_THAT(out, HasSubstr("layers    2, of which a batch runs the first, shown here\n"
                               "values    0\n"
                               "missing   6 (100.00 %)\n"));
    EXPECT_THAT(out, testing::Not(HasSubstr("\nstep ")));
}

TEST_F(InfoOfGrid, ShowsResultGridsUnderAnyName) {
    for (const std::string name : {"out.nc", "out.tsq0"}) {
        WriteResults(name);
        ASSERT_EQ(Run({"info", name}), 0) << err;
        EXPECT_THAT(out, HasSubstr("2: 10 to 10.25 degrees_east, spacing 0.25\n")) << name;
        EXPECT_THAT(out, HasSubstr("item 1: Mean [m]\n"));
        EXPECT_THAT(out, HasSubstr("missing   1 (25.00 %)\nsmallest  1.5\nlargest   4\n"));
    }
}

TEST_F(InfoOfGrid, TakesTheNameOfAFileThatIsBothAtItsWord) {
    WritePacked("both.nc", true);
    ASSERT_EQ(Run({"info", "both.nc"}), 0) << err;
    EXPECT_THAT(out, HasSubstr("x  lon"));
    EXPECT_THAT(out, HasSubstr("note: Plain series beside the grid: 2 index.\n"));
    std::filesystem::rename("both.nc", "both.tsq0");
    ASSERT_EQ(Run({"info", "both.tsq0"}), 0) << err;
    EXPECT_THAT(out, HasSubstr("item 2: index\nvalues    4\n"));
}

TEST_F(InfoOfGrid, RefusesWhatIsNeitherGridNorSeriesInOneLine) {
    WriteStations("stations.nc");
    EXPECT_EQ(Run({"info", "stations.nc"}), 1);
    EXPECT_EQ(out, "");
    EXPECT_EQ(err, "ryn: stations.nc: has no item that is a plain series; no grid: besides time, "
                   "\"level\" runs along \"station\", not along two axes of space\n");
    files.Write("torn.nc", "CDF\x01");
    EXPECT_EQ(Run({"info", "torn.nc"}), 1);
    EXPECT_EQ(std::count(err.begin(), err.end(), '\n'), 1) << err;
}

TEST_F(NewOfGrid, RefusesToWriteResultsOverTheAnalysisOrTheGrid) {
    WritePacked("q.nc");
    for (const std::string output : {"q.nc", "case.ryn", "./case.ryn"}) {
        EXPECT_EQ(New({"--grid", "q.nc", "--grid-item", "1", "--grid-out", output}), 1) << output;
        EXPECT_THAT(err, HasSubstr("--grid-out: ")) << output;
    }
}

TEST_F(NewOfGrid, TakesTheWholeGridUnlessRangesAreGiven) {
    WritePacked("q.nc");
    ASSERT_EQ(New({"--grid", "q.nc", "--grid-item", "1", "--grid-out", "out.nc"}), 0) << err;
    auto input = Saved("case.ryn", "/Tsq2Input");
    EXPECT_EQ(input["UseTsq2Input"], true);
    EXPECT_EQ(input["Tsq2InputFile"], files.Path("q.nc"));
    EXPECT_EQ(input["Tsq2OutputFile"], files.Path("out.nc"));
    EXPECT_EQ(input["Tsq2ItemNo"], 1);
    EXPECT_THAT(input["X_Range_And_Interval"], ElementsAre(0, 2, 1));
    EXPECT_THAT(input["Y_Range_And_Interval"], ElementsAre(0, 1, 1));
    EXPECT_THAT(input["Time_Range_And_Interval"], ElementsAre(0, 3, 1));
    EXPECT_EQ(Saved("case.ryn", "/BasicInput/SelectionMethod"),
              Saved("case.ryn", "/DefineEVS/SelectionMethod"));

    ASSERT_EQ(New({"--yes", "--grid", "q.nc", "--grid-item", "1", "--grid-out", "out.nc", "--x",
                   "0:2:2", "--y", "1:1", "--time", "1:3", "Tsq2Input.UncertaintyCal=false",
                   "Tsq2Input.SaveEVS=true"}),
              0)
        << err;
    input = Saved("case.ryn", "/Tsq2Input");
    EXPECT_THAT(input["X_Range_And_Interval"], ElementsAre(0, 2, 2));
    EXPECT_THAT(input["Y_Range_And_Interval"], ElementsAre(1, 1, 1));
    EXPECT_THAT(input["Time_Range_And_Interval"], ElementsAre(1, 3, 1));
    EXPECT_EQ(input["UncertaintyCal"], false);
    EXPECT_EQ(input["SaveEVS"], true);
}

TEST_F(NewOfGrid, CountsFileNamesFromTheCallersDirectory) {
    WritePacked("q.nc");
    std::filesystem::create_directory("down");
    ASSERT_EQ(Run({"new", "down/case.ryn", "--grid", "q.nc", "--grid-item", "1", "--grid-out",
                   "down/out.nc"}),
              0)
        << err;
    EXPECT_EQ(Saved("down/case.ryn", "/Tsq2Input/Tsq2InputFile"), files.Path("q.nc"));
    EXPECT_EQ(Saved("down/case.ryn", "/Tsq2Input/Tsq2OutputFile"), files.Path("down/out.nc"));
}

TEST_F(NewOfGrid, RefusesInOneLineWhatTheGridDoesNotHaveAndSavesNothing) {
    WritePacked("q.nc");
    WriteStations("stations.nc");
    std::filesystem::create_symlink("q.nc", "link.nc");
    std::filesystem::create_directory("down");
    struct Case {
        std::vector<std::string> arguments;
        std::string reason; ///< the end of the line
    };
    const std::string range = ", LAST not before FIRST, a step of 1 or more\n";
    const std::string x = " is no valid value; expected: FIRST:LAST:STEP or FIRST:LAST, places "
                          "from 0 to 2" +
                          range;
    const std::string y = " is no valid value; expected: FIRST:LAST:STEP or FIRST:LAST, places "
                          "from 0 to 1" +
                          range;
    const std::string steps = " is no valid value; expected: FIRST:LAST, time steps from 0 to 3, "
                              "LAST not before FIRST\n";
    const std::vector<std::string> good = {"--grid", "q.nc", "--grid-item", "1"};
    const Case cases[] = {
        {{"--grid-out", "o.nc", "--x", "0:3"}, "ryn: --x: \"0:3\"" + x},
        {{"--grid-out", "o.nc", "--x", "2:1"}, "ryn: --x: \"2:1\"" + x},
        {{"--grid-out", "o.nc", "--x", "0:2:0"}, "ryn: --x: \"0:2:0\"" + x},
        {{"--grid-out", "o.nc", "--x", "0:1:1:1"}, "ryn: --x: \"0:1:1:1\"" + x},
        {{"--grid-out", "o.nc", "--x", "99999999999:2"}, "ryn: --x: \"99999999999:2\"" + x},
        {{"--grid-out", "o.nc", "--y=-1:1"}, "ryn: --y: \"-1:1\"" + y},
        {{"--grid-out", "o.nc", "--y", "1"}, "ryn: --y: \"1\"" + y},
        {{"--grid-out", "o.nc", "--y", ""}, "ryn: --y: \"\"" + y},
        {{"--grid-out", "o.nc", "--time", "0:4"}, "ryn: --time: \"0:4\"" + steps},
        {{"--grid-out", "o.nc", "--time", "0:3:1"}, "ryn: --time: \"0:3:1\"" + steps},
        {{}, "ryn: --grid needs --grid-out\n"},
        {{"--grid-out", ""},
         "ryn: --grid-out: \"\" is no valid value; expected: the name of a file\n"},
        {{"--grid-out", "link.nc"},
         "/link.nc: is the input file itself; choose another output file\n"},
        {{"--grid-out", "down/../q.nc"},
         "/q.nc: is the input file itself; choose another output file\n"},
    };
    for (const Case& c : cases) {
        std::vector<std::string> arguments = good;
        arguments.insert(arguments.end(), c.arguments.begin(), c.arguments.end());
        EXPECT_EQ(New(arguments), 1);
        EXPECT_THAT(err, testing::EndsWith(c.reason));
        EXPECT_EQ(std::count(err.begin(), err.end(), '\n'), 1) << err;
    }
    const Case others[] = {
        {{"--grid", "q.nc", "--grid-out", "o.nc"}, "--grid needs --grid-item\n"},
        {{"--grid", "q.nc", "--grid-item", "2", "--grid-out", "o.nc"},
         "ryn: --grid-item: there is no item 2; the grid has 1\n"},
        {{"--grid", "stations.nc", "--grid-item", "1", "--grid-out", "o.nc"},
         "not along two axes of space\n"},
        {{"--grid", "none.nc", "--grid-item", "1", "--grid-out", "o.nc"},
         "/none.nc: No such file or directory\n"},
        {{"--grid", "down", "--grid-item", "1", "--grid-out", "o.nc"},
         "/down: not a regular file\n"},
        {{"--x", "0:1"}, "ryn: --x needs --grid\n"},
        {{"--time", "0:1"}, "ryn: --time needs --grid\n"},
        {{"--grid-item", "1"}, "ryn: --grid-item needs --grid\n"},
        {{"--grid-out", "o.nc"}, "ryn: --grid-out needs --grid\n"},
    };
    for (const Case& c : others) {
        EXPECT_EQ(New(c.arguments), 1);
        EXPECT_THAT(err, testing::EndsWith(c.reason));
        EXPECT_EQ(std::count(err.begin(), err.end(), '\n'), 1) << err;
    }
    EXPECT_FALSE(files.Has("case.RYN"));
}

} // namespace
} // namespace ryn::cli
