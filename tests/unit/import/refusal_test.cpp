#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "import/line_reader.h"
#include "unit/import/import_fixture.h"

namespace ryn {
namespace {

using test::Imported;

struct Refusal {
    std::string text;
    std::string reason; ///< the whole message behind the table's name
    ImportOptions options = {};
};

void CheckAll(const std::vector<Refusal>& refusals) {
    for (const Refusal& refusal : refusals) {
        SCOPED_TRACE(refusal.text.substr(0, 200));
        const Imported imported(refusal.text, refusal.options);
        EXPECT_EQ(imported.status.Kind(), Fault::Input);
        EXPECT_EQ(imported.status.Text(), "table.csv: " + refusal.reason);
    }
}

/// A good table of daily values with one row put in its place, line 4.
std::string WithRow(const std::string& row) {
    return "time,q,w\n2001-01-01,1.5,0\n2001-01-02,2.5,0\n" + row +
           "\n2001-01-04,4.5,0\n2001-01-05,5.5,0\n2001-01-06,6.5,0\n2001-01-07,7.5,0\n";
}

TEST(TableRefusal, NamesTheLineOfAValueThatIsNone) {
    CheckAll({
        {WithRow("2001-01-03,abc,0"), "line 4: \"abc\" in column 2 \"q\" is no number; if it marks "
                                      "a missing value say so with --missing"},
        {WithRow("2001-01-03,inf,0"), "line 4: \"inf\" in column 2 \"q\" is not finite"},
        {WithRow("2001-01-03,-Infinity,0"),
         "line 4: \"-Infinity\" in column 2 \"q\" is not finite"},
        {WithRow("2001-01-03,1e999,0"),
         "line 4: \"1e999\" in column 2 \"q\" is too large for a 32-bit number"},
        {WithRow("2001-01-03,-3.5e38,0"),
         "line 4: \"-3.5e38\" in column 2 \"q\" is too large for a 32-bit number"},
        {WithRow("2001-01-03,\"1,234.5\",0"), "line 4: \"1,234.5\" in column 2 \"q\" has thousands "
                                              "separators, which are not read; export the table "
                                              "without them"},
        {WithRow("2001-01-03,1 234,0"), "line 4: \"1 234\" in column 2 \"q\" has thousands "
                                        "separators, which are not read; export the table "
                                        "without them"},
        {WithRow("2001-01-03,1.2.3,0"), "line 4: \"1.2.3\" in column 2 \"q\" is no number"},
        {WithRow("2001-01-03,<0.5,0"),
         "line 4: \"<0.5\" in column 2 \"q\" is a bound and not a value; leave such rows out with "
         "--missing \"<\", or edit them"},
        {WithRow("2001-01-03,########,0"),
         "line 4: \"########\" in column 2 \"q\" is what a spreadsheet writes where a column is "
         "too narrow; widen it and export again"},
        {WithRow("########,3.5,0"),
         "line 4: \"########\" in column 1 \"time\" is what a spreadsheet writes where a column is "
         "too narrow; widen it and export again"},
        {WithRow("########,########,########"),
         "line 4: \"########\" in column 1 \"time\" is what a spreadsheet writes where a column is "
         "too narrow; widen it and export again"},
        {"d;q\n#####;1,5\n2001-01-02;2\n#####;3\n",
         "line 2: \"#####\" in column 1 \"d\" is what a spreadsheet writes where a column is too "
         "narrow; widen it and export again"},
        {"d,q,t\n2001-01-01,####,1\n2001-01-02,####,2\n",
         "line 2: \"####\" in column 2 \"q\" is what a spreadsheet writes where a column is too "
         "narrow; widen it and export again"},
        {"q\n####\n1.5\n2.5\n",
         "line 2: \"####\" in column 1 \"q\" is what a spreadsheet writes where a column is too "
         "narrow; widen it and export again",
         [] {
             ImportOptions options;
             options.start = "1914-01-01";
             options.step = "1d";
             return options;
         }()},
        {WithRow("2001-01-03"), "line 4: ends before column 2 \"q\"; if the value is missing there "
                                "say --missing \"\""},
    });
}

TEST(TableRefusal, NamesTheLineOfATimeThatIsNone) {
    CheckAll({
        {WithRow("2001-02-30,3.5,0"),
         "line 4: \"2001-02-30\" is no time of the form year-month-day"},
        {WithRow("2001-01-03 25:00,3.5,0"),
         "line 4: \"2001-01-03 25:00\" is no time of the form year-month-day"},
        {WithRow(",3.5,0"), "line 4: \"\" is no time of the form year-month-day"},
        {WithRow("0099-01-01,3.5,0"),
         "line 4: \"0099-01-01\" is no time of the form year-month-day"},
        {WithRow("Station moved upstream,,"),
         "lines 2-3 and 5-8 look like two tables, with something else between; take that out, or "
         "give the lines before the one to take with --skip"},
        {WithRow("2001-01-03T00:00Z,3.5,0"),
         "line 2: the time has no offset from UTC, and the one in line 4 has"},
        {"a,b\n2001-01-01,1\n2001-13-02,2\n2001-01-03,3\n2001-14-03,3\n2001-01-05,3\n",
         "line 3: \"2001-13-02\" is no time of the form year-month-day (2 rows cannot be read: "
         "lines 3, 5)"},
        {"year,q\n1901,3\n1902,4\n19031,5\n", "line 4: \"19031\" is no time of the form year"},
        // One fault does not drop the times of day.
        {"d,clock,q\n2001-01-01,12:30,1\n2001-01-01,24:30,2\n2001-01-02,13:30,3\n",
         "line 3: \"2001-01-01 24:30\" is no time of the form year-month-day"},
        {"d,Uhrzeit,q\n2001-01-01,noon,1\n2001-01-02,dusk,2\n",
         "line 2: \"noon\" in column 2 \"Uhrzeit\" is no time of day; tell its form with --time "
         "and "
         "--time-format, or leave the times of day out by naming the date alone with --time"},
        {"d,time,q\n2001-01-01,0.25,1\n2001-01-01,0.75,2\n",
         "line 2: \"0.25\" in column 2 \"time\" is no time of day; tell its form with --time and "
         "--time-format, or leave the times of day out by naming the date alone with --time"},
        // A faulty first row is no header.
        {"time,q\n2001-02-30,1\n2001-03-01,2\n2001-03-02,3\n2001-03-03,4\n2001-03-04,5\n",
         "line 2: \"2001-02-30\" is no time of the form year-month-day"},
    });
}

TEST(TableRefusal, NamesRowsAboveTheTableWhoseTimeIsWrittenOtherwise) {
    const std::string days = "2001-01-01;5\n2001-01-02;6\n2001-01-03;7\n2001-01-04;5\n";
    CheckAll({
        {"date;q\nQ1 1950;300\nQ2 1950;280\n" + days,
         "line 2: \"Q1 1950\" in column 1 is not written as in the rows from line 4 on, but the "
         "line looks like one of them (2 such lines, up to 3); write them alike, or leave out what "
         "is none with --skip 3"},
        {"year;q\n1961-62;345\n1963;210\n1964;310\n1965;310\n1966;310\n1967;310\n",
         "line 2: \"1961-62\" in column 1 is not written as in the rows from line 3 on, but the "
         "line "
         "looks like one of them; write them alike, or leave out what is none with --skip 2"},
    });
    EXPECT_TRUE(Imported("Gauge 12;x\nGauge zero;12.5\nArea in km;300\ndate;q\n" + days).status);
}

TEST(TableRefusal, CountsTheRowsThatCannotBeRead) {
    std::string text = "time,q\n";
    for (int day = 10; day < 30; ++day)
        text += "2001-01-" + std::to_string(day) + (day < 14 || day > 19 ? ",5.5\n" : ",5.5.5\n");
    EXPECT_EQ(Imported(text).status.Text(),
              "table.csv: line 6: \"5.5.5\" in column 2 \"q\" is no number (6 rows cannot be read: "
              "lines 6, 7, 8, 9, 10, 11)");
}

TEST(TableRefusal, SaysWhatToGiveWhereTheTableLeavesItOpen) {
    ImportOptions twoTables;
    CheckAll({
        {"rain\n0\n2.3\n1.3\n",
         "no column holds dates or times; name one with --time (and --time-format, such as excel "
         "or "
         "unix), or give the time of the first row and the step with --start DATE --step S"},
        {"Year,Day,Hour,Prec\n49,1,2,0\n49,1,3,0\n49,1,24,5\n",
         "the columns give year and day but no month; give it with --start YYYY-MM-DD (the date of "
         "the first row)"},
        {"d,v\n1/2/2001,1\n3/4/2001,2\n",
         "the dates may be day-month-year or month-day-year, and no row decides; tell which with "
         "--time-format, such as %d/%m/%Y or %m/%d/%Y"},
        {"year,v\n1999/00,5\n2000/01,6\n2001/02,7\n",
         "line 2: \"1999/00\" and the like in column 1 \"year\" are hydrological years, not "
         "months; take the year in which each begins with --time-format %Y/%y (and its first day "
         "with --start, such as 1999-10-01)"},
        {"NA;4\n1960-1961;5\n1961-1962;6\n",
         "line 2: \"1960-1961\" and the like in column 1 are hydrological years, not months; take "
         "the year in which each begins with --time-format %Y-%Y (and its first day with --start, "
         "such as 1999-10-01)"},
        {"d;v\n2001-01-01;147,000\n2001-01-02;152,500\n2001-01-03;160,250\n",
         "line 2: the comma in \"147,000\", column 2 \"v\", may part decimals or thousands; if it "
         "is "
         "a decimal comma say so with --decimal , (thousands separators are not read)"},
        {"d;v\n2001-01-01;377\n2001-01-02;754 e\n2001-01-03;1.131 e\n2001-01-04;1.224\n",
         "line 4: the point in \"1.131\", column 2 \"v\", may part decimals or thousands (line 2 "
         "has "
         "\"377\" without one); if it is a decimal point say so with --decimal . (thousands "
         "separators are not read)"},
        {"date,q\n2001-01-01,10,0\n2001-01-02,11,7\n2001-01-03,12,4\n",
         "line 2 has a field more than the names above it: a decimal comma may part its numbers; "
         "write decimal points, or say --decimal . if they are whole numbers"},
        {"year,q\n1901,10,05\n1902,11,71\n1903,12,43\n",
         "line 2 has a field more than the names above it: a decimal comma may part its numbers; "
         "write decimal points, or say --decimal . if they are whole numbers"},
        {"start;end;comment\n2001-01-01;2001-02-01;\n2002-01-01;2002-02-01;\n",
         "no column holds measured numbers; name one with --item if there is"},
        {"rain\n0\n2.3\n\n1.3\n",
         "line 4: is blank: without a column of times it cannot be told whether a value is missing "
         "there; if so say --missing \"\"",
         [] {
             ImportOptions options;
             options.start = "1914-01-01";
             options.step = "1d";
             return options;
         }()},
    });
}

/// Rows of the same number under so many titles.
std::string Wide(const std::string& titles, const std::vector<std::string>& times, int columns) {
    std::string text = titles;
    for (const std::string& time : times) {
        text += time;
        for (int i = 0; i < columns; ++i)
            text += "," + std::to_string(i) + ".5";
        text += "\n";
    }
    return text;
}

TEST(TableRefusal, RefusesOneColumnForEachDayMonthOrHour) {
    const auto counted = [](std::string titles, const std::string& stem, int count) {
        for (int i = 1; i <= count; ++i)
            titles += "," + stem + std::to_string(i);
        return titles + "\n";
    };
    const auto reason = [](const std::string& part, const std::string& columns) {
        return "line 1: the table has one column for each " + part + ", " + columns +
               "; bring it into one row for each " + part +
               " first, or take one of the columns with --item";
    };
    CheckAll({
        {Wide(counted("year,month", "d", 31), {"1961,1", "1961,2", "1961,3"}, 31),
         reason("day", "\"d1\" to \"d31\"")},
        {Wide(counted("month", "", 31), {"1961-01", "1961-02", "1961-03"}, 31),
         reason("day", "\"1\" to \"31\"")},
        {Wide(counted("year", "", 12), {"1961", "1962", "1963", "1964", "1965"}, 12),
         reason("month", "\"1\" to \"12\"")},
        {Wide("year,Oct,Nov,Dec,Jan,Feb,Mar,Apr,May,Jun,Jul,Aug,Sep\n", {"1961", "1962", "1963"},
              12),
         reason("month", "\"Oct\" to \"Sep\"")},
        {Wide("", {"1961", "1962", "1963"}, 12), reason("month", "2 to 13")},
        {Wide(counted("date", "h", 24), {"1961-01-01", "1961-01-02"}, 24),
         reason("hour", "\"h1\" to \"h24\"")},
    });
    ImportOptions first;
    first.itemColumns = {"d1"};
    EXPECT_EQ(
        Imported(Wide(counted("year,month", "d", 31), {"1961,1", "1961,2"}, 31), first).Days(),
        "1961-01-01 0.5; 1961-02-01 0.5");
    // As many columns of another kind: a date has no thirty-one days.
    EXPECT_TRUE(Imported(Wide(counted("date", "d", 31), {"1961-01-01", "1961-01-02"}, 31)).status);
}

TEST(TableRefusal, RefusesACommaThatMayPartTheDecimals) {
    const auto pair = [](const std::string& text, const std::string& columns) {
        return "line 1: \"" + text + "\" may be one number with a decimal comma, or columns " +
               columns + "; write decimal points, or name the column with --item if they are two";
    };
    CheckAll({
        {"1961-01-01,3,45\n1961-01-02,2,05\n1961-01-03,12,10\n", pair("3,45", "2 and 3")},
        {"1961,3,4\n1962,2,0\n1963,12,1\n", pair("3,4", "2 and 3")},
        {"1961-01-01,3,45\n1961-01-02,2\n1961-01-03,2,5\n1961-01-04,12,125\n1961-01-05,4\n",
         pair("3,45", "2 and 3")},
        // A whole part that never changes looks like a label.
        {"1961-01-01,1,45\n1961-01-02,1,05\n1961-01-03,1,10\n1961-01-04,1,31\n",
         pair("1,45", "2 and 3")},
        {"date,q\n1961-01-01,3\n1961-01-02,2\n1961-01-03,3,5\n1961-01-04,3\n1961-01-05,3\n",
         "line 4: has 3 fields where the table has 2: \"3,5\" may be one number; write it without "
         "the comma, or say --decimal . if it is two"},
        {"date q\n1961-01-01 3\n1961-01-02 2\n1961-01-03 1 234\n1961-01-04 3\n1961-01-05 3\n",
         "line 4: has 3 fields where the table has 2: \"1 234\" may be one number; write it "
         "without the blanks, or say --decimal . if it is two"},
    });
    ImportOptions second;
    second.itemColumns = {"3"};
    EXPECT_EQ(Imported("1961-01-01,3,45\n1961-01-02,2,12\n", second).Days(),
              "1961-01-01 45; 1961-01-02 12");
}

TEST(TableRefusal, RefusesThousandsSeparatorsRatherThanMisreadThem) {
    CheckAll({
        {"Timestamp,Stage (ft)\n1/1/2000 12:00:00 AM,\"1,005.80\"\n"
         "1/13/2000 1:00:00 PM,\"1,014.01\"\n",
         "line 2: \"1,005.80\" in column 2 \"Stage\" has thousands separators, which are not read; "
         "export the table without them (2 rows cannot be read: lines 2, 3)"},
        {"d;v\n2001-01-01;999,5\n2001-01-02;1.002,25\n2001-01-03;12,5\n2001-01-04;3,5\n",
         "line 3: \"1.002,25\" in column 2 \"v\" has thousands separators, which are not read; "
         "export the table without them"},
    });
}

TEST(TableRefusal, TellsStepsThatDoNotRise) {
    CheckAll({
        {"t,v\n2001-01-01,1\n2001-01-02,2\n2001-01-02,3\n2001-01-03,4\n",
         "a time is repeated in line 4 (choose with --duplicates first, last or max); first: "
         "2001-01-02 00:00:00 after 2001-01-02 00:00:00"},
        {"t,v\n2001-01-01,1\n2001-01-02,2\n=======\n2001-01-01,3\n2001-01-02,4\n",
         "time runs backwards in line 5 (allow it with --sort); first: 2001-01-01 00:00:00 after "
         "2001-01-02 00:00:00"},
    });
}

TEST(TableRefusal, RefusesSeveralSeriesInOneTable) {
    const std::string rest = "; write a table for each (or take the column out where all are one "
                             "series)";
    ImportOptions sorted;
    sorted.sort = true;
    sorted.duplicates = "max";
    CheckAll({
        {"station,date,q\nA,2001-01-01,1\nA,2001-01-02,2\nB,2002-01-01,3\nB,2002-01-02,4\n",
         "line 4: \"B\" in column 1 \"station\" is another series than \"A\" in line 2" + rest},
        {"Datum;Messgröße;Wert\n1.1.2001 00:00;W;1\n1.1.2001 01:00;Q;2\n1.1.2001 02:00;W;3\n"
         "1.1.2001 03:00;T;4\n13.1.2001 00:00;Q;2\n",
         "line 3: \"Q\" in column 2 \"Messgröße\" is another series than \"W\" in line 2 (3 in "
         "all)" +
             rest},
        {"観測所,d,q\nx,2001-01-01,1\n,2001-01-02,2\n"
         "y,2002-01-01,3\n,2002-01-02,4\n",
         "line 4: \"y\" in column 1 \"観測所\" is another "
         "series than \"x\" in line 2" +
             rest},
        {"site_no,d,q\n11,2001-01-01,1\n11,2001-01-02,2\n12,2001-01-01,3\n12,2001-01-03,4\n",
         "line 4: \"12\" in column 1 \"site_no\" is another series than \"11\" in line 2" + rest,
         sorted},
        {"Rees;2001-01-01;1.5\nRees;2001-01-02;2\nEmmerich;2001-02-01;3\nEmmerich;2001-02-02;4\n",
         "line 3: \"Emmerich\" in column 1 is another series than \"Rees\" in line 1" + rest},
    });
    // Flags, constant names, row numbers and measurements of a place are no names of series.
    for (const char* rows :
         {"station,d,q,flag\nA,2001-01-01,1,e\nA,2001-01-02,2,e\nA,2001-01-03,3,g\n",
          "d,q,quality code\n2001-01-01,1,10\n2001-01-02,2,10\n2001-01-03,3,20\n",
          "2001-01-01,1,provisional\n2001-01-02,2,provisional\n2001-01-03,3,final\n",
          "d,q,station pressure\n2001-01-01,1,10\n2001-01-02,2,10\n2001-01-03,3,11\n",
          "id,d,q\nx1,2001-01-01,1\nx2,2001-01-02,2\nx3,2001-01-03,3\n",
          "Mo,2001-01-01,1\nDi,2001-01-02,2\nMo,2001-01-03,3\n"})
        EXPECT_EQ(Imported(rows).Days(), "2001-01-01 1; 2001-01-02 2; 2001-01-03 3") << rows;
}

TEST(TableRefusal, RefusesTwoTablesInOneFile) {
    std::string text = "t,v\n";
    for (int day = 10; day < 22; ++day)
        text += "2001-01-" + std::to_string(day) + ",5\n";
    text += "Second gauge,of the same river\n";
    for (int day = 10; day < 28; ++day)
        text += "2002-01-" + std::to_string(day) + ",5\n";
    EXPECT_EQ(Imported(text).status.Text(),
              "table.csv: lines 2-13 and 15-32 look like two tables, with something else between; "
              "take that out, or give the lines before the one to take with --skip");
    ImportOptions second;
    second.skipLines = 14;
    EXPECT_EQ(Imported(text, second).samples.Count(), 18U);
}

TEST(TableRefusal, NamesTextBetweenRowsBehindTheHead) {
    std::string text = "t,v\n";
    for (int i = 0; i < 3000; ++i)
        text += DateText(i * kMillisPerDay) + ",5\n";
    text += "Station moved upstream\n" + DateText(3000 * kMillisPerDay) + ",5\n";
    EXPECT_EQ(Imported(text).status.Text(),
              "table.csv: line 3002: \"Station moved upstream\" stands between rows and is none");
}

TEST(TableRefusal, RefusesWhatIsNoTable) {
    CheckAll({
        {"", "is empty"},
        {"\n\n  \n", "has no lines with text"},
        {"time,q\n", "no rows with numbers were found"},
        {"once upon a time\nthere was a river\n", "no rows with numbers were found"},
        {"x;1.5 e\ny;1.5 e\nz;1.5 e\nfoo bar\nw;2\n", "no rows with numbers were found"},
        {"t,v\n2001-01-01,NA\n2001-01-02,NA\n", "no column holds measured numbers; name one with "
                                                "--item if there is"},
        {std::string("t,v\n2001-01-01,1\n2001-01-02,\0", 29) + "1\n",
         "line 3: holds a NUL byte; this is no text (for UTF-16 give the encoding)"},
    });
}

TEST(TableRefusal, NamesTheLineWhereAQuoteOpensThatNeverCloses) {
    std::string text = "t,v,c\n2001-01-01,1,a\n2001-01-02,2,\"b\n";
    for (int i = 0; i < 100000; ++i)
        text += "2001-01-03,3,c\n";
    EXPECT_EQ(Imported(text).status.Text(),
              "table.csv: line 3: a quote opens that is never closed");
    std::string many = "t,v,c\n2001-01-01,1,a\n2001-01-02,2,\"b\n";
    for (int i = 0; i < 100000; ++i)
        many += "2001-01-03,3,\"\"\"c\n"; // opens and closes in turns, and is never done
    EXPECT_FALSE(Imported(many).status);
}

/// A line that never ends.
class EndlessLine : public TextSource {
  public:
    Status Read(char* buffer, std::size_t size, std::size_t* got) override {
        std::fill(buffer, buffer + size, 'x');
        *got = size;
        bytes += size;
        return Status::Ok();
    }
    Status Rewind() override { return Status::Ok(); }
    const std::string& Name() const override { return name; }

