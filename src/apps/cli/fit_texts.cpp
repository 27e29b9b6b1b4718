#include "apps/cli/fit_texts.h"

#include <cmath>

#include "base/number_text.h"
#include "strings/catalogue.h"

namespace ryn::cli {

namespace {

/// The catalogue holds the texts in the order of the codes.
int TextOf(const stats::FitFailure& failure) {
    if (failure.fault == stats::FitFault::DistributionNotOffered &&
        failure.kind == stats::SeriesKind::PartialDuration)
        return kTextFitNotOfferedForPartialDurations;
    return kTextFitNotOfferedForAnnualMaxima - 1 + static_cast<int>(failure.fault);
}

std::string NumberText(const stats::FitFailure& failure, double number) {
    const bool isCount = failure.fault == stats::FitFault::TooFewValues;
    return FixedText(number, isCount ? 0 : 3);
}

} // namespace

std::string FitFailureText(const stats::FitFailure& failure) {
    const std::string code = stats::FailureCode(failure);
    const auto [first, second] = failure.numbers;
    // A text without places for the numbers passes over them.
    return (code.empty() ? "" : code + ": ") +
           FormatText(TextOf(failure), NumberText(failure, first), NumberText(failure, second));
}

std::string FitWarningText(const stats::FitWarning& warning) {
    return FormatText(kTextFitValuesOutside - 1 + static_cast<int>(warning.kind),
                      static_cast<int>(warning.count));
}

} // namespace ryn::cli
