#include "params/analysis_kvf.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "params/global_kvf.h"
#include "strings/language.h"
#include "support/sample_series.h"

namespace ryn {
namespace {

using test::At;
using ::testing::ElementsAre;
using ::testing::IsEmpty;

std::vector<std::string> FindingsOf(CGlobalKvf& root) {
    CMessageList messages;
    const int found = root.Analysis().Check(messages, 1);
    std::vector<std::string> texts;
    for (const CMessage& message : messages) {
        EXPECT_EQ(message.page, 4);
        EXPECT_EQ(message.flag, 1);
        texts.push_back(message.text);
    }
    EXPECT_EQ(static_cast<std::size_t>(found), texts.size());
    return texts;
}

TEST(ReturnPeriods, OfAnAnnualSeriesMustBeAboveOneYear) {
    CGlobalKvf root;
    root.Analysis().EvaluatedReturnPeriods = {1.0, 1.01, 0.5};
    EXPECT_THAT(FindingsOf(root),
                ElementsAre("Evaluated return period 1.000 must be greater than 1.000",
                            "Evaluated return period 0.500 must be greater than 1.000"));
}

TEST(ReturnPeriods, OfAPartialSeriesMustBeAboveTheIntervalOfItsEvents) {
    CGlobalKvf root;
    root.DefineEVS().SelectionMethod = 1;
    root.DefineEVS().AvgAnNum = 2.0;
    root.Analysis().EvaluatedReturnPeriods = {0.5, 0.6};
    EXPECT_THAT(FindingsOf(root),
                ElementsAre("Evaluated return period 0.500 must be greater than 0.500"));
    root.Analysis().AnnualReturnPeriod = true;
    root.Analysis().EvaluatedReturnPeriods = {1.1565, 1.2};
    EXPECT_THAT(FindingsOf(root),
                ElementsAre("Evaluated return period 1.157 must be greater than 1.157"));
    root.DefineEVS().AvgAnNum = 0.0;
    EXPECT_THAT(FindingsOf(root), IsEmpty());
}

TEST(ReturnPeriods, AreNotCheckedWithoutAParent) {
    CAnalysisKvf alone;
    alone.EvaluatedReturnPeriods = {0.1};
    CMessageList messages;
    EXPECT_EQ(alone.Check(messages, 1), 0);
}

TEST(ReturnPeriods, AreReportedInJapanese) {
    CGlobalKvf root;
    root.Analysis().EvaluatedReturnPeriods = {1.0};
    SetLanguage(Language::Japanese);
    const auto texts = FindingsOf(root);
    SetLanguage(Language::English);
    EXPECT_THAT(texts, ElementsAre("評価する再現期間 1.000 は 1.000 より大きくなければなりません"));
}

CAnalysisKvf& Split(CGlobalKvf& root, int method, std::vector<COleDateTime> dates) {
    root.Analysis().TestForShiftInMean = true;
    root.Analysis().SplitMethod = method;
    root.Analysis().SplitDates = std::move(dates);
    return root.Analysis();
}

TEST(Subsamples, AreAllZeroWithoutTheTestForShift) {
    CGlobalKvf root;
    CAnalysisKvf& analysis = Split(root, kSplitByDate, {At("1990-06-01")});
    analysis.TestForShiftInMean = false;
    EXPECT_EQ(analysis.SampleOfDate(At("1980-01-01")), 0);
    analysis.TestForShiftInMean = true;
    analysis.SplitDates.clear();
    EXPECT_EQ(analysis.SampleOfDate(At("1980-01-01")), 0);
}

TEST(Subsamples, ByDatePutTheSplitDateIntoTheSecond) {
    CGlobalKvf root;
    const CAnalysisKvf& analysis = Split(root, kSplitByDate, {At("1990-06-01 12:00")});
    EXPECT_EQ(analysis.SampleOfDate(At("1990-06-01 11:59")), 1);
    EXPECT_EQ(analysis.SampleOfDate(At("1990-06-01 12:00")), 2);
}

TEST(Subsamples, BySeasonHoldBothDaysUnlessTheSeasonWraps) {
    CGlobalKvf root;
    const CAnalysisKvf& summer = Split(root, kSplitBySeason, {At("1990-06-01"), At("1990-08-31")});
    EXPECT_EQ(summer.SampleOfDate(At("2001-06-01")), 1);
    EXPECT_EQ(summer.SampleOfDate(At("2001-08-31 23:00")), 1);
    EXPECT_EQ(summer.SampleOfDate(At("2001-09-01")), 2);
    const CAnalysisKvf& winter = Split(root, kSplitBySeason, {At("1990-11-01"), At("1990-03-01")});
    EXPECT_EQ(winter.SampleOfDate(At("2001-11-01")), 2);
    EXPECT_EQ(winter.SampleOfDate(At("2001-11-02")), 1);
    EXPECT_EQ(winter.SampleOfDate(At("2001-02-28")), 1);
    EXPECT_EQ(winter.SampleOfDate(At("2001-03-01")), 2);
    EXPECT_EQ(Split(root, kSplitBySeason, {At("1990-11-01")}).SampleOfDate(At("2001-01-01")), 0);
}

TEST(Subsamples, ByCustomPeriodsLeaveOutTheLimits) {
    CGlobalKvf root;
    CAnalysisKvf& analysis =
        Split(root, kSplitCustom,
              {At("1990-01-01"), At("1995-01-01"), At("1996-01-01"), At("2000-01-01")});
    analysis.Intervals = {2, 1};
    EXPECT_EQ(analysis.SampleOfDate(At("1990-01-01")), 0);
    EXPECT_EQ(analysis.SampleOfDate(At("1990-01-02")), 2);
    EXPECT_EQ(analysis.SampleOfDate(At("1995-01-01")), 0);
    EXPECT_EQ(analysis.SampleOfDate(At("1995-06-01")), 0);
    EXPECT_EQ(analysis.SampleOfDate(At("1999-12-31")), 1);
    analysis.Intervals = {2};
    EXPECT_EQ(analysis.SampleOfDate(At("1999-12-31")), 0);
}

} // namespace
} // namespace ryn
