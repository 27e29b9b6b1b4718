#include <cmath>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "unit/tsq/series_fixture.h"

namespace ryn {
namespace {

using test::MakeNetcdf;
using test::Reading;
using test::Step;

/// A file with times and one item of four values.
std::string FourSteps(const std::string& name, const std::string& timeAttributes,
                      const std::string& times, const std::string& timeType = "double") {
    return MakeNetcdf(name, "dimensions: time = 4 ; variables: " + timeType + " time(time) ; " +
                                timeAttributes +
                                " float q(time) ; q:units = \"m3 s-1\" ;"
                                " q:long_name = \"Abfluss\" ; data: time = " +
                                times + " ; q = 1, 2, 3, 4 ;");
}

std::vector<double> Times(Reading* read) {
    std::vector<double> times;
    for (const Step& step : read->Steps())
        times.push_back(step.time);
    return times;
}

std::string Refusal(const std::string& path) {
    Reading read(path);
    EXPECT_NE(read.result, 0) << path;
    EXPECT_EQ(read.header, nullptr);
    EXPECT_EQ(read.file, nullptr);
    const std::string text = tsqTakeError().Text();
    EXPECT_EQ(text.rfind(path + ": ", 0), 0U) << text;
    EXPECT_EQ(text.find('\n'), std::string::npos) << text;
    return text.substr(std::min(text.size(), path.size() + 2));
}

TEST(ForeignFile, HasACalendarAxisInSecondsFromItsFirstStep) {
    struct Case {
        const char* units;
        const char* calendar;
        const char* times;
        const char* date;
        std::vector<double> seconds;
    };
    const double day = 86400.0;
    const Case cases[] = {
        {"days since 1900-1-1",
         "",
         "0.5, 1, 2, 36524",
         "1900-01-01 12:00:00",
         {0, day / 2, day * 1.5, day * 36523.5}},
        {"hours since 1990-01-01T06:00:00Z",
         "gregorian",
         "-6, 0, 1, 2",
         "1990-01-01 00:00:00",
         {0, 21600, 25200, 28800}},
        {"seconds since 1990-01-01 00:00:00",
         "standard",
         "0.25, 1, 2, 3",
         "1990-01-01 00:00:00",
         {0.25, 1, 2, 3}},
        {"months since 1999-12-01",
         "proleptic_gregorian",
         "0, 1, 2, 3",
         "1999-12-01 00:00:00",
         {0, day * 31, day * 62, day * 91}},
        {"months since 1999-12-01",
         "",
         "0, 0.5, 1, 2",
         "1999-12-01 00:00:00",
         {0, 1314871.916, 2629743.831, 5259487.662}},
        {"days since 2000-02-27",
         "noleap",
         "0, 1, 2, 3",
         "2000-02-27 00:00:00",
         {0, day, day * 3, day * 4}},
        {"days since 2001-01-01",
         "360_day",
         "0, 179, 180, 359",
         "2001-01-01 00:00:00",
         {0, day * 181, day * 183, day * 364}},
        {"days since 0101-02-03",
         "julian",
         "0, 1, 2, 3",
         "0101-02-02 00:00:00",
         {0, day, day * 2, day * 3}},
    };
    for (const Case& c : cases) {
        std::string attributes = "time:units = \"" + std::string(c.units) + "\" ;";
        if (*c.calendar != '\0')
            attributes += "time:calendar = \"" + std::string(c.calendar) + "\" ;";
        Reading read(FourSteps("calendar", attributes, c.times));
        ASSERT_EQ(read.result, 0) << c.units << tsqTakeError().Text();
        EXPECT_EQ(tsqGetTimeAxisType(read.header.get()), kTsqNeqCalendarAxis);
        EXPECT_EQ(read.Date(), c.date) << c.units;
        EXPECT_EQ(Times(&read), c.seconds) << c.units << c.calendar;
    }
}

TEST(ForeignFile, TakesItsDescriptionFromTheUsualAttributes) {
    Reading read(FourSteps("described",
                           "time:units = \"days since 2000-01-01\" ; :title = \"Rhine\" ;",
                           "0, 1, 2, 3", "int"));
    ASSERT_EQ(read.result, 0) << tsqTakeError().Text();
    EXPECT_EQ(tsqGetFileTitle(read.header.get()), "Rhine");
    EXPECT_EQ(read.ItemName(1), "Abfluss");
    int unit = 0;
    std::string type;
    tsqGetItemInfo(tsqItemD(read.header.get(), 1), nullptr, &type, nullptr, &unit, nullptr,
                   nullptr);
    EXPECT_EQ(unit, UnitOfText("m3/s"));
    EXPECT_EQ(type, "Discharge");
    EXPECT_EQ(read.Steps()[3].values[0], 4.0F);
}

TEST(ForeignFile, AnAxisWithoutADateIsRelative) {
    Reading read(FourSteps("relative", "time:units = \"hours\" ;", "1, 2, 3, 4.5"));
    ASSERT_EQ(read.result, 0) << tsqTakeError().Text();
    EXPECT_EQ(tsqGetTimeAxisType(read.header.get()), kTsqNeqTimeAxis);
    EXPECT_EQ(Times(&read), (std::vector<double>{3600, 7200, 10800, 16200}));
}

TEST(ForeignFile, ItemsAreTheNumbersAlongTheTimeAxis) {
    const std::string path = MakeNetcdf(
        "items",
        "dimensions: station = 1 ; obs = 3 ; two = 2 ; y = 3 ;\n"
        "variables: double when(obs) ; when:units = \"days since 2000-01-01\" ;\n"
        "  when:bounds = \"when_bnds\" ; double when_bnds(obs, two) ;\n"
        "  short level(station, obs) ; level:scale_factor = 0.1 ; level:coordinates = \"lat\" ;\n"
        "  float lat(obs) ; char flag(obs) ; float place(y) ; float spread(obs, y) ;\n"
        "  double turned(y, obs) ; int count(obs, station) ;\n"
        "data: when = 0, 1, 2 ; level = 10, 20, 30 ; count = 7, 8, 9 ;\n"
        "  spread = 1, 2, 3, 4, 5, 6, 7, 8, 9 ; turned = 1, 2, 3, 4, 5, 6, 7, 8, 9 ;");
    Reading read(path);
    ASSERT_EQ(read.result, 0) << tsqTakeError().Text();
    std::string names;
    std::string dimensions;
    for (int i = 1; i <= tsqGetNoOfItems(read.header.get()); ++i) {
        names += read.ItemName(i) + " ";
        dimensions += std::to_string(tsqGetItemDimensions(tsqItemD(read.header.get(), i)));
    }
    EXPECT_EQ(names, "level spread turned count ");
    EXPECT_EQ(dimensions, "0110");
    float values[4][3] = {};
    for (int step = 0; step < 2; ++step)
        for (auto& each : values)
            ASSERT_EQ(tsqReadItemTimeStep(read.header.get(), read.file.get(), nullptr, each), 0);
    EXPECT_EQ(values[0][0], 2.0F);
    EXPECT_EQ(std::vector<float>(values[1], values[1] + 3), (std::vector<float>{4, 5, 6}));
    EXPECT_EQ(std::vector<float>(values[2], values[2] + 3), (std::vector<float>{2, 5, 8}));
    EXPECT_EQ(values[3][0], 8.0F);
}

TEST(ForeignFile, OpensInEveryFormat) {
    for (const char* const kind : {"classic", "64-bit-offset", "64-bit-data", "nc4", "nc7"}) {
        Reading read(MakeNetcdf("format",
                                "dimensions: time = UNLIMITED ; variables: double time(time) ;"
                                " time:units = \"s\" ; float a(time) ; float b(time) ;"
                                " data: time = 1, 2 ; a = 3, 4 ; b = 5, 6 ;",
                                kind));
        ASSERT_EQ(read.result, 0) << kind << tsqTakeError().Text();
        EXPECT_EQ(read.Steps(), (std::vector<Step>{{1.0, {3, 5}}, {2.0, {4, 6}}})) << kind;
    }
}

TEST(ForeignFile, CountsMissingValuesAndReadsThemAsNaN) {
    const std::string path = MakeNetcdf(
        "missing",
        "dimensions: time = 4 ; variables: double time(time) ; time:units = \"s\" ;"
        " float a(time) ; a:_FillValue = -9.f ; a:missing_value = -8.f ; double b(time) ;"
        " data: time = 1, 2, 3, 4 ; a = -9, 1, -8, NaN ; b = 1, 2, 3, _ ;");
    Reading read(path);
    ASSERT_EQ(read.result, 0) << tsqTakeError().Text();
    int missing = 0;
    ASSERT_EQ(tsqCountMissing(read.header.get(), read.file.get(), 1, &missing), 0);
    EXPECT_EQ(missing, 3);
    ASSERT_EQ(tsqCountMissing(read.header.get(), read.file.get(), 2, &missing), 0);
    EXPECT_EQ(missing, 1);
    EXPECT_NE(tsqCountMissing(read.header.get(), read.file.get(), 3, &missing), 0);
    EXPECT_EQ(tsqGetDeleteValFloat(read.header.get()), -9.0F);
    float value = 0.0F;
    ASSERT_EQ(tsqReadItemTimeStep(read.header.get(), read.file.get(), nullptr, &value), 0);
    EXPECT_TRUE(std::isnan(value));
}

TEST(ForeignFile, IsRefusedInOneClearLine) {
    const std::string since = "time:units = \"days since 2000-01-01\" ;";
    EXPECT_EQ(Refusal(FourSteps("backward", since, "0, 2, 1, 3")),
              "\"time\" goes back in time at step 3");
    EXPECT_EQ(Refusal(FourSteps("repeated", since, "0, 1, 1, 3")),
              "\"time\" repeats a time at step 3");
    EXPECT_EQ(Refusal(FourSteps("nan", since, "0, 1, NaN, 3")),
              "\"time\" has no date between the years 100 and 9999 at step 3");
    EXPECT_EQ(
        Refusal(FourSteps("unit", "time:units = \"furlongs\" ; time:axis = \"T\" ;", "0, 1, 2, 3")),
        "\"time\" has a fault: unit \"furlongs\" is no unit of time");
    EXPECT_EQ(Refusal(FourSteps("calendar", since + "time:calendar = \"mayan\" ;", "0, 1, 2, 3")),
              "\"time\" has a fault: calendar \"mayan\" is not known");
    EXPECT_EQ(Refusal(FourSteps("text", since, "\"abcd\"", "char")), "has no time axis");
    EXPECT_EQ(Refusal(MakeNetcdf("none", "dimensions: x = 2 ; variables: float q(x) ;"
                                         " data: q = 1, 2 ;")),
              "has no time axis");
    EXPECT_EQ(Refusal(MakeNetcdf("alone", "dimensions: time = 2 ; variables: double time(time) ;"
                                          " time:units = \"s\" ; data: time = 1, 2 ;")),
              "has no item along its time axis");
    EXPECT_EQ(Refusal(MakeNetcdf("empty_variable",
                                 "dimensions: time = 500000000 ; variables: double time(time) ;"
                                 " time:units = \"s\" ; float q(time) ;",
                                 "nc4")),
              "\"time\" counts 500000000 time steps, more than the file can hold");
}

TEST(ForeignFile, StepsInAnyOrderOpenForWhoSortsThem) {
    const std::string path =
        FourSteps("any_order", "time:units = \"days since 2000-01-01\" ;", "1, 0, 0, 2");
    Reading read("");
    ASSERT_EQ(tsqFileReadUnordered(path, &read.header, &read.file), 0);
    EXPECT_EQ(read.Date(), "2000-01-02 00:00:00");
    EXPECT_EQ(Times(&read), (std::vector<double>{0, -86400, -86400, 86400}));
}

// What a program does that reads a file of ours and writes it anew: our attributes stay beside its
// own choice of times and marks.
TEST(ForeignFile, OurAttributesDoNotOutweighTheTimes) {
    const std::string ours = "int q_dummy ; :ryn_format = 1 ; time:ryn_axis = 3 ;"
                             " time:ryn_unit = 1400 ; time:ryn_start = 0. ; time:ryn_step = 60. ;";
    const std::string since = "time:units = \"seconds since 2000-01-01\" ;"
                              " time:calendar = \"proleptic_gregorian\" ;";
    Reading whole(FourSteps("rewritten", ours + since, "0, 60, 120, 180"));
    EXPECT_EQ(tsqGetTimeAxisType(whole.header.get()), kTsqEqCalendarAxis);
    Reading cut(FourSteps("rewritten", ours + since, "60, 120, 180, 300"));
    EXPECT_EQ(tsqGetTimeAxisType(cut.header.get()), kTsqNeqCalendarAxis);
    EXPECT_EQ(Times(&cut), (std::vector<double>{60, 120, 180, 300}));
    Reading days(FourSteps("rewritten", ours + "time:units = \"days since 2000-01-01\" ;",
                           "0, 1, 2, 3", "int"));
    EXPECT_EQ(Times(&days), (std::vector<double>{0, 86400, 172800, 259200}));
    Reading marked(FourSteps("rewritten", ours + since + "float r(time) ; r:_FillValue = NaNf ;",
                             "0, 60, 120, 180"));
    int missing = 0;
    ASSERT_EQ(tsqCountMissing(marked.header.get(), marked.file.get(), 1, &missing), 0);
    EXPECT_EQ(missing, 4);
}

} // namespace
} // namespace ryn
