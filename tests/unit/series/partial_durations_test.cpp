#include "series/partial_durations.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

#include "support/sample_series.h"

namespace ryn {
namespace {

using test::At;
using test::Daily;
using test::DaysOf;
using test::Samples;
using test::ValuesOf;
using ::testing::ElementsAre;
using ::testing::IsEmpty;
using ::testing::SizeIs;

const std::vector<double> kFifteenDays = {1, 5, 2, 1, 7, 3, 1, 0.5, 1, 6, 2, 8, 1, 2, 1};

SelectionRules ByThreshold(double days) {
    SelectionRules rules;
    rules.SelectionMethod = kSelectPartialDurations;
    rules.InterTime = days;
    rules.InterLevelSpecified = false;
    return rules;
}

SelectionRules WithLevel(double days, double level) {
    SelectionRules rules = ByThreshold(days);
    rules.InterLevelSpecified = true;
    rules.InterLevel = level;
    return rules;
}

/// Every sample is a peak; the largest AvgAnNum x RecordLength stay.
SelectionRules ByNumber(double perYear, double years) {
    SelectionRules rules = ByThreshold(1.0);
    rules.InterTimeSpecified = false;
    rules.PdsDataType = kPartialDurationsByNumber;
    rules.AvgAnNum = perYear;
    rules.RecordLength = years;
    return rules;
}

std::vector<double> PeaksOf(const std::vector<double>& values, const SelectionRules& rules) {
    Samples samples = Daily("2000-01-01", values);
    return ValuesOf(SelectPartialDurations(samples, rules).selection);
}

TEST(PartialDurations, AreIndependentByTime) {
    EXPECT_THAT(PeaksOf(kFifteenDays, ByThreshold(1.5)), ElementsAre(5, 7, 1, 6, 8, 2));
    EXPECT_THAT(PeaksOf(kFifteenDays, ByThreshold(3.0)), ElementsAre(7, 8));
}

TEST(PartialDurations, AreIndependentByLevel) {
    EXPECT_THAT(PeaksOf(kFifteenDays, WithLevel(1.5, 0.5)), ElementsAre(5, 7, 6, 8));
    EXPECT_THAT(PeaksOf(kFifteenDays, WithLevel(1.5, 0.2)), ElementsAre(7, 8));
}

TEST(PartialDurations, KeepTheEarlierOfTwoEqualPeaksByTimeAndTheLaterByLevel) {
    Samples byTime = Daily("2000-01-01", {0, 5, 1, 5, 0});
    EXPECT_THAT(DaysOf(SelectPartialDurations(byTime, ByThreshold(3.0)).selection),
                ElementsAre("2000-01-02"));
    Samples byLevel = Daily("2000-01-01", {0, 5, 4, 5, 0});
    EXPECT_THAT(DaysOf(SelectPartialDurations(byLevel, WithLevel(1.5, 0.5)).selection),
                ElementsAre("2000-01-04"));
}

TEST(PartialDurations, KeepOneSampleOfAFlatPeak) {
    EXPECT_THAT(PeaksOf({0, 5, 5, 5, 0}, ByThreshold(2.0)), SizeIs(1));
}

TEST(PartialDurations, KeepEverySampleWithoutATimeToWait) {
    EXPECT_EQ(PeaksOf(kFifteenDays, ByThreshold(0.0)), kFifteenDays);
}

TEST(PartialDurations, TakeMarkedNeighboursAsDependentByLevel) {
    EXPECT_THAT(PeaksOf({1, 2, 3}, WithLevel(0.0, 1.0)), ElementsAre(3));
}

TEST(PartialDurations, IgnoreSeasonAndLevelWithoutTheTimeCriterion) {
    SelectionRules rules = WithLevel(1.5, 0.5);
    rules.InterTimeSpecified = false;
    rules.IncludeSeasonalAnalysis = true;
    rules.SeasonalStartDate = At("2000-06-01");
    rules.SeasonalEndDate = At("2000-06-30");
    EXPECT_EQ(PeaksOf(kFifteenDays, rules), kFifteenDays);
}

TEST(PartialDurations, CountOnlySamplesInSeason) {
    SelectionRules rules = ByThreshold(1.5);
    rules.IncludeSeasonalAnalysis = true;
    rules.SeasonalStartDate = At("2000-01-01");
    rules.SeasonalEndDate = At("2000-01-07");
    EXPECT_THAT(PeaksOf(kFifteenDays, rules), ElementsAre(5, 7, 1));
    rules.SeasonalStartDate = At("2000-07-01");
    rules.SeasonalEndDate = At("2000-07-31");
    EXPECT_THAT(PeaksOf(kFifteenDays, rules), IsEmpty());
    rules.SeasonalEndDate = COleDateTime();
    EXPECT_THAT(PeaksOf(kFifteenDays, rules), IsEmpty());
}

TEST(PartialDurations, KeepAValueEqualToTheThreshold) {
    SelectionRules rules = ByThreshold(1.5);
    rules.Threshold = 6.0;
    EXPECT_THAT(PeaksOf(kFifteenDays, rules), ElementsAre(7, 6, 8));
}

TEST(PartialDurations, KeepTheLargestByNumberInTimeOrder) {
    EXPECT_THAT(PeaksOf(kFifteenDays, ByNumber(2.0, 2.0)), ElementsAre(5, 7, 6, 8));
    EXPECT_THAT(PeaksOf(kFifteenDays, ByNumber(0.0, 2.0)), IsEmpty());
}

TEST(PartialDurations, KeepTheEarlierOfEqualValuesAtTheCut) {
    Samples samples = Daily("2000-01-01", {3, 1, 3, 3});
    EXPECT_THAT(DaysOf(SelectPartialDurations(samples, ByNumber(1.0, 2.0)).selection),
                ElementsAre("2000-01-01", "2000-01-03"));
}

TEST(PartialDurations, CutTheRequiredNumberToAnInteger) {
    EXPECT_THAT(PeaksOf(kFifteenDays, ByNumber(0.35, 15.0)), SizeIs(5)); // 5.25
    std::vector<double> many(40);
    for (std::size_t i = 0; i < many.size(); ++i)
        many[i] = static_cast<double>(i);
    EXPECT_THAT(PeaksOf(many, ByNumber(0.29, 100.0)), SizeIs(29)); // 28.999999999999996
}

TEST(PartialDurations, ChangeTheParametersWhenPeaksAreTooFew) {
    Samples samples = Daily("2000-01-01", kFifteenDays);
    const PartialDurations few = SelectPartialDurations(samples, ByNumber(2.0, 10.0));
    EXPECT_TRUE(few.fewerThanRequired);
    EXPECT_EQ(few.AvgAnNum, 1.5);
    EXPECT_EQ(few.Threshold, 0.5);
    EXPECT_THAT(few.selection, SizeIs(15));

    Samples again = Daily("2000-01-01", kFifteenDays);
    const PartialDurations exact = SelectPartialDurations(again, ByNumber(1.5, 10.0));
    EXPECT_FALSE(exact.fewerThanRequired);
    EXPECT_EQ(exact.AvgAnNum, 1.5);
    EXPECT_EQ(exact.Threshold, 0.0);
}

TEST(PartialDurations, FindNothingInNothing) {
    Samples none;
    EXPECT_THAT(SelectPartialDurations(none, WithLevel(1.0, 0.5)).selection, IsEmpty());
    const PartialDurations byNumber = SelectPartialDurations(none, ByNumber(1.0, 10.0));
    EXPECT_TRUE(byNumber.fewerThanRequired);
    EXPECT_EQ(byNumber.AvgAnNum, 0.0);
}

// 24 hours summed up as day fractions can come out a hair above one day.
TEST(PartialDurations, DoNotCountOneDayAsMoreThanOneDay) {
    Samples samples;
    for (int hour = 0; hour < 24 * 40; ++hour)
        samples.push_back({At("1987-03-01 01:00") + COleDateTimeSpan(hour / 24.0),
                           hour % 24 == 0 ? 5.0 + hour / 24 : 1.0, 0});
    EXPECT_THAT(ValuesOf(SelectPartialDurations(samples, ByThreshold(1.0)).selection),
                ElementsAre(44));
}

RC_GTEST_PROP(PartialDurationsProperty, PeaksLieFurtherApartThanTheInterTime, ()) {
    const auto values = *rc::gen::container<std::vector<double>>(
        rc::gen::map(rc::gen::inRange(0, 20), [](int v) { return v * 1.0; }));
    const double days = *rc::gen::inRange(0, 6) + 0.5;
    Samples samples = Daily("2000-01-01", values);
    const PartialDurations peaks = SelectPartialDurations(samples, ByThreshold(days));
    RC_ASSERT(peaks.selection.empty() == values.empty());
    for (std::size_t i = 1; i < peaks.selection.size(); ++i)
        RC_ASSERT((peaks.selection[i]->date - peaks.selection[i - 1]->date).GetTotalDays() > days);
}

} // namespace
} // namespace ryn
