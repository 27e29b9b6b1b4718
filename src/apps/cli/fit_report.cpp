#include "apps/cli/fit_report.h"

#include <algorithm>
#include <cmath>
#include <ostream>

#include "apps/cli/plain_text.h"
#include "apps/cli/settings.h"
#include "apps/cli/text_table.h"
#include "base/number_text.h"
#include "strings/catalogue.h"

namespace ryn::cli {

namespace {

std::string TextOf(int id) {
    return std::string(Text(id));
}

/// Whether fixed notation shows a number in few digits: neither the probability of the
/// 10^30-year event nor an event of 10^300.
bool IsOfCommonSize(double value) {
    const double size = std::fabs(value);
    return value == 0.0 || (size >= 1e-9 && size < 1e15);
}

/// "-" stands for a number that there is none of, such as the likelihood of a fit that leaves a
/// value outside its range.
std::string NumberText(double value, int decimals) {
    if (!std::isfinite(value))
        return "-";
    return IsOfCommonSize(value) ? FixedText(value, decimals) : ShortestText(value);
}

std::string NumberText(double value) {
    constexpr int kDigits = 6;
    return NumberText(value, DecimalsFor(value, kDigits));
}

/// One number of decimals for a whole column, so that its points stand below each other: what the
/// smallest number needs for so many digits.
int ColumnDecimals(const std::vector<double>& numbers, int digits) {
    int decimals = 0;
    for (const double number : numbers)
        if (IsOfCommonSize(number))
            decimals = std::max(decimals, DecimalsFor(number, digits));
    return decimals;
}

void PrintParameters(std::ostream& out, const stats::FittedModel& model) {
    TextTable table({Alignment::Left, Alignment::Right});
    for (const stats::Parameter& parameter : model.parameters)
        table.AddRow({std::string(parameter.symbol), NumberText(parameter.value)});
    table.Print(out);
}

std::string LevelText(double percent) {
    constexpr int kDecimals = 2;
    return FormatText(kTextCliLevel, NumberText(percent, kDecimals));
}

void PrintGoodness(std::ostream& out, const FitReport& report) {
    const FitGoodness& goodness = *report.goodness;
    const stats::ChiSquaredTest& chiSquared = goodness.chiSquared;
    const std::string positions =
        FormatText(kTextCliPositions,
                   std::string(kPlottingMethodNames[static_cast<std::size_t>(report.plotting)]));
    const std::string classes =
        FormatText(kTextCliClasses, chiSquared.classes.size(), chiSquared.degreesOfFreedom);
    TextTable table({Alignment::Left, Alignment::Right, Alignment::Left});
    table.AddRow({TextOf(kTextCliChiSquared), NumberText(chiSquared.statistic),
                  LevelText(chiSquared.level) + classes});
    table.AddRow({TextOf(kTextCliKolmogorovSmirnov),
                  NumberText(goodness.kolmogorovSmirnov.statistic),
                  LevelText(goodness.kolmogorovSmirnov.level)});
    table.AddRow({"SLSC", NumberText(goodness.leastSquares), positions});
    table.AddRow({"PPCC I", NumberText(goodness.correlation), positions});
    table.AddRow({"PPCC II", NumberText(goodness.reducedCorrelation), positions});
    table.AddRow({TextOf(kTextCliLogLikelihood), NumberText(report.model->logLikelihood)});
    table.AddRow({"AIC", NumberText(goodness.akaike)});
    table.Print(out);
}

/// So many that estimates and deviations have their digits; in all columns of the same unit.
int QuantileDecimals(const stats::ResampledQuantiles& quantiles) {
    constexpr int kEstimateDigits = 5;
    constexpr int kDeviationDigits = 3;
    std::vector<double> estimates;
    std::vector<double> deviations;
    for (const stats::ResampledQuantile& quantile : quantiles.atPeriods) {
        estimates.push_back(quantile.estimate);
        deviations.push_back(quantile.standardDeviation);
    }
    return std::max(ColumnDecimals(estimates, kEstimateDigits),
                    ColumnDecimals(deviations, kDeviationDigits));
}

std::vector<std::string> QuantileHeading(const FitReport& report) {
    const std::string unit = report.unit.empty() ? "" : " [" + PlainLine(report.unit) + ']';
    std::vector<std::string> row{TextOf(kTextCliReturnPeriod), TextOf(kTextCliExceedance),
                                 TextOf(kTextCliEstimate) + unit};
    if (report.uncertainty != FitUncertainty::None)
        for (const int id : {kTextCliAverage, kTextCliStandardDeviation, kTextCliBias})
            row.push_back(TextOf(id));
    return row;
}

void PrintQuantiles(std::ostream& out, const FitReport& report) {
    constexpr int kProbabilityDigits = 3;
    const int probabilityDecimals = ColumnDecimals(report.exceedances, kProbabilityDigits);
    const int decimals = QuantileDecimals(report.quantiles);
    const std::vector<std::string> heading = QuantileHeading(report);
    TextTable table(std::vector<Alignment>(heading.size(), Alignment::Right));
    table.AddRow(heading);
    for (std::size_t i = 0; i < report.periods.size(); ++i) {
        const stats::ResampledQuantile& quantile = report.quantiles.atPeriods[i];
        // The table drops what it has no column for.
        table.AddRow({ShortestText(report.periods[i]),
                      NumberText(report.exceedances[i], probabilityDecimals),
                      NumberText(quantile.estimate, decimals),
                      NumberText(quantile.average, decimals),
                      NumberText(quantile.standardDeviation, decimals),
                      NumberText(quantile.bias, decimals)});
    }
    table.Print(out);
}

void PrintResamples(std::ostream& out, const FitReport& report) {
    if (report.uncertainty == FitUncertainty::None)
        return;
    const int method =
        report.uncertainty == FitUncertainty::MonteCarlo ? kTextCliMonteCarlo : kTextCliJackknife;
    out << FormatText(kTextCliResamples, TextOf(method), report.quantiles.asked,
                      report.quantiles.Failed())
        << '\n';
}

} // namespace

int DecimalsFor(double value, int significantDigits) {
    constexpr int kMost = 12;
    if (!std::isfinite(value) || value == 0.0)
        return 0;
    const double magnitude = std::floor(std::log10(std::fabs(value)));
    return std::clamp(significantDigits - 1 - static_cast<int>(magnitude), 0, kMost);
}

void PrintFit(std::ostream& out, const FitReport& report) {
    if (!report.model) {
        out << FormatText(kTextCliFitFailed, report.name, report.failure) << '\n';
        return;
    }
    out << FormatText(report.sampleCorrection ? kTextCliFitHeadingCorrected : kTextCliFitHeading,
                      report.name, report.count)
        << "\n\n";
    PrintParameters(out, *report.model);
    out << '\n';
    PrintGoodness(out, report);
    if (report.periods.empty())
        return;
    out << '\n';
    PrintQuantiles(out, report);
    PrintResamples(out, report);
}

} // namespace ryn::cli
