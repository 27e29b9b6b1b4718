#include "apps/cli/fit_report.h"

#include <algorithm>
#include <cmath>
#include <ostream>

#include "apps/cli/plain_text.h"
#include "apps/cli/text_table.h"
#include "base/number_text.h"
#include "strings/catalogue.h"

namespace ryn::cli {

namespace {

std::string TextOf(int id) {
    return std::string(Text(id));
}

Json JsonOfParameters(const FitReport& report) {
    Json list = Json::array();
    if (report.model)
        for (const stats::Parameter& parameter : report.model->parameters)
            list.push_back({{"symbol", parameter.symbol}, {"estimate", JsonOf(parameter.value)}});
    return list;
}

Json JsonOfQuantile(const FitQuantile& quantile) {
    return {{"period", JsonOf(quantile.period)},
            {"probability", JsonOf(quantile.exceedance)},
            {"estimate", JsonOf(quantile.estimate)},
            {"average", nullptr},
            {"standardDeviation", nullptr}};
}

/// "-" stands for a number that there is none of, such as the likelihood of a fit that leaves a
/// value outside its range.
std::string NumberText(double value) {
    constexpr int kDigits = 6;
    return std::isfinite(value) ? FixedText(value, DecimalsFor(value, kDigits)) : "-";
}

void PrintParameters(std::ostream& out, const stats::FittedModel& model) {
    TextTable table({Alignment::Left, Alignment::Right});
    for (const stats::Parameter& parameter : model.parameters)
        table.AddRow({std::string(parameter.symbol), NumberText(parameter.value)});
    table.AddRow({TextOf(kTextCliLogLikelihood), NumberText(model.logLikelihood)});
    table.Print(out);
}

/// One number of decimals for a whole column, so that its points stand below each other: what the
/// smallest number needs for so many digits.
int ColumnDecimals(const std::vector<double>& numbers, int digits) {
    int decimals = 0;
    for (const double number : numbers)
        decimals = std::max(decimals, DecimalsFor(number, digits));
    return decimals;
}

void PrintQuantiles(std::ostream& out, const FitReport& report) {
    constexpr int kProbabilityDigits = 3;
    constexpr int kEstimateDigits = 5;
    std::vector<double> probabilities;
    std::vector<double> estimates;
    for (const FitQuantile& quantile : report.quantiles) {
        probabilities.push_back(quantile.exceedance);
        estimates.push_back(quantile.estimate);
    }
    const int probabilityDecimals = ColumnDecimals(probabilities, kProbabilityDigits);
    const int estimateDecimals = ColumnDecimals(estimates, kEstimateDigits);
    TextTable table({Alignment::Right, Alignment::Right, Alignment::Right});
    const std::string unit = report.unit.empty() ? "" : " [" + PlainLine(report.unit) + ']';
    table.AddRow({TextOf(kTextCliReturnPeriod), TextOf(kTextCliExceedance),
                  TextOf(kTextCliEstimate) + unit});
    for (const FitQuantile& quantile : report.quantiles)
        table.AddRow({ShortestText(quantile.period),
                      FixedText(quantile.exceedance, probabilityDecimals),
                      FixedText(quantile.estimate, estimateDecimals)});
    table.Print(out);
}

} // namespace

int DecimalsFor(double value, int significantDigits) {
    constexpr int kMost = 12;
    if (!std::isfinite(value) || value == 0.0)
        return 0;
    const double magnitude = std::floor(std::log10(std::fabs(value)));
    return std::clamp(significantDigits - 1 - static_cast<int>(magnitude), 0, kMost);
}

Json JsonOfFit(const FitReport& report) {
    Json quantiles = Json::array();
    for (const FitQuantile& quantile : report.quantiles)
        quantiles.push_back(JsonOfQuantile(quantile));
    return {{"name", report.name},
            {"n", report.count},
            {"unit", report.unit},
            {"failed", report.failure.empty() ? Json(nullptr) : Json(report.failure)},
            {"parameters", JsonOfParameters(report)},
            {"logLikelihood", report.model ? JsonOf(report.model->logLikelihood) : Json(nullptr)},
            {"quantiles", std::move(quantiles)},
            {"goodness", Json::object()}};
}

void PrintFit(std::ostream& out, const FitReport& report) {
    out << FormatText(kTextCliFitHeading, report.name, static_cast<int>(report.count)) << "\n\n";
    PrintParameters(out, *report.model);
    out << '\n';
    PrintQuantiles(out, report);
}

} // namespace ryn::cli
