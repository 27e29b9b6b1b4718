#include "apps/cli/fit_texts.h"

#include <algorithm>
#include <cmath>

#include "base/number_text.h"
#include "strings/catalogue.h"

namespace ryn::cli {

namespace {

int TextIdOf(const stats::FitFailure& failure) {
    if (failure.fault == stats::FitFault::DistributionNotOffered &&
        failure.kind == stats::SeriesKind::PartialDuration)
        return kTextCliFitNotOfferedForPds;
    return kTextCliFitNotOfferedForAms + static_cast<int>(failure.fault) - 1;
}

/// A failure's text without its code. All numbers of a text are of one kind, and a text takes as
/// many of them as it has places for.
std::string ReasonOf(const stats::FitFailure& failure) {
    const bool areCounts = failure.fault == stats::FitFault::TooFewValues;
    const auto text = [areCounts](double number) {
        constexpr int kDecimals = 3;
        return areCounts ? std::to_string(std::llround(number)) : FixedText(number, kDecimals);
    };
    return FormatText(TextIdOf(failure), text(failure.numbers[0]), text(failure.numbers[1]));
}

template <typename Predicate>
std::ptrdiff_t CountWhere(const FitReport& report, Predicate isMeant) {
    const auto& quantiles = report.quantiles.atPeriods;
    return std::count_if(quantiles.begin(), quantiles.end(), isMeant);
}

void AddBeyondNumbers(const FitReport& report, std::vector<std::string>& warnings) {
    const auto lost = CountWhere(report, [](const stats::ResampledQuantile& quantile) {
        return !std::isfinite(quantile.estimate);
    });
    if (lost > 0)
        warnings.push_back(FormatText(kTextCliBeyondNumbers, lost));
}

// One warning for each cause: where too few resamples could be fitted, every period lacks its
// average for that reason.
void AddNoUncertainty(const FitReport& report, std::vector<std::string>& warnings) {
    const stats::ResampledQuantiles& found = report.quantiles;
    if (found.asked == 0) // no uncertainty was wanted
        return;
    if (found.kept < found.needed) {
        warnings.push_back(
            FormatText(kTextCliNoUncertainty, found.kept, found.asked, found.needed));
        return;
    }
    const auto without = CountWhere(report, [](const stats::ResampledQuantile& quantile) {
        return std::isfinite(quantile.estimate) && !std::isfinite(quantile.average);
    });
    if (without > 0)
        warnings.push_back(FormatText(kTextCliPeriodsWithoutUncertainty, without));
}

} // namespace

std::string FitFailureText(const stats::FitFailure& failure) {
    return stats::FailureCode(failure) + ": " + ReasonOf(failure);
}

std::string FitWarningText(const stats::FitWarning& warning) {
    return FormatText(kTextCliFitOutsideSupport + static_cast<int>(warning.kind) - 1,
                      static_cast<int>(warning.count));
}

std::vector<std::string> FitWarnings(const FitReport& report) {
    std::vector<std::string> warnings;
    for (const stats::FitWarning& warning : report.model->warnings)
        warnings.push_back(FitWarningText(warning));
    AddBeyondNumbers(report, warnings);
    AddNoUncertainty(report, warnings);
    return warnings;
}

} // namespace ryn::cli