    std::size_t bytes = 0;

  private:
    std::string name = "endless";
};

TEST(TableRefusal, GivesUpOnAnEndlessLineBeforeItFillsTheMemory) {
    EndlessLine source;
    TableSamples samples;
    ImportReport report;
    const Status status = ImportTable(source, {}, "x", &samples, &report);
    EXPECT_EQ(status.Text(), "endless: line 1: longer than 1048576 bytes; this is no table");
    EXPECT_LT(source.bytes, 4 * LineReader::kLongestLine);
}

TEST(TableRefusal, PassesOnAReadError) {
    class Broken : public EndlessLine {
        Status Read(char* /*buffer*/, std::size_t /*size*/, std::size_t* /*got*/) override {
            return Status::SystemFault("the disk is gone");
        }
    } source;
    TableSamples samples;
    ImportReport report;
    const Status status = ImportTable(source, {}, "x", &samples, &report);
    EXPECT_EQ(status.Kind(), Fault::System);
    EXPECT_EQ(status.Text(), "the disk is gone");
}

TEST(TableRefusal, SurvivesATableCutAtEveryByte) {
    const std::string whole = "\xEF\xBB\xBF# no data: -99\r\ntime;\"Q \"\"x\"\"\nz [m3/s]\";c\r\n"
                              "01.02.2001 10:00;1,5;\"a;b\"\r\n02.02.2001 10:00;-99;\r\n"
                              "13.02.2001 24:00;3,5 e;\"c\nd\"\r\n";
    for (std::size_t size = 0; size <= whole.size(); ++size) {
        const Imported imported(std::string_view(whole).substr(0, size));
        EXPECT_EQ(imported.status.IsOk(),
                  imported.samples.Count() > 0 && imported.status.Text().empty())
            << size;
        EXPECT_EQ(imported.status.Text().find('\n'), std::string::npos);
    }
    EXPECT_EQ(Imported(whole).Samples(), "2001-02-01 10:00:00 1.5; 2001-02-14 00:00:00 3.5");
}

TEST(ImportOption, IsRefusedWithWhatItMayBe) {
    struct Case {
        std::string ImportOptions::*option;
        const char* value;
        const char* reason;
    };
    const Case cases[] = {
        {&ImportOptions::delimiter, "ab",
         "--delimiter \"ab\": one character that is no letter and no digit, or comma, semicolon, "
         "tab, bar, blank"},
        {&ImportOptions::decimal, ";", "--decimal \";\": \".\" or \",\""},
        {&ImportOptions::encoding, "ebcdic",
         "--encoding \"ebcdic\": utf-8, latin-1, windows-1252, utf-16le, utf-16be, shift_jis or "
         "euc-jp"},
        {&ImportOptions::start, "yesterday",
         "--start \"yesterday\": a date such as 1914-01-01 or \"1914-01-01 06:00\""},
        {&ImportOptions::step, "1d", "--step needs --start: the date of the first row"},
        {&ImportOptions::timeFormat, "%Q",
         "--time-format \"%Q\": %Q is no field of a time; use fields such as %Y-%m-%d %H:%M, or "
         "excel, unix, decimal-year, year"},
        {&ImportOptions::timeFormat, "year-month",
         "--time-format \"year-month\": it has no field such as %Y; use fields such as %Y-%m-%d "
         "%H:%M, or excel, unix, decimal-year, year"},
        {&ImportOptions::duplicates, "mean", "--duplicates \"mean\": refuse, first, last or max"},
    };
    for (const Case& wrong : cases) {
        ImportOptions options;
        options.*wrong.option = wrong.value;
        EXPECT_EQ(Imported("t,v\n2001-01-01,1\n", options).status.Text(), wrong.reason);
    }
}

TEST(ImportOption, IsRefusedWhereTheTableHasNoSuchColumn) {
    const std::string text = "time,q [mm],q\n2001-01-01,1,2\n2001-01-02,3,4\n";
    const auto refusal = [&text](const std::vector<std::string>& items, const std::string& time) {
        ImportOptions options;
        options.itemColumns = items;
        if (!time.empty())
            options.timeColumns = {time};
        return Imported(text, options).status.Text();
    };
    EXPECT_EQ(refusal({"w"}, ""),
              "table.csv: --item \"w\": no such column; there are 1 \"time\", 2 "
              "\"q\", 3 \"q\"");
    EXPECT_EQ(refusal({"1"}, ""), "table.csv: --item \"1\": column 1 \"time\" holds no numbers");
    EXPECT_EQ(refusal({"2", "q"}, ""), "table.csv: --item \"q\" names a column twice");
    EXPECT_EQ(refusal({}, "4"), "table.csv: --time \"4\": no such column; there are 1 \"time\", 2 "
                                "\"q\", 3 \"q\"");
    EXPECT_EQ(refusal({}, "2"), "table.csv: column 2 \"q\" does not read as time; tell its form "
                                "with --time-format");
}

} // namespace
} // namespace ryn
