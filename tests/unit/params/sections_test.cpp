#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "params/combination_name.h"
#include "params/global_kvf.h"
#include "support/sample_series.h"
#include "support/temporary_directory.h"

namespace ryn {
namespace {

using test::At;
using test::Daily;
using test::TemporaryDirectory;
using test::WriteDataFile;
using ::testing::ElementsAre;
using ::testing::HasSubstr;
using ::testing::IsEmpty;

std::string TextOf(CGlobalKvf& root, const std::string& baseDirectory = "") {
    KvfHandle tree = kvfCreate();
    root.Write(tree.get(), baseDirectory);
    return kvfText(tree.get());
}

void ReadText(CGlobalKvf& root, const std::string& text, const std::string& baseDirectory = "") {
    const KvfHandle tree = kvfLoadText(text, "test");
    ASSERT_NE(tree, nullptr);
    root.Read(kvfTargetByNameNum(tree.get(), "RynEditor", 1), baseDirectory);
}

// Written by hand from the description of the file; every default and the order of the keywords.
constexpr const char* kDefaults = R"(RynEditor {
    BasicInput {
        SelectionMethod = 0
        PdsDataType = 0
        InputFileName = ""
        InputItem = 0
        OutputFileName = ""
        IncludeSeasonalAnalysis = false
        InterTimeSpecified = true
        InterLevelSpecified = true
        Threshold = 0.0
        AvgAnNum = 0.0
        InterTime = 1.0
        InterLevel = 0.5
        RecordLength = 0.0
        AmsStartDate = 1990, 1, 1, 0, 0
        SeasonalStartDate = 1990, 1, 1, 0, 0
        SeasonalEndDate = 1990, 1, 1, 0, 0
    }
    Tsq2Input {
        UseTsq2Input = false
        Tsq2InputFile = file("")
        Tsq2ItemNo = 0
        X_Range_And_Interval = 0, 0, 0
        Y_Range_And_Interval = 0, 0, 0
        Time_Range_And_Interval = 0, 0, 0
        Tsq2OutputFile = file("")
        UncertaintyCal = true
        SaveEVS = false
    }
    DefineEVS {
        SelectionMethod = 0
        InputFileName = ""
        OutputFileName = ""
        InputItem = 0
        Title = ""
        Subtitle = ""
        ItemName = ""
        Unit = ""
        Threshold = 0.0
        AvgAnNum = 0.0
    }
    Analysis {
        RunTest = false
        TestForTrend = false
        TestForShiftInMean = false
        ChiSquaredTest = false
        KolmogorovSmirnovTest = false
        SLSCTest = false
        PPCCTest = false
        PPCCTest2 = false
        LogLikelihood = false
        UncertaintyCalcType = 0
        PlottingMethod = 0
        EvaluatedReturnPeriods {
            AnnualReturnPeriod = false
            NoOfItems = 0
        }
        SelectedPeriods {
            NoOfItems = 0
        }
        SplitMethod = 0
        SplitDate {
            Date1 = 1990, 1, 1, 0, 0
        }
    }
    ProbabilityDistribution {
        NoOfItems = 0
    }
    ExtremeValueSection {
        NoOfItems = 0
        ExtremeValues =
        SampleNo =
    }
}
)";

TEST(ParameterFile, OfANewDocumentHoldsAllSectionsWithTheirDefaults) {
    CGlobalKvf root;
    EXPECT_EQ(TextOf(root), kDefaults);
}

