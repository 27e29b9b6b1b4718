#include "apps/cli/size_text.h"
#include "command_fixture.h"
#include "support/sample_batch.h"

namespace ryn::cli {
namespace {

using test::SampleHistory;
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

TEST_F(GridCommand, RefusesWhatWouldGoWrongAtTheFirstPoint) {
    ASSERT_EQ(New({}), 0) << err;
    ASSERT_EQ(Run({"set", "case.ryn", "BasicInput.SelectionMethod=1"}), 0);
    EXPECT_EQ(Run({"grid", "case.ryn"}), 1);
    EXPECT_THAT(err, HasSubstr("a batch needs the same in both"));
    ASSERT_EQ(Run({"set", "case.ryn", "DefineEVS.SelectionMethod=1"}), 0);
    EXPECT_EQ(Run({"grid", "case.ryn"}), 1);
    EXPECT_THAT(err, HasSubstr("BasicInput.AvgAnNum above 0"));
    ASSERT_EQ(Run({"set", "case.ryn", "BasicInput.AvgAnNum=2", "BasicInput.PdsDataType=1"}), 0);
    EXPECT_EQ(Run({"grid", "case.ryn"}), 1);
    EXPECT_THAT(err, HasSubstr("BasicInput.RecordLength above 0"));
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

TEST_F(GridCommand, IsCheckedWithItsGridAndWithoutASeries) {
    SampleHistory().Write("grid.nc");
    ASSERT_EQ(New({}), 0) << err;
    EXPECT_EQ(Run({"check", "case.ryn"}), 0) << out;
    ASSERT_EQ(Run({"set", "case.ryn", "Tsq2Input.Tsq2ItemNo=7"}), 0) << err;
    EXPECT_EQ(Run({"check", "case.ryn"}), 1);
    EXPECT_THAT(err, HasSubstr("grid.nc: "));
    EXPECT_EQ(std::count(err.begin(), err.end(), '\n'), 1) << err;
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
    EXPECT_THAT(
        err,
        HasSubstr("points with missing values after the first time step, which count as data: 2"));
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
