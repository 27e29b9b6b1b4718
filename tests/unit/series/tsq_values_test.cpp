#include "series/tsq_values.h"

#include <algorithm>
#include <cmath>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "support/recording_ports.h"
#include "support/sample_series.h"
#include "support/temporary_directory.h"

namespace ryn {
namespace {

using test::At;
using test::Daily;
using test::RecordingPorts;
using test::Samples;
using test::SamplesOf;
using test::TemporaryDirectory;
using test::WriteDataFile;
using ::testing::ElementsAre;
using ::testing::HasSubstr;
using ::testing::IsEmpty;

/// A data file being described and filled step by step.
class DataFile {
  public:
    DataFile(std::string filePath, int items) : path(std::move(filePath)) {
        tsqHeaderCreate(1, "a title", "test", 1, items, 1, &header);
        for (int i = 1; i <= items; ++i)
            tsqSetItemInfo(header.get(), tsqItemD(header.get(), i), kItemTypeUndefined,
                           "item " + std::to_string(i), UnitOfText("m"), kTsqDataTypeFloat);
    }
    TsqHeader* Header() { return header.get(); }
    void Step(double time, const std::vector<float>& values) {
        if (!file) {
            ASSERT_EQ(tsqFileCreate(path, header.get(), &file), 0);
        }
        for (const float value : values)
            ASSERT_EQ(tsqWriteItemTimeStep(header.get(), file.get(), time, &value), 0);
    }
    void Close() { ASSERT_EQ(tsqFileClose(header.get(), &file), 0); }