TEST(ParameterFile, ComesBackAsItWasWritten) {
    CGlobalKvf root;
    CBasicInputKvf& basic = root.BasicInput();
    basic.SelectionMethod = 1;
    basic.PdsDataType = 1;
    basic.InputItem = 3;
    basic.IncludeSeasonalAnalysis = true;
    basic.InterTimeSpecified = false;
    basic.InterLevelSpecified = false;
    basic.Threshold = 0.1;
    basic.AvgAnNum = 2.5;
    basic.InterTime = 1.0 / 24.0;
    basic.InterLevel = 1.0 / 3.0;
    basic.RecordLength = 48.0;
    basic.AmsStartDate = At("2001-10-01");
    basic.SeasonalStartDate = At("2001-06-01 12:30");
    basic.SeasonalEndDate = COleDateTime();
    CTsq2InputKvf& grid = root.GridInput();
    grid.UseTsq2Input = true;
    grid.Tsq2InputFile = "grid one.nc";
    grid.Tsq2ItemNo = 2;
    grid.X_Range_And_Interval = {1, 9, 2};
    grid.Time_Range_And_Interval = {0, 365, 1};
    grid.Tsq2OutputFile = "/out/格子.nc";
    grid.UncertaintyCal = false;
    grid.SaveEVS = true;
    CDefineEVSKvf& define = root.DefineEVS();
    define.SelectionMethod = 1;
    define.Title = "A \"title\" with\nlines";
    define.Subtitle = "観測";
    define.Threshold = 12.5;
    define.AvgAnNum = 3.25;
    CAnalysisKvf& analysis = root.Analysis();
    analysis.RunTest = analysis.PPCCTest2 = analysis.AnnualReturnPeriod = true;
    analysis.UncertaintyCalcType = 1;
    analysis.PlottingMethod = 4;
    analysis.SplitMethod = 2;
    analysis.SplitDates = {At("1990-01-01"), At("1995-01-01 06:00")};
    analysis.Intervals = {2};
    analysis.EvaluatedReturnPeriods = {2, 10.5, 100};
    analysis.SelectedPeriods = {3, 4};
    for (const char* name : {"GP2/LMOM", "EXP1/MOM"})
        root.Distributions().Combinations.push_back(
            std::make_unique<CDieCombinationKvf>(*CombinationOfName(name, 1)));

    const std::string text = TextOf(root);
    CGlobalKvf back;
    ReadText(back, text);
    EXPECT_EQ(TextOf(back), text);
    EXPECT_FALSE(back.BasicInput().SeasonalEndDate.IsValid());
    EXPECT_THAT(text, HasSubstr("SeasonalEndDate = -1, -1, -1, -1, -1"));
    EXPECT_EQ(back.Distributions().Combinations.at(1)->ItemName, "EXP1/MOM");
    EXPECT_EQ(back.Analysis().EvaluatedReturnPeriods, analysis.EvaluatedReturnPeriods);
}

TEST(ParameterFile, StoresFileNamesRelativeToItsDirectory) {
    const TemporaryDirectory directory;
    CGlobalKvf root;
    root.BasicInput().InputFileName = directory.Path("data/in put.tsq0");
    root.DefineEVS().OutputFileName = "/elsewhere/case.res";
    const std::string base = directory.Path("");
    const std::string text = TextOf(root, base);
    EXPECT_THAT(text, HasSubstr("InputFileName = \"data/in put.tsq0\"\n"));
    EXPECT_THAT(text, HasSubstr("OutputFileName = \"\"\n"));
    CGlobalKvf back;
    ReadText(back, text, base);
    EXPECT_EQ(back.BasicInput().InputFileName, root.BasicInput().InputFileName);
    EXPECT_EQ(back.DefineEVS().OutputFileName, "/elsewhere/case.res");
    EXPECT_EQ(back.BasicInput().OutputFileName, "");
}

TEST(ParameterFile, LeavesAMemberWhoseKeywordOrSectionIsMissing) {
    CGlobalKvf root;
    ReadText(root, "RynEditor {\n BasicInput {\n InputItem = 2\n Threshold = \"no number\"\n }\n"
                   " ProbabilityDistribution {\n NoOfItems = 9\n Item1 { ItemName = \"a\" }\n"
                   " Item3 { ItemName = \"b\" }\n }\n"
                   " Analysis {\n EvaluatedReturnPeriods { Item = 5\n Item = 10.0\n Item = \"x\"\n"
                   " Item = 20 }\n SelectedPeriods { Item = 2.9 }\n }\n}\n");
    EXPECT_EQ(root.BasicInput().InputItem, 2);
    EXPECT_EQ(root.BasicInput().Threshold, 0.0);
    EXPECT_TRUE(root.GridInput().UncertaintyCal);
    EXPECT_EQ(root.Distributions().Combinations.size(), 1U);
    EXPECT_THAT(root.Analysis().EvaluatedReturnPeriods, ElementsAre(5.0, 10.0));
    EXPECT_THAT(root.Analysis().SelectedPeriods, ElementsAre(2));
}

TEST(ParameterFile, WithoutItsTargetLeavesTheDefaults) {
    CGlobalKvf root;
    root.Read(nullptr, "");
    EXPECT_EQ(TextOf(root), kDefaults);
}

std::vector<std::string> FindingsOf(CKvfBase& section, int page) {
    CMessageList messages;
    const int found = section.Check(messages, 1);
    EXPECT_EQ(static_cast<std::size_t>(found), messages.size());
    std::vector<std::string> texts;
    for (const CMessage& message : messages) {
        EXPECT_EQ(message.page, page);
        texts.push_back(message.text);
    }
    return texts;
}

TEST(BasicInputCheck, PassesAnAnnualSetupWithNonsensePartialValues) {
    CBasicInputKvf basic;
    basic.RecordLength = basic.Threshold = basic.AvgAnNum = basic.InterTime = -1.0;
    basic.InterLevel = 7.0;
    EXPECT_THAT(FindingsOf(basic, 2), IsEmpty());
}

