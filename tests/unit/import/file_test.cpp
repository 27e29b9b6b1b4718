#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "support/scratch_directory.h"
#include "tsq/tsq.h"
#include "unit/import/import_fixture.h"
#include "units/units.h"

namespace ryn {
namespace {

using test::ExpectContains;

class ImportedFile : public testing::Test {
  protected:
    void SetUp() override { std::filesystem::create_directories(directory); }
    void TearDown() override { std::filesystem::remove_all(directory); }

    std::string PathOf(const std::string& name) const { return directory + name; }
    std::string Write(const std::string& name, const std::string& bytes) const {
        std::ofstream(PathOf(name), std::ios::binary) << bytes;
        return PathOf(name);
    }
    Status Import(const std::string& input, const ImportOptions& options = {}) {
        report = {};
        return ImportFile(input, Output(), options, &report);
    }
    std::string Output() const { return PathOf("out.tsq0"); }
    bool HasOutput() const {
        // Neither the file nor something half-written beside it.
        std::size_t files = 0;
        for (const auto& entry : std::filesystem::directory_iterator(directory))
            files += entry.path().string().find("out.tsq0") != std::string::npos ? 1 : 0;
        return files > 0;
    }

    std::string directory = test::ScratchDirectory() + "import_file_test/";
    ImportReport report;
};

/// A data file as text: its axis, then times and values.
struct DataFile {
    TsqHeaderHandle header;
    TsqFileHandle file;
    int type = 0;
    std::string date;
    std::string time;
    double step = 0.0;
    int count = 0;