  private:
    std::string path;
    TsqHeaderHandle header;
    TsqFileHandle file;
};

std::string Stamp(const COleDateTime& date) {
    return date.Format("%Y-%m-%d %H:%M:%S");
}

TEST(TsqValues, TellsHowFarAReadHasCome) {
    const TemporaryDirectory files;
    ASSERT_TRUE(
        WriteDataFile(files.Path("s.tsq0"), Daily("1900-01-01", std::vector<double>(20000, 1.5))));
    RecordingPorts ports;
    CTsqValues values;
    values.UsePorts(ports);
    ASSERT_TRUE(values.ReadSeries(files.Path("s.tsq0"), 0));
    ASSERT_GE(ports.progress.size(), 2U);
    EXPECT_EQ(ports.progress.front(), std::pair(0LL, 20000LL));
    EXPECT_EQ(ports.progress.back(), std::pair(20000LL, 20000LL));
    EXPECT_TRUE(std::is_sorted(ports.progress.begin(), ports.progress.end()));
}

TEST(SeriesReading, StartsAnEquidistantAxisAtItsDateAndOffset) {
    const TemporaryDirectory directory;
    DataFile file(directory.Path("a.tsq0"), 1);
    tsqSetEqCalendarAxis(file.Header(), "2000-01-01", "00:00:00", kUnitHour, 1.5, 0.5, 0);
    for (int i = 0; i < 3; ++i)
        file.Step(0.0, {static_cast<float>(i)});
    file.Close();
    CTsqValues values;
    ASSERT_TRUE(values.ReadSeries(directory.Path("a.tsq0"), 0)) << values.ReadError().Text();
    ASSERT_EQ(values.samples.size(), 3U);
    EXPECT_EQ(values.axisKind, AxisKind::EquidistantCalendar);
    EXPECT_EQ(values.title, "a title");
    EXPECT_EQ(Stamp(values.samples[0].date), "2000-01-01 01:30:00");
    EXPECT_EQ(Stamp(values.samples[2].date), "2000-01-01 02:30:00");
    EXPECT_EQ(values.samples[2].value, 2.0);
    EXPECT_EQ(values.samples[2].selected, 0);
    values.ClearSeries();
    EXPECT_EQ(values.count, 0);
    EXPECT_THAT(values.samples, IsEmpty());
}

TEST(SeriesReading, PicksOneOfSeveralItemsAndTheTimeOfItsStep) {
    const TemporaryDirectory directory;
    DataFile file(directory.Path("a.tsq0"), 3);
    tsqSetNeqCalendarAxis(file.Header(), "1990-03-01", "12:00:00", kUnitSecond, 0.0, 0);
    file.Step(0.0, {1, 10, 100});
    file.Step(90.7, {2, 20, 200});
    file.Close();
    CTsqValues values;
    ASSERT_TRUE(values.ReadSeries(directory.Path("a.tsq0"), 1));
    EXPECT_EQ(values.itemName, "item 2");
    EXPECT_EQ(values.samples[1].value, 20.0);
    EXPECT_EQ(Stamp(values.samples[1].date), "1990-03-01 12:01:30");
    CTsqValues summary;
    ASSERT_TRUE(summary.ReadSummary(directory.Path("a.tsq0"), 2));
    EXPECT_EQ(summary.count, 2);
    EXPECT_EQ(summary.maximum.value, 200.0);
    EXPECT_EQ(Stamp(summary.last.date), "1990-03-01 12:01:30");
}

TEST(SeriesReading, SummarisesTheEarliestOfEqualExtremes) {
    const TemporaryDirectory directory;
    const std::string path = directory.Path("a.tsq0");
    ASSERT_TRUE(WriteDataFile(path, Daily("2000-01-01", {2, 7, 1, 7, 1, 3})));
    CTsqValues values;
    ASSERT_TRUE(values.ReadSummary(path, 0));
    EXPECT_EQ(Stamp(values.maximum.date), "2000-01-02 00:00:00");
    EXPECT_EQ(Stamp(values.minimum.date), "2000-01-03 00:00:00");
    EXPECT_EQ(values.first.value, 2.0);
    EXPECT_EQ(values.last.value, 3.0);
    EXPECT_THAT(values.samples, IsEmpty());

    ASSERT_TRUE(WriteDataFile(path, Daily("2000-01-05", {4})));
    ASSERT_TRUE(values.ReadSummary(path, 0));
    EXPECT_EQ(values.first.date, values.last.date);
}

TEST(SeriesReading, CountsARelativeAxisFrom1900) {
    const TemporaryDirectory directory;
    DataFile file(directory.Path("a.tsq0"), 1);
    tsqSetNeqTimeAxis(file.Header(), kUnitHour, 24.0, 0);
    file.Step(0.0, {1});
    file.Step(36.0, {2});
    file.Close();
    CTsqValues values;
    ASSERT_TRUE(values.ReadSeries(directory.Path("a.tsq0"), 0));
    EXPECT_EQ(values.axisKind, AxisKind::NonEquidistantRelative);
    EXPECT_EQ(Stamp(values.samples[1].date), "1900-01-03 12:00:00");
}

// Thirds of an hour lie a hair below their seconds; days before 1900 have no room for a hair.
TEST(SeriesReading, PutsHoursAndOldMidnightsWhereTheyBelong) {
    const TemporaryDirectory directory;
    DataFile file(directory.Path("a.tsq0"), 1);
    tsqSetNeqCalendarAxis(file.Header(), "1894-01-01", "01:00:00", kUnitHour, 0.0, 0);
    constexpr int kSteps = 3 * 24 * 200;
    for (int i = 0; i < kSteps; ++i)
        file.Step(i / 3.0, {static_cast<float>(i)});
    file.Close();
    CTsqValues values;
    ASSERT_TRUE(values.ReadSeries(directory.Path("a.tsq0"), 0));
    for (int i = 0; i < kSteps; ++i) {
        const COleDateTime expected = At("1894-01-01") +
                                      COleDateTimeSpan(i / 72, i / 3 % 24, i % 3 * 20, 0) +
                                      COleDateTimeSpan(0, 1, 0, 0);
        ASSERT_EQ(Stamp(values.samples[static_cast<std::size_t>(i)].date), Stamp(expected)) << i;
    }
}

TEST(SeriesReading, ReadsMoreStepsThanABlockHolds) {
    const TemporaryDirectory directory;
    for (const bool equidistant : {false, true}) {
        DataFile file(directory.Path("a.tsq0"), 2);
        if (equidistant)
            tsqSetEqCalendarAxis(file.Header(), "1990-01-01", "00:00:00", kUnitSecond, 0.0, 60.0,
                                 0);
        else
            tsqSetNeqCalendarAxis(file.Header(), "1990-01-01", "00:00:00", kUnitSecond, 0.0, 0);
        for (int i = 0; i < 50000; ++i)
            file.Step(i * 60.0, {0.0F, static_cast<float>(i)});
        file.Close();
        CTsqValues values;
        ASSERT_TRUE(values.ReadSeries(directory.Path("a.tsq0"), 1));
        ASSERT_EQ(values.samples.size(), 50000U);
        EXPECT_EQ(values.samples[40000].value, 40000.0);
        EXPECT_EQ(values.samples[49999].date, At("1990-01-01") + COleDateTimeSpan(49999 / 1440.0));
    }
}

TEST(SeriesReading, LeavesEverythingAsItWasWhenAFileCannotBeRead) {
    const TemporaryDirectory directory;
    const std::string good = directory.Path("a.tsq0");
    ASSERT_TRUE(WriteDataFile(good, Daily("2000-01-01", {2, 7})));
    const std::string bad = directory.Write("b.tsq0", "no data file");
    CTsqValues values;
    ASSERT_TRUE(values.ReadSeries(good, 0));
    ASSERT_TRUE(values.ReadSummary(good, 0));
    EXPECT_FALSE(values.ReadSeries(bad, 0));
    EXPECT_THAT(values.ReadError().Text(), HasSubstr("b.tsq0"));
    EXPECT_FALSE(values.ReadSeries(directory.Path("none.tsq0"), 0));
    EXPECT_FALSE(values.ReadSeries(good, 1));
    EXPECT_FALSE(values.ReadSeries(good, -1));
    EXPECT_EQ(values.samples.size(), 2U);
    EXPECT_EQ(values.count, 2);
    EXPECT_FALSE(values.ReadSummary(bad, 0));
    EXPECT_EQ(values.maximum.value, -CTsqValues::kHighestValue);
    EXPECT_EQ(values.last.value, 7.0);
}

/// Extracts through files: samples to a data file, read, extracted, the series file read back.
struct Extraction {
    TemporaryDirectory directory;
    RecordingPorts ports;
    SelectionRules rules;
    CTsqValues source;
    CTsqValues series;
    ExtractionReport report;

