#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "unit/import/import_fixture.h"

namespace ryn {
namespace {

using test::ExpectContains;
using test::Imported;

/// A daily table of these values.
std::string Daily(const std::vector<std::string>& values, const std::string& head = "t,v\n") {
    std::string text = head;
    int day = 1;
    for (const std::string& value : values) {
        const std::string number = std::to_string(day++);
        text += number.size() < 2 ? "2001-01-0" : "2001-01-";
        text.append(number).append(",").append(value).append("\n");
    }
    return text;
}

/// The values that stay.
std::string Kept(const Imported& imported) {
    std::string text = imported.status.Text();
    for (std::size_t i = 0; i < imported.samples.Count(); ++i)
        text += (i > 0 ? " " : "") + ShortestText(imported.samples.values[0][i]);
    return text;
}

TEST(MissingValue, IsKnownByItsUsualWords) {
    const std::string latin = std::string("l\xFC") + "cke";
    const Imported imported(
        Daily({"1",   "",      "NA",  "nan", "NULL", "-",   "--",  "***", "ND", "M",
               "Ice", "Lücke", latin, ".",   "2",    "3",   "4",   "5",   "6",  "7",
               "8",   "9",     "n/a", "1.5", "2.5",  "3.5", "4.5", "5.5"}));
    EXPECT_EQ(Kept(imported), "1 2 3 4 5 6 7 8 9 1.5 2.5 3.5 4.5 5.5");
    ExpectContains(imported.Report(), "missing: empty, once");
    ExpectContains(imported.Report(), "missing: \"NULL\", once");
    ExpectContains(imported.Report(), "left out: 14 with a missing value (line 3, 4, 5");
}

TEST(MissingValue, IsANumberOnlyWhereThatIsUnmistakable) {
    struct Case {
        const char* why;
        std::vector<std::string> values;
        std::string kept;
        const char* report;
    };
    const Case cases[] = {
        {"a negative code in a series without negative values",
         {"5", "-999", "7", "3000"},
         "5 7 3000",
         "missing: \"-999\", once (far from all other values"},
        {"far below a series that has negative values",
         {"-177", "294", "-999", "5", "-999"},
         "-177 294 5",
         "missing: \"-999\", 2 times"},
        {"two codes", {"1.5", "-9999", "2.5", "-999", "-9999"}, "1.5 2.5", "\"-9999\", 2 times"},
        {"with a decimal", {"-12.5", "-99.9", "20.5", "-99.9"}, "-12.5 20.5", "\"-99.9\", 2 times"},
        {"sevens", {"1", "-777.0", "2"}, "1 2", "\"-777\", once"},
        {"minus one among finer values",
         {"4.5", "-1.000", "5.25", "-1.000", "-1.000", "6"},
         "4.5 5.25 6",
         "\"-1\", 3 times"},
        {"minus one among whole numbers may be a temperature or a trace",
         {"4", "-1", "5", "-1", "-1", "0"},
         "4 -1 5 -1 -1 0",
         "note: -1 occurs 3 times in column 2 \"v\" and is taken as a value; if it means missing, "
         "say --missing -1"},
        {"one negative value that is no code",
         {"4.5", "-1.5", "5.5", "-1.5", "-1.5"},
         "4.5 -1.5 5.5 -1.5 -1.5",
         "rows read: 5"},
        {"lone negative values of any look",
         {"4", "-8.88", "5", "-9"},
         "4 -8.88 5 -9",
         "note: -8.88 occurs once"},
        {"a code too short to be sure of",
         {"4.5", "-99", "5.5"},
         "4.5 -99 5.5",
         "note: -99 occurs once"},
        {"nines far above",
         {"1.6", "99.0", "1.5", "99.00", "99", "2"},
         "1.6 1.5 2",
         "\"99\", 3 times"},
        {"nines that the series may reach",
         {"88", "99", "97", "99", "99", "50"},
         "88 99 97 99 99 50",
         "note: 99 occurs 3 times"},
        {"nines that occur once are a flood",
         {"10", "999", "12", "11"},
         "10 999 12 11",
         "rows read: 4"},
        {"fill values of netCDF", {"1", "9.96921e36", "2", "1e20"}, "1 2", "\"1e+20\", once"},
        {"nines that a 32-bit number rounds",
         {"1", "999999999", "2", "999999999", "999999999"},
         "1 2",
         "\"1e+09\", 3 times"},
        {"long nines that occur once are told",
         {"10", "9999", "12", "11"},
         "10 9999 12 11",
         "note: 9999 occurs once in column 2"},
        {"limits of integers", {"1", "-32768", "2"}, "1 2", "\"-32768\", once"},
    };
    for (const Case& one : cases) {
        SCOPED_TRACE(one.why);
        const Imported imported(Daily(one.values));
        EXPECT_EQ(Kept(imported), one.kept);
        ExpectContains(imported.Report(), one.report);
    }
}

TEST(MissingValue, IsAnnouncedByTheTablesHeader) {
    for (const char* head :
         {"# -5 = missing\nt,v\n", "# Missing data flag: -5\nt,v\n", "RINVAL-5\nt,v\n",
          "#kein Wert oder L\xFC"
          "cke: -5.0\nt,v\n"}) {
        const Imported imported(Daily({"-9", "-5", "3", "-7.5"}, head));
        EXPECT_EQ(Kept(imported), "-9 3 -7.5") << head;
        ExpectContains(imported.Report(), "missing: \"-5\", once (announced in line 1)");
    }
    // Numbers beside the mention that no gauge would code with are none.
    EXPECT_EQ(Kept(Imported(Daily({"5", "4", "3"}, "5 spaces represent a missing value\nt,v\n"))),
              "5 4 3");
}

TEST(MissingValue, IsWhatTheOptionSays) {
    ImportOptions options;
    options.missing = {"5", "Q", "<", "out of order"};
    const Imported imported(Daily({"1", "5.000", "2 q", "<0.5", "Out of Order", "-999", "2", "3",
                                   "4", "6", "7", "8", "9", "10", "11"}),
                            options);
    EXPECT_EQ(Kept(imported), "1 -999 2 3 4 6 7 8 9 10 11"); // the search for codes is off
    options.missing = {"none"};
    EXPECT_EQ(Kept(Imported(Daily({"1", "-999", "NA"}), options)), "1 -999");
}

TEST(MissingValue, LeavesNothingAndSaysWhy) {
    EXPECT_EQ(Imported(Daily({"99.0", "99.0", "99.0", "99.0"})).status.Text(),
              "table.csv: none of its 4 rows has a value in every chosen item; taken for missing: "
              "\"99\" 4 times");
}

TEST(QualityMark, IsToldAndTheValueTaken) {
    const Imported imported(Daily({"31.1*", "12.3 e", "5", "7.5A", "8"}));
    EXPECT_EQ(Kept(imported), "31.1 12.3 5 7.5 8");
    ExpectContains(imported.Report(), "mark: \"e\" behind values, once; the values are taken "
                                      "(--missing \"e\" leaves them out)");
}

} // namespace
} // namespace ryn
