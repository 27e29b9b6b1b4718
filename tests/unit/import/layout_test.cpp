#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "unit/import/import_fixture.h"

namespace ryn {
namespace {

using test::ExpectContains;
using test::Imported;

struct Layout {
    const char* description;
    std::string text;
    std::string samples;             ///< as Imported::Days
    std::vector<std::string> report; ///< parts of the report
};

void CheckAll(const std::vector<Layout>& layouts) {
    for (const Layout& layout : layouts) {
        SCOPED_TRACE(layout.description);
        const Imported imported(layout.text);
        EXPECT_EQ(imported.Days(), layout.samples);
        for (const std::string& part : layout.report)
            ExpectContains(imported.Report(), part);
    }
}

TEST(TableLayout, FindsDelimiterDecimalAndHeaderByItself) {
    CheckAll({
        {"comma",
         "time,q\n2001-01-01,5\n2001-01-02,6.5\n",
         "2001-01-01 5; 2001-01-02 6.5",
         {"UTF-8, 2 columns parted by comma, names in line 1, rows from line 2", "item: \"q\""}},
        {"semicolon and decimal comma, quoted names",
         "\"time\";\"discharge\"\n1929-04-01;31,2\n1929-04-02;25,5\n1929-04-03;16\n",
         "1929-04-01 31.2; 1929-04-02 25.5; 1929-04-03 16",
         {"parted by semicolon, decimal comma", "item: \"discharge\""}},
        {"quoted decimal commas between commas",
         "Datum,Wert\n2001-01-01,\"4,45\"\n2001-01-02,\"5,1\"\n2001-01-03,\"12,75\"\n",
         "2001-01-01 4.45; 2001-01-02 5.1; 2001-01-03 12.75",
         {"decimal comma"}},
        {"tab",
         "date\tQ\n1-1-1986\t0.5\n2-1-1986\tNA\n13-1-1986\t0.7\n",
         "1986-01-01 0.5; 1986-01-13 0.7",
         {"parted by tab", "missing: \"NA\", once"}},
        {"bar", "date|Q\n2001-01-01|1\n2001-01-02|2\n", "2001-01-01 1; 2001-01-02 2", {"bar"}},
        {"semicolon and blank, units in brackets",
         "time (YYYY-MM-DD-HH); significant wave height (m); period (s)\n"
         "1996-01-01-00; 0.28; 4.7\n1996-01-01-01; 0.31; 4.6\n",
         "1996-01-01 0.28; 1996-01-01 01:00:00 0.31",
         {"item: \"significant wave height\" from column 2", "unit m", "3 \"period\""}},
        {"blanks and decimal comma",
         "1.1.2001 31,2\n2.1.2001 30,25\n13.1.2001 9\n",
         "2001-01-01 31.2; 2001-01-02 30.25; 2001-01-13 9",
         {"parted by blanks, decimal comma"}},
        {"year and whole numbers are no decimal comma",
         "Year,Flow\n1895,68500\n1896,56000\n",
         "1895-01-01 68500; 1896-01-01 56000",
         {"2 columns parted by comma"}},
        {"three decimals beside whole numbers are no thousands",
         "d;h\n2001-01-01;1.131\n2001-01-02;2\n2001-01-03;122\n2001-01-04;0.754\n",
         "2001-01-01 1.131; 2001-01-02 2; 2001-01-03 122; 2001-01-04 0.754",
         {}},
        {"nor are they beside a code for missing values",
         "d;h\n2001-01-01;1.131\n2001-01-02;-999\n2001-01-03;1.554\n2001-01-04;1.613\n",
         "2001-01-01 1.131; 2001-01-03 1.554; 2001-01-04 1.613",
         {}},
        {"whole numbers in two columns without a header",
         "2001-01-01,12,100\n2001-01-02,7,95\n2001-01-03,12,110\n",
         "2001-01-01 12; 2001-01-02 7; 2001-01-03 12",
         {"item: \"table\" from column 2", "could be chosen with --item: 3"}},
        {"temperatures in two columns without a header",
         "2001-01-01,12,5\n2001-01-02,7,-1\n2001-01-03,12,4\n",
         "2001-01-01 12; 2001-01-02 7; 2001-01-03 12",
         {}},
        {"no header",
         "20-09-1963,30.512\n21-09-1963,52.858\n",
         "1963-09-20 30.512; 1963-09-21 52.858",
         {"no names, rows from line 1", "\"table\""}},
        {"carriage returns alone, and blank lines",
         "time,q\r\r2001-01-01,5\r2001-01-02,6\r\r",
         "2001-01-01 5; 2001-01-02 6",
         {}},
        {"carriage returns and line feeds, trailing comma",
         "STN,YYYYMMDD,   RD,   SX,\r\n905,19190711,  105,     ,\r\n905,19190712,     ,    3,\r\n"
         "905,19190713,   34,    4,\r\n",
         "1919-07-11 105; 1919-07-13 34",
         {"missing: empty, once", "item: \"RD\"", "4 \"SX\""}},
    });
}

TEST(TableLayout, PassesOverHeadersOfGaugeNetworks) {
    CheckAll({
        {"comments, names, and a line of types",
         "#####\n### 2 sites, 2012 ###\n# Data provided for site 01\n#    DD "
         "parameter\n#\nagency_cd\tsite_no\tdatetime\tx_cd\tv\n"
         "5s\t15s\t20d\t10s\t14n\nUSGS\t02177000\t2012-09-01\tA\t191\n"
         "USGS\t02177000\t2012-09-02\tP\t213\n",
         "2012-09-01 191; 2012-09-02 213",
         {"names in line 6", "rows from line 8", "item: \"v\""}},
        {"names and units in comments, parts of the date in columns",
         "#YY  MM DD hh mm WDIR  WVHT\n#yr  mo dy hr mn degT     m\n2019 08 01 00 00 231  1.60\n"
         "2019 08 01 00 10 222  1.70\n",
         "2019-08-01 231; 2019-08-01 00:10:00 222",
         {"time: columns 1 \"YY\", 2 \"MM\", 3 \"DD\", 4 \"hh\", 5 \"mm\"", "unit degT",
          "units in line 2"}},
        {"free text with its own dated tables, Latin-1",
         "Messstelle:                Kl\xF6sterle (Bad)\nHZB-Nummer:                200071\n"
         "orogr.Einzugsgebiet [km\xB2]: 57.2\n  g\xFCltig seit:             H\xF6he [m]:\n"
         "   01.01.1976              1070.00\n   01.01.1979              1069.38\n"
         "Einheit:                   m\xB3/s\nWerteformat:               3 Nachkommast.\nWerte:\n"
         "01.01.1961 00:00:00        0.730\n02.01.1961 00:00:00        0.731\n"
         "03.01.1961 00:00:00        0.732\n04.01.1961 00:00:00        0.733\n",
         "1961-01-01 0.73; 1961-01-02 0.731; 1961-01-03 0.732; 1961-01-04 0.733",
         {"Windows-1252", "rows from line 10", "unit m\xC2\xB3/s", "no names"}},
        {"sub-tables of the very shape of the rows",
         "Station;X\nPegelnullpunkt:\n01.01.1976;1070,00\n01.01.1979;1069,38\nWerte:\n"
         "01.01.1961;0,5\n02.01.1961;0,6\n03.01.1961;0,7\n04.01.1961;0,8\n05.01.1961;0,9\n"
         "06.01.1961;0,9\n07.01.1961;0,9\n08.01.1961;0,9\n09.01.1961;0,9\n10.01.1961;1,0\n",
         "1961-01-01 0.5; 1961-01-02 0.6; 1961-01-03 0.7; 1961-01-04 0.8; 1961-01-05 0.9; "
         "1961-01-06 0.9; 1961-01-07 0.9; 1961-01-08 0.9; 1961-01-09 0.9; 1961-01-10 1",
         {"what looks like rows in line 3-4 stands in the header and is not taken"}},
        {"key and value lines before the rows",
         "station,id,39001\nstation,name,Kingston\ndata,first,1883-01-01\ndata,last,1883-01-03\n"
         "1883-01-01,231.3,\n1883-01-02,229,E\n1883-01-03,228.1,\n1883-01-04,228,\n"
         "1883-01-05,227,\n",
         "1883-01-01 231.3; 1883-01-02 229; 1883-01-03 228.1; 1883-01-04 228; 1883-01-05 227",
         {"no names, rows from line 5"}},
        {"a code announced in a header that is no table",
         "#SSNR*|*|SANR1|*|\n#RINVAL-777.0|*|RNR1|*|RID-1|*|\n192311011200 160.5\n"
         "192311021200 -777.0\n192311031200 145\n",
         "1923-11-01 12:00:00 160.5; 1923-11-03 12:00:00 145",
         {"missing: \"-777\", once (announced in line 2)", "no names"}},
        {"a clock column of dashes",
         "# Station: Rees\n# DATA\nYYYY-MM-DD;hh:mm; Value\n1930-01-01;--:--;    1230.5\n"
         "1930-01-02;--:--;   -999.0\n1930-01-03;--:--;    1300.0\n",
         "1930-01-01 1230.5; 1930-01-03 1300",
         {"missing: \"-999\", once", "item: \"Value\""}},
        {"names, units and kinds in three lines under a line of its own",
         "\"TOA5\",\"CR1000\",\"1234\"\n\"TIMESTAMP\",\"RECORD\",\"Level\"\n\"TS\",\"RN\",\"m\"\n"
         "\"\",\"\",\"Avg\"\n\"2020-01-01 00:00:00\",0,1.5\n\"2020-01-01 00:10:00\",1,1.6\n"
         "\"2020-01-01 00:20:00\",2,1.7\n",
         "2020-01-01 1.5; 2020-01-01 00:10:00 1.6; 2020-01-01 00:20:00 1.7",
         {"item: \"Level\"", "rows from line 5"}},
        {"row names, which the header leaves out",
         "\"time\" \"obs\"\n\"1\" 1970.5 0.114\n\"2\" 1970.75 NA\n\"3\" 1971.5 0.13\n"
         "\"4\" 1972.5 0.2\n\"5\" 1973.5 0.3\n",
         "1970-07-02 12:00:00 0.114; 1971-07-02 12:00:00 0.13; 1972-07-02 0.2; "
         "1973-07-02 12:00:00 0.3",
         {"time: column 2 \"time\", decimal year", "item: \"obs\" from column 3"}},
        {"an end-of-record column, a quality level, and -999",
         "STATIONS_ID;MESS_DATUM;QN_3;  FX;eor\n44;20010101;   10;  12.5;eor\n"
         "44;20010102;   10;  -999;eor\n44;20010103;    9;  11.0;eor\n",
         "2001-01-01 12.5; 2001-01-03 11",
         {"item: \"FX\"", "missing: \"-999\", once"}},
    });
}

TEST(TableLayout, JoinsDatesAndTimesThatStandInSeveralColumns) {
    CheckAll({
        {"date and time of day",
         "Date,Time,Level\n31/01/2001,06:30,1.5\n01/02/2001,18:00:30,2\n",
         "2001-01-31 06:30:00 1.5; 2001-02-01 18:00:30 2",
         {"columns 1 \"Date\", 2 \"Time\""}},
        {"date and hours from 1 to 24",
         "# STN,YYYYMMDD,   HH,   FF\n\n330,20010131,   23,   40\n330,20010131,   24,   50\n"
         "330,20010201,    1,   60\n",
         "2001-01-31 23:00:00 40; 2001-02-01 50; 2001-02-01 01:00:00 60",
         {"hour 24 is 00:00 of the next day", "item: \"FF\""}},
        {"times of day in words, under their names",
         "Datum;Uhrzeit;W\n31.1.2001;7h30;1\n31.1.2001;8 Uhr;2\n31.1.2001;9 Uhr 05;3\n"
         "31.1.2001;12:45 Uhr;4\n",
         "2001-01-31 07:30:00 1; 2001-01-31 08:00:00 2; 2001-01-31 09:05:00 3; "
         "2001-01-31 12:45:00 4",
         {"columns 1 \"Datum\", 2 \"Uhrzeit\""}},
        {"hours with half of the day",
         "date,time,q\n2001-01-31,6 am,1\n2001-01-31,12 pm,2\n2001-01-31,6 p.m.,3\n",
         "2001-01-31 06:00:00 1; 2001-01-31 12:00:00 2; 2001-01-31 18:00:00 3",
         {}},
        {"digits and a word for hours, beside a date in parts",
         "year,month,day,time,q\n2001,1,31,0730 hrs,1\n2001,1,31,1845 hrs,2\n",
         "2001-01-31 07:30:00 1; 2001-01-31 18:45:00 2",
         {}},
        {"Japanese",
         "年,月,日,時刻,水位\n2001,1,31,9時,1\n2001,1,31,9時30分,2\n2001,1,31,24時,3\n",
         "2001-01-31 09:00:00 1; 2001-01-31 09:30:00 2; 2001-02-01 3",
         {"item: \"水位\""}},
        {"times of day that most rows lack",
         "peak_dt,peak_tm,v\n2001-01-31,,1\n2001-02-01,12:30,2\n2001-02-03,,3\n",
         "2001-01-31 1; 2001-02-01 2; 2001-02-03 3",
         {"note: the times of day in column 2 \"peak_tm\" are not used: many rows have none, the "
          "first in line 2"}},
        {"hour ending, and hours that are counted",
         "Date,Hour Ending,sunshine hours\n01/31/2001,23,1\n01/31/2001,24,0\n02/01/2001,1,1\n",
         "2001-01-31 23:00:00 1; 2001-02-01 0; 2001-02-01 01:00:00 1",
         {"time: columns 1 \"Date\", 2 \"Hour Ending\"", "item: \"sunshine hours\""}},
        {"parts in any order",
         "obs,month,day,year,Prec\n1,1,1,1900,0\n2,1,2,1900,3\n"
         "3,1,3,1900,0.5\n4,1,4,1900,0\n5,1,5,1900,0\n",
         "1900-01-01 0; 1900-01-02 3; 1900-01-03 0.5; 1900-01-04 0; 1900-01-05 0",
         {"4 \"year\", 2 \"month\", 3 \"day\""}},
        {"a minimum is no minute",
         "Time,Year,Mon,Day,Min\n1,1949,1,1,26\n2,1949,1,2,7\n3,1949,1,3,1\n4,1949,1,4,4\n"
         "5,1949,1,5,4\n6,1949,1,6,9\n",
         "1949-01-01 26; 1949-01-02 7; 1949-01-03 1; 1949-01-04 4; 1949-01-05 4; 1949-01-06 9",
         {"item: \"Min\""}},
        {"two-digit years",
         "Year,Month,Day,MaxT\n48,7,1,110\n48,7,2,109\n",
         "1948-07-01 110; 1948-07-02 109",
         {"two-digit years"}},
        {"day of the year",
         "jaar doy debiet\n2000 60 1.5\n2000 366 2.5\n2001 60 3\n",
         "2000-02-29 1.5; 2000-12-31 2.5; 2001-03-01 3",
         {"item: \"debiet\""}},
        {"German names",
         "Jahr;Monat;Tag;Stunde;Wert\n2001;1;1;0;1,5\n2001;1;1;1;1,25\n",
         "2001-01-01 1.5; 2001-01-01 01:00:00 1.25",
         {}},
        {"year and month",
         "Year,Month,Rain\n2001,1,5\n2001,2,6\n",
         "2001-01-01 5; 2001-02-01 6",
         {"months alone"}},
        {"a row for each year with its months",
         "Year Jan Feb Mar Apr May Jun Jul Aug Sep Oct Nov Dec\n"
         "1999 1 2 3 4 5 6 7 8 9 10 11 12.5\n2000 1 2 -99.9 4 5 6 7 8 9 10 11 -99.9\n",
         "1999-01-01 1; 1999-02-01 2; 1999-03-01 3; 1999-04-01 4; 1999-05-01 5; 1999-06-01 6; "
         "1999-07-01 7; 1999-08-01 8; 1999-09-01 9; 1999-10-01 10; 1999-11-01 11; "
         "1999-12-01 12.5; 2000-01-01 1; 2000-02-01 2; 2000-04-01 4; 2000-05-01 5; 2000-06-01 6; "
         "2000-07-01 7; 2000-08-01 8; 2000-09-01 9; 2000-10-01 10; 2000-11-01 11",
         {"each row holds the twelve months of a year", "item: \"table\" from column 2 \"Jan\" to",
          "missing: \"-99.9\", 2 times"}},
        {"a water level named H is no hour",
         "Datum;H\n2001-01-01;12\n2001-01-02;7\n2001-01-03;20\n",
         "2001-01-01 12; 2001-01-02 7; 2001-01-03 20",
         {"item: \"H\""}},
        {"parts without names",
         "2001 1 30 1.5\n2001 1 31 2.5\n2001 2 1 2\n",
         "2001-01-30 1.5; 2001-01-31 2.5; 2001-02-01 2",
         {}},
        {"parts with a clock without names",
         "2001 1 31 23 30 1.5\n2001 2 1 0 0 2.5\n2001 2 1 0 30 2\n",
         "2001-01-31 23:30:00 1.5; 2001-02-01 2.5; 2001-02-01 00:30:00 2",
         {}},
        {"zone names beside local times; the hour that daylight saving repeats stays two",
         "datetime\ttz_cd\tv\n2010-11-07 01:00\tEDT\t1.5\n2010-11-07 01:00\tEST\t2.5\n",
         "2010-11-07 05:00:00 1.5; 2010-11-07 06:00:00 2.5",
         {"stored as UTC"}},
    });
}

TEST(TableLayout, KnowsManyWaysToWriteATime) {
    CheckAll({
        {"offsets from UTC",
         ",v\n2010-10-31 02:00:00+02:00,1\n2010-10-31 02:00:00+01:00,2\n2010-10-31 "
         "03:00:00+01:00,3\n",
         "2010-10-31 1; 2010-10-31 01:00:00 2; 2010-10-31 02:00:00 3",
         {"stored as UTC"}},
        {"T and Z and fractions",
         "t,v\n2010-10-31T02:00:00.250Z,1\n2010-10-31T02:00:00.5Z,2\n",
         "2010-10-31 02:00:00.250 1; 2010-10-31 02:00:00.500 2",
         {}},
        {"day first by its values",
         "d,v\n1/2/2001,1\n13/2/2001,2\n",
         "2001-02-01 1; 2001-02-13 2",
         {"day-month-year"}},
        {"month first by its values",
         "d,v\n1/2/2001,1\n1/13/2001,2\n",
         "2001-01-02 1; 2001-01-13 2",
         {"month-day-year"}},
        {"points between mean day first",
         "d;v\n1.2.2001;1\n2.2.2001;2\n",
         "2001-02-01 1; 2001-02-02 2",
         {"day-month-year"}},
        {"twelve-hour clock",
         "d,v\n1/31/2001 12:00:00 AM,1\n1/31/2001 1:30:00 PM,2\n",
         "2001-01-31 1; 2001-01-31 13:30:00 2",
         {}},
        {"digits and a slash before the clock",
         "19730101/1200 1.5\n19730102/1200 -9999.000000\n19730103/1200 2.5\n",
         "1973-01-01 12:00:00 1.5; 1973-01-03 12:00:00 2.5",
         {"missing: \"-9999\""}},
        {"digits with hour and minute",
         "200101312330 1\n200102010000 2\n",
         "2001-01-31 23:30:00 1; 2001-02-01 2",
         {}},
        {"names of months", "d,v\n30-Dez-1999,1\n1-Jan-2000,2\n", "1999-12-30 1; 2000-01-01 2", {}},
        {"midnights written without their clock",
         "d,v\n2001-01-01,1\n2001-01-01 06:00:00,2\n",
         "2001-01-01 1; 2001-01-01 06:00:00 2",
         {}},
        {"year alone, behind a byte order mark",
         "\xEF\xBB\xBFYear,SeaLevel\n1923,4.03\n1924,3.83\n",
         "1923-01-01 4.03; 1924-01-01 3.83",
         {"each value is placed at 1 January"}},
        {"year and month in one",
         "m,v\n2000-01,1\n2000-02,2\n2001-02,3\n",
         "2000-01-01 1; 2000-02-01 2; 2001-02-01 3",
         {}},
        {"lengths of time",
         "time,U\n0 days 00:00:00,8.3\n0 days 00:10:00,11.5\n1 days 00:00:00,9\n",
         "0 8.3; 600 11.5; 86400 9",
         {}},
        {"hours since a date",
         "time [hours since 1990-01-01],v\n0,1.5\n12,2.5\n",
         "1990-01-01 1.5; 1990-01-01 12:00:00 2.5",
         {}},
        {"dates without a day are the first of their month, and told",
         "peak_dt\tpeak_va\n1869-07\t6\n1895-07-00\t5\n1939\t7\n1940-07-16\t8\n1941-09-16\t9\n"
         "1942-09-16\t10\n1943-09-16\t11\n",
         "1869-07-01 6; 1895-07-01 5; 1940-07-16 8; 1941-09-16 9; 1942-09-16 10; 1943-09-16 11",
         {"dates without a day are taken as the first of their month: line 2, 3",
          "left out: 1 with a date that lacks its month (line 4)"}},
        {"in American order too",
         "Date,Q\n1929-03,220\n11/22/1930,34\n1/19/1932,22\n4/18/1933,35\n",
         "1929-03-01 220; 1930-11-22 34; 1932-01-19 22; 1933-04-18 35",
         {}},
    });
}

TEST(TableLayout, ReadsUtf16AndJapaneseEncodings) {
    const std::string ascii = "Zeit\tWert\r\n2001-01-01\t1,5\r\n2001-01-02\t2,5\r\n";
    std::string little = "\xFF\xFE";
    std::string bigWithoutMark;
    for (const char c : ascii) {
        little += c;
        little += '\0';
        bigWithoutMark += '\0';
        bigWithoutMark += c;
    }
    EXPECT_EQ(Imported(little).Days(), "2001-01-01 1.5; 2001-01-02 2.5");
    EXPECT_EQ(Imported(bigWithoutMark).Days(), "2001-01-01 1.5; 2001-01-02 2.5");
    ExpectContains(Imported(little).Report(), "UTF-16LE");
    // Shift_JIS, in which a character may end with a bar.
    const Imported japanese("\x94N\x8C\x8E\x93\xFA|\x90\x85\x88\xCA(m)|\x94\xF5\x8Dl\n"
                            "2001/01/30|1.5|\x83|\n"
                            "2001/01/31|2|\x83\\\n");
    EXPECT_EQ(japanese.Days(), "2001-01-30 1.5; 2001-01-31 2");
    for (const char* part : {"Shift_JIS, 3 columns parted by bar", "item: \"水位\"", "unit m"})
        ExpectContains(japanese.Report(), part);
    ImportOptions options;
    options.encoding = "EUC-JP";
    EXPECT_EQ(Imported("\xC6\xFC,\xBF\xE5\xB0\xCC\n"
                       "2001-01-30,5\n"
                       "2001-01-31,6\n",
                       options)
                  .report.items[0]
                  .name,
              "水位");
}

TEST(TableLayout, ReadsQuotedFieldsWithDelimitersQuotesAndLineBreaks) {
    const Imported imported("when,\"the \"\"Q\"\"\nof the river (m3/s)\",place\n"
                            "2001-01-01,5,\"(  2) Here, there\"\n2001-01-02,6,\"two\nlines\"\n"
                            "2001-01-03,7,5\" pipe\n");
    EXPECT_EQ(imported.Days(), "2001-01-01 5; 2001-01-02 6; 2001-01-03 7");
    EXPECT_EQ(imported.report.items[0].name, "the \"Q\" of the river");
    EXPECT_EQ(imported.report.items[0].unit, "m3/s");
}

TEST(TableLayout, FindsTheTableBehindAVeryLongPreamble) {
    std::string text;
    for (int i = 0; i < 5000; ++i)
        text += "This is a line of the licence, and it says little.\n";
    text += "time,q\n2001-01-01,5\n2001-01-02,6\n";
    EXPECT_EQ(Imported(text).Days(), "2001-01-01 5; 2001-01-02 6");
}

TEST(TableLayout, SearchesTheWholeTableForTheRowThatTellsDayFromMonth) {
    std::string text = "d,v\n";
    for (int year = 1000; year < 6000; ++year)
        text += "1/2/" + std::to_string(year) + ",1\n";
    text += "# \"a remark that opens a quote\n";
    Imported undecided(text);
    ExpectContains(undecided.Samples(), "day-month-year or month-day-year, and no row decides");
    Imported decided(text + "31/12/6000,2\n");
    EXPECT_EQ(decided.samples.Count(), 5001U);
    ExpectContains(decided.Days(), "1000-02-01 1; 1001-02-01 1");
}

} // namespace
} // namespace ryn