TEST(BasicInputCheck, FindsEveryFaultInOrder) {
    CBasicInputKvf basic;
    basic.InputFileName = "/none/in.tsq0";
    basic.InputItem = 1;
    basic.SelectionMethod = 1;
    basic.Threshold = -1.0;
    basic.InterTime = -1.0;
    basic.InterLevel = 1.5;
    EXPECT_THAT(FindingsOf(basic, 2),
                ElementsAre("Can not open input file ", "Record Length must be greater than 0",
                            "Threshold Level must be greater or equal to 0",
                            "Inter Event Time must be greater or equal to 0",
                            "Inter Event Level must be in interval (0,1)"));
    basic.PdsDataType = 1;
    EXPECT_THAT(FindingsOf(basic, 2),
                ElementsAre("Can not open input file ", "Record Length must be greater than 0",
                            "Avg. Annual No. of Exceedance must be greater than 0",
                            "Inter Event Time must be greater or equal to 0",
                            "Inter Event Level must be in interval (0,1)"));
    basic.InterTimeSpecified = basic.InterLevelSpecified = false;
    basic.RecordLength = basic.AvgAnNum = 1.0;
    basic.InputFileName.clear();
    EXPECT_THAT(FindingsOf(basic, 2), IsEmpty());
}

TEST(BasicInputCheck, ComparesTheThresholdWithTheLargestValue) {
    const TemporaryDirectory directory;
    CBasicInputKvf basic;
    basic.InputFileName = directory.Path("in.tsq0");
    basic.InputItem = 1;
    basic.SelectionMethod = 1;
    basic.RecordLength = 1.0;
    ASSERT_TRUE(WriteDataFile(basic.InputFileName, Daily("2000-01-01", {1, 7.25, 3})));
    ASSERT_TRUE(basic.summary.ReadSummary(basic.InputFileName, 0));
    basic.Threshold = 7.25;
    EXPECT_THAT(FindingsOf(basic, 2), IsEmpty());
    basic.Threshold = 7.26;
    EXPECT_THAT(FindingsOf(basic, 2), ElementsAre("Threshold must be smaller than 7.250"));
}

TEST(DefineEvsCheck, FindsEveryFaultInOrder) {
    CDefineEVSKvf define;
    EXPECT_THAT(FindingsOf(define, 3),
                ElementsAre("Input file not specified", "Output file not specified"));
    define.InputFileName = "/none/series.tsq0";
    define.SelectionMethod = 1;
    define.Threshold = -0.5;
    EXPECT_THAT(FindingsOf(define, 3),
                ElementsAre("Can not open input file ", "Output file not specified",
                            "Threshold Level must be greater or equal to 0",
                            "Record Length must be greater than 0"));
    define.SelectionMethod = 0;
    define.OutputFileName = "case.res";
    EXPECT_THAT(FindingsOf(define, 3), ElementsAre("Can not open input file "));
}

TEST(DefineEvsCheck, ComparesTheThresholdWithTheSmallestValue) {
    const TemporaryDirectory directory;
    CDefineEVSKvf define;
    define.InputFileName = directory.Path("series.tsq0");
    define.OutputFileName = directory.Path("case.res");
    define.InputItem = 1;
    define.SelectionMethod = 1;
    define.AvgAnNum = 1.0;
    ASSERT_TRUE(WriteDataFile(define.InputFileName, Daily("2000-01-01", {4, 3, 5})));
    ASSERT_TRUE(define.summary.ReadSummary(define.InputFileName, 0));
    define.Threshold = 3.0 + 1e-9;
    EXPECT_THAT(FindingsOf(define, 3), IsEmpty());
    define.Threshold = 3.001;
    EXPECT_THAT(FindingsOf(define, 3), ElementsAre("Threshold must be smaller or equal to 3.000"));
}

TEST(RootCheck, LeavesTheBasicInputOutOfWhatStopsARun) {
    CGlobalKvf root;
    root.BasicInput().InputFileName = "/none/in.tsq0";
    root.DefineEVS().InputFileName = "/dev/null";
    root.DefineEVS().OutputFileName = "case.res";
    EXPECT_EQ(root.CheckForRun(), 0);
    root.Analysis().EvaluatedReturnPeriods = {0.5};
    EXPECT_EQ(root.CheckForRun(), 1);
    CMessageList messages;
    EXPECT_EQ(root.Check(messages, 1), 2);
    EXPECT_EQ(root.Check(messages, 0), 0);
    EXPECT_EQ(messages.size(), 2U);
}

TEST(SyncFromExtraction, DoesNothingBeforeAnExtraction) {
    CGlobalKvf root;
    root.BasicInput().OutputFileName = "/a/series.tsq0";
    root.DefineEVS().SyncFromExtraction(root.BasicInput());
    EXPECT_EQ(root.DefineEVS().InputFileName, "");
}

