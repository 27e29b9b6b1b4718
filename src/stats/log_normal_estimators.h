#pragma once

#include "stats/combination.h"
#include "stats/fit_outcome.h"
#include "stats/log_normal.h"
#include "stats/sample_statistics.h"

#include <cstddef>
#include <span>

namespace ryn::stats {

/// Two parameters above a known bound, from mean and s (Aitchison and Brown 1957).
/// Fails: MeanExceedanceNotPositive, InvalidParameters.
Outcome<LogNormal> LogNormalAboveFromMoments(double lowerBound, const CentralMoments& moments);

/// Two parameters above a known bound, sigma from the L-Cv of the exceedances (Hosking 1990).
/// Fails: MeanExceedanceNotPositive, LMomentsOutOfRange, InvalidParameters.
Outcome<LogNormal> LogNormalAboveFromLMoments(double lowerBound, const LMoments& moments);

/// The sample skewness of a log-normal variable corrected for bias: by correction I Fisher's G1
/// (Ishihara and Takase 1957), by correction II the polynomial of Bobee and Robitaille (1975).
double CorrectedSkewness(const CentralMoments& moments, LogNormalType correction);

/// Whether correction II was calibrated for such samples: 20 to 90 values, and a corrected skewness
/// of 0.25 to 5. Far beyond it grows without limit.
bool IsCalibrated(std::size_t count, double correctedSkewness);

/// Whether a bound `distance` below a value is below it as a double too, whatever the unit.
bool IsBelow(double value, double distance);

/// Three parameters from mean, s and a corrected skewness (Kite 1977; Stedinger et al. 1993).
/// Fails: SkewnessNotPositive (up to 1e-6, where rounding alone would tell), InvalidParameters.
Outcome<LogNormal> LogNormalFromMoments(const CentralMoments& moments, double correctedSkewness);

// The lower bound from order statistics, then mu and sigma as mean and standard deviation of
// ln(x - xi). `ascending` holds at least five values.

/// Lower bound quantile method I (Iwai 1949; Takara and Stedinger 1994): each of the outermost
/// pairs of values is made symmetric about the geometric mean. All values must be > 0.
/// Fails: NoConvergence, LowerBoundTooHigh, InvalidParameters.
Outcome<LogNormal> LogNormalByBoundI(std::span<const double> ascending);

/// Lower bound quantile method II (Stedinger 1980; Hoshi et al. 1984): smallest and largest value
/// are made symmetric about the median.
/// Fails: LowerBoundUndefined (also where the two distances agree to six digits),
/// LowerBoundTooHigh, InvalidParameters.
Outcome<LogNormal> LogNormalByBoundII(std::span<const double> ascending);

} // namespace ryn::stats
