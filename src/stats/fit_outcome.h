#pragma once

#include "stats/combination.h"
#include "stats/fixed_list.h"

#include <array>
#include <cassert>
#include <cstddef>
#include <optional>
#include <string>
#include <utility>
#include <variant>

namespace ryn::stats {

/// Why a combination could not be fitted. The numbers are those of the log's codes C01 to C15.
enum class FitFault {
    DistributionNotOffered = 1,
    MethodNotOffered = 2,
    TooFewValues = 3,
    ValuesNotPositive = 4,
    ValuesAtThreshold = 5,
    SkewnessOutOfRange = 6,
    SkewnessNotPositive = 7,
    LMomentsOutOfRange = 8,
    LowerBoundUndefined = 9,
    LowerBoundTooHigh = 10,
    NoInteriorMaximum = 11,
    NoConvergence = 12,
    ValuesOutsideSupport = 13,
    InvalidParameters = 14,
    MeanExceedanceNotPositive = 15,
};

/// A failure as a value: the text is made when somebody asks for it, since resampling drops
/// failures by the hundred without reading them.
struct FitFailure {
    FitFault fault = FitFault::MethodNotOffered;
    /// The numbers of the text in their order: sample skewness; L-Cv and L-skewness; count and
    /// smallest count; lower bound and smallest value.
    std::array<double, 2> numbers{};
    SeriesKind kind = SeriesKind::AnnualMaximum; ///< for DistributionNotOffered
};

/// "C01" to "C15".
std::string FailureCode(const FitFailure& failure);

/// One line for the log, without code and full stop. Numbers have a decimal point in any locale.
std::string FailureText(const FitFailure& failure);

/// What a fit is to be read with, though it stands. The numbers are those of the log's W1 to W3.
enum class FitWarningKind {
    ValuesOutsideSupport = 1,    ///< W1
    SkewnessCorrectionRange = 2, ///< W2
    ReducedToExponential = 3,    ///< W3
};

/// A warning as a value; its text is made when somebody asks for it.
struct FitWarning {
    FitWarningKind kind = FitWarningKind::ValuesOutsideSupport;
    std::size_t count = 0; ///< ValuesOutsideSupport: number of values
};

/// Each warning at most once.
using WarningList = FixedList<FitWarning, 3>;

/// "W1" to "W3".
std::string WarningCode(const FitWarning& warning);

/// One line for the log, without code and full stop.
std::string WarningText(const FitWarning& warning);

/// A value, or the failure that stood in its way.
template <class T>
class [[nodiscard]] Outcome {
  public:
    Outcome(T success) : state(std::move(success)) {}
    Outcome(FitFailure failure) : state(failure) {}

    explicit operator bool() const { return std::holds_alternative<T>(state); }
    /// Only for a success.
    const T& operator*() const {
        assert(*this);
        return *std::get_if<T>(&state);
    }
    const T* operator->() const { return &**this; }
    /// Only for a failure.
    const FitFailure& Failure() const {
        assert(!*this);
        return *std::get_if<FitFailure>(&state);
    }

  private:
    std::variant<T, FitFailure> state;
};

} // namespace ryn::stats