struct Synced {
    TemporaryDirectory directory;
    CGlobalKvf root;

    explicit Synced(int selectionMethod, int dataType, const std::vector<double>& values) {
        CBasicInputKvf& basic = root.BasicInput();
        basic.OutputFileName = directory.Path("series.tsq0");
        basic.SelectionMethod = selectionMethod;
        basic.PdsDataType = dataType;
        basic.Threshold = 2.5;
        basic.RecordLength = 10.0;
        basic.Extracted = true;
        root.DefineEVS().Threshold = 99.0;
        EXPECT_TRUE(WriteDataFile(basic.OutputFileName, Daily("2000-01-01", values)));
        root.DefineEVS().SyncFromExtraction(basic);
    }
    CDefineEVSKvf& Define() { return root.DefineEVS(); }
};

TEST(SyncFromExtraction, TakesOverAnAnnualSeries) {
    Synced synced(0, 0, {3, 4, 5});
    EXPECT_EQ(synced.Define().InputFileName, synced.root.BasicInput().OutputFileName);
    EXPECT_EQ(synced.Define().InputItem, 1);
    EXPECT_EQ(synced.Define().AvgAnNum, 1.0);
    EXPECT_EQ(synced.Define().Threshold, 99.0);
}

TEST(SyncFromExtraction, TakesTheThresholdOrTheSmallestValueOfAPartialSeries) {
    Synced byThreshold(1, 0, {3, 4, 5});
    EXPECT_EQ(byThreshold.Define().Threshold, 2.5);
    EXPECT_EQ(byThreshold.Define().AvgAnNum, 0.3);
    Synced byNumber(1, 1, {3, 4, 5});
    EXPECT_EQ(byNumber.Define().Threshold, 3.0);
    EXPECT_EQ(byNumber.Define().SelectionMethod, 1);
}

TEST(SyncFromExtraction, GivesNoEventsAYearForAnEmptySeries) {
    Synced synced(0, 0, {});
    EXPECT_EQ(synced.Define().AvgAnNum, 0.0);
    Synced byNumber(1, 1, {});
    EXPECT_EQ(byNumber.Define().AvgAnNum, 0.0);
    EXPECT_EQ(byNumber.Define().Threshold, 99.0);
}

TEST(ParameterFile, TakesNoItemNumberBelowOne) {
    const TemporaryDirectory directory;
    ASSERT_TRUE(WriteDataFile(directory.Path("in.tsq0"), Daily("2000-01-01", {1})));
    CGlobalKvf root;
    ReadText(root,
             "RynEditor { BasicInput { InputFileName = \"in.tsq0\"\n InputItem = -2147483648 }\n"
             "DefineEVS { InputFileName = \"in.tsq0\"\n InputItem = -2147483648 } }",
             directory.Path(""));
    EXPECT_EQ(root.BasicInput().summary.count, 0);
    EXPECT_THAT(TextOf(root), HasSubstr("NoOfItems = 0\n        ExtremeValues =\n"));
}

TEST(ExtremeValuesInTheFile, ComeFromTheSeriesFileInForce) {
    const TemporaryDirectory directory;
    CGlobalKvf root;
    root.BasicInput().OutputFileName = directory.Path("output.tsq0");
    ASSERT_TRUE(WriteDataFile(directory.Path("output.tsq0"), Daily("2000-01-01", {1, 2})));
    ASSERT_TRUE(WriteDataFile(directory.Path("series.tsq0"), Daily("2000-01-01", {7, 8, 9})));
    EXPECT_THAT(TextOf(root), HasSubstr("ExtremeValues = 1.0f, 2.0f\n"));
    root.DefineEVS().InputFileName = directory.Path("series.tsq0");
    root.DefineEVS().InputItem = 1;
    EXPECT_THAT(TextOf(root), HasSubstr("ExtremeValues = 7.0f, 8.0f, 9.0f\n"));
    EXPECT_THAT(TextOf(root), HasSubstr("SampleNo = 0, 0, 0\n"));
    EXPECT_THAT(TextOf(root), HasSubstr("ItemName = \"Discharge\"\n        Unit = \"m3/s\"\n"));
    EXPECT_THAT(root.Values().samples, IsEmpty());

    root.Analysis().TestForShiftInMean = true;
    root.Analysis().SplitDates = {At("2000-01-02")};
    EXPECT_THAT(TextOf(root), HasSubstr("SampleNo = 1, 2, 2\n"));

    root.DefineEVS().InputFileName = directory.Path("vanished.tsq0");
    EXPECT_THAT(TextOf(root), HasSubstr("NoOfItems = 0\n        ExtremeValues =\n"));
    EXPECT_THAT(TextOf(root), HasSubstr("ItemName = \"\"\n        Unit = \"\"\n"));
}

} // namespace
} // namespace ryn
