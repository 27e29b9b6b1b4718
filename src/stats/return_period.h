#pragma once

#include "stats/combination.h"
#include "stats/distribution.h"

namespace ryn::stats {

/// What recurs once in T years on average: an event of the series, or an annual maximum. For an
/// annual maximum series they are the same.
enum class PeriodMeaning { OfEvent, OfAnnualMaximum };

/// The exceedance probability e of the T-year event within the series, T in years.
///
///     annual maxima:                      e = 1/T
///     partial durations, of an event:     e = 1/(rate T)
///     partial durations, annual maximum:  e = -ln(1 - 1/T)/rate
///
/// (Cunnane 1973; the last with Poisson arrivals, Shane and Lynn 1964.) NaN where there is no such
/// event: T <= 1 where years are counted, e >= 1, or a rate that is not positive.
double ExceedanceOfPeriod(double period, const SeriesFrame& frame, PeriodMeaning meaning);

/// The T-year event; NaN where ExceedanceOfPeriod is.
double QuantileOfPeriod(const Distribution& d, double period, const SeriesFrame& frame,
                        PeriodMeaning meaning);

} // namespace ryn::stats
