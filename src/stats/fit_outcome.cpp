#include "stats/fit_outcome.h"

#include <array>
#include <charconv>
#include <cmath>

namespace ryn::stats {

namespace {

// to_chars knows no locale: the log has a decimal point everywhere.
std::string ThreeDecimals(double value) {
    if (std::isnan(value))
        return "nan"; // whose sign differs between machines
    // The largest double has 309 digits before the point.
    std::array<char, 320> buffer{};
    const auto end = std::to_chars(buffer.data(), buffer.data() + buffer.size(), value,
                                   std::chars_format::fixed, 3)
                         .ptr;
    return {buffer.data(), end};
}

std::string Count(double value) {
    return std::to_string(std::llround(value));
}

std::string NotOffered(SeriesKind kind) {
    return kind == SeriesKind::AnnualMaximum
               ? "distribution is not offered for an annual maximum series"
               : "distribution is not offered for a partial duration series";
}

} // namespace

std::string FailureCode(const FitFailure& failure) {
    const int number = static_cast<int>(failure.fault);
    return (number < 10 ? "C0" : "C") + std::to_string(number);
}

std::string FailureText(const FitFailure& failure) {
    const auto [first, second] = failure.numbers;
    switch (failure.fault) {
    case FitFault::DistributionNotOffered:
        return NotOffered(failure.kind);
    case FitFault::MethodNotOffered:
        return "estimation method is not offered for this distribution";
    case FitFault::TooFewValues:
        return "too few values: " + Count(first) + ", at least " + Count(second) + " are needed";
    case FitFault::ValuesNotPositive:
        return "all values must be greater than 0";
    case FitFault::ValuesAtThreshold:
        return "too many values equal the threshold";
    case FitFault::SkewnessOutOfRange:
        return "sample skewness " + ThreeDecimals(first) +
               " is outside the range of the distribution";
    case FitFault::SkewnessNotPositive:
        return "sample skewness " + ThreeDecimals(first) + " must be positive";
    case FitFault::LMomentsOutOfRange:
        return "sample L-moments are outside the range of the distribution (L-Cv " +
               ThreeDecimals(first) + ", L-skewness " + ThreeDecimals(second) + ")";
    case FitFault::LowerBoundUndefined:
        return "lower bound cannot be estimated: largest + smallest - 2 x median is not positive";
    case FitFault::LowerBoundTooHigh:
        return "estimated lower bound " + ThreeDecimals(first) +
               " is not below the smallest value " + ThreeDecimals(second);
    case FitFault::NoInteriorMaximum:
        return "the likelihood has no maximum inside the parameter range";
    case FitFault::NoConvergence:
        return "no convergence";
    case FitFault::ValuesOutsideSupport:
        return "more than a quarter of the values lie outside the range of the fitted distribution";
    case FitFault::InvalidParameters:
        return "parameters are not valid";
    case FitFault::MeanExceedanceNotPositive:
        break;
    }
    return "mean exceedance is not positive";
}

std::string WarningCode(const FitWarning& warning) {
    return "W" + std::to_string(static_cast<int>(warning.kind));
}

std::string WarningText(const FitWarning& warning) {
    switch (warning.kind) {
    case FitWarningKind::ValuesOutsideSupport:
        return std::to_string(warning.count) +
               " value(s) lie outside the range of the fitted distribution";
    case FitWarningKind::SkewnessCorrectionRange:
        return "skewness correction used outside its calibration range (20 <= n <= 90, "
               "0.25 <= skewness <= 5)";
    case FitWarningKind::ReducedToExponential:
        break;
    }
    return "reduced to the exponential distribution";
}

} // namespace ryn::stats
