#include "engine/goodness_report.h"

#include <algorithm>
#include <cmath>

#include "engine/input_summary.h"
#include "engine/plain_text.h"
#include "engine/report_parts.h"
#include "engine/report_text.h"

namespace ryn {

namespace {

// Those of the values, for partial durations too: users compare them with their own table of peaks,
// not with one of exceedances.
void AppendStatistics(std::string& text, const stats::SampleStatistics& statistics) {
    AppendHeading(text, "Sample statistics", '-');
    text +=
        "Skewness and kurtosis are the estimators that are unbiased for normal samples (kurtosis"
        " 3).\n\n";
    AppendValue(text, "Number of values", std::to_string(statistics.count));
    AppendValue(text, "Mean", SixDigits(statistics.mean));
    AppendValue(text, "Variance", SixDigits(statistics.variance));
    AppendValue(text, "Skewness", SixDigits(statistics.skewness));
    AppendValue(text, "Kurtosis", SixDigits(statistics.kurtosis));
    AppendValue(text, "Weighted moment b0", SixDigits(statistics.weighted.b0));
    AppendValue(text, "Weighted moment b1", SixDigits(statistics.weighted.b1));
    AppendValue(text, "Weighted moment b2", SixDigits(statistics.weighted.b2));
    AppendValue(text, "Weighted moment b3", SixDigits(statistics.weighted.b3));
    AppendValue(text, "L-moment l1", SixDigits(statistics.l1));
    AppendValue(text, "L-moment l2", SixDigits(statistics.l2));
    AppendValue(text, "L-skewness", SixDigits(statistics.lSkewness));
    AppendValue(text, "L-kurtosis", SixDigits(statistics.lKurtosis));
}

// Results hold the level as a fraction; people read percent, as on the page of the tests.
void AppendScore(std::string& text, const stats::TestScore& score) {
    if (!score.IsMade()) {
        text += "  Not made: " + std::string(stats::TestObstacleText(score.obstacle)) + ".\n";
        return;
    }
    AppendValue(text, "z", SixDigits(score.z));
    AppendValue(text, "Significance level [%]", SixDigits(100 * score.level));
}

// Wald and Wolfowitz (1940).
void AppendRunTest(std::string& text, const stats::RunTest& test) {
    text += "\nRun test: z < 0 means too few runs, as a trend or persistence makes them\n";
    AppendValue(text, "Runs", std::to_string(test.runs));
    AppendValue(text, "Values above the median", std::to_string(test.above));
    AppendValue(text, "Values below the median", std::to_string(test.below));
    AppendScore(text, test.score);
}

// Mann (1945), Kendall (1975).
void AppendTrendTest(std::string& text, const stats::TrendTest& test) {
    text += "\nTest for trend (Mann-Kendall): z > 0 means rising\n";
    AppendValue(text, "S", std::to_string(test.s));
    AppendValue(text, "Variance of S", SixDigits(test.variance));
    AppendScore(text, test.score);
}

// Wilcoxon (1945), Mann and Whitney (1947).
void AppendShiftTest(std::string& text, const stats::ShiftTest& test) {
    text += "\nTest for shift in mean (rank sums): z > 0 means that subsample 1 is higher\n";
    AppendValue(text, "Values in subsample 1", std::to_string(test.first));
    AppendValue(text, "Values in subsample 2", std::to_string(test.second));
    AppendValue(text, "Rank sum of subsample 1", SixDigits(test.rankSum));
    AppendScore(text, test.score);
}

void AppendTests(std::string& text, const SeriesResults& series) {
    if (!series.run && !series.trend && !series.shift)
        return;
    AppendHeading(text, "Independence and homogeneity", '-');
    text += "z is standard normal for an independent, homogeneous series; levels are two-sided.\n";
    if (series.run)
        AppendRunTest(text, *series.run);
    if (series.trend)
        AppendTrendTest(text, *series.trend);
    if (series.shift)
        AppendShiftTest(text, *series.shift);
}

// With its classes: whether the misfit sits in the tail or in the middle is what the sum hides.
void AppendChiSquared(std::string& text, const stats::ChiSquaredTest& test) {
    text += "\nChi-squared test, classes of equal probability\n";
    AppendRow(text,
              {"class", "lower bound", "upper bound", "observed", "expected", "contribution"});
    for (std::size_t j = 0; j < test.classes.size(); ++j) {
        const stats::ChiSquaredClass& c = test.classes[j];
        AppendRow(text, {std::to_string(j + 1), SixDigits(c.lower), SixDigits(c.upper),
                         std::to_string(c.observed), SixDigits(test.expected),
                         SixDigits(c.contribution)});
    }
    AppendValue(text, "Classes", std::to_string(test.classes.size()));
    AppendValue(text, "Statistic", SixDigits(test.statistic));
    AppendValue(text, "Degrees of freedom", std::to_string(test.degreesOfFreedom));
    AppendValue(text, "Level [%]", SixDigits(test.level));
}

// D alone does not say where the curve leaves the sample.
void AppendKolmogorovSmirnov(std::string& text, const stats::KolmogorovSmirnovTest& test) {
    text += "\nKolmogorov-Smirnov test\n";
    AppendValue(text, "D", SixDigits(test.statistic));
    AppendValue(text, "at the value", SixDigits(test.at));
    AppendValue(text, "of ascending rank", std::to_string(test.rank));
    AppendValue(text, "F there", SixDigits(test.cdf));
    AppendValue(text, "Sample's share there", SixDigits(test.empirical));
    AppendValue(text, "Level [%]", SixDigits(test.level));
}

// The two variates are the criterion's scale: without them it cannot be compared with one computed
// from other quantiles.
void AppendPlotMeasures(std::string& text, const FitMeasureRequests& asked,
                        const FitMeasures& found) {
    if (asked.leastSquares) {
        text += "\nStandard least squares criterion: about 0.02 is good, above 0.04 poor\n";
        AppendValue(text, "SLSC", SixDigits(found.leastSquares.criterion));
        AppendValue(text, "Standard variate of 0.01", SixDigits(found.leastSquares.lowVariate));
        AppendValue(text, "Standard variate of 0.99", SixDigits(found.leastSquares.highVariate));
    }
    if (!asked.correlation && !asked.reducedCorrelation)
        return;
    text += "\nProbability plot correlation coefficient\n";
    if (asked.correlation)
        AppendValue(text, "I (values)", SixDigits(found.correlation));
    if (asked.reducedCorrelation)
        AppendValue(text, "II (reduced variates)", SixDigits(found.reducedCorrelation));
}

// A peak at the threshold, which every series selected by number has, has density 0 or infinity in
// some families: without a word the missing likelihood would look like a fault of the fit.
void AppendReason(std::string& text, const stats::Distribution& fitted,
                  const stats::ProbabilityPlot& plot) {
    const auto count =
        std::count_if(plot.observed.begin(), plot.observed.end(),
                      [&fitted](double x) { return !std::isfinite(stats::LogDensity(fitted, x)); });
    if (count > 0)
        text += "  It does not exist: the density is 0 or infinite at " + std::to_string(count) +
                " value(s), such as peaks at the threshold.\n";
}

// What was not asked for was not computed: it is left out rather than shown as 0.
void AppendMeasures(std::string& text, const FitMeasureRequests& asked,
                    const CombinationAnalysis& analysis) {
    const CombinationResults& results = analysis.results;
    const FitMeasures& found = results.measures;
    if (asked.chiSquared)
        AppendChiSquared(text, found.chiSquared);
    if (asked.kolmogorovSmirnov)
        AppendKolmogorovSmirnov(text, found.kolmogorovSmirnov);
    AppendPlotMeasures(text, asked, found);
    if (!asked.logLikelihood)
        return;
    // Akaike (1974): likelihoods alone favour the distribution with more parameters.
    text += "\nLikelihood\n";
    AppendValue(text, "Log-likelihood", SixDigits(found.logLikelihood));
    AppendValue(text, "Akaike's criterion", SixDigits(stats::AkaikeCriterion(*results.fit)));
    if (std::isnan(found.logLikelihood))
        AppendReason(text, results.fit->distribution, analysis.plot);
}

// The numbers behind the probability plot, for users who draw their own.
void AppendPlot(std::string& text, const stats::Distribution& fitted,
                const stats::ProbabilityPlot& plot, const std::vector<std::size_t>& places) {
    text +=
        "\nObservations x and fitted quantiles; p is the plotting position, as non-exceedance,\n"
        "and the place is that in the series, in order of time\n";
    AppendRow(text, {"rank", "place", "x", "p", "F(x)", "quantile of p", "difference"});
    for (std::size_t i = 0; i < plot.observed.size(); ++i) {
        const double x = plot.observed[i];
        AppendRow(text, {std::to_string(i + 1), std::to_string(places[i]), SixDigits(x),
                         SixDigits(plot.positions[i]), SixDigits(stats::Cdf(fitted, x)),
                         SixDigits(plot.quantiles[i]), SixDigits(x - plot.quantiles[i])});
    }
}

} // namespace

std::string GoodnessReportHead(const EngineInput& input, const SeriesResults& series) {
    std::string text = ReportHead(kGoodnessReportSubject, input);
    const std::string unit = PlainName(input.labels.unit);
    // A level is easily taken for the probability that the distribution is right.
    text +=
        "Values, bounds and quantiles are in " + (unit.empty() ? "the series' unit" : unit) +
        ".\n\nThe levels of the chi-squared and Kolmogorov-Smirnov tests take the parameters as "
        "known.\nThey were fitted to the same values, so that the levels are too high.\n";
    AppendStatistics(text, series.statistics);
    AppendTests(text, series);
    return text;
}

std::string GoodnessReportOf(const EngineInput& input, std::size_t index,
                             const SeriesResults& series, const CombinationAnalysis& analysis) {
    const CombinationResults& results = analysis.results;
    std::string text = CombinationHead(input, index, results);
    if (!results.fit)
        return text;
    AppendMeasures(text, input.measures, analysis);
    AppendPlot(text, results.fit->distribution, analysis.plot, series.places);
    return text;
}

} // namespace ryn
