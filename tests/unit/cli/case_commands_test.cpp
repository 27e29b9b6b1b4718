#include <sys/stat.h>

#include "command_fixture.h"

namespace ryn::cli {
namespace {

using NewCommand = CommandTest;
using SetCommand = CommandTest;
using CheckCommand = CommandTest;

TEST_F(NewCommand, WritesSettingsCombinationsAndPeriods) {
    ASSERT_EQ(Run({"new", "case.ryn", "BasicInput.Threshold=12.5", "DefineEVS.Title=Neckar, W",
                   "--fit", "gev/lmom", "--fit", "LN3/MOM/BII", "--periods", "2,10,100"}),
              0)
        << err;
    EXPECT_EQ(out, "saved case.RYN\n");
    EXPECT_EQ(Saved("case.ryn", "/BasicInput/Threshold"), 12.5);
    EXPECT_EQ(Saved("case.ryn", "/DefineEVS/Title"), "Neckar, W");
    EXPECT_EQ(Saved("case.ryn", "/Analysis/EvaluatedReturnPeriods/Item"),
              nlohmann::ordered_json::array({2.0, 10.0, 100.0}));
    EXPECT_EQ(Saved("case.ryn", "/ProbabilityDistribution/Item1/ItemName"), "GEV/LMOM");
    const auto second = Saved("case.ryn", "/ProbabilityDistribution/Item2");
    EXPECT_EQ(second["DistributionType"], 7);
    EXPECT_EQ(second["EstimationMethod"], 0);
    EXPECT_EQ(second["EstimateLocationType"], 1);
    EXPECT_EQ(second["LogNormalType"], 1);
}

TEST_F(NewCommand, TakesTheKindOfSeriesFromTheSameCommandLineWhereverItStands) {
    EXPECT_EQ(Run({"new", "case.ryn", "--fit", "GP2/ML", "DefineEVS.SelectionMethod=1"}), 0) << err;
    EXPECT_EQ(Run({"new", "b.ryn", "DefineEVS.SelectionMethod=PDS", "--fit", "GEV/ML"}), 1);
    EXPECT_FALSE(files.Has("b.RYN"));
}

TEST_F(NewCommand, ReplacesAnExistingFileOnlyWithConsent) {
    ASSERT_EQ(Run({"new", "case.ryn", "DefineEVS.Title=old"}), 0);
    EXPECT_EQ(Run({"new", "case.RYN", "DefineEVS.Title=new"}), 1);
    EXPECT_EQ(Saved("case.ryn", "/DefineEVS/Title"), "old");
    EXPECT_EQ(Run({"new", "case.RYN", "DefineEVS.Title=new", "--yes"}), 0);
    EXPECT_EQ(Saved("case.ryn", "/DefineEVS/Title"), "new");
}

TEST_F(NewCommand, StoresFileNamesAsSeenFromTheParameterFile) {
    std::filesystem::create_directory(files.Path("down"));
    ASSERT_EQ(Run({"new", "down/case.ryn", "BasicInput.InputFileName=g.tsq0",
                   "BasicInput.OutputFileName=down/s.tsq0",
                   "DefineEVS.OutputFileName=" + files.Path("case.res")}),
              0);
    EXPECT_EQ(Saved("down/case.ryn", "/BasicInput/InputFileName"), "../g.tsq0");
    EXPECT_EQ(Saved("down/case.ryn", "/BasicInput/OutputFileName"), "s.tsq0");
    EXPECT_EQ(Saved("down/case.ryn", "/DefineEVS/OutputFileName"), "../case.res");
    EXPECT_EQ(std::filesystem::current_path(), files.Root());
}

TEST_F(NewCommand, TakesTheFirstItemOfAFileNamedWithoutOne) {
    ASSERT_EQ(Run({"new", "case.ryn", "BasicInput.InputFileName=g.tsq0"}), 0);
    EXPECT_EQ(Saved("case.ryn", "/BasicInput/InputItem"), 1);
    EXPECT_EQ(Saved("case.ryn", "/DefineEVS/InputItem"), 0);
    ASSERT_EQ(Run({"set", "case.ryn", "DefineEVS.InputFileName=s.tsq0", "DefineEVS.InputItem=3"}),
              0);
    EXPECT_EQ(Saved("case.ryn", "/DefineEVS/InputItem"), 3);
}

TEST_F(SetCommand, MakesOneFileOfTheLowerCaseSpelling) {
    ASSERT_EQ(Run({"new", "case.ryn"}), 0);
    std::filesystem::rename(files.Path("case.RYN"), files.Path("case.ryn"));
    ASSERT_EQ(Run({"set", "case.ryn", "DefineEVS.Title=T"}), 0) << err;
    EXPECT_EQ(out, "saved case.RYN\n");
    EXPECT_FALSE(files.Has("case.ryn"));
    ASSERT_EQ(Run({"set", "case.ryn", "DefineEVS.Subtitle=S"}), 0) << err;
    EXPECT_EQ(Saved("case.RYN", "/DefineEVS/Title"), "T");
    EXPECT_EQ(files.EntryCount(), 1U);
}

TEST_F(SetCommand, LeavesTwoFilesOfBothSpellingsAlone) {
    ASSERT_EQ(Run({"new", "case.ryn"}), 0);
    std::filesystem::copy(files.Path("case.RYN"), files.Path("case.ryn"));
    const std::string before = files.Read("case.RYN");
    EXPECT_EQ(Run({"set", "case.ryn", "DefineEVS.Title=T"}), 3);
    EXPECT_THAT(err, testing::HasSubstr("case.ryn"));
    EXPECT_THAT(err, testing::HasSubstr("case.RYN"));
    EXPECT_EQ(files.Read("case.RYN"), before);
    EXPECT_EQ(files.Read("case.ryn"), before);
}

TEST_F(SetCommand, ChangesNothingElse) {
    ASSERT_EQ(Run({"new", "case.ryn", "BasicInput.AmsStartDate=10-01", "--fit", "GUM/ML",
                   "Analysis.SplitDate.Date2=2001-04-01T06:30", "Analysis.SelectedPeriods.Item=1,2",
                   "Tsq2Input.X_Range_And_Interval=1,9,2"}),
              0)
        << err;
    const std::string before = files.Read("case.RYN");
    ASSERT_EQ(Run({"set", "case.ryn", "DefineEVS.Title=T"}), 0);
    EXPECT_NE(files.Read("case.RYN"), before);
    ASSERT_EQ(Run({"set", "case.ryn", "DefineEVS.Title="}), 0);
    EXPECT_EQ(files.Read("case.RYN"), before);
}

TEST_F(SetCommand, ReplacesTheListsOfCombinationsAndPeriods) {
    ASSERT_EQ(Run({"new", "case.ryn", "--fit", "GEV/ML", "--fit", "GUM/ML", "--periods", "2,5"}),
              0);
    ASSERT_EQ(Run({"set", "case.ryn", "--fit", "LN2/ML", "--periods", "1000"}), 0);
    EXPECT_EQ(Saved("case.ryn", "/ProbabilityDistribution/NoOfItems"), 1);
    EXPECT_EQ(Saved("case.ryn", "/ProbabilityDistribution/Item1/ItemName"), "LN2/ML");
    EXPECT_EQ(Saved("case.ryn", "/Analysis/EvaluatedReturnPeriods/Item"), 1000.0);
}

TEST_F(SetCommand, ReachesWhatANameOfACombinationDoesNotSay) {
    ASSERT_EQ(Run({"new", "case.ryn", "ProbabilityDistribution.Item1.SampleCorrection=true",
                   "ProbabilityDistribution.Item1.ItemName=Mine", "--fit", "GUM/MOM"}),
              0)
        << err;
    const auto item = Saved("case.ryn", "/ProbabilityDistribution/Item1");
    EXPECT_EQ(item["SampleCorrection"], true);
    EXPECT_EQ(item["ItemName"], "Mine");
    EXPECT_EQ(item["IsDefaultName"], true);
}

TEST_F(SetCommand, ExitsWithThreeWhereTheFileCannotBeWritten) {
    ASSERT_EQ(Run({"new", "case.ryn"}), 0);
    // A directory in the place of the file beside which the new one is written cannot be replaced.
    std::filesystem::remove(files.Path("case.RYN"));
    std::filesystem::create_directory(files.Path("case.RYN"));
    files.Write("case.ryn", "RynEditor {\n}\n");
    EXPECT_EQ(Run({"set", "case.ryn", "DefineEVS.Title=T"}), 3);
    EXPECT_THAT(err, testing::StartsWith("ryn: "));
    EXPECT_EQ(files.Read("case.ryn"), "RynEditor {\n}\n");
}

TEST_F(CheckCommand, ListsFindingsByPage) {
    ASSERT_EQ(Run({"new", "case.ryn", "BasicInput.SelectionMethod=PDS",
                   "BasicInput.InputFileName=no.tsq0", "BasicInput.Threshold=-1",
                   "BasicInput.RecordLength=20", "--periods", "1,10"}),
              0);
    EXPECT_EQ(Run({"check", "case.ryn"}), 1);
    EXPECT_EQ(out,
              "page 2 (Extract Extreme Value Series): Can not open input file\n"
              "page 2 (Extract Extreme Value Series): Threshold Level must be greater or equal to "
              "0\n"
              "page 3 (Define Extreme Value Series): Input file not specified\n"
              "page 3 (Define Extreme Value Series): Output file not specified\n"
              "page 4 (Analysis): Evaluated return period 1.000 must be greater than 1.000\n");
    EXPECT_EQ(err, "");
    EXPECT_EQ(Run({"check", "case.ryn", "--json"}), 1);
    EXPECT_EQ(Json().size(), 5U);
    EXPECT_EQ(Json()[4]["page"], 4);
}

TEST_F(CheckCommand, SpeaksJapaneseWhenAsked) {
    ASSERT_EQ(Run({"new", "case.ryn", "--lang", "ja"}), 0);
    EXPECT_EQ(out, "case.RYN を保存しました\n");
    EXPECT_EQ(Run({"check", "case.ryn", "--lang=ja"}), 1);
    EXPECT_THAT(out, testing::StartsWith("ページ 3（極値系列の定義）: "));
}

TEST_F(CheckCommand, FindsNothingWrongWithAWholeAnalysis) {
    WriteYearly("s.tsq0", {1, 2, 3, 4, 5, 6});
    ASSERT_EQ(Run({"new", "case.ryn", "DefineEVS.InputFileName=s.tsq0",
                   "DefineEVS.OutputFileName=case.res", "--fit", "GUM/ML"}),
              0);
    EXPECT_EQ(Run({"check", "case.ryn"}), 0);
    EXPECT_EQ(out, "case.RYN: no findings\n");
    EXPECT_EQ(Run({"check", "case.ryn", "--json"}), 0);
    EXPECT_EQ(out, "[]\n");
}

} // namespace
} // namespace ryn::cli
