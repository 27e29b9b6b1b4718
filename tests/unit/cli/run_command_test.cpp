#include "apps/cli/run_command.h"

#include "command_fixture.h"

namespace ryn::cli {
namespace {

using testing::HasSubstr;
using testing::Not;

/// An analysis of seven years, ready to run.
class RunCommandLine : public CommandTest {
  protected:
    RunCommandLine() {
        WriteYearly("s.tsq0", {3, 1, 5, 2, 4, 7, 6});
        EXPECT_EQ(Run({"new", "case.ryn", "DefineEVS.InputFileName=s.tsq0",
                       "DefineEVS.OutputFileName=case.res", "DefineEVS.Title=Seven years", "--fit",
                       "GUM/LMOM", "--periods", "2,100"}),
                  0)
            << err;
    }
    int Set(const std::string& assignment) { return Run({"set", "case.ryn", assignment}); }
};

TEST_F(RunCommandLine, PrintsQuantilesAndWritesTheResults) {
    ASSERT_EQ(Run({"run", "case.ryn"}), 0) << err;
    EXPECT_THAT(out, HasSubstr("case.res: 7 values, D/E combinations: 1\n"));
    EXPECT_THAT(out, HasSubstr("GUM/LMOM"));
    EXPECT_THAT(out, HasSubstr("Standard deviation"));
    for (const char* file : {"case.res", "Ryn.log", "Rynout1.txt", "Rynout2.txt"})
        EXPECT_TRUE(files.Has(file)) << file;
    ASSERT_EQ(Run({"run", "case.ryn", "--json"}), 0) << err;
    EXPECT_EQ(Json()["combinations"][0]["quantiles"][1]["period"], 100.0);
    EXPECT_TRUE(Json()["combinations"][0]["quantiles"][1]["standardDeviation"].is_number());
    ASSERT_EQ(Run({"show", "case.ryn", "--page", "14"}), 0) << err;
    EXPECT_THAT(out, HasSubstr("Seven years\n\n\nSample statistics:\n"));
}

TEST_F(RunCommandLine, PrintsTheFindingsThatStopIt) {
    ASSERT_EQ(Set("Analysis.EvaluatedReturnPeriods.Item=1"), 0) << err;
    EXPECT_EQ(Run({"run", "case.ryn"}), 1);
    EXPECT_THAT(err, HasSubstr("Computation can not start because of error(s) in input data."));
    EXPECT_THAT(err, HasSubstr("page 4"));
    EXPECT_FALSE(files.Has("case.res"));
}

TEST_F(RunCommandLine, ShowsTheEndOfTheLogWhenTheEngineFails) {
    WriteYearly("s.tsq0", {3, 1, 5});
    EXPECT_EQ(Run({"run", "case.ryn"}), 2);
    EXPECT_THAT(err, HasSubstr("Ryn.log:"));
    EXPECT_THAT(err, HasSubstr("the series has 3 value(s); at least 5 are needed"));
    EXPECT_THAT(err, HasSubstr("finished with status 1"));
    EXPECT_EQ(Run({"show", "case.ryn", "--page", "12"}), 1);
    EXPECT_THAT(err, HasSubstr("has no results"));
}

TEST_F(RunCommandLine, TellsThatTheSeriesCannotBeRead) {
    files.Write("s.tsq0", files.Read("s.tsq0").substr(0, 500));
    EXPECT_EQ(Run({"run", "case.ryn"}), 2);
    EXPECT_THAT(err, HasSubstr("s.tsq0: "));
}

TEST_F(RunCommandLine, NeverTakesAnotherFileOfTheAnalysisForTheResults) {
    files.Write("grid.nc", "a grid");
    for (const char* name :
         {"other.RYN", "s.tsq0", "grid.nc", "Ryn.log", "Rynout2.txt", "/dev/null"}) {
        ASSERT_EQ(Run({"new", "other.ryn", "--yes", "DefineEVS.InputFileName=s.tsq0",
                       "Tsq2Input.Tsq2InputFile=grid.nc",
                       std::string("DefineEVS.OutputFileName=") + name}),
                  0)
            << err;
        const std::string before = files.Read(name);
        EXPECT_NE(Run({"run", "other.ryn"}), 0) << name;
        EXPECT_THAT(err, HasSubstr("Can not create output file"));
        EXPECT_EQ(files.Read(name), before) << name;
    }
}

TEST_F(RunCommandLine, ShowRefusesWhatIsNoTextPage) {
    EXPECT_EQ(Run({"show", "case.ryn", "--page", "11"}), 1);
    EXPECT_THAT(err, HasSubstr("page 11 cannot be shown"));
    EXPECT_THAT(out, Not(HasSubstr("page")));
}

} // namespace
} // namespace ryn::cli