    explicit DataFile(const std::string& path) {
        EXPECT_EQ(tsqFileRead(path, &header, &file), 0) << tsqTakeError().Text();
        type = tsqGetTimeAxisType(header.get());
        const TsqHeader* h = header.get();
        if (type == kTsqEqCalendarAxis)
            tsqGetEqCalendarAxis(h, &date, &time, nullptr, nullptr, nullptr, &step, &count,
                                 nullptr);
        else if (type == kTsqNeqCalendarAxis)
            tsqGetNeqCalendarAxis(h, &date, &time, nullptr, nullptr, nullptr, nullptr, &count,
                                  nullptr);
        else if (type == kTsqEqTimeAxis)
            tsqGetEqTimeAxis(h, nullptr, nullptr, nullptr, &step, &count, nullptr);
        else
            tsqGetNeqTimeAxis(h, nullptr, nullptr, nullptr, nullptr, &count, nullptr);
    }
    std::string Rows() {
        std::string rows;
        tsqFindBlockDynamic(header.get(), file.get());
        for (int i = 0; i < count; ++i) {
            for (int item = 0; item < tsqGetNoOfItems(header.get()); ++item) {
                double seconds = 0.0;
                float value = 0.0F;
                EXPECT_EQ(tsqReadItemTimeStep(header.get(), file.get(), &seconds, &value), 0);
                rows += (item == 0 ? (i > 0 ? "; " : "") + ShortestText(seconds) : "") + " " +
                        ShortestText(value);
            }
        }
        return rows;
    }
};

TEST_F(ImportedFile, HasAnEquidistantCalendarAxisWhereStepsAreEqual) {
    const std::string table = Write(
        "gauge.csv", "time,Q [m3/s]\n1999-12-31 23:50:00.500,5.25\n2000-01-01 00:00:00.500,6\n"
                     "2000-01-01 00:10:00.500,0.1\n");
    ASSERT_TRUE(Import(table)) << report.source;
    DataFile data(Output());
    EXPECT_EQ(data.type, kTsqEqCalendarAxis);
    EXPECT_EQ(data.date + " " + data.time, "1999-12-31 23:50:00");
    EXPECT_EQ(data.step, 600.0);
    EXPECT_EQ(data.Rows(), "0 5.25; 600 6; 1200 0.1");
    EXPECT_EQ(tsqGetFileTitle(data.header.get()), "gauge");
    int type = 0;
    std::string name;
    std::string unit;
    tsqGetItemInfo(tsqItemD(data.header.get(), 1), &type, nullptr, &name, nullptr, &unit, nullptr);
    EXPECT_EQ(name, "Q");
    EXPECT_EQ(unit, UnitText(UnitOfText("m3/s")));
    EXPECT_EQ(type, ItemTypeOfUnit(UnitOfText("m3/s")));
    ExpectContains(test::Imported("x").Report(), "table");
    EXPECT_EQ(report.equalStep, 600000);
    EXPECT_EQ(report.samples, 3);
}

TEST_F(ImportedFile, HasANonEquidistantAxisInSecondsOtherwise) {
    ASSERT_TRUE(Import(Write("t.csv", "Year,a,b\n1923,4.5,1\n1924,3.5,2\n1926,9,3\n"), [] {
        ImportOptions options;
        options.itemColumns = {"b", "a"};
        return options;
    }()));
    DataFile data(Output());
    EXPECT_EQ(data.type, kTsqNeqCalendarAxis);
    EXPECT_EQ(data.date + " " + data.time, "1923-01-01 00:00:00");
    EXPECT_EQ(data.Rows(), "0 1 4.5; 31536000 2 3.5; 94694400 3 9");
}

TEST_F(ImportedFile, HasARelativeAxisForLengthsOfTime) {
    ASSERT_TRUE(Import(Write("t.csv", "time,U\n0 days 00:10:00,8.5\n0 days 00:20:00,9\n")));
    EXPECT_EQ(DataFile(Output()).type, kTsqEqTimeAxis);
    EXPECT_TRUE(report.isRelative);
    EXPECT_EQ(report.first, 600000);
    ASSERT_TRUE(Import(Write("t.csv", "time (h),U\n0,8.5\n1.5,9\n2,10\n")));
    DataFile uneven(Output());
    EXPECT_EQ(uneven.type, kTsqNeqTimeAxis);
    EXPECT_EQ(uneven.Rows(), "0 8.5; 5400 9; 7200 10");
}

TEST_F(ImportedFile, KeepsSamplesBeforeTheYear1900AndOneAlone) {
    ASSERT_TRUE(Import(Write("t.csv", "date;flow\n1342-07-22;8000\n1784-02-28;7500\n")));
    DataFile data(Output());
    EXPECT_EQ(data.date, "1342-07-22");
    EXPECT_EQ(report.last, report.first + (161293LL * kMillisPerDay));
    ASSERT_TRUE(Import(Write("t.csv", "date;flow\n1342-07-22;8000\n")));
    EXPECT_EQ(DataFile(Output()).Rows(), "0 8000");
}

TEST_F(ImportedFile, IsNotMadeWhereTheTableIsRefused) {
    const std::vector<std::string> refused = {
        "",
        "time,q\n",
        "time,q\n2001-01-01,1e999\n",
        "time,q\n2001-01-01,inf\n2001-01-02,1\n",
        "time,q\n2001-01-01,1\n2001-01-02,\"2\n",
        "time,q\n2001-01-01,1\n2001-01-02,2\n200",
        "time,q\n2001-01-02,1\n2001-01-01,2\n",
        std::string(5000000, 'x'),
        std::string("CDF\x01 but no netCDF file"),
    };
    for (const std::string& text : refused) {
        const std::string table = Write("bad.csv", text);
        const Status status = Import(table);
        EXPECT_EQ(status.Kind(), Fault::Input) << text.substr(0, 80);
        EXPECT_EQ(status.Text().rfind(table + ": ", 0), 0U) << status.Text();
        EXPECT_FALSE(HasOutput()) << text.substr(0, 80);
    }
    EXPECT_EQ(Import(directory).Text(), directory + ": is a directory, not a table");
    EXPECT_EQ(Import(PathOf("none.csv")).Text(),
              PathOf("none.csv") + ": No such file or directory");
    EXPECT_FALSE(HasOutput());
}

TEST_F(ImportedFile, KeepsTheOldOutputWhereTheImportFails) {
    ASSERT_TRUE(Import(Write("t.csv", "date;flow\n2001-01-01;1\n2001-01-02;2\n")));
    EXPECT_FALSE(Import(Write("t.csv", "date;flow\n2001-01-02;1\n2001-01-01;2\n")));
    EXPECT_EQ(DataFile(Output()).Rows(), "0 1; 86400 2");
    const Status nowhere =
        ImportFile(Write("t.csv", "d;q\n2001-01-01;1\n"), PathOf("no/such/out.tsq0"), {}, &report);
    EXPECT_EQ(nowhere.Kind(), Fault::System);
    ExpectContains(nowhere.Text(), "no/such/out.tsq0");
}

TEST_F(ImportedFile, TakesADifFileOfManyValuesALine) {
    const std::string head = "[IDT;*DIF*;A;CENT;20190206]\n[W3H]\nPAR;WATHTE;Waterhoogte;J\n"
                             "EHD;I;cm\nLOC;XY;Sluis;P;RD;1;2\nTYP;TE\n[RKS]\n";
    ASSERT_TRUE(Import(Write("dif.txt", head + "TYD;19760101;2200;19760102;0100;60;min\n[WRD]\n"
                                               "5/0:-92/25:\n999999999/99:7/0:\n"
                                               "[RKS]\nTYD;19760103;0000;19760103;0000;60;min\n"
                                               "[WRD]\n8/0:\n")));
    DataFile data(Output());
    EXPECT_EQ(data.date + " " + data.time, "1976-01-01 22:00:00");
    EXPECT_EQ(data.Rows(), "0 5; 3600 -92; 10800 7; 93600 8");
    std::string name;
    std::string unit;
    tsqGetItemInfo(tsqItemD(data.header.get(), 1), nullptr, nullptr, &name, nullptr, &unit,
                   nullptr);
    EXPECT_EQ(name, "Waterhoogte");
    EXPECT_EQ(unit, "cm");
    const auto refusal = [&](const std::string& rest) {
        return Import(Write("bad.txt", head + rest)).Text().substr(PathOf("bad.txt: ").size());
    };
    const std::string period = "TYD;19760101;0000;19760101;0200;60;min\n[WRD]\n";
    EXPECT_EQ(refusal(period + "5/0:6/0:\n"),
              "line 10: the values end after 2 of the 3 that TYD announces");
    EXPECT_EQ(refusal(period + "5/0:6/0:7/0:8/0:\n"), "line 10: more values than TYD announces");
    EXPECT_EQ(refusal(period + "5/0:x/0:7/0:\n"), "line 10: \"x/0\" is no value with its quality");
    EXPECT_EQ(refusal("[WRD]\n5/0:\n"), "line 8: values begin without a TYD line before them");
    EXPECT_EQ(
        refusal("TYP;TN\n"),
        "line 8: series of type TN carry a time with each value and are not read; only TE is");
    EXPECT_EQ(refusal("[W3H]\n"), "line 8: a second series begins; only one is imported at a time");
}

/// A netCDF file from its description.
std::string MakeNetcdf(const std::string& path, const std::string& cdl) {
    std::ofstream(path + ".cdl") << "netcdf x {\n" << cdl << "\n}\n";
    EXPECT_EQ(std::system(("ncgen -o " + path + " " + path + ".cdl").c_str()), 0);
    return path;
}

TEST_F(ImportedFile, TakesSeriesOfForeignNetcdfWithoutTheirMissingValues) {
    const std::string source =
        MakeNetcdf(PathOf("a.nc"), "dimensions: time = 4 ; x = 2 ; variables: double time(time) ; "
                                   "time:units = \"hours since 2001-01-01 06:00\" ; "
                                   "float grid(time, x) ; float q(time) ; q:units = \"m3 s-1\" ; "
                                   "q:_FillValue = -99.f ; q:long_name = \"Discharge\" ; "
                                   "float w(time) ; data: time = 0, 1, 3, 2 ; "
                                   "grid = 1,2,3,4,5,6,7,8 ; q = 1, -99, 3, 4 ; "
                                   "w = 5, 6, NaN, -1 ;");
    ExpectContains(Import(source).Text(), "time runs backwards in line 4");
    ImportOptions options;
    options.sort = true;
    ASSERT_TRUE(Import(source, options));
    DataFile data(Output());
    EXPECT_EQ(data.date + " " + data.time, "2001-01-01 06:00:00");
    EXPECT_EQ(data.Rows(), "0 1; 7200 4; 10800 3");
    ExpectContains(report.otherItems.at(0), "\"w\"");
    options.itemColumns = {"w"};
    options.missing = {"-1"};
    ASSERT_TRUE(Import(source, options));
    EXPECT_EQ(DataFile(Output()).Rows(), "0 5; 3600 6");
    options.itemColumns = {"1"};
    EXPECT_EQ(Import(source, options).Text(),
              source + ": item 1 \"grid\" has values at many places; import takes series of one "
                       "place");
    options.itemColumns = {"z"};
    EXPECT_EQ(Import(source, options).Text(), source + ": --item \"z\": no such item");
    const std::string grid = MakeNetcdf(
        PathOf("grid.nc"), "dimensions: time = 1 ; x = 2 ; variables: double time(time) ; "
                           "time:units = \"days since 2001-01-01\" ; float grid(time, x) ; "
                           "data: time = 0 ; grid = 1,2 ;");
    EXPECT_EQ(Import(grid).Text(), grid + ": every item has values at many places (a grid, or "
                                          "stations); import takes series of one place");
}

TEST_F(ImportedFile, ReportsWhatWasFoundInPlainLines) {
    const std::string table = Write("r.csv", "# Missing: -99\nd;Q [m3/s];mark\n2001-01-01;1,5;a\n"
                                             "2001-01-02;-99;\n2001-01-03;2,5 e;b\n;;\n"
                                             "2001-01-05;7,25;c\n");
    ASSERT_TRUE(Import(table));
    const std::vector<std::string> expected = {
        table + ": table",
        "UTF-8, 3 columns parted by semicolon, decimal comma, names in line 2, rows from line 3",
        "time: column 1 \"d\", year-month-day",
        "item: \"Q\" from column 2 \"Q\", unit m3/s",
        "missing: \"-99\", once (announced in line 1)",
        "mark: \"e\" behind values, once; the values are taken (--missing \"e\" leaves them out)",
        "rows read: 4",
        "left out: 1 without content (line 6)",
        "left out: 1 with a missing value (line 4)",
        "written: 3 samples, 2001-01-01 00:00:00 to 2001-01-05 00:00:00, every 172800 s",
    };
    EXPECT_EQ(ReportLines(report), expected);
}

} // namespace
} // namespace ryn
