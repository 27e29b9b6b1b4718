#include "apps/cli/size_text.h"
#include "command_fixture.h"
#include "support/sample_batch.h"

namespace ryn::cli {
namespace {

using test::SampleHistory;
using testing::AllOf;
using testing::ElementsAre;
using testing::HasSubstr;

class GridCommand : public CommandTest {
  protected:
    GridCommand() { SampleHistory().Write("grid.nc"); }

    int New(const std::vector<std::string>& more) {
        std::vector<std::string> arguments = {"new",
                                              "case.ryn",
                                              "--yes",
                                              "--fit",
                                              "GUM/LMOM",
                                              "--periods",
                                              "2,10",
                                              "--grid",
                                              "grid.nc",
                                              "--grid-item",
                                              "1",
                                              "--grid-out",
                                              "out.nc",
                                              "Tsq2Input.UncertaintyCal=false",
                                              "DefineEVS.OutputFileName=case.res"};
        arguments.insert(arguments.end(), more.begin(), more.end());
        return Run(arguments);
    }
};

TEST_F(GridCommand, RunsTheWholeGridThatWasNamed) {
    ASSERT_EQ(New({}), 0) << err;
    EXPECT_THAT(Saved("case.RYN", "/Tsq2Input/X_Range_And_Interval"), ElementsAre(0, 2, 1));
    EXPECT_THAT(Saved("case.RYN", "/Tsq2Input/Y_Range_And_Interval"), ElementsAre(0, 1, 1));
    EXPECT_THAT(Saved("case.RYN", "/Tsq2Input/Time_Range_And_Interval"), ElementsAre(0, 149, 1));
    EXPECT_EQ(Saved("case.RYN", "/Tsq2Input/Tsq2OutputFile"), files.Path("out.nc"));
    EXPECT_EQ(Run({"grid", "case.ryn"}), 0) << err;
    EXPECT_EQ(out, "Created: 6 TS-files. Remaining: 0\n");
    EXPECT_THAT(err, HasSubstr("has the results of 6 of 6 points"));
    EXPECT_EQ(Run({"info", "out.nc"}), 0) << err;
    EXPECT_THAT(out, HasSubstr("GUM/LMOM - Estimated quantile 10.00 years [m]"));
}

TEST_F(GridCommand, TakesPartsOfAGrid) {
    ASSERT_EQ(New({"--x", "1:2", "--y", "0:1:2", "--time", "12:130"}), 0) << err;
    EXPECT_THAT(Saved("case.RYN", "/Tsq2Input/X_Range_And_Interval"), ElementsAre(1, 2, 1));
    EXPECT_THAT(Saved("case.RYN", "/Tsq2Input/Y_Range_And_Interval"), ElementsAre(0, 1, 2));
    EXPECT_THAT(Saved("case.RYN", "/Tsq2Input/Time_Range_And_Interval"), ElementsAre(12, 130, 1));
}

TEST_F(GridCommand, RefusesPartsThatAreNotThere) {
    struct Refusal {
        std::vector<std::string> arguments;
        const char* text;
    };
    const std::vector<Refusal> refusals = {
        {{"--x", "0:3"},
         "--x: \"0:3\" is no valid value; expected: FIRST:LAST:STEP or FIRST:LAST, "
         "places from 0 to 2"},
        {{"--x", "2:1"}, "--x"},
        {{"--x", "0:2:0"}, "--x"},
        {{"--x", "-1:2"}, "--x"},
        {{"--y", "1"}, "--y"},
        {{"--y", "0:1:1:1"}, "--y"},
        {{"--time", "0:149:2"}, "FIRST:LAST, time steps from 0 to 149"},
        {{"--time", "0:150"}, "--time"},
        {{"--time", "a:b"}, "--time"},
    };
    for (const Refusal& refusal : refusals) {
        EXPECT_EQ(New(refusal.arguments), 1);
        EXPECT_THAT(err, HasSubstr(refusal.text));
        EXPECT_EQ(std::count(err.begin(), err.end(), '\n'), 1) << err;
        EXPECT_FALSE(files.Has("case.RYN"));
    }
    const std::vector<Refusal> others = {
        {{"--grid", "grid.nc", "--grid-item", "2", "--grid-out", "o.nc"}, "there is no item 2"},
        {{"--grid", "grid.nc", "--grid-item", "1", "--grid-out", "./grid.nc"}, "input file itself"},
        {{"--grid", "none.nc", "--grid-item", "1", "--grid-out", "o.nc"}, "none.nc"},
        {{"--grid", "grid.nc", "--grid-item", "1"}, "--grid needs --grid-out"},
        {{"--grid", "grid.nc", "--grid-out", "o.nc"}, "--grid needs --grid-item"},
        {{"--x", "0:1"}, "--x needs --grid"},
    };
    for (const Refusal& refusal : others) {
        std::vector<std::string> arguments = {"new", "case.ryn"};
        arguments.insert(arguments.end(), refusal.arguments.begin(), refusal.arguments.end());
        EXPECT_EQ(Run(arguments), 1);
        EXPECT_THAT(err, HasSubstr(refusal.text));
    }
}

TEST_F(GridCommand, RefusesWhatWouldGoWrongAtTheFirstPoint) {
    ASSERT_EQ(New({}), 0) << err;
    ASSERT_EQ(Run({"set", "case.ryn", "BasicInput.SelectionMethod=1"}), 0);
    EXPECT_EQ(Run({"grid", "case.ryn"}), 1);
    EXPECT_THAT(err, HasSubstr("a batch needs the same in both"));
    ASSERT_EQ(Run({"set", "case.ryn", "DefineEVS.SelectionMethod=1"}), 0);
    EXPECT_EQ(Run({"grid", "case.ryn"}), 1);
    EXPECT_THAT(err, HasSubstr("BasicInput.AvgAnNum above 0"));
    ASSERT_EQ(Run({"set", "case.ryn", "Tsq2Input.UseTsq2Input=false",
                   "BasicInput.SelectionMethod=0", "DefineEVS.SelectionMethod=0"}),
              0);
    EXPECT_EQ(Run({"grid", "case.ryn"}), 1);
    EXPECT_THAT(err, HasSubstr("UseTsq2Input is false"));
    for (const std::vector<std::string>& options : {std::vector<std::string>{"--part", "1"},
                                                    {"--merge"},
                                                    {"--parts", "2", "--part", "3"},
                                                    {"--parts", "2", "--part", "1", "--merge"},
                                                    {"--jobs", "2", "--merge"},
                                                    {"--memory", "much"},
                                                    {"--scratch", "tape"},
                                                    {"--parts", "0"}}) {
        std::vector<std::string> arguments = {"grid", "case.ryn"};
        arguments.insert(arguments.end(), options.begin(), options.end());
        EXPECT_EQ(Run(arguments), 1) << options[0];
        EXPECT_EQ(std::count(err.begin(), err.end(), '\n'), 1) << err;
    }
}

TEST_F(GridCommand, SaysWhyNoPointWasGood) {
    SampleHistory history;
    history.steps = 20;
    history.Write("grid.nc");
    ASSERT_EQ(New({}), 0) << err;
    EXPECT_EQ(Run({"grid", "case.ryn"}), 2);
    EXPECT_THAT(err, HasSubstr("the last point: the series has 2 value(s)"));
    history.value = [](int, int, int step) { return step == 0 ? test::kMissingCell : 1.0; };
    history.Write("grid.nc");
    EXPECT_EQ(Run({"grid", "case.ryn"}), 2);
    EXPECT_THAT(err, HasSubstr("all points are missing at the first time step"));
}

TEST_F(GridCommand, WarnsOfMissingValuesThatCountAsData) {
    SampleHistory history;
    const auto good = history.value;
    history.value = [good](int x, int y, int step) {
        return x == 2 && step == 40 ? double{test::kMissingCell} : good(x, y, step);
    };
    history.Write("grid.nc");
    ASSERT_EQ(New({}), 0) << err;
    EXPECT_EQ(Run({"grid", "case.ryn"}), 0);
    EXPECT_THAT(err, HasSubstr("2 points have missing values after the first time step"));
}

TEST_F(GridCommand, TellsWhatAGridHolds) {
    test::NetcdfSample file("packed.nc");
    file.Dimension("time", 3).Dimension("lat", 2).Dimension("lon", 2);
    file.Variable("time", NC_INT, {"time"}).Text("time", "units", "months since 2000-01-01");
    file.Text("time", "calendar", "standard");
    file.Variable("lat", NC_FLOAT, {"lat"}).Text("lat", "units", "degrees_north");
    file.Variable("lon", NC_FLOAT, {"lon"}).Text("lon", "units", "degrees_east");
    file.Variable("sst", NC_SHORT, {"time", "lat", "lon"}).Text("sst", "units", "degC");
    file.Text("sst", "long_name", "sea surface temperature").Mark("sst", "_FillValue", -32767);
    file.Number("sst", "scale_factor", 0.25).Number("sst", "add_offset", 10.0);
    file.Values("time", {0, 1, 2}).Values("lat", {51, 50}).Values("lon", {4, 4.5});
    file.Values("sst", {0, 1, 2, 3, 4, 5, 6, 7, 8, 9, -32767, -32767}).Finish();
    ASSERT_EQ(Run({"info", "packed.nc"}), 0) << err;
    EXPECT_THAT(out, AllOf(HasSubstr("lon      2: 4 - 4.5 degrees_east, spacing 0.5"),
                           HasSubstr("50 - 51 degrees_north, spacing 1, descending in the file"),
                           HasSubstr("30.000 d on average"), HasSubstr("sst(time, lat, lon)"),
                           HasSubstr("missing   16.7 %"), HasSubstr("largest   12.25")));
    ASSERT_EQ(Run({"info", "packed.nc", "--json"}), 0) << err;
    EXPECT_EQ(Json()["items"][0]["missing"], 2);
    EXPECT_EQ(Json()["items"][0]["minimum"], 10.0);
    EXPECT_EQ(Json()["last"], "2000-03-01T00:00:00");
}

TEST(SizeText, IsReadWithItsSuffix) {
    EXPECT_EQ(ParseSize("4096"), 4096U);
    EXPECT_EQ(ParseSize("1.5k"), 1536U);
    EXPECT_EQ(ParseSize("2G"), std::size_t{2} << 30);
    EXPECT_EQ(ParseSize("800MiB"), std::size_t{800} << 20);
    EXPECT_EQ(ParseSize("1tb"), std::size_t{1} << 40);
    for (const char* text : {"", "G", "-1", "0", "1X", "1 G", "1e40", "nan", "1.5.2G", "infG"})
        EXPECT_FALSE(ParseSize(text)) << text;
}

} // namespace
} // namespace ryn::cli
