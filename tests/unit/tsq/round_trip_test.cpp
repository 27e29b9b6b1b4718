#include <csignal>
#include <filesystem>
#include <limits>
#include <sys/resource.h>

#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

#include "unit/tsq/series_fixture.h"

#include "support/scratch_directory.h"

namespace ryn {
namespace {

using test::Bytes;
using test::NewHeader;
using test::NewSeries;
using test::PathOf;
using test::Reading;
using test::Step;
using test::Write;
using test::WriteBytes;

const std::vector<Step> kThree = {{0.0, {1.5F}}, {3600.0, {0.0F}}, {90000.5, {-2.25F}}};

TEST(DataFile, KeepsANonEquidistantCalendarAxis) {
    const std::string path = PathOf("neq_calendar.tsq0");
    TsqHeaderHandle header = NewHeader(1);
    ASSERT_EQ(tsqSetNeqCalendarAxis(header.get(), "1987-6-5", "4:30:01", kUnitSecond, 0.0, 2), 0);
    ASSERT_EQ(Write(path, header.get(), kThree), 0);
    Reading read(path);
    ASSERT_EQ(read.result, 0) << tsqTakeError().Text();
    EXPECT_EQ(tsqGetTimeAxisType(read.header.get()), kTsqNeqCalendarAxis);
    std::string date;
    std::string time;
    std::string unitText;
    int unit = 0;
    int count = 0;
    int index = 0;
    double start = -1.0;
    double span = 0.0;
    ASSERT_EQ(tsqGetNeqCalendarAxis(read.header.get(), &date, &time, &unit, &unitText, &start,
                                    &span, &count, &index),
              0);
    EXPECT_EQ(date, "1987-06-05");
    EXPECT_EQ(time, "04:30:01");
    EXPECT_EQ(unit, kUnitSecond);
    EXPECT_EQ(unitText, "s");
    EXPECT_EQ(start, 0.0);
    EXPECT_EQ(span, 90000.5);
    EXPECT_EQ(count, 3);
    EXPECT_EQ(index, 2);
    EXPECT_EQ(read.Steps(), kThree);
    EXPECT_NE(
        tsqGetEqTimeAxis(read.header.get(), &unit, nullptr, &start, nullptr, nullptr, nullptr), 0);
}

TEST(DataFile, KeepsANonEquidistantRelativeAxis) {
    const std::string path = PathOf("neq_relative.tsq0");
    TsqHeaderHandle header = NewHeader(1);
    ASSERT_EQ(tsqSetNeqTimeAxis(header.get(), kUnitHour, 1.5, 2), 0);
    ASSERT_EQ(Write(path, header.get(), {{0.0, {1.0F}}, {0.1, {2.0F}}, {7.3, {3.0F}}}), 0);
    Reading read(path);
    int unit = 0;
    double start = 0.0;
    double span = 0.0;
    ASSERT_EQ(tsqGetNeqTimeAxis(read.header.get(), &unit, nullptr, &start, &span, nullptr, nullptr),
              0);
    EXPECT_EQ(unit, kUnitHour);
    EXPECT_EQ(start, 1.5);
    EXPECT_EQ(span, 7.3);
    EXPECT_EQ(read.Steps()[1].time, 0.1);
}

TEST(DataFile, TellsTheTimesOfAnEquidistantAxisByTheAxis) {
    const std::string path = PathOf("eq.tsq0");
    for (const TsqAxisType type : {kTsqEqTimeAxis, kTsqEqCalendarAxis}) {
        TsqHeaderHandle header = NewHeader(1);
        if (type == kTsqEqTimeAxis)
            ASSERT_EQ(tsqSetEqTimeAxis(header.get(), kUnitSecond, 0.0, 600.0, 0), 0);
        else
            ASSERT_EQ(tsqSetEqCalendarAxis(header.get(), "2000-01-01", "00:00:00", kUnitHour, 1.5,
                                           1.0 / 3.0, 0),
                      0);
        // The times given are absolute ones, and not the axis's.
        ASSERT_EQ(
            Write(path, header.get(), {{3e9, {1.0F}}, {-1.0, {2.0F}}, {std::nan(""), {3.0F}}}), 0);
        Reading read(path);
        ASSERT_EQ(tsqGetTimeAxisType(read.header.get()), type);
        const double step = type == kTsqEqTimeAxis ? 600.0 : 1.0 / 3.0;
        EXPECT_EQ(read.Steps(),
                  (std::vector<Step>{{0.0, {1.0F}}, {step, {2.0F}}, {2 * step, {3.0F}}}));
    }
    double start = 0.0;
    Reading read(path);
    ASSERT_EQ(tsqGetEqCalendarAxis(read.header.get(), nullptr, nullptr, nullptr, nullptr, &start,
                                   nullptr, nullptr, nullptr),
              0);
    EXPECT_EQ(start, 1.5);
}

TEST(DataFile, KeepsWhatItSaysOfFileAndItems) {
    const std::string path = PathOf("description.tsq0");
    TsqHeaderHandle header = NewHeader(4, "Pegel K\xc3\xb6ln, \"gauge\"\n\xe6\xb5\x81\xe9\x87\x8f");
    ASSERT_EQ(tsqSetNeqTimeAxis(header.get(), kUnitSecond, 0.0, 2), 0);
    tsqSetDeleteValFloat(header.get(), -1e-30F);
    const auto set = [&](int number, int type, const std::string& name, int unit) {
        return tsqSetItemInfo(header.get(), tsqItemD(header.get(), number), type, name, unit, 1);
    };
    set(1, 102, "Abflu\xc3\x9f / Tag (m\xc2\xb3)", UnitOfText("m3/s"));
    set(2, 100, "time", UnitOfText("furlongs of rope"));
    set(3, 4711, "time", kUnitUndefined);
    set(4, kItemTypeUndefined, "", 987654);
    ASSERT_EQ(Write(path, header.get(), {{0.0, {1, 2, 3, 4}}, {1.0, {5, 6, 7, 8}}}), 0);
    Reading read(path);
    ASSERT_EQ(read.result, 0) << tsqTakeError().Text();
    EXPECT_EQ(tsqGetFileTitle(read.header.get()), tsqGetFileTitle(header.get()));
    EXPECT_EQ(tsqGetDeleteValFloat(read.header.get()), -1e-30F);
    ASSERT_EQ(tsqGetNoOfItems(read.header.get()), 4);
    for (int i = 1; i <= 4; ++i) {
        int types[2] = {};
        int units[2] = {};
        std::string names[2];
        std::string texts[2];
        tsqGetItemInfo(tsqItemD(header.get(), i), &types[0], nullptr, &names[0], &units[0],
                       &texts[0], nullptr);
        tsqGetItemInfo(tsqItemD(read.header.get(), i), &types[1], nullptr, &names[1], &units[1],
                       &texts[1], nullptr);
        EXPECT_EQ(types[0], types[1]);
        EXPECT_EQ(units[0], units[1]);
        EXPECT_EQ(names[0], names[1]);
        EXPECT_EQ(texts[0], texts[1]);
    }
    EXPECT_EQ(read.Steps()[1].values, (std::vector<float>{5, 6, 7, 8}));
    EXPECT_EQ(tsqItemD(read.header.get(), 0), nullptr);
    EXPECT_EQ(tsqItemD(read.header.get(), 5), nullptr);
}

TEST(DataFile, PassesOverWhatIsNotAskedFor) {
    const std::string path = PathOf("three_items.tsq0");
    TsqHeaderHandle header = NewHeader(3);
    ASSERT_EQ(tsqSetNeqTimeAxis(header.get(), kUnitSecond, 0.0, 2), 0);
    ASSERT_EQ(Write(path, header.get(), {{5.0, {1, 2, 3}}, {6.0, {4, 5, 6}}}), 0);
    Reading read(path);
    float value = 0.0F;
    double time = 0.0;
    const auto next = [&](double* t, float* v) {
        return tsqReadItemTimeStep(read.header.get(), read.file.get(), t, v);
    };
    for (const float expected : {2.0F, 5.0F}) {
        EXPECT_EQ(next(nullptr, nullptr), 0);
        EXPECT_EQ(next(&time, &value), 0);
        EXPECT_EQ(next(nullptr, nullptr), 0);
        EXPECT_EQ(value, expected);
    }
    EXPECT_EQ(time, 6.0);
    EXPECT_NE(next(&time, &value), 0);
    EXPECT_EQ(tsqTakeError().Text(), path + ": no time step behind the last one");
    EXPECT_TRUE(tsqTakeError().IsOk());
    ASSERT_EQ(tsqFindBlockDynamic(read.header.get(), read.file.get()), 0);
    EXPECT_EQ(next(&time, &value), 0);
    EXPECT_EQ(value, 1.0F);
}

TEST(DataFile, CanHoldNoStepOrOne) {
    const std::string path = PathOf("few.tsq0");
    for (const std::vector<Step>& steps : {std::vector<Step>{}, {{0.0, {7.0F}}}}) {
        TsqHeaderHandle header = NewSeries();
        ASSERT_EQ(Write(path, header.get(), steps), 0);
        Reading read(path);
        ASSERT_EQ(read.result, 0) << tsqTakeError().Text();
        EXPECT_EQ(test::CountOf(read.header.get()), static_cast<int>(steps.size()));
        EXPECT_EQ(read.Date(), "1990-01-01 00:00:00");
        EXPECT_EQ(read.Steps(), steps);
        EXPECT_NE(tsqReadItemTimeStep(read.header.get(), read.file.get(), nullptr, nullptr), 0);
    }
}

RC_GTEST_PROP(DataFile, GivesBackEveryFloatAndMillisecond, ()) {
    const auto milliseconds = *rc::gen::container<std::vector<int>>(rc::gen::arbitrary<int>());
    std::vector<Step> steps;
    for (const int each : milliseconds)
        steps.push_back({each / 1000.0, {*rc::gen::arbitrary<float>()}});
    TsqHeaderHandle header = NewSeries();
    RC_ASSERT(Write(PathOf("property.tsq0"), header.get(), steps) == 0);
    RC_ASSERT(Reading(PathOf("property.tsq0")).Steps() == steps);
}

TEST(DataFile, ReadsAcrossItsBlocks) {
    const std::string path = PathOf("long.tsq0");
    std::vector<Step> steps;
    for (int i = 0; i < 40000; ++i)
        steps.push_back({i * 60.0, {static_cast<float>(i), static_cast<float>(-i)}});
    TsqHeaderHandle header = NewHeader(2);
    ASSERT_EQ(tsqSetNeqCalendarAxis(header.get(), "1890-01-01", "00:00:00", kUnitSecond, 0.0, 2),
              0);
    ASSERT_EQ(Write(path, header.get(), steps), 0);
    EXPECT_EQ(Reading(path).Steps(), steps);
}

TEST(DataFile, RoundsTimesToTheMillisecond) {
    const std::string path = PathOf("rounded.tsq0");
    TsqHeaderHandle header = NewSeries();
    // A difference of day counts times 86400: 3600 s less some 1e-7.
    const double hour = (39448.0 + 1.0 / 24.0 - 39448.0) * 86400.0;
    ASSERT_NE(hour, 3600.0);
    ASSERT_EQ(Write(path, header.get(), {{0.0, {1.0F}}, {hour, {2.0F}}, {1e300, {3.0F}}}), 0);
    const auto steps = Reading(path).Steps();
    EXPECT_EQ(steps[1].time, 3600.0);
    EXPECT_EQ(steps[2].time, 1e300);
}

TEST(DataFile, HoldsPlanesOfValues) {
    const std::string path = PathOf("plane.tsq0");
    TsqHeaderHandle header = NewHeader(2);
    tsqSetDeleteValFloat(header.get(), -9999.0F);
    ASSERT_EQ(
        tsqSetEqCalendarAxis(header.get(), "2000-01-01", "00:00:00", kUnitSecond, 0.0, 3600.0, 0),
        0);
    for (int i = 1; i <= 2; ++i)
        ASSERT_EQ(tsqSetItemAxisEqD2(tsqItemD(header.get(), i), UnitOfText("degree"), 3, 2, 10.1F,
                                     50.0F, 0.1F, -0.25F),
                  0);
    TsqFileHandle file;
    ASSERT_EQ(tsqFileCreate(path, header.get(), &file), 0);
    const float plane[6] = {1, 2, 3, 4, std::numeric_limits<float>::quiet_NaN(), 6};
    for (int i = 1; i <= 2; ++i)
        ASSERT_EQ(tsqWriteItemTimeStep(header.get(), file.get(), 3.15e9, plane), 0);
    ASSERT_EQ(tsqFileClose(header.get(), &file), 0);
    Reading read(path);
    ASSERT_EQ(read.result, 0) << tsqTakeError().Text();
    EXPECT_EQ(tsqGetItemDimensions(tsqItemD(read.header.get(), 2)), 2);
    ASSERT_EQ(tsqGetItemSize(tsqItemD(read.header.get(), 2)), 6U);
    float values[6] = {};
    ASSERT_EQ(tsqReadItemTimeStep(read.header.get(), read.file.get(), nullptr, nullptr), 0);
    ASSERT_EQ(tsqReadItemTimeStep(read.header.get(), read.file.get(), nullptr, values), 0);
    EXPECT_EQ(std::vector<float>(values, values + 6),
              (std::vector<float>{1, 2, 3, 4, -9999.0F, 6}));
}

TEST(DataFile, TheSameContentGivesTheSameBytes) {
    for (const char* const name : {"same_a.tsq0", "same_b.tsq0"}) {
        TsqHeaderHandle header = NewSeries();
        ASSERT_EQ(Write(PathOf(name), header.get(), kThree), 0);
    }
    EXPECT_EQ(Bytes(PathOf("same_a.tsq0")), Bytes(PathOf("same_b.tsq0")));
}

TEST(DataFile, TakesNamesOfAnyKind) {
    const std::string deep = PathOf(std::string(200, 'd')) + "/" + std::string(200, 'e');
    std::filesystem::create_directories(deep);
    for (const std::string& path :
         {PathOf("mit Leerzeichen.tsq0"), PathOf("\xe6\xb5\x81\xe9\x87\x8f.tsq0"),
          PathOf("a#mode=bytes\\b'\"$(x).tsq0"), deep + "/series.tsq0"}) {
        TsqHeaderHandle header = NewSeries();
        ASSERT_EQ(Write(path, header.get(), kThree), 0) << path << tsqTakeError().Text();
        EXPECT_EQ(Reading(path).Steps(), kThree) << path;
    }
}

TEST(DataFile, RefusesAxesAndItemsThatMeanNothing) {
    TsqHeaderHandle header = NewHeader(1);
    TsqHeader* const h = header.get();
    EXPECT_NE(tsqSetNeqCalendarAxis(h, "2001-02-29", "00:00:00", kUnitSecond, 0.0, 2), 0);
    EXPECT_NE(tsqSetNeqCalendarAxis(h, "", "", kUnitSecond, 0.0, 2), 0);
    EXPECT_NE(tsqSetNeqCalendarAxis(h, "2001-02-03", "24:00:00", kUnitSecond, 0.0, 2), 0);
    EXPECT_NE(tsqSetNeqCalendarAxis(h, "2001-02-03", "00:00:00", UnitOfText("month"), 0.0, 2), 0);
    EXPECT_NE(tsqSetNeqTimeAxis(h, UnitOfText("m"), 0.0, 2), 0);
    EXPECT_NE(tsqSetEqTimeAxis(h, kUnitSecond, 0.0, 0.0, 0), 0);
    EXPECT_NE(tsqSetEqTimeAxis(h, kUnitSecond, std::nan(""), 1.0, 0), 0);
    EXPECT_NE(tsqSetNeqTimeAxis(nullptr, kUnitSecond, 0.0, 2), 0);
    EXPECT_NE(tsqSetItemInfo(h, tsqItemD(h, 1), 1, "x", 0, 2), 0);
    EXPECT_NE(tsqSetItemAxisEqD2(tsqItemD(h, 1), 0, 0, 5, 0, 0, 1, 1), 0);
    EXPECT_NE(tsqSetItemAxisEqD2(tsqItemD(h, 1), 0, 1 << 20, 1 << 20, 0, 0, 1, 1), 0);
    EXPECT_EQ(tsqGetTimeAxisType(h), 0);
    TsqFileHandle file;
    EXPECT_NE(tsqFileCreate(PathOf("no_axis.tsq0"), h, &file), 0);
    EXPECT_EQ(file, nullptr);
    TsqHeaderHandle none;
    EXPECT_NE(tsqHeaderCreate(1, "t", "a", 1, 0, 1, &none), 0);
    EXPECT_EQ(none, nullptr);
}

TEST(DataFile, AnIncompleteFileDoesNotTakeItsName) {
    const std::string path = PathOf("incomplete.tsq0");
    WriteBytes(path, "old");
    const auto failing = [&](const std::vector<Step>& steps) {
        TsqHeaderHandle header = NewHeader(2);
        tsqSetNeqTimeAxis(header.get(), kUnitSecond, 0.0, 2);
        EXPECT_NE(Write(path, header.get(), steps), 0);
        return tsqTakeError().Text();
    };
    EXPECT_EQ(failing({{0.0, {1, 2}}, {1.0, {3}}}), path + ": the last time step lacks items");
    EXPECT_EQ(failing({{std::nan(""), {1, 2}}}), path + ": the time of step 1 is not finite");
    {
        TsqHeaderHandle header = NewSeries(); // dropped without being closed
        TsqFileHandle file;
        ASSERT_EQ(tsqFileCreate(path, header.get(), &file), 0);
    }
    EXPECT_EQ(Bytes(path), "old");
}

TEST(DataFile, TellsOfAPathThatCannotBeWrittenWhenItIsMade) {
    TsqHeaderHandle header = NewSeries();
    TsqFileHandle file;
    int handled = 0;
    const auto previous = tsqAddCommonErrorHandler([&](int type, const char* source, int line) {
        EXPECT_GT(type, 0);
        EXPECT_STREQ(source, "files.cpp");
        EXPECT_GT(line, 0);
        return handled++;
    });
    for (const std::string& path : {std::string("/dev/full"), test::ScratchDirectory(),
                                    PathOf("missing/series.tsq0"), std::string("")}) {
        EXPECT_NE(tsqFileCreate(path, header.get(), &file), 0) << path;
        EXPECT_EQ(file, nullptr);
        EXPECT_EQ(tsqTakeError().Kind(), Fault::System) << path;
    }
    EXPECT_EQ(handled, 4);
    EXPECT_EQ(tsqFileClose(header.get(), &file), 0);
    EXPECT_TRUE(tsqAddCommonErrorHandler(previous));
}

TEST(DataFile, AFullDiskLeavesTheOldFile) {
    const std::string directory = PathOf("full_disk/");
    std::filesystem::create_directories(directory);
    const std::string path = directory + "series.tsq0";
    WriteBytes(path, "old");
    std::vector<Step> steps;
    for (int i = 0; i < 50000; ++i)
        steps.push_back({i * 1.0, {1.0F}});
    int handled = 0;
    tsqAddCommonErrorHandler([&](int, const char*, int) { return handled++; });
    rlimit limit{};
    ASSERT_EQ(::getrlimit(RLIMIT_FSIZE, &limit), 0);
    const rlimit small{100000, limit.rlim_max}; // writing beyond it fails as on a full disk
    std::signal(SIGXFSZ, SIG_IGN);
    ASSERT_EQ(::setrlimit(RLIMIT_FSIZE, &small), 0);
    TsqHeaderHandle header = NewSeries();
    const int result = Write(path, header.get(), steps);
    ::setrlimit(RLIMIT_FSIZE, &limit);
    tsqAddCommonErrorHandler({});
    EXPECT_NE(result, 0);
    EXPECT_EQ(handled, 1);
    const Status status = tsqTakeError();
    EXPECT_EQ(status.Kind(), Fault::System);
    EXPECT_EQ(status.Text(), path + ": writing: File too large");
    EXPECT_EQ(Bytes(path), "old");
    EXPECT_EQ(std::distance(std::filesystem::directory_iterator(directory), {}), 1);
}

TEST(DataFile, ANullHandleFailsAndDoesNotCrash) {
    float value = 0.0F;
    int number = 0;
    EXPECT_EQ(tsqGetTimeAxisType(nullptr), 0);
    EXPECT_EQ(tsqGetNoOfItems(nullptr), 0);
    EXPECT_EQ(tsqItemD(nullptr, 1), nullptr);
    EXPECT_NE(tsqGetItemInfo(nullptr, &number, nullptr, nullptr, nullptr, nullptr, nullptr), 0);
    EXPECT_NE(tsqFindBlockDynamic(nullptr, nullptr), 0);
    EXPECT_NE(tsqReadItemTimeStep(nullptr, nullptr, nullptr, &value), 0);
    EXPECT_NE(tsqCountMissing(nullptr, nullptr, 1, &number), 0);
    EXPECT_NE(tsqWriteItemTimeStep(nullptr, nullptr, 0.0, &value), 0);
    EXPECT_NE(tsqSetItemRefCoords(nullptr, 0, 0, 0), 0);
    EXPECT_EQ(tsqFileClose(nullptr, nullptr), 0);
    TsqHeaderHandle header = NewSeries();
    TsqFileHandle file;
    ASSERT_EQ(tsqFileCreate(PathOf("null.tsq0"), header.get(), &file), 0);
    EXPECT_NE(tsqReadItemTimeStep(header.get(), file.get(), nullptr, &value), 0);
    EXPECT_NE(tsqWriteItemTimeStep(header.get(), file.get(), 0.0, nullptr), 0);
}

} // namespace
} // namespace ryn
