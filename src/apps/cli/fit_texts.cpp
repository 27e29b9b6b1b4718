#include "apps/cli/fit_texts.h"

#include <algorithm>
#include <cmath>
#include <functional>

#include "base/number_text.h"
#include "strings/catalogue.h"

namespace ryn::cli {

namespace {

bool AreAllEqual(std::span<const double> values) {
    return !values.empty() &&
           std::adjacent_find(values.begin(), values.end(), std::not_equal_to<>()) == values.end();
}

/// Whether a fault is what a sample without spread comes to; the others say more than that it has
/// none.
bool ComesFromSpread(stats::FitFault fault) {
    return fault >= stats::FitFault::SkewnessOutOfRange;
}

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

} // namespace

std::string FitFailureText(const stats::FitFailure& failure, std::span<const double> values) {
    const std::string reason =
        ComesFromSpread(failure.fault) && AreAllEqual(values)
            ? FormatText(kTextCliFitAllEqual, static_cast<int>(values.size()),
                         ShortestText(values.front()))
            : ReasonOf(failure);
    return stats::FailureCode(failure) + ": " + reason;
}

std::string FitWarningText(const stats::FitWarning& warning) {
    return FormatText(kTextCliFitOutsideSupport + static_cast<int>(warning.kind) - 1,
                      static_cast<int>(warning.count));
}

} // namespace ryn::cli
