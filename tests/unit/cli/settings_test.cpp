#include "apps/cli/settings.h"

#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

#include "apps/cli/setting_value.h"
#include "params/global_kvf.h"

namespace ryn::cli {
namespace {

struct Assignment {
    std::string text;
    std::string stored; ///< as ValueText shows it; empty: refused
};

std::string ValueOf(CGlobalKvf& root, const std::string& name) {
    for (const Setting& setting : SettingsOf(root))
        if (setting.name == name)
            return ValueText(setting);
    return "no such setting";
}

TEST(Settings, TakeValuesByTheTypeOfTheKeyword) {
    const Assignment kAssignments[] = {
        {"BasicInput.SelectionMethod=PDS", "1"},
        {"BasicInput.SelectionMethod=0", "0"},
        {"BasicInput.SelectionMethod=pds", ""},
        {"BasicInput.InputItem=-3", "-3"},
        {"BasicInput.InputItem=3.0", ""},
        {"BasicInput.Threshold=1e3", "1000"},
        {"BasicInput.Threshold=inf", ""},
        {"BasicInput.Threshold=", ""},
        {"BasicInput.Threshold= 1", ""},
        {"BasicInput.InterTimeSpecified=false", "false"},
        {"BasicInput.InterTimeSpecified=1", "true"},
        {"BasicInput.InterTimeSpecified=yes", ""},
        {"BasicInput.AmsStartDate=10-01", "1990-10-01T00:00"},
        {"BasicInput.AmsStartDate=02-29", "1992-02-29T00:00"},
        {"BasicInput.AmsStartDate=2001-10-01T06:30", "2001-10-01T06:30"},
        {"BasicInput.AmsStartDate=2001-10-01 06:30", ""},
        {"BasicInput.AmsStartDate=13-01", ""},
        {"BasicInput.AmsStartDate=2001-10-01T06:30junk", ""},
        {"BasicInput.InputFileName=a/../b c.tsq0", "/home/b c.tsq0"},
        {"BasicInput.InputFileName=/data/x.tsq0", "/data/x.tsq0"},
        {"BasicInput.OutputFileName=", ""},
        {"Tsq2Input.Time_Range_And_Interval=1,20,3", "1,20,3"},
        {"Tsq2Input.Time_Range_And_Interval=1,20", ""},
        {"DefineEVS.Title=a=b", "a=b"},
        {"Analysis.PlottingMethod=Cunnane", "4"},
        {"Analysis.PlottingMethod=5", ""},
        {"Analysis.EvaluatedReturnPeriods.Item=2,2.5,1e2", "2,2.5,100"},
        {"Analysis.EvaluatedReturnPeriods.AnnualReturnPeriod=true", "true"},
        {"Analysis.SelectedPeriods.Item=3,1", "3,1"},
        {"Analysis.SelectedPeriods.Item=3,1.5", ""},
        {"Analysis.SplitDate.Date2=2001-01-01", "2001-01-01T00:00"},
        {"Analysis.SplitDate.Date3=2001-01-01", "no such setting"},
        {"Analysis.SplitDate.Interval1=2", "2"},
        {"Analysis.SplitDate.Interval2=2", "no such setting"},
    };
    for (const Assignment& assignment : kAssignments) {
        CGlobalKvf root;
        const std::string name = assignment.text.substr(0, assignment.text.find('='));
        const std::string before = ValueOf(root, name);
        const Status applied = ApplyAssignment(root, assignment.text, "/home");
        const bool mayPass = !assignment.stored.empty() || name == "BasicInput.OutputFileName";
        EXPECT_EQ(applied.IsOk(), mayPass && assignment.stored != "no such setting")
            << assignment.text << " " << applied.Text();
        EXPECT_EQ(ValueOf(root, name), applied ? assignment.stored : before) << assignment.text;
    }
}

TEST(Settings, AppendToListsInAnyNumber) {
    CGlobalKvf root;
    for (int number = 2; number <= 12; ++number)
        ASSERT_TRUE(ApplyAssignment(
            root, "Analysis.SplitDate.Date" + std::to_string(number) + "=2001-05-01", "/"));
    EXPECT_EQ(root.Analysis().SplitDates.size(), 12U);
    EXPECT_EQ(root.Analysis().SplitDates[11].GetMonth(), 5);
}

TEST(Settings, GiveBackEveryValueThatTheyShow) {
    CGlobalKvf root;
    for (const Setting& setting : SettingsOf(root)) {
        const std::string text = ValueText(setting);
        if (text.empty()) // an empty name, or an element that is not there yet
            continue;
        EXPECT_TRUE(SetValue(setting, text, "/")) << setting.name << "=" << text;
        EXPECT_EQ(ValueText(setting), text) << setting.name;
    }
}

RC_GTEST_PROP(SettingsProperty, ANumberIsStoredToTheBit, (double number)) {
    RC_PRE(std::isfinite(number));
    CGlobalKvf root;
    root.BasicInput().Threshold = number;
    const std::string text = ValueOf(root, "BasicInput.Threshold");
    root.BasicInput().Threshold = 0.0;
    RC_ASSERT(ApplyAssignment(root, "BasicInput.Threshold=" + text, "/"));
    RC_ASSERT(root.BasicInput().Threshold == number);
}

RC_GTEST_PROP(SettingsProperty, AnyTextIsTakenOrRefused, (const std::string& text)) {
    CGlobalKvf root;
    for (const Setting& setting : SettingsOf(root)) {
        const Status applied = ApplyAssignment(root, setting.name + "=" + text, "/");
        RC_ASSERT(applied.IsOk() || !applied.Text().empty());
    }
    RC_ASSERT(ApplyAssignment(root, text, "/").Text() != "" || text.find('=') != text.npos);
}

} // namespace
} // namespace ryn::cli
