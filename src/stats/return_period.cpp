#include "stats/return_period.h"

#include <cmath>
#include <limits>

namespace ryn::stats {

// With Poisson arrivals the annual maximum stays below x with probability exp(-rate e), and that is
// 1 - 1/T: e = -ln(1 - 1/T)/rate, which tends to 1/(rate T) for long periods.
double ExceedanceOfPeriod(double period, const SeriesFrame& frame, PeriodMeaning meaning) {
    double e = 1 / period;
    if (frame.kind == SeriesKind::PartialDuration) {
        e = (meaning == PeriodMeaning::OfEvent ? e : -std::log1p(-e)) / frame.rate;
    }
    // Written so that NaN, and the negative results of a negative period or rate, fall through.
    return period > 0 && e >= 0 && e < 1 ? e : std::numeric_limits<double>::quiet_NaN();
}

double QuantileOfPeriod(const Distribution& d, double period, const SeriesFrame& frame,
                        PeriodMeaning meaning) {
    return QuantileOfExceedance(d, ExceedanceOfPeriod(period, frame, meaning));
}

} // namespace ryn::stats
