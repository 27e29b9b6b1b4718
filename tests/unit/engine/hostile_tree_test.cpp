#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "unit/engine/engine_case.h"

namespace ryn::test {
namespace {

using ::testing::HasSubstr;

struct Edit {
    const char* name;
    const char* from;
    std::string to;
    int status;
    const char* sentence; // in the log
};

std::string Repeated(const std::string& text, int count) {
    std::string all;
    for (int i = 0; i < count; ++i)
        all += text;
    return all;
}

constexpr const char* kNoNoOfItems = "ExtremeValueSection {\n        NoOfItems = 44";
constexpr const char* kFirstValue = "ExtremeValues = 44.5f";
constexpr const char* kThreshold = "Threshold = 40.0";
constexpr const char* kRate = "AvgAnNum = 0.9166666666666666";

// Edits of the text of a good tree: rain40 with one combination.
const Edit kEdits[] = {
    {"NoTarget", "RynEditor", "Other", 3, ""},
    {"NoDefinition", "DefineEVS", "Other", 3, ""},
    {"NoAnalysis", "Analysis", "Other", 3, "section Analysis is missing"},
    {"NoDistributions", "ProbabilityDistribution", "Other", 3,
     "section ProbabilityDistribution is missing"},
    {"NoSeries", "ExtremeValueSection", "Other", 3, "section ExtremeValueSection is missing"},
    {"MethodUnknown", "SelectionMethod = 1", "SelectionMethod = 2", 3,
     "DefineEVS/SelectionMethod is 2, but must be 0 (annual maxima) or 1 (partial durations)"},
    {"MethodIsText", "SelectionMethod = 1", "SelectionMethod = \"1\"", 3,
     "DefineEVS/SelectionMethod is not a whole number"},
    {"NoRate", kRate, "Other = 1", 3, "DefineEVS/AvgAnNum is missing"},
    {"RateZero", kRate, "AvgAnNum = 0", 3, "DefineEVS/AvgAnNum is 0"},
    {"RateNegative", kRate, "AvgAnNum = -2.5", 3, "DefineEVS/AvgAnNum is -2.5"},
    {"RateNaN", kRate, "AvgAnNum = nan", 3, "DefineEVS/AvgAnNum is nan"},
    {"RateInfinite", kRate, "AvgAnNum = inf", 3, "DefineEVS/AvgAnNum is inf"},
    {"ThresholdNaN", kThreshold, "Threshold = nan", 3, "DefineEVS/Threshold is nan"},
    {"ThresholdIsText", kThreshold, "Threshold = \"40\"", 3, "DefineEVS/Threshold is not a number"},
    {"ThresholdAboveAValue", kThreshold, "Threshold = 40.2", 1,
     "value 39 of the series is 40.1, below DefineEVS/Threshold 40.2"},
    {"DistributionUnknown", "DistributionType = 8", "DistributionType = 11", 3,
     "ProbabilityDistribution/Item1/DistributionType is 11, but must be from 0 to 10"},
    {"DistributionNegative", "DistributionType = 8", "DistributionType = -2147483648", 3,
     "ProbabilityDistribution/Item1/DistributionType is -2147483648"},
    {"MethodOfEstimationMissing", "EstimationMethod", "Other", 3,
     "ProbabilityDistribution/Item1/EstimationMethod is missing"},
    {"OptionUnknown", "LogNormalType = 0", "LogNormalType = 99", 2,
     "warning: ProbabilityDistribution/Item1/LogNormalType is 99"},
    {"FlagIsNumber", "ChiSquaredTest = true", "ChiSquaredTest = 1", 3,
     "Analysis/ChiSquaredTest is neither true nor false"},
    {"PlottingUnknown", "PlottingMethod = 4", "PlottingMethod = 5", 2,
     "warning: Analysis/PlottingMethod is 5, which has no meaning; 0 is taken"},
    {"UncertaintyUnknown", "UncertaintyCalcType = 0", "UncertaintyCalcType = -1", 2,
     "warning: Analysis/UncertaintyCalcType is -1"},
    {"CountMissing", kNoNoOfItems, "ExtremeValueSection {", 3,
     "ExtremeValueSection/NoOfItems is missing"},
    {"CountTooLarge", kNoNoOfItems, "ExtremeValueSection {\nNoOfItems = 45", 3,
     "ExtremeValueSection/NoOfItems is 45, but ExtremeValues has 44 values"},
    {"CountNegative", kNoNoOfItems, "ExtremeValueSection {\nNoOfItems = -1", 3,
     "ExtremeValueSection/NoOfItems is -1"},
    {"CountHuge", kNoNoOfItems, "ExtremeValueSection {\nNoOfItems = 2147483647", 3,
     "NoOfItems is 2147483647; at most 1000000 values are analysed"},
    {"SamplesMissing", "SampleNo", "Other", 3, "but SampleNo has 0 values"},
    {"SampleIsDouble", "SampleNo = 1", "SampleNo = 1.5", 3,
     "ExtremeValueSection/SampleNo has no number at position 1"},
    {"ValueIsText", kFirstValue, "ExtremeValues = \"44.5\"", 3,
     "ExtremeValueSection/ExtremeValues has no number at position 1"},
    {"ValueNaN", kFirstValue, "ExtremeValues = nan", 1, "value 1 of the series is nan"},
    {"ValueInfinite", kFirstValue, "ExtremeValues = -inf", 1, "value 1 of the series is -inf"},
    {"ValueAtTheEndOfFloats", kFirstValue, "ExtremeValues = 3.4e38f", 0, "EXP1/MOM: ok"},
    {"ValueAtTheEndOfDoubles", kFirstValue, "ExtremeValues = 1.7e308", 0, "EXP1/MOM: ok"},
    {"PeriodNaN", "Item = 10.0", "Item = nan", 2,
     "warning: no event has a return period of nan years: it must be a number greater than 1.09"},
    {"PeriodInfinite", "Item = 10.0", "Item = inf", 2, "no event has a return period of inf years"},
    {"PeriodTooShort", "Item = 10.0", "Item = 1", 2, "no event has a return period of 1 years"},
    {"PeriodNegative", "Item = 10.0", "Item = -5.5", 2,
     "no event has a return period of -5.5 years"},
    {"PeriodIsText", "Item = 50.0", "Item = \"50\"", 3,
     "Analysis/EvaluatedReturnPeriods/Item number 2 is not a number"},
    {"PeriodsBeyondBounds", "Item = 50.0", Repeated("Item = 20\n", 1'000'000), 3,
     "Analysis/EvaluatedReturnPeriods/Item occurs more than 10000 times"},
    {"PeriodCountLies", "NoOfItems = 3", "NoOfItems = 2000000000", 2,
     "warning: Analysis/EvaluatedReturnPeriods/NoOfItems is 2000000000, but 3 were found"},
    {"CombinationCountLies", "NoOfItems = 1\n", "NoOfItems = -7\n", 2,
     "warning: ProbabilityDistribution/NoOfItems is -7, but 1 were found"},
    {"NameWithLineFeeds", "\"EXP1/MOM\"", "\"a\\nfinished with status 0\\x1B[2J\"", 0,
     "\na finished with status 0 [2J: ok\n"},
    {"NameEmpty", "\"EXP1/MOM\"", "\"\"", 0, "\ncombination 1: ok\n"},
    {"NameHuge", "\"EXP1/MOM\"", "\"" + Repeated("x", 1'000'000) + "\"", 0, "xxx...: ok\n"},
    {"UncertaintyNotWanted", "UseTsq2Input = false\n        UncertaintyCal = true",
     "UseTsq2Input = true\nUncertaintyCal = false", 0,
     "Uncertainty: not computed, since Tsq2Input/UncertaintyCal is false"},
};

class HostileTree : public ::testing::TestWithParam<Edit> {};

TEST_P(HostileTree, EndsInItsStatusAndSaysWhy) {
    const Edit& edit = GetParam();
    const EngineRunOf run({"rain40", {"EXP1/MOM"}}, edit.from, edit.to);
    EXPECT_EQ(run.status, edit.status);
    EXPECT_EQ(run.Target() != nullptr, edit.status == 0 || edit.status == 2);
    if (edit.sentence[0] == '\0') { // nothing names a directory
        EXPECT_FALSE(run.directory.Has("Ryn.log"));
        return;
    }
    EXPECT_THAT(run.Log(), HasSubstr(edit.sentence));
    EXPECT_THAT(run.Log(),
                ::testing::EndsWith("finished with status " + std::to_string(edit.status) + "\n"));
}

INSTANTIATE_TEST_SUITE_P(Edits, HostileTree, ::testing::ValuesIn(kEdits),
                         [](const auto& edit) { return std::string(edit.param.name); });

std::int32_t StatusOfValues(const std::vector<double>& values, std::string* log) {
    const TemporaryDirectory directory;
    KvfHandle tree = kvfCreate();
    kvfAddTarget(tree.get(), "RynEditor");
    PutDefinition(tree.get(), "portpirie", directory.Root().string());
    PutAnalysis(tree.get(), {});
    kvfAddSection(tree.get(), "ProbabilityDistribution");
    kvfEndSection(tree.get());
    PutSeries(tree.get(), values, 1);
    KvfHandle output = kvfCreate();
    std::int32_t status = -1;
    RYNENGINE(&tree, &output, &status);
    *log = directory.Read("Ryn.log");
    return status;
}

TEST(UnusableSeries, FailsForItsPointAlone) {
    const struct {
        std::vector<double> values;
        const char* sentence;
    } cases[] = {
        {{}, "error: the series is empty"},
        {{1, 2, 3, 4}, "error: the series has 4 value(s); at least 5 are needed"},
        {{7, 7, 7, 7, 7, 7}, "error: all values of the series are equal (7)"},
    };
    for (const auto& c : cases) {
        std::string log;
        EXPECT_EQ(StatusOfValues(c.values, &log), 1);
        EXPECT_THAT(log, HasSubstr(c.sentence));
    }
}

// A tree without anything to resample is cheap at any size: the bound on values is far beyond.
TEST(UnusableSeries, HasTestsThatCannotBeMade) {
    std::string log;
    EXPECT_EQ(StatusOfValues({1, 1, 1, 1, 1, 2}, &log), 2);
    EXPECT_THAT(log, HasSubstr("warning: run test not made"));
    EXPECT_THAT(log, HasSubstr("warning: test for shift in mean not made"));
}

TEST(NullArguments, EndInStatus3) {
    const KvfHandle none;
    const TemporaryDirectory directory;
    const KvfHandle good = TreeOf({}, directory.Root().string());
    KvfHandle output = kvfCreate();
    KvfHandle nullOutput;
    const struct {
        const KvfHandle* input;
        KvfHandle* output;
    } cases[] = {{nullptr, &output}, {&none, &output}, {&good, nullptr}, {&good, &nullOutput}};
    for (const auto& c : cases) {
        std::int32_t status = 0;
        RYNENGINE(c.input, c.output, &status);
        EXPECT_EQ(status, 3);
    }
    EXPECT_THAT(directory.Read("Ryn.log"),
                HasSubstr("error: there is no tree that could take the results"));
    EXPECT_EQ(kvfText(output.get()), kvfText(kvfCreate().get()));
    RYNENGINE(&good, &output, nullptr);
    EXPECT_NE(kvfTargetByNameNum(output.get(), "RYNoutput", 1), nullptr);
}

} // namespace
} // namespace ryn::test
