#include "stats/fit.h"

#include <algorithm>
#include <cmath>
#include <cstddef>
#include <limits>
#include <vector>

namespace ryn::stats {

namespace {

struct Agreement {
    std::size_t outside = 0;
    double logLikelihood = 0;
};

// The smallest value that rounding may have left of a peak at the threshold.
double LowestPeak(const SeriesFrame& frame) {
    return frame.kind == SeriesKind::PartialDuration
               ? frame.threshold - 1e-6 * std::max(1.0, std::abs(frame.threshold))
               : std::numeric_limits<double>::infinity();
}

// One visit for the whole sample. The support is asked once and the formula inside it directly; the
// guarded LogDensity would ask it again for each value.
template <Family D>
Agreement Compare(const D& d, const FitInput& input) {
    const Interval support = d.Support();
    const double lowestPeak = LowestPeak(input.frame);
    Agreement found;
    for (const double value : input.values) {
        const double x = value >= lowestPeak ? std::max(value, input.frame.threshold) : value;
        if (support.Contains(x)) {
            found.logLikelihood += d.LogDensityInside(x);
        } else {
            ++found.outside;
        }
    }
    if (found.outside > 0 || !std::isfinite(found.logLikelihood)) {
        found.logLikelihood = std::numeric_limits<double>::quiet_NaN();
    }
    return found;
}

} // namespace

// Sums over the ascending values: the order in which a series was observed shows in no bit of a
// fit, and the small values are added first.
FitResult Fit(const Combination& combination, const FitInput& given, FitScratch& scratch) {
    std::vector<double> sorted;
    FitInput input = given;
    if (given.order == ValueOrder::AsObserved) {
        sorted.assign(given.values.begin(), given.values.end());
        SortAscending(sorted);
        input = {sorted, given.frame, ValueOrder::Ascending};
    }
    const auto estimate = EstimateParameters(combination, input, scratch);
    if (!estimate) {
        return estimate.Failure();
    }
    const Distribution& distribution = estimate->distribution;
    const Agreement found =
        std::visit([&](const auto& d) { return Compare(d, input); }, distribution);
    if (4 * found.outside > input.values.size()) {
        return FitFailure{FitFault::ValuesOutsideSupport};
    }
    FittedModel model{distribution, EstimatedParameters(distribution), estimate->warnings,
                      found.logLikelihood};
    if (found.outside > 0) {
        model.warnings.Add({FitWarningKind::ValuesOutsideSupport, found.outside});
    }
    return model;
}

FitResult Fit(const Combination& combination, const FitInput& input) {
    FitScratch scratch;
    return Fit(combination, input, scratch);
}

} // namespace ryn::stats
