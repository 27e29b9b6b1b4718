#include "command_fixture.h"
#include "import/import.h"

namespace ryn::cli {
namespace {

using testing::HasSubstr;
using ImportCommand = CommandTest;

TEST_F(ImportCommand, TakesItsOwnExportBackToTheByte) {
    const auto samples = test::SamplesOf(
        {{"1990-01-01", 3.25}, {"1990-01-01 06:00:30", 0.1}, {"1990-03-01", -7e-12}});
    ASSERT_TRUE(test::WriteDataFile(files.Path("s.tsq0"), samples, "Discharge", "m3/s"));
    ASSERT_EQ(Run({"export", "s.tsq0", "-o", "t.csv"}), 0) << err;
    ASSERT_EQ(Run({"import", "t.csv", "back.tsq0"}), 0) << err;
    EXPECT_THAT(out, HasSubstr("unit m3/s"));
    EXPECT_THAT(out, HasSubstr("saved back.tsq0\n"));
    ASSERT_EQ(Run({"export", "back.tsq0"}), 0) << err;
    EXPECT_EQ(out, files.Read("t.csv"));
}

TEST_F(ImportCommand, PassesEveryOptionOn) {
    files.Write("t.txt", "junk\n* remark\nday;clock;a;b\n01/02/2001;06.30;1,5;x\n"
                         "01/02/2001;06.45;-99;x\n31/01/2001;00.00;2,5;x\n"
                         "31/01/2001;00.00;3,5;x\n");
    ASSERT_EQ(Run({"import",
                   "t.txt",
                   "o.tsq0",
                   "--skip",
                   "1",
                   "--comment",
                   "*",
                   "--delimiter",
                   ";",
                   "--time",
                   "day",
                   "--time",
                   "2",
                   "--item",
                   "a",
                   "--time-format",
                   "%d/%m/%Y %H.%M",
                   "--decimal",
                   ",",
                   "--missing",
                   "-99",
                   "--unit",
                   "m",
                   "--name",
                   "Level",
                   "--encoding",
                   "latin-1",
                   "--sort",
                   "--duplicates",
                   "max",
                   "--json"}),
              0)
        << err;
    EXPECT_EQ(Json()["count"], 2);
    EXPECT_EQ(Json()["first"], "2001-01-31T00:00:00");
    EXPECT_EQ(Json()["items"][0]["name"], "Level");
    ASSERT_EQ(Run({"export", "o.tsq0"}), 0) << err;
    EXPECT_EQ(out, "time,Level [m]\n2001-01-31T00:00:00,3.5\n2001-02-01T06:30:00,1.5\n");
}

TEST_F(ImportCommand, GivesUnitsAndNamesToItemsInTheirOrder) {
    files.Write("t.csv", "time,a,b\n2001-01-01,1,10\n2001-01-02,2,20\n");
    const std::vector<std::string> start = {"import", "t.csv", "o.tsq0", "--yes",
                                            "--item", "b",     "--item", "a"};
    const auto importWith = [&](const std::vector<std::string>& more) {
        std::vector<std::string> arguments = start;
        arguments.insert(arguments.end(), more.begin(), more.end());
        return Run(arguments);
    };
    ASSERT_EQ(importWith({"--unit", "mm", "--unit", "m", "--name", "B", "--name", "A"}), 0) << err;
    ASSERT_EQ(Run({"export", "o.tsq0"}), 0);
    EXPECT_THAT(out, testing::StartsWith("time,B [mm],A [m]\n2001-01-01T00:00:00,10,1\n"));
    ASSERT_EQ(importWith({"--unit", "mm"}), 0) << err;
    ASSERT_EQ(Run({"export", "o.tsq0"}), 0);
    EXPECT_THAT(out, testing::StartsWith("time,b [mm],a [mm]\n"));
    EXPECT_EQ(importWith({"--unit", "mm", "--unit", "m", "--unit", "m"}), 1);
    EXPECT_EQ(err, "ryn: --unit: 3 given for 2 item(s); give one for each --item, in order\n");
    EXPECT_EQ(importWith({"--name", "A"}), 1);
    EXPECT_EQ(err, "ryn: --name: 1 given for 2 item(s); give one for each --item, in order\n");
}

TEST_F(ImportCommand, MakesAnAxisForATableWithoutTimes) {
    files.Write("t.txt", "1\n2\n4\n");
    ASSERT_EQ(Run({"import", "t.txt", "o.tsq0", "--start", "2001-12-31", "--step", "1d"}), 0)
        << err;
    ASSERT_EQ(Run({"info", "o.tsq0", "--json"}), 0) << err;
    EXPECT_EQ(Json()["axis"], "equidistant calendar");
    EXPECT_EQ(Json()["last"], "2002-01-02T00:00:00");
}

TEST_F(ImportCommand, KeepsAUnitThatNobodyKnowsAndSaysSo) {
    files.Write("t.csv", "time,v [furlong]\n2001-01-01,1\n2001-01-02,2\n");
    ASSERT_EQ(Run({"import", "t.csv", "o.tsq0"}), 0);
    EXPECT_EQ(err, "");
    ASSERT_EQ(Run({"import", "t.csv", "o.tsq0", "--unit", "blah", "--yes"}), 0);
    EXPECT_EQ(err, "ryn: note: t.csv: unit \"blah\" is not known; it is kept, and cannot be "
                   "converted\n");
    ASSERT_EQ(Run({"info", "o.tsq0", "--json"}), 0);
    EXPECT_EQ(Json()["items"][0]["unit"], "blah");
}

TEST_F(ImportCommand, WritesNothingWhenARowIsRefused) {
    files.Write("t.csv", "time,v\n2001-01-01,1\n2001-01-03,2\n2001-01-02,3\n");
    EXPECT_EQ(Run({"import", "t.csv", "o.tsq0"}), 1);
    EXPECT_THAT(err, testing::StartsWith("ryn: t.csv"));
    EXPECT_EQ(std::count(err.begin(), err.end(), '\n'), 1);
    EXPECT_EQ(files.EntryCount(), 1U);
}

TEST_F(ImportCommand, HearsHowMuchOfATableWasRead) {
    std::string table = "time,v\n";
    for (int year = 1000; year < 9000; ++year)
        table += std::to_string(year) + "-01-01 00:00:00," + std::to_string(year) + ".25\n";
    files.Write("t.csv", table);
    std::vector<long long> heard;
    ImportCallbacks callbacks;
    callbacks.progress = [&](long long done, long long total) {
        EXPECT_EQ(total, static_cast<long long>(table.size()));
        heard.push_back(done);
    };
    ImportReport report;
    ASSERT_TRUE(ImportFile("t.csv", "o.tsq0", {}, &report, callbacks));
    EXPECT_EQ(heard.back(), static_cast<long long>(table.size()));
    EXPECT_GE(heard.size(), 2U);
}

TEST_F(ImportCommand, ReplacesADataFileOnlyWithConsent) {
    files.Write("t.csv", "time,v\n2001-01-01,1\n2001-01-02,2\n");
    WriteYearly("o.tsq0", {1, 2, 3});
    const std::string before = files.Read("o.tsq0");
    EXPECT_EQ(Run({"import", "t.csv", "o.tsq0"}), 1);
    EXPECT_EQ(files.Read("o.tsq0"), before);
    EXPECT_EQ(Run({"import", "t.csv", "o.tsq0", "--yes"}), 0) << err;
    EXPECT_NE(files.Read("o.tsq0"), before);
}

} // namespace
} // namespace ryn::cli
