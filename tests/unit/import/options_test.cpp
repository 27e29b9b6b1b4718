#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "unit/import/import_fixture.h"

namespace ryn {
namespace {

using test::ExpectContains;
using test::Imported;

TEST(ImportOption, GivesAnAxisToValuesWithoutTimes) {
    ImportOptions options;
    options.start = "1914-01-30";
    options.step = "1d";
    EXPECT_EQ(Imported("rain\n0\n2.3\nNA\n1.3\n", options).Days(),
              "1914-01-30 0; 1914-01-31 2.3; 1914-02-02 1.3");
    options.step = "1mo"; // the day that a month lacks is its last
    EXPECT_EQ(Imported("wave,surge\n1,2\n3,4\n5,6\n", options).Days(),
              "1914-01-30 1; 1914-02-28 3; 1914-03-30 5");
    options.start = "1914-01-30 06:00";
    options.step = "10min";
    EXPECT_EQ(Imported("1.5\n2.5\n", options).Samples(),
              "1914-01-30 06:00:00 1.5; 1914-01-30 06:10:00 2.5");
}

TEST(ImportOption, CountsABlankLineAsMissingOnlyWhenTold) {
    ImportOptions options;
    options.start = "2001-01-01";
    options.step = "1d";
    options.missing = {""};
    EXPECT_EQ(Imported("rain\n1.5\n\n2.5\n", options).Days(), "2001-01-01 1.5; 2001-01-03 2.5");
    // Blank lines at the end are none.
    options.missing = {};
    EXPECT_EQ(Imported("rain\n1.5\n2.5\n\n\n", options).Days(), "2001-01-01 1.5; 2001-01-02 2.5");
}

TEST(ImportOption, TakesDecimalCommasInASingleColumn) {
    ImportOptions options;
    options.start = "2001-01-01";
    options.step = "1d";
    EXPECT_EQ(Imported("Regen\n1,5\n12,25\n0,5\n", options).Days(),
              "2001-01-01 1.5; 2001-01-02 12.25; 2001-01-03 0.5");
}

TEST(ImportOption, StartGivesThePartsThatTheColumnsLack) {
    ImportOptions options;
    options.start = "1949-07-01";
    const Imported july("Year,Day,Hour,Prec\n49,1,23,0.5\n49,1,24,1.5\n49,2,1,2.5\n", options);
    EXPECT_EQ(july.Samples(), "1949-07-01 23:00:00 0.5; 1949-07-02 00:00:00 1.5; "
                              "1949-07-02 01:00:00 2.5");
    ExpectContains(july.Report(), "the month is that of --start");
    options.start = "2000-10-01";
    EXPECT_EQ(Imported("Year,Peak\n1998,5\n1999,6\n", options).Days(),
              "1998-10-01 5; 1999-10-01 6");
    EXPECT_EQ(Imported("time,U\n0 days 00:10:00,8.5\n0 days 00:20:00,9\n", options).Samples(),
              "2000-10-01 00:10:00 8.5; 2000-10-01 00:20:00 9");
}

TEST(ImportOption, TimeFormatDecidesWhatTheTableLeavesOpen) {
    struct Case {
        const char* text;
        const char* format;
        const char* samples;
    };
    const Case cases[] = {
        {"d,v\n1/2/2001,1\n3/2/2001,2\n", "%d/%m/%Y", "2001-02-01 1; 2001-02-03 2"},
        {"d,v\n1/2/2001,1\n3/2/2001,2\n", "%m/%d/%Y", "2001-01-02 1; 2001-03-02 2"},
        {"v,d\n1,d98_001\n2,d98_365\n", "d%y_%j", "1998-01-01 1; 1998-12-31 2"},
        {"1 31.12.99 24:00\n2 01.01.00 01:00\n", "%d.%m.%y %H:%M",
         "2000-01-01 1; 2000-01-01 01:00:00 2"},
        {"d,v\n36526.5,1\n36527.04167,2\n", "excel",
         "2000-01-01 12:00:00 1; 2000-01-02 01:00:00 2"},
        {"d,v\n946684800,1\n946684801.5,2\n", "unix", "2000-01-01 1; 2000-01-01 00:00:01.500 2"},
        {"d,v\n2000.5,1\n2001,2\n", "decimal-year", "2000-07-02 1; 2001-01-01 2"},
        {"y,v\n1925/26,1\n1926/27,2\n", "%Y/%y", "1925-01-01 1; 1926-01-01 2"},
        {"d;v\nMi 01 mai 2001 2 PM;1\nDo 02 mai 2001 3 AM;2\n", "Mi %d %b %Y %I %p",
         "table.csv: no column reads as --time-format \"Mi %d %b %Y %I %p\"; name the column with "
         "--time"},
        {"d;v\n01 mai 2001 2 PM;1\n02 mai 2001 3 AM;2\n", "%d %b %Y %I %p",
         "2001-05-01 14:00:00 1; 2001-05-02 03:00:00 2"},
        {"d,v\n01 10,1\n02 10,2\n", "%d %H",
         "table.csv: --time-format \"%d %H\" has no year; give what it lacks with --start "
         "YYYY-MM-DD"},
    };
    for (const Case& given : cases) {
        ImportOptions options;
        options.timeFormat = given.format;
        EXPECT_EQ(Imported(given.text, options).Days(), given.samples) << given.format;
    }
}

TEST(ImportOption, JoinsTheColumnsThatTimeNames) {
    ImportOptions options;
    options.timeColumns = {"when", "3"};
    options.timeFormat = "%Y-%m-%d %H%M";
    EXPECT_EQ(Imported("when,v,clock\n2001-01-01,1,0630\n2001-01-01,2,1845\n", options).Samples(),
              "2001-01-01 06:30:00 1; 2001-01-01 18:45:00 2");
    options.timeFormat = "";
    options.timeColumns = {"1", "2"};
    EXPECT_EQ(Imported("2001-01-01 06:30 1\n2001-01-01 18:45 2\n", options).Samples(),
              "2001-01-01 06:30:00 1; 2001-01-01 18:45:00 2");
}

TEST(ImportOption, ChoosesItemsAndKeepsRowsInWhichAllAreThere) {
    const std::string text = "date\tQ\tPp\tGW\n1965-01-01\t30.6\t0.0\tNA\n"
                             "1965-02-01\tNA\t1.0\t12\n1965-03-01\t31.0\t2.0\t13\n";
    EXPECT_EQ(Imported(text).Days(), "1965-01-01 30.6; 1965-03-01 31");
    ExpectContains(Imported(text).Report(), "could be chosen with --item: 3 \"Pp\", 4 \"GW\"");
    ImportOptions options;
    options.itemColumns = {"GW", "2"};
    const Imported two(text, options);
    EXPECT_EQ(two.Days(), "1965-03-01 13 31");
    ExpectContains(two.Report(), "left out: 2 with a missing value (line 2, 3)");
}

TEST(ImportOption, NamesTheItemAndItsUnit) {
    ImportOptions options;
    options.name = "Discharge";
    options.unit = "m3/s";
    const Imported imported("t,Q [cfs]\n2001-01-01,1\n2001-01-02,2\n", options);
    EXPECT_EQ(imported.report.items[0].name, "Discharge");
    EXPECT_EQ(imported.report.items[0].unit, "m3/s");
    options.itemColumns = {"1", "2"};
    EXPECT_EQ(Imported("1,2\n", options).status.Text(),
              "--name names one item, and there are several --item");
}

TEST(ImportOption, OverridesDelimiterDecimalCommentAndEncoding) {
    ImportOptions options;
    options.delimiter = "~";
    options.decimal = ",";
    options.comment = "'";
    options.encoding = "latin-1";
    const Imported imported("' made by hand\nwann~H\xF6he\n2001-01-01~147,000\n2001-01-02~1,5\n",
                            options);
    EXPECT_EQ(imported.Days(), "2001-01-01 147; 2001-01-02 1.5");
    EXPECT_EQ(imported.report.items[0].name, "H\xC3\xB6he");
}

TEST(ImportOption, SortsAndMergesAsTold) {
    const std::string text = "t,v,w\n2001-01-02,1,8\n2001-01-03,5,1\n=======\n2001-01-01,9,9\n"
                             "2001-01-02,3,7\n";
    ImportOptions options;
    options.sort = true;
    ExpectContains(Imported(text, options).status.Text(), "a time is repeated in line 6");
    options.duplicates = "first";
    EXPECT_EQ(Imported(text, options).Days(), "2001-01-01 9; 2001-01-02 1; 2001-01-03 5");
    options.duplicates = "last";
    EXPECT_EQ(Imported(text, options).Days(), "2001-01-01 9; 2001-01-02 3; 2001-01-03 5");
    options.duplicates = "max";
    options.itemColumns = {"v", "w"};
    const Imported most(text, options);
    EXPECT_EQ(most.Days(), "2001-01-01 9 9; 2001-01-02 3 8; 2001-01-03 5 1");
    ExpectContains(most.Report(),
                   "left out: 1 of a time that another row has, merged with it (line 6)");
    ExpectContains(most.Report(), "left out: 1 that only divide (line 4)");
    options.sort = false;
    ExpectContains(Imported(text, options).status.Text(), "time runs backwards in line 5");
}

TEST(TableRows, AreLeftOutAndToldWhereTheyAreNoData) {
    const Imported imported("t,v\n2001-01-01,1\n,\nt,v\n2001-01-02,2\n-----\n2001-01-03,3\n"
                            "End of file\n(3 rows)\n");
    EXPECT_EQ(imported.Days(), "2001-01-01 1; 2001-01-02 2; 2001-01-03 3");
    for (const char* part :
         {"left out: 1 without content (line 3)", "left out: 1 that repeat the header (line 4)",
          "left out: 1 that only divide (line 6)",
          "left out: 2 of text behind the last row (line 8, 9)"})
        ExpectContains(imported.Report(), part);
}

} // namespace
} // namespace ryn
