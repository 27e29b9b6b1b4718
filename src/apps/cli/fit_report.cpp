#include "apps/cli/fit_report.h"

#include <algorithm>
#include <cmath>
#include <ostream>

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

void PrintParameters(std::ostream& out, const stats::FittedModel& model) {
    constexpr int kDigits = 6;
    TextTable table({Alignment::Left, Alignment::Right});
    for (const stats::Parameter& parameter : model.parameters)
        table.AddRow({std::string(parameter.symbol),
                      FixedText(parameter.value, DecimalsFor(parameter.value, kDigits))});
    table.AddRow({TextOf(kTextCliLogLikelihood),
                  FixedText(model.logLikelihood, DecimalsFor(model.logLikelihood, kDigits))});
    table.Print(out);
}

/// One number of decimals for the whole column, so that its points stand below each other: what
/// the smallest estimate needs for five digits.
int ColumnDecimals(const std::vector<FitQuantile>& quantiles) {
    constexpr int kDigits = 5;
    int decimals = 0;
    for (const FitQuantile& quantile : quantiles)
        decimals = std::max(decimals, DecimalsFor(quantile.estimate, kDigits));
    return decimals;
}

void PrintQuantiles(std::ostream& out, const std::vector<FitQuantile>& quantiles) {
    constexpr int kProbabilityDigits = 4;
    const int decimals = ColumnDecimals(quantiles);
    TextTable table({Alignment::Right, Alignment::Right, Alignment::Right});
    table.AddRow(
        {TextOf(kTextCliReturnPeriod), TextOf(kTextCliExceedance), TextOf(kTextCliEstimate)});
    for (const FitQuantile& quantile : quantiles)
        table.AddRow(
            {ShortestText(quantile.period),
             FixedText(quantile.exceedance, DecimalsFor(quantile.exceedance, kProbabilityDigits)),
             FixedText(quantile.estimate, decimals)});
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
    PrintQuantiles(out, report.quantiles);
}

} // namespace ryn::cli
