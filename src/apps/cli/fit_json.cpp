#include "apps/cli/fit_report.h"

#include "apps/cli/settings.h"

namespace ryn::cli {

namespace {

Json JsonOfParameters(const FitReport& report) {
    Json list = Json::array();
    if (report.model)
        for (const stats::Parameter& parameter : report.model->parameters)
            list.push_back({{"symbol", parameter.symbol}, {"estimate", JsonOf(parameter.value)}});
    return list;
}

Json JsonOfQuantiles(const FitReport& report) {
    Json list = Json::array();
    for (std::size_t i = 0; i < report.periods.size(); ++i) {
        const stats::ResampledQuantile& quantile = report.quantiles.atPeriods[i];
        list.push_back({{"period", JsonOf(report.periods[i])},
                        {"probability", JsonOf(report.exceedances[i])},
                        {"estimate", JsonOf(quantile.estimate)},
                        {"average", JsonOf(quantile.average)},
                        {"standardDeviation", JsonOf(quantile.standardDeviation)},
                        {"bias", JsonOf(quantile.bias)}});
    }
    return list;
}

Json JsonOfGoodness(const FitReport& report) {
    if (!report.goodness)
        return Json::object();
    const FitGoodness& goodness = *report.goodness;
    return {{"chiSquared",
             {{"statistic", JsonOf(goodness.chiSquared.statistic)},
              {"classes", goodness.chiSquared.classes.size()},
              {"degreesOfFreedom", goodness.chiSquared.degreesOfFreedom},
              {"level", JsonOf(goodness.chiSquared.level)}}},
            {"kolmogorovSmirnov",
             {{"statistic", JsonOf(goodness.kolmogorovSmirnov.statistic)},
              {"level", JsonOf(goodness.kolmogorovSmirnov.level)}}},
            {"plottingPositions", kPlottingMethodNames[static_cast<std::size_t>(report.plotting)]},
            {"slsc", JsonOf(goodness.leastSquares)},
            {"ppcc1", JsonOf(goodness.correlation)},
            {"ppcc2", JsonOf(goodness.reducedCorrelation)},
            {"logLikelihood", JsonOf(report.model->logLikelihood)},
            {"aic", JsonOf(goodness.akaike)}};
}

const char* MethodName(FitUncertainty uncertainty) {
    switch (uncertainty) {
    case FitUncertainty::MonteCarlo:
        return "montecarlo";
    case FitUncertainty::Jackknife:
        return "jackknife";
    case FitUncertainty::None:
        break;
    }
    return "none";
}

} // namespace

Json JsonOfFit(const FitReport& report) {
    return {{"name", report.name},
            {"n", report.count},
            {"unit", report.unit},
            {"failed", report.failure.empty() ? Json(nullptr) : Json(report.failure)},
            {"parameters", JsonOfParameters(report)},
            {"logLikelihood", report.model ? JsonOf(report.model->logLikelihood) : Json(nullptr)},
            {"quantiles", JsonOfQuantiles(report)},
            {"goodness", JsonOfGoodness(report)},
            {"uncertainty",
             {{"method", MethodName(report.uncertainty)},
              {"resamples", report.quantiles.asked},
              {"failed", report.quantiles.Failed()}}},
            {"sampleCorrection", report.sampleCorrection}};
}

} // namespace ryn::cli
