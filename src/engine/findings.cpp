#include "engine/findings.h"

#include <algorithm>
#include <cmath>

#include "base/number_text.h"
#include "engine/plain_text.h"

namespace ryn {

namespace {

using stats::ResampledQuantile;
using stats::ResampledQuantiles;

// The result tree has no place for the reason.
template <typename Test>
void AddObstacle(Sentences& warnings, const char* name, const std::optional<Test>& test) {
    if (test && !test->score.IsMade())
        warnings.push_back(std::string(name) + " not made: " +
                           std::string(stats::TestObstacleText(test->score.obstacle)));
}

/// The period that an event of exceedance 1 would have. With Poisson arrivals a year has an event
/// at all with probability 1 - exp(-rate).
double ShortestPeriod(const EngineInput& input) {
    if (input.frame.kind == stats::SeriesKind::AnnualMaximum)
        return 1;
    return input.meaning == stats::PeriodMeaning::OfAnnualMaximum
               ? -1 / std::expm1(-input.frame.rate)
               : 1 / input.frame.rate;
}

// Samples of few events have no quantile at a short period; too many of them leave it without
// average.
std::size_t CountWithoutAverage(const std::vector<ResampledQuantile>& quantiles) {
    return static_cast<std::size_t>(
        std::count_if(quantiles.begin(), quantiles.end(), [](const ResampledQuantile& quantile) {
            return std::isfinite(quantile.estimate) && !std::isfinite(quantile.average);
        }));
}

/// Periods that have an event by their own, but whose quantile is beyond what a number holds.
std::size_t CountLost(const SeriesResults& series, const ResampledQuantiles& found) {
    std::size_t count = 0;
    for (std::size_t i = 0; i < series.exceedances.size(); ++i)
        if (std::isfinite(series.exceedances[i]) && std::isnan(found.atPeriods[i].estimate))
            ++count;
    return count;
}

// One warning for each cause: where too few resamples could be fitted, every period lacks its
// average for that reason.
void AddUncertaintyWarnings(Sentences& warnings, const std::string& label,
                            const ResampledQuantiles& found) {
    if (found.asked == 0) // no uncertainty was wanted
        return;
    if (found.kept < found.needed) {
        warnings.push_back(label + ": no uncertainty: only " + std::to_string(found.kept) + " of " +
                           std::to_string(found.asked) + " resamples could be fitted, " +
                           std::to_string(found.needed) + " are needed");
        return;
    }
    const std::size_t without = CountWithoutAverage(found.atPeriods);
    if (without > 0)
        warnings.push_back(label + ": no uncertainty at " + std::to_string(without) +
                           " return period(s): too few resamples have such an event");
}

} // namespace

Sentences SeriesWarnings(const EngineInput& input, const SeriesResults& series) {
    Sentences warnings;
    AddObstacle(warnings, "run test", series.run);
    AddObstacle(warnings, "test for trend", series.trend);
    AddObstacle(warnings, "test for shift in mean", series.shift);
    for (std::size_t i = 0; i < input.periods.size(); ++i)
        if (std::isnan(series.exceedances[i]))
            warnings.push_back("no event has a return period of " + PeriodText(input.periods[i]) +
                               " years: it must be a number greater than " +
                               ShortestText(ShortestPeriod(input)));
    return warnings;
}

Sentences CombinationWarnings(const std::string& label, const SeriesResults& series,
                              const CombinationResults& results) {
    Sentences warnings;
    for (const stats::FitWarning& warning : results.fit->warnings)
        warnings.push_back(label + ": " + stats::WarningText(warning) + " (" +
                           stats::WarningCode(warning) + ")");
    const std::size_t lost = CountLost(series, results.quantiles);
    if (lost > 0)
        warnings.push_back(label + ": the event is beyond all numbers at " + std::to_string(lost) +
                           " return period(s)");
    AddUncertaintyWarnings(warnings, label, results.quantiles);
    return warnings;
}

std::string FailureSentence(const stats::FitFailure& failure) {
    const std::string code = stats::FailureCode(failure);
    return "failed: " + stats::FailureText(failure) + (code.empty() ? "" : " (" + code + ")");
}

} // namespace ryn
