#include "engine/result_tree.h"

#include <cmath>
#include <limits>
#include <string>

namespace ryn {

namespace {

constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();

/// A section for as long as the object lives.
/// Its end closes it, so that no early return leaves the rest of the tree one level too deep.
class OpenSection {
  public:
    OpenSection(KvfTree* builtTree, std::string_view name) : tree(builtTree) {
        kvfAddSection(tree, name);
    }
    ~OpenSection() { kvfEndSection(tree); }
    OpenSection(const OpenSection&) = delete;
    OpenSection& operator=(const OpenSection&) = delete;

  private:
    KvfTree* tree;
};

std::string Item(std::size_t index) {
    return "Item" + std::to_string(index + 1);
}

template <typename Values>
void PutList(KvfTree* tree, const char* keyword, const Values& values) {
    kvfAddKeyword(tree, keyword);
    for (const double value : values)
        kvfAddDouble(tree, value);
}

// Counts are bounded by what is read; a list longer than an int counts cannot get here.
void PutCount(KvfTree* tree, const char* keyword, std::size_t count) {
    kvfPutParam(tree, keyword, static_cast<int>(count));
}

// Pages show these on their own; they are handed on as they came.
void WriteSettings(const SeriesLabels& labels, KvfTree* tree) {
    const OpenSection section(tree, "Settings");
    kvfPutParam(tree, "ItemName", labels.itemName);
    kvfPutParam(tree, "Unit", labels.unit);
    kvfPutParam(tree, "Title", labels.title);
    kvfPutParam(tree, "Subtitle", labels.subtitle);
}

/// A test that was not asked for, or cannot be made of this series, has false and zeros.
template <typename Test>
void WriteTest(const std::optional<Test>& test, const char* name, KvfTree* tree) {
    const bool made = test && test->score.IsMade();
    const OpenSection section(tree, name);
    kvfPutParam(tree, name, made);
    kvfPutParam(tree, "TestStatistic", made ? test->score.z : 0.0);
    kvfPutParam(tree, "SignificanceLevel", made ? test->score.level : 0.0);
}

// All three always: a page shows a test that was not made as such.
void WriteTests(const SeriesResults& series, KvfTree* tree) {
    const OpenSection section(tree, "IndependenceHomogeneityTest");
    WriteTest(series.run, "RunTest", tree);
    WriteTest(series.trend, "TestForTrend", tree);
    WriteTest(series.shift, "TestForShiftInMean", tree);
}

void WriteMoments(const stats::SampleStatistics& statistics, KvfTree* tree) {
    {
        const OpenSection section(tree, "OrdinaryMoments");
        kvfPutParam(tree, "Mean", statistics.mean);
        kvfPutParam(tree, "Variance", statistics.variance);
        kvfPutParam(tree, "Skewness", statistics.skewness);
        kvfPutParam(tree, "Kurtosis", statistics.kurtosis);
    }
    {
        const OpenSection section(tree, "ProbabilityWeightedMoments");
        kvfPutParam(tree, "Beta_0", statistics.weighted.b0);
        kvfPutParam(tree, "Beta_1", statistics.weighted.b1);
        kvfPutParam(tree, "Beta_2", statistics.weighted.b2);
        kvfPutParam(tree, "Beta_3", statistics.weighted.b3);
    }
    const OpenSection section(tree, "LMoments");
    kvfPutParam(tree, "L_1", statistics.l1);
    kvfPutParam(tree, "L_2", statistics.l2);
    kvfPutParam(tree, "L_skewness", statistics.lSkewness);
    kvfPutParam(tree, "L_Kurtosis", statistics.lKurtosis);
}

void WriteSampleStatistics(const EngineInput& input, const SeriesResults& series, KvfTree* tree) {
    const OpenSection section(tree, "SampleStatistics");
    PutCount(tree, "SampleSize", series.statistics.count);
    kvfPutParam(tree, "bPDS", input.frame.kind == stats::SeriesKind::PartialDuration);
    // As stored: the frame of annual maxima has no threshold and rate 1.
    kvfPutParam(tree, "Threshold", input.threshold);
    kvfPutParam(tree, "AvgAnNum", input.averageNumber);
    WriteMoments(series.statistics, tree);
}

// Densities, so that bars and density curves share an axis.
void WriteHistogram(const stats::Histogram& histogram, KvfTree* tree) {
    const OpenSection section(tree, "Histogram");
    PutCount(tree, "NoIntHistogram", histogram.counts.size());
    kvfPutParam(tree, "XstartHistogram", histogram.start);
    kvfPutParam(tree, "XstepHistogram", histogram.step);
    PutList(tree, "FrequencyHistogram", histogram.densities);
}

// All five formulas, whichever the analysis used for its measures: the page of plotting positions
// compares them, and finds them by their order.
void WritePlottingPositions(const std::vector<double>& ascending, KvfTree* tree) {
    const std::size_t count = ascending.size();
    const OpenSection section(tree, "ProbabilityPlotObs");
    PutCount(tree, "Nobs", count);
    // Rank 1 is the largest value, so that its exceedance probability is the smallest.
    kvfAddKeyword(tree, "XobsSort");
    for (auto value = ascending.rbegin(); value != ascending.rend(); ++value)
        kvfAddDouble(tree, *value);
    for (std::size_t i = 0; i < stats::kPlottingMethods.size(); ++i) {
        const stats::PlottingMethod method = stats::kPlottingMethods[i];
        const OpenSection item(tree, Item(i));
        kvfPutParam(tree, "PlottingMethod", static_cast<int>(method));
        PutList(tree, "ExceedanceProbability", stats::PlottingPositions(method, count));
    }
}

// Three places whatever the distribution has, so that tables line up.
void WriteParameters(const CombinationResults& results, KvfTree* tree) {
    const OpenSection section(tree, "ParameterEstimates");
    for (std::size_t i = 0; i < 3; ++i) {
        const std::string number = std::to_string(i + 1);
        const bool estimated = results.fit && i < results.fit->parameters.size();
        const bool exists = i < results.symbols.size();
        kvfPutParam(tree, "bParEst" + number, estimated);
        kvfPutParam(tree, "strParEst" + number, exists ? results.symbols[i] : std::string_view());
        // 0 for a parameter that the distribution does not have, NaN where none could be found.
        const double missing = results.fit ? 0.0 : kNaN;
        kvfPutParam(tree, "ParEst" + number,
                    estimated ? results.fit->parameters[i].value : missing);
    }
}

struct Number {
    const char* keyword;
    double value;
};

/// A measure's flag and its numbers, which are 0 where nobody asked for them.
void PutMeasure(KvfTree* tree, const char* flag, bool asked,
                std::initializer_list<Number> numbers) {
    kvfPutParam(tree, flag, asked);
    for (const Number& number : numbers)
        kvfPutParam(tree, number.keyword, asked ? number.value : 0.0);
}

// The flags follow the request and not the outcome: the grid batch counts its output items by
// them, and a failed fit must not shift those that follow.
void WriteMeasures(const FitMeasureRequests& asked, const FitMeasures& found, KvfTree* tree) {
    const OpenSection section(tree, "GoodnessOfFitStatistics");
    PutMeasure(tree, "ChiSquaredTest", asked.chiSquared,
               {{"ChiSquaredStatistic", found.chiSquared.statistic},
                {"ChiSquaredLevel", found.chiSquared.level}});
    PutMeasure(tree, "KolmogorovSmirnovTest", asked.kolmogorovSmirnov,
               {{"KolmogorovSmirnovStatistic", found.kolmogorovSmirnov.statistic},
                {"KolmogorovSmirnovLevel", found.kolmogorovSmirnov.level}});
    PutMeasure(tree, "SLSCTest", asked.leastSquares,
               {{"SLSCStatistic", found.leastSquares.criterion}});
    PutMeasure(tree, "PPCCTest", asked.correlation, {{"PPCCStatistic", found.correlation}});
    PutMeasure(tree, "PPCC2Test", asked.reducedCorrelation,
               {{"PPCC2Statistic", found.reducedCorrelation}});
    PutMeasure(tree, "LogLikelihood", asked.logLikelihood,
               {{"LogLikelihoodStatistic", found.logLikelihood}});
}

void WriteDensities(const std::vector<double>& densities, const char* name, KvfTree* tree) {
    const OpenSection section(tree, name);
    PutList(tree, "PDF", densities);
}

// One keyword for each of the three numbers, and not one for each quantile: readers take a whole
// column at once.
void PutQuantiles(KvfTree* tree, const char* keyword,
                  const std::vector<stats::ResampledQuantile>& quantiles,
                  double stats::ResampledQuantile::*member) {
    kvfAddKeyword(tree, keyword);
    for (const stats::ResampledQuantile& quantile : quantiles)
        kvfAddDouble(tree, quantile.*member);
}

void WriteQuantiles(const std::vector<stats::ResampledQuantile>& quantiles, const char* name,
                    KvfTree* tree) {
    using stats::ResampledQuantile;
    const OpenSection section(tree, name);
    PutQuantiles(tree, "TyearEvent", quantiles, &ResampledQuantile::estimate);
    PutQuantiles(tree, "AvgTyearEvent", quantiles, &ResampledQuantile::average);
    PutQuantiles(tree, "StdTyearEvent", quantiles, &ResampledQuantile::standardDeviation);
}

void WriteCombination(const FitMeasureRequests& asked, const CombinationResults& results,
                      KvfTree* tree) {
    kvfPutParam(tree, "ItemName", results.name);
    WriteParameters(results, tree);
    WriteMeasures(asked, results.measures, tree);
    WriteDensities(results.intervalDensities, "PDFTable", tree);
    WriteDensities(results.densityCurve, "PDFPlot", tree);
    WriteQuantiles(results.quantiles.atPeriods, "TyearEventTable", tree);
    WriteQuantiles(results.quantiles.atProbabilities, "TyearEventPlot", tree);
}

// First what all curves share, then the combinations.
void WriteDistributions(const EngineInput& input, const SeriesResults& series,
                        std::span<const CombinationResults> combinations, KvfTree* tree) {
    const OpenSection section(tree, "DistributionAnalysis");
    PutCount(tree, "NoItemPDFPlot", series.curveAbscissae.size());
    PutList(tree, "XvaluePDFPlot", series.curveAbscissae);
    PutCount(tree, "NoItemProbabilityPlot", series.curveProbabilities.size());
    PutList(tree, "ProbabilityPlot", series.curveProbabilities);
    // As they were asked for, those without an event included: results go by position.
    PutCount(tree, "NoReturnPeriods", input.periods.size());
    PutList(tree, "ReturnPeriods", input.periods);
    for (std::size_t i = 0; i < combinations.size(); ++i) {
        const OpenSection item(tree, Item(i));
        WriteCombination(input.measures, combinations[i], tree);
    }
}

} // namespace

void WriteResultTree(const EngineInput& input, const SeriesResults& series,
                     std::span<const CombinationResults> combinations, KvfTree* tree) {
    kvfAddTarget(tree, "RYNoutput");
    WriteSettings(input.labels, tree);
    WriteTests(series, tree);
    WriteSampleStatistics(input, series, tree);
    WriteHistogram(series.histogram, tree);
    WritePlottingPositions(series.ascending, tree);
    WriteDistributions(input, series, combinations, tree);
    kvfEndSection(tree);
}

} // namespace ryn
