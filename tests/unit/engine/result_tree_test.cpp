#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <cmath>

#include "unit/engine/engine_case.h"

namespace ryn::test {
namespace {

/// A tree as one line for each keyword: path, types of its parameters, their number.
class SchemaListing : public KvfVisitor {
  public:
    std::vector<std::string> lines;

    void BeginSection(std::string_view name) override { path += std::string(name) + "/"; }
    void EndSection() override {
        path.pop_back();
        path.erase(path.rfind('/') + 1);
    }
    void BeginKeyword(std::string_view name, int parameterCount) override {
        lines.push_back(path + std::string(name) + " " + std::to_string(parameterCount));
        type.clear();
    }
    void Parameter(const KvfParam& parameter) override {
        const char* const names[] = {"int", "float", "double", "bool", "text", "file"};
        const std::string found = names[static_cast<int>(kvfParamType(parameter))];
        type = type.empty() || type == found ? found : "mixed";
    }
    void EndKeyword() override { lines.back() += " " + type; }

  private:
    std::string path;
    std::string type;
};

struct Counts {
    int values, intervals, periods, combinations;
};

using Lines = std::vector<std::string>;

void Add(Lines& lines, const std::string& section, const std::string& keywords,
         const std::string& countAndType) {
    std::istringstream names(keywords);
    for (std::string name; names >> name;)
        lines.emplace_back("RYNoutput/" + section).append("/" + name).append(" " + countAndType);
}

std::string Doubles(int count) {
    return count == 0 ? "0 " : std::to_string(count) + " double";
}

void AddCombination(Lines& lines, const std::string& item, const Counts& counts) {
    Add(lines, item, "ItemName", "1 text");
    for (const char* n : {"1", "2", "3"}) {
        Add(lines, item + "/ParameterEstimates", std::string("bParEst") + n, "1 bool");
        Add(lines, item + "/ParameterEstimates", std::string("strParEst") + n, "1 text");
        Add(lines, item + "/ParameterEstimates", std::string("ParEst") + n, "1 double");
    }
    const struct {
        const char* flag;
        const char* numbers;
    } measures[] = {{"ChiSquaredTest", "ChiSquaredStatistic ChiSquaredLevel"},
                    {"KolmogorovSmirnovTest", "KolmogorovSmirnovStatistic KolmogorovSmirnovLevel"},
                    {"SLSCTest", "SLSCStatistic"},
                    {"PPCCTest", "PPCCStatistic"},
                    {"PPCC2Test", "PPCC2Statistic"},
                    {"LogLikelihood", "LogLikelihoodStatistic"}};
    for (const auto& measure : measures) {
        Add(lines, item + "/GoodnessOfFitStatistics", measure.flag, "1 bool");
        Add(lines, item + "/GoodnessOfFitStatistics", measure.numbers, "1 double");
    }
    Add(lines, item + "/PDFTable", "PDF", Doubles(counts.intervals));
    Add(lines, item + "/PDFPlot", "PDF", Doubles(201));
    const char* const events = "TyearEvent AvgTyearEvent StdTyearEvent";
    Add(lines, item + "/TyearEventTable", events, Doubles(counts.periods));
    Add(lines, item + "/TyearEventPlot", events, Doubles(100));
}

Lines Schema(const Counts& counts) {
    Lines lines;
    Add(lines, "Settings", "ItemName Unit Title Subtitle", "1 text");
    for (const std::string test : {"RunTest", "TestForTrend", "TestForShiftInMean"}) {
        Add(lines, "IndependenceHomogeneityTest/" + test, test, "1 bool");
        Add(lines, "IndependenceHomogeneityTest/" + test, "TestStatistic SignificanceLevel",
            "1 double");
    }
    Add(lines, "SampleStatistics", "SampleSize", "1 int");
    Add(lines, "SampleStatistics", "bPDS", "1 bool");
    Add(lines, "SampleStatistics", "Threshold AvgAnNum", "1 double");
    Add(lines, "SampleStatistics/OrdinaryMoments", "Mean Variance Skewness Kurtosis", "1 double");
    Add(lines, "SampleStatistics/ProbabilityWeightedMoments", "Beta_0 Beta_1 Beta_2 Beta_3",
        "1 double");
    Add(lines, "SampleStatistics/LMoments", "L_1 L_2 L_skewness L_Kurtosis", "1 double");
    Add(lines, "Histogram", "NoIntHistogram", "1 int");
    Add(lines, "Histogram", "XstartHistogram XstepHistogram", "1 double");
    Add(lines, "Histogram", "FrequencyHistogram", Doubles(counts.intervals));
    Add(lines, "ProbabilityPlotObs", "Nobs", "1 int");
    Add(lines, "ProbabilityPlotObs", "XobsSort", Doubles(counts.values));
    for (const char* n : {"1", "2", "3", "4", "5"}) {
        Add(lines, std::string("ProbabilityPlotObs/Item") + n, "PlottingMethod", "1 int");
        Add(lines, std::string("ProbabilityPlotObs/Item") + n, "ExceedanceProbability",
            Doubles(counts.values));
    }
    Add(lines, "DistributionAnalysis", "NoItemPDFPlot", "1 int");
    Add(lines, "DistributionAnalysis", "XvaluePDFPlot", "201 double");
    Add(lines, "DistributionAnalysis", "NoItemProbabilityPlot", "1 int");
    Add(lines, "DistributionAnalysis", "ProbabilityPlot", "100 double");
    Add(lines, "DistributionAnalysis", "NoReturnPeriods", "1 int");
    Add(lines, "DistributionAnalysis", "ReturnPeriods", Doubles(counts.periods));
    for (int i = 1; i <= counts.combinations; ++i)
        AddCombination(lines, "DistributionAnalysis/Item" + std::to_string(i), counts);
    return lines;
}

Lines SchemaOf(const EngineRunOf& run) {
    SchemaListing listing;
    kvfVisit(run.output.get(), listing);
    return listing.lines;
}

TEST(ResultTree, HoldsEveryKeyOfAnnualMaximaInOrder) {
    const EngineRunOf run({"portpirie", {"GEV/LMOM", "GUM/MOM"}});
    EXPECT_EQ(run.status, 0) << run.Log();
    EXPECT_EQ(SchemaOf(run), Schema({65, 7, 3, 2}));
}

TEST(ResultTree, HoldsEveryKeyOfPartialDurationsInOrder) {
    const EngineRunOf run({"rain40", {"EXP1/MOM"}, 1, 0, {10}});
    EXPECT_EQ(run.status, 0) << run.Log();
    EXPECT_EQ(SchemaOf(run), Schema({44, 5, 1, 1}));
    bool isPartial = false;
    kvfGetParam(SectionAt(run.Target(), "SampleStatistics"), "bPDS", &isPartial, 1, 1);
    EXPECT_TRUE(isPartial);
    EXPECT_EQ(NumberAt(run.Target(), "SampleStatistics/Threshold"), 40);
    EXPECT_EQ(NumberAt(run.Target(), "SampleStatistics/AvgAnNum"), 44.0 / 48);
}

TEST(ResultTree, IsWholeWithoutCombinationsAndPeriods) {
    const EngineRunOf run({"portpirie", {}, 0, 0, {}});
    EXPECT_EQ(run.status, 0) << run.Log();
    EXPECT_EQ(SchemaOf(run), Schema({65, 7, 0, 0}));
}

// Frechet by L-moments is offered nowhere, and GEV not for partial durations.
TEST(ResultTree, HoldsAFailedCombinationInFull) {
    for (const EngineCase& engineCase : {EngineCase{"portpirie", {"GUM/MOM", "FRE/LMOM"}},
                                         EngineCase{"rain40", {"EXP1/MOM", "GEV/MOM"}}}) {
        const EngineRunOf run(engineCase);
        EXPECT_EQ(run.status, 2) << run.Log();
        const bool isPartial = engineCase.series == "rain40";
        EXPECT_EQ(SchemaOf(run), Schema({isPartial ? 44 : 65, isPartial ? 5 : 7, 3, 2}));
        const std::string item = "DistributionAnalysis/Item2/";
        for (const char* path :
             {"ParameterEstimates/ParEst1", "ParameterEstimates/ParEst3",
              "GoodnessOfFitStatistics/ChiSquaredStatistic",
              "GoodnessOfFitStatistics/KolmogorovSmirnovLevel",
              "GoodnessOfFitStatistics/SLSCStatistic", "GoodnessOfFitStatistics/PPCCStatistic",
              "GoodnessOfFitStatistics/PPCC2Statistic",
              "GoodnessOfFitStatistics/LogLikelihoodStatistic", "PDFTable/PDF", "PDFPlot/PDF",
              "TyearEventTable/TyearEvent", "TyearEventTable/StdTyearEvent",
              "TyearEventPlot/AvgTyearEvent"})
            EXPECT_TRUE(std::isnan(NumberAt(run.Target(), item + path))) << path;
        bool flag = true;
        kvfGetParam(SectionAt(run.Target(), item + "ParameterEstimates"), "bParEst1", &flag, 1, 1);
        EXPECT_FALSE(flag);
        kvfGetParam(SectionAt(run.Target(), item + "GoodnessOfFitStatistics"), "SLSCTest", &flag, 1,
                    1);
        EXPECT_TRUE(flag);
        std::string symbol;
        kvfGetParam(SectionAt(run.Target(), item + "ParameterEstimates"), "strParEst2", &symbol, 1,
                    1);
        EXPECT_EQ(symbol, isPartial ? "alpha" : "kappa");
        EXPECT_TRUE(std::isfinite(
            NumberAt(run.Target(), "DistributionAnalysis/Item1/TyearEventTable/TyearEvent")));
    }
}

// To the bit, resamples included.
TEST(ResultTree, HoldsNumbersThatDoNotDependOnTheOtherCombinations) {
    const auto numbersOf = [](const std::vector<std::string>& names, int item) {
        const EngineRunOf run({"portpirie", names});
        const std::string path = "DistributionAnalysis/Item" + std::to_string(item);
        std::vector<double> numbers;
        for (const char* const list : {"TyearEvent", "AvgTyearEvent", "StdTyearEvent"}) {
            for (int i = 1; i <= 3; ++i)
                numbers.push_back(NumberAt(run.Target(), path + "/TyearEventTable/" + list, i));
            numbers.push_back(NumberAt(run.Target(), path + "/TyearEventPlot/" + list, 100));
        }
        return numbers;
    };
    EXPECT_EQ(numbersOf({"P3/MOM", "FRE/ML", "LN3/MOM/LBQI", "GEV/LMOM", "GEV/ML"}, 4),
              numbersOf({"GEV/LMOM"}, 1));
}

TEST(ResultTree, HasZerosForWhatWasNotAskedFor) {
    const EngineRunOf run({}, "SLSCTest = true", "SLSCTest = false");
    const std::string item = "DistributionAnalysis/Item1/GoodnessOfFitStatistics";
    bool asked = true;
    kvfGetParam(SectionAt(run.Target(), item), "SLSCTest", &asked, 1, 1);
    EXPECT_FALSE(asked);
    EXPECT_EQ(NumberAt(run.Target(), item + "/SLSCStatistic"), 0);
    EXPECT_NE(NumberAt(run.Target(), item + "/PPCCStatistic"), 0);
}

TEST(ResultTree, ListsObservationsFromTheLargestAndPositionsByFormula) {
    const EngineRunOf run({"fishkill"});
    EXPECT_EQ(NumberAt(run.Target(), "ProbabilityPlotObs/XobsSort", 1), 8800);
    EXPECT_EQ(NumberAt(run.Target(), "ProbabilityPlotObs/XobsSort", 5), 3220);
    const double ofRank5[] = {0.2, 0.1875, 0.1890547, 0.1907216, 0.1900826};
    for (int i = 0; i < 5; ++i) {
        const std::string item = "ProbabilityPlotObs/Item" + std::to_string(i + 1);
        EXPECT_EQ(NumberAt(run.Target(), item + "/PlottingMethod"), i);
        EXPECT_NEAR(NumberAt(run.Target(), item + "/ExceedanceProbability", 5), ofRank5[i], 5e-8);
    }
}

} // namespace
} // namespace ryn::test
