#include "series/annual_maxima.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

#include "support/sample_series.h"

namespace ryn {
namespace {

using test::At;
using test::DaysOf;
using test::Samples;
using test::SamplesOf;
using test::ValuesOf;
using ::testing::ElementsAre;
using ::testing::IsEmpty;

SelectionRules YearFrom(const char* monthAndDay) {
    SelectionRules rules;
    rules.AmsStartDate = At(std::string("2000-") + monthAndDay);
    return rules;
}

SelectionRules SeasonOf(const char* start, const char* end) {
    SelectionRules rules;
    rules.IncludeSeasonalAnalysis = true;
    rules.SeasonalStartDate = At(std::string("2000-") + start);
    rules.SeasonalEndDate = At(std::string("2000-") + end);
    return rules;
}

TEST(AnnualMaxima, TakeTheLargestSampleOfEachYear) {
    Samples samples = SamplesOf({{"1990-03-01", 3},
                                 {"1990-07-01", 9},
                                 {"1991-01-01", 4},
                                 {"1991-12-31", 2},
                                 {"1992-05-05", 7}});
    const AnnualMaxima maxima = SelectAnnualMaxima(samples, SelectionRules());
    EXPECT_THAT(ValuesOf(maxima.selection), ElementsAre(9, 4, 7));
    EXPECT_THAT(maxima.missingYears, IsEmpty());
}

TEST(AnnualMaxima, TakeTheEarliestOfEqualMaxima) {
    Samples samples = SamplesOf({{"1990-03-01", 5}, {"1990-07-01", 5}, {"1991-06-01", 1}});
    EXPECT_THAT(DaysOf(SelectAnnualMaxima(samples, SelectionRules()).selection),
                ElementsAre("1990-03-01", "1991-06-01"));
}

TEST(AnnualMaxima, BeginTheYearAtMidnightOfTheStartDay) {
    Samples samples = SamplesOf(
        {{"1990-12-01", 1}, {"1991-09-30 23:59", 8}, {"1991-10-01 00:00", 6}, {"1992-03-01", 2}});
    EXPECT_THAT(ValuesOf(SelectAnnualMaxima(samples, YearFrom("10-01")).selection),
                ElementsAre(8, 6));
}

TEST(AnnualMaxima, DoNotDependOnTheYearOfTheStartDate) {
    Samples a = SamplesOf({{"1990-12-01", 1}, {"1991-11-01", 6}, {"1992-11-01", 2}});
    Samples b = a;
    SelectionRules later = YearFrom("10-01");
    later.AmsStartDate = At("2005-10-01");
    EXPECT_EQ(ValuesOf(SelectAnnualMaxima(a, YearFrom("10-01")).selection),
              ValuesOf(SelectAnnualMaxima(b, later).selection));
}

TEST(AnnualMaxima, ListTheYearsOfAGap) {
    Samples samples =
        SamplesOf({{"1990-02-01", 1}, {"1990-05-01", 2}, {"1993-05-01", 3}, {"1994-05-01", 4}});
    const AnnualMaxima maxima = SelectAnnualMaxima(samples, SelectionRules());
    EXPECT_THAT(ValuesOf(maxima.selection), ElementsAre(2, 3, 4));
    EXPECT_THAT(maxima.missingYears, ElementsAre(1991, 1992));
}

TEST(AnnualMaxima, CountBothDaysOfASeasonWithinTheYear) {
    Samples samples = SamplesOf({{"1990-05-31 23:00", 99},
                                 {"1990-06-01 00:00", 1},
                                 {"1990-09-30 23:00", 5},
                                 {"1990-10-01 00:00", 99},
                                 {"1991-07-01", 2},
                                 {"1991-09-30 12:00", 3}});
    EXPECT_THAT(ValuesOf(SelectAnnualMaxima(samples, SeasonOf("06-01", "09-30")).selection),
                ElementsAre(5, 3));
}

TEST(AnnualMaxima, CountNeitherDayOfASeasonThatWraps) {
    Samples samples = SamplesOf({{"1990-11-01", 99},
                                 {"1990-11-02", 1},
                                 {"1991-02-28", 4},
                                 {"1991-03-01", 99},
                                 {"1991-12-31", 2},
                                 {"1992-01-01", 3}});
    EXPECT_THAT(ValuesOf(SelectAnnualMaxima(samples, SeasonOf("11-01", "03-01")).selection),
                ElementsAre(4, 3));
}

TEST(AnnualMaxima, CountAllDaysButOneWhenASeasonStartsWhereItEnds) {
    Samples samples =
        SamplesOf({{"1990-06-30", 1}, {"1990-07-01", 99}, {"1990-07-02", 2}, {"1991-06-30", 3}});
    EXPECT_THAT(ValuesOf(SelectAnnualMaxima(samples, SeasonOf("07-01", "07-01")).selection),
                ElementsAre(1, 3));
}

TEST(AnnualMaxima, ListYearsWithoutASampleInSeason) {
    Samples samples =
        SamplesOf({{"1990-07-01", 1}, {"1991-01-01", 9}, {"1991-12-01", 9}, {"1992-07-01", 2}});
    const AnnualMaxima maxima = SelectAnnualMaxima(samples, SeasonOf("06-01", "08-31"));
    EXPECT_THAT(ValuesOf(maxima.selection), ElementsAre(1, 2));
    EXPECT_THAT(maxima.missingYears, ElementsAre(1991));
}

TEST(AnnualMaxima, TakeThe1stOfMarchForThe29thOfFebruaryInACommonYear) {
    SelectionRules rules;
    rules.AmsStartDate = At("2000-02-29");
    Samples samples = SamplesOf({{"1995-06-01", 1},
                                 {"1996-02-28", 5},
                                 {"1996-02-29", 7},
                                 {"1997-02-28", 3},
                                 {"1997-03-01", 2}});
    EXPECT_THAT(ValuesOf(SelectAnnualMaxima(samples, rules).selection), ElementsAre(5, 7, 2));
}

TEST(AnnualMaxima, AreEmptyForOneSampleNoneInSeasonAndInvalidDates) {
    Samples one = SamplesOf({{"1990-01-01", 1}});
    EXPECT_THAT(SelectAnnualMaxima(one, SelectionRules()).selection, IsEmpty());
    Samples none;
    EXPECT_THAT(SelectAnnualMaxima(none, SelectionRules()).selection, IsEmpty());
    Samples winter = SamplesOf({{"1990-01-01", 1}, {"1991-01-01", 1}});
    EXPECT_THAT(SelectAnnualMaxima(winter, SeasonOf("06-01", "08-31")).selection, IsEmpty());
    SelectionRules invalid;
    invalid.AmsStartDate = COleDateTime();
    Samples years = SamplesOf({{"1990-01-01", 1}, {"1991-01-01", 1}});
    EXPECT_THAT(SelectAnnualMaxima(years, invalid).selection, IsEmpty());
}

TEST(AnnualMaxima, EndAtTheCalendarsLastYear) {
    Samples samples = SamplesOf({{"9998-06-01", 1}, {"9999-06-01", 2}, {"9999-12-31 23:59:59", 3}});
    EXPECT_THAT(ValuesOf(SelectAnnualMaxima(samples, SelectionRules()).selection),
                ElementsAre(1, 3));
    for (STSItem& sample : samples)
        sample.selected = 0;
    EXPECT_THAT(ValuesOf(SelectAnnualMaxima(samples, SeasonOf("01-01", "12-31")).selection),
                ElementsAre(1, 3));
}

// A day fraction summed up from hours lies a hair beside the same moment computed from its fields.
TEST(AnnualMaxima, PutMidnightIntoTheNewYearHoweverItsDateWasSummedUp) {
    const COleDateTime start = At("1990-12-31 01:00");
    Samples samples;
    for (int hour = 0; hour < 48; ++hour)
        samples.push_back(
            {start + COleDateTimeSpan(hour / 24.0), hour == 23 ? 100.0 : hour * 1.0, 0});
    EXPECT_THAT(ValuesOf(SelectAnnualMaxima(samples, SelectionRules()).selection),
                ElementsAre(22, 100));
}

/// The definition, written the slow way: group the samples by year, take the first largest.
std::vector<double> MaximaByYear(const Samples& samples) {
    std::vector<double> maxima;
    int year = 0;
    for (const STSItem& sample : samples) {
        if (maxima.empty() || sample.date.GetYear() != year)
            maxima.push_back(sample.value);
        maxima.back() = std::max(maxima.back(), sample.value);
        year = sample.date.GetYear();
    }
    return maxima;
}

RC_GTEST_PROP(AnnualMaximaProperty, AgreeWithGroupingByCalendarYear, ()) {
    const auto steps = *rc::gen::container<std::vector<int>>(rc::gen::inRange(1, 900));
    RC_PRE(steps.size() > 1U);
    Samples samples;
    int day = 0;
    for (const int step : steps) {
        day += step;
        samples.push_back(
            {At("1950-01-01") + COleDateTimeSpan(day), *rc::gen::inRange(0, 50) * 1.0, 0});
    }
    Samples walked = samples;
    const AnnualMaxima maxima = SelectAnnualMaxima(walked, SelectionRules());
    RC_ASSERT(ValuesOf(maxima.selection) == MaximaByYear(samples));
    const int span = samples.back().date.GetYear() - samples.front().date.GetYear() + 1;
    RC_ASSERT(static_cast<int>(maxima.selection.size() + maxima.missingYears.size()) == span);
}

} // namespace
} // namespace ryn