    void Run(const Samples& samples, bool silent = false) {
        ASSERT_TRUE(WriteDataFile(directory.Path("in.tsq0"), samples));
        source.UsePorts(ports);
        ASSERT_TRUE(source.ReadSeries(directory.Path("in.tsq0"), 0));
        report = source.ExtractSeries(directory.Path("out.tsq0"), rules, silent);
        ASSERT_TRUE(report.written) << report.written.Text();
        ASSERT_TRUE(series.ReadSeries(directory.Path("out.tsq0"), 0)) << series.ReadError().Text();
    }
    std::vector<std::string> Lines() const {
        std::vector<std::string> lines;
        for (const STSItem& sample : series.samples)
            lines.push_back(sample.date.Format("%Y-%m-%d %H:%M ") +
                            std::to_string(std::lround(sample.value)));
        return lines;
    }
};

TEST(Extraction, CarriesTheSelectionThroughTheSeriesFile) {
    Extraction extraction;
    extraction.Run(SamplesOf({{"1990-03-01 06:00", 3},
                              {"1990-07-01 07:15", 9},
                              {"1993-01-01 00:00", 4},
                              {"1993-12-31 23:00", 2}}));
    EXPECT_THAT(extraction.Lines(), ElementsAre("1990-07-01 07:15 9", "1993-01-01 00:00 4"));
    EXPECT_EQ(extraction.series.axisKind, AxisKind::NonEquidistantCalendar);
    EXPECT_EQ(extraction.series.itemName, "Discharge");
    EXPECT_EQ(extraction.series.itemUnit, UnitOfText("m3/s"));
    EXPECT_EQ(extraction.series.title, "gauge");
    EXPECT_EQ(extraction.report.selected, 2);
    EXPECT_THAT(extraction.ports.missingYears, ElementsAre(ElementsAre(1991, 1992)));
}

TEST(Extraction, ShowsMissingYearsEvenWhenSilent) {
    Extraction extraction;
    extraction.Run(SamplesOf({{"1990-03-01", 3}, {"1992-07-01", 9}}), /*silent=*/true);
    EXPECT_THAT(extraction.ports.missingYears, ElementsAre(ElementsAre(1991)));
}

TEST(Extraction, TellsOfTooFewPeaksUnlessSilent) {
    for (const bool silent : {false, true}) {
        Extraction extraction;
        extraction.rules.SelectionMethod = kSelectPartialDurations;
        extraction.rules.PdsDataType = kPartialDurationsByNumber;
        extraction.rules.InterTimeSpecified = false;
        extraction.rules.AvgAnNum = 2.0;
        extraction.rules.RecordLength = 2.0;
        extraction.Run(Daily("2000-01-01", {4, 6, 5}), silent);
        EXPECT_EQ(extraction.rules.AvgAnNum, 1.5);
        EXPECT_EQ(extraction.rules.Threshold, 4.0);
        EXPECT_TRUE(extraction.report.parametersChanged);
        EXPECT_EQ(extraction.ports.messages.size(), silent ? 0U : 1U);
    }
}

TEST(Extraction, WritesAValidFileWithoutStepsForAnEmptySelection) {
    Extraction extraction;
    extraction.Run(SamplesOf({{"1990-03-01", 3}}));
    EXPECT_THAT(extraction.series.samples, IsEmpty());
    EXPECT_EQ(extraction.series.itemName, "Discharge");
    EXPECT_EQ(extraction.report.selected, 0);
    EXPECT_FALSE(extraction.report.first.IsValid());
}

TEST(Extraction, KeepsAZeroAsAValue) {
    Extraction extraction;
    extraction.Run(SamplesOf({{"1990-03-01", 0}, {"1990-04-01", -2}, {"1991-07-01", -1}}));
    EXPECT_THAT(extraction.Lines(), ElementsAre("1990-03-01 00:00 0", "1991-07-01 00:00 -1"));
}

TEST(Extraction, KeepsTheOldSeriesWhenTheNewOneCannotBeWritten) {
    Extraction extraction;
    extraction.Run(SamplesOf({{"1990-03-01", 3}, {"1991-07-01", 9}}));
    const ExtractionReport report = extraction.source.ExtractSeries(
        extraction.directory.Path("none/out.tsq0"), extraction.rules, false);
    EXPECT_FALSE(report.written);
    EXPECT_THAT(report.written.Text(), HasSubstr("none/out.tsq0"));
    EXPECT_THAT(extraction.ports.messages, ElementsAre(HasSubstr("detected in file")));
}

TEST(ExtremeValueSection, HoldsValuesAndSubsamplesInFileOrder) {
    CTsqValues values;
    values.samples = Daily("2000-01-01", {1.5, 0.1, 7});
    KvfHandle tree = kvfCreate();
    kvfAddTarget(tree.get(), "RynEditor");
    values.WriteExtremeValueSection(tree.get(),
                                    [](const COleDateTime& date) { return date.GetDay(); });
    kvfEndSection(tree.get());
    EXPECT_EQ(kvfText(tree.get()), "RynEditor {\n"
                                   "    ExtremeValueSection {\n"
                                   "        NoOfItems = 3\n"
                                   "        ExtremeValues = 1.5f, 0.1f, 7.0f\n"
                                   "        SampleNo = 1, 2, 3\n"
                                   "    }\n"
                                   "}\n");
}

} // namespace
} // namespace ryn
