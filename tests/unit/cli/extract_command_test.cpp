#include "apps/cli/extract_command.h"

#include "command_fixture.h"

namespace ryn::cli {
namespace {

using ExtractCommand = CommandTest;

/// One value a month; the largest of each year in its July. 1993 and 1994 have no sample.
test::Samples MonthlySamples() {
    test::Samples samples;
    for (int year = 1990; year <= 1997; ++year)
        for (int month = 1; month <= 12; ++month)
            if (year != 1993 && year != 1994)
                samples.push_back({COleDateTime(year, month, 15, 12, 0, 0),
                                   month == 7 ? year - 1900.0 : month, 0});
    return samples;
}

TEST_F(ExtractCommand, WritesTheSeriesTakesItOverAndSaves) {
    ASSERT_TRUE(test::WriteDataFile(files.Path("g.tsq0"), MonthlySamples()));
    ASSERT_EQ(Run({"new", "case.ryn", "BasicInput.InputFileName=g.tsq0",
                   "BasicInput.OutputFileName=ams.tsq0"}),
              0);
    ASSERT_EQ(Run({"extract", "case.ryn"}), 0) << err;
    EXPECT_EQ(out, files.Path("ams.tsq0") +
                       ": 6 values from 1990-07-15 12:00 to 1997-07-15 12:00\n"
                       "missing years: 1993-1994\n"
                       "DefineEVS.InputFileName changed from \"\" to \"" +
                       files.Path("ams.tsq0") +
                       "\"\n"
                       "DefineEVS.InputItem changed from \"0\" to \"1\"\n"
                       "DefineEVS.AvgAnNum changed from \"0\" to \"1\"\n"
                       "saved case.RYN\n");
    EXPECT_EQ(Saved("case.ryn", "/DefineEVS/InputFileName"), "ams.tsq0");
    EXPECT_EQ(Saved("case.ryn", "/ExtremeValueSection/ExtremeValues"),
              nlohmann::ordered_json::array({90.0, 91.0, 92.0, 95.0, 96.0, 97.0}));
    ASSERT_EQ(Run({"export", "ams.tsq0"}), 0);
    EXPECT_THAT(out, testing::HasSubstr("1995-07-15T12:00:00,95\n"));
}

TEST_F(ExtractCommand, TellsChangedParametersAsJsonToo) {
    ASSERT_TRUE(test::WriteDataFile(files.Path("g.tsq0"), MonthlySamples()));
    ASSERT_EQ(Run({"new", "case.ryn", "BasicInput.InputFileName=g.tsq0",
                   "BasicInput.OutputFileName=pds.tsq0", "BasicInput.SelectionMethod=PDS",
                   "BasicInput.PdsDataType=number", "BasicInput.AvgAnNum=50",
                   "BasicInput.RecordLength=6"}),
              0);
    ASSERT_EQ(Run({"extract", "case.ryn", "--json"}), 0) << err;
    EXPECT_EQ(err, "ryn: warning: Number of extracted peak values is smaller than requiered. "
                   "Parameters were changed to fit results.\n");
    const auto report = Json();
    std::vector<std::string> changed;
    for (const auto& change : report["changed"])
        changed.push_back(change["name"]);
    EXPECT_THAT(changed, testing::ElementsAre("BasicInput.Threshold", "BasicInput.AvgAnNum",
                                              "DefineEVS.SelectionMethod",
                                              "DefineEVS.InputFileName", "DefineEVS.InputItem",
                                              "DefineEVS.Threshold", "DefineEVS.AvgAnNum"));
    EXPECT_GT(Json()["count"], 0);
    EXPECT_TRUE(Json()["missingYears"].empty());
}

TEST_F(ExtractCommand, SavesAnEmptySelection) {
    WriteYearly("g.tsq0", {1, 2, 3});
    ASSERT_EQ(Run({"new", "case.ryn", "BasicInput.InputFileName=g.tsq0",
                   "BasicInput.OutputFileName=pds.tsq0", "BasicInput.SelectionMethod=PDS",
                   "BasicInput.Threshold=10"}),
              0);
    ASSERT_EQ(Run({"extract", "case.ryn"}), 0) << err;
    EXPECT_THAT(
        out, testing::StartsWith(files.Path("pds.tsq0") + ": no values; the selection is empty\n"));
    ASSERT_EQ(Run({"info", "pds.tsq0", "--json"}), 0) << err;
    EXPECT_EQ(Json()["count"], 0);
}

TEST_F(ExtractCommand, ChangesNothingWhenItIsRefused) {
    WriteYearly("g.tsq0", {1, 2, 3});
    ASSERT_EQ(Run({"new", "case.ryn", "BasicInput.InputFileName=g.tsq0",
                   "BasicInput.OutputFileName=g.tsq0"}),
              0);
    const std::string analysis = files.Read("case.RYN");
    const std::string series = files.Read("g.tsq0");
    EXPECT_EQ(Run({"extract", "case.ryn"}), 1);
    EXPECT_EQ(err, "ryn: case.RYN: The extreme value series would replace its own input file; "
                   "choose another output file: " +
                       files.Path("g.tsq0") + "\n");
    EXPECT_EQ(files.Read("case.RYN"), analysis);
    EXPECT_EQ(files.Read("g.tsq0"), series);
}

TEST_F(ExtractCommand, ExitsWithThreeWhereTheSeriesCannotBeWritten) {
    WriteYearly("g.tsq0", {1, 2, 3});
    ASSERT_EQ(Run({"new", "case.ryn", "BasicInput.InputFileName=g.tsq0",
                   "BasicInput.OutputFileName=no/ams.tsq0"}),
              0);
    EXPECT_EQ(Run({"extract", "case.ryn"}), 3);
    EXPECT_EQ(err, "ryn: case.RYN: Can not open output file for extraction: " +
                       files.Path("no/ams.tsq0") + ": No such file or directory\n");
}

TEST(YearRanges, GatherYearsInARow) {
    EXPECT_EQ(YearRanges({}), "");
    EXPECT_EQ(YearRanges({1961}), "1961");
    EXPECT_EQ(YearRanges({1961, 1963, 1964, 1965, 1970}), "1961, 1963-1965, 1970");
}

} // namespace
} // namespace ryn::cli
