#include "stats/quantile_tally.h"

#include <algorithm>
#include <cmath>
#include <limits>

namespace ryn::stats {

namespace {

constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();

} // namespace

// West (1979): with a weight of 1 it is Welford's update, with w the same as w updates would be.
void Spread::Add(double value, double weight) {
    if (!std::isfinite(value)) {
        return;
    }
    count += weight;
    const double before = value - mean;
    mean += before * (weight / count);
    squares += weight * before * (value - mean);
}

QuantileTally::QuantileTally(const Distribution& fitted, const SeriesFrame& frame,
                             const QuantileRequests& wanted)
    : requests(wanted) {
    for (const double period : requests.periods) {
        atPeriods.push_back({QuantileOfPeriod(fitted, period, frame, requests.meaning), {}});
    }
    for (const double probability : requests.probabilities) {
        atProbabilities.push_back({Quantile(fitted, probability), {}});
    }
}

// One visit for all quantiles of the resample: this loop is where the time goes.
void QuantileTally::Add(const Distribution& resample, const SeriesFrame& frame,
                        std::size_t weight) {
    kept += weight;
    const auto w = static_cast<double>(weight);
    std::visit(
        [&](const auto& d) {
            for (std::size_t i = 0; i < atPeriods.size(); ++i) {
                const double e = ExceedanceOfPeriod(requests.periods[i], frame, requests.meaning);
                Entry& entry = atPeriods[i];
                entry.differences.Add(QuantileOfExceedance(d, e) - entry.estimate, w);
            }
            for (std::size_t i = 0; i < atProbabilities.size(); ++i) {
                Entry& entry = atProbabilities[i];
                entry.differences.Add(Quantile(d, requests.probabilities[i]) - entry.estimate, w);
            }
        },
        resample);
}

std::vector<ResampledQuantile> QuantileTally::Summarised(const std::vector<Entry>& entries,
                                                         std::size_t needed, Summary summary) {
    std::vector<ResampledQuantile> results;
    for (const Entry& entry : entries) {
        ResampledQuantile& result =
            results.emplace_back(ResampledQuantile{entry.estimate, kNaN, kNaN, kNaN});
        if (entry.differences.count >= static_cast<double>(needed)) {
            summary(result, entry.differences);
        }
    }
    return results;
}

ResampledQuantiles QuantileTally::Results(std::size_t asked, std::size_t needed,
                                          Summary summary) const {
    // None needed of none asked for must not pass for enough.
    needed = std::max<std::size_t>(needed, 1);
    return {Summarised(atPeriods, needed, summary), Summarised(atProbabilities, needed, summary),
            asked, kept, needed};
}

} // namespace ryn::stats
