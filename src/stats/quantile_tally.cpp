#include "stats/quantile_tally.h"

#include <algorithm>
#include <cmath>
#include <cstddef>
#include <limits>

namespace ryn::stats {

namespace {

constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();

// The k-th smallest and the k-th largest of B', k the whole part of 0.025 (B' + 1) (Efron and
// Tibshirani 1993, section 12.5).
void SetPercentileInterval(std::vector<double>& replicates, ResampledQuantile& quantile) {
    const auto k = static_cast<std::ptrdiff_t>((replicates.size() + 1) / 40);
    if (k == 0) {
        return;
    }
    std::nth_element(replicates.begin(), replicates.begin() + (k - 1), replicates.end());
    quantile.lower = replicates[static_cast<std::size_t>(k - 1)];
    std::nth_element(replicates.begin(), replicates.end() - k, replicates.end());
    quantile.upper = *(replicates.end() - k);
}

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
                             const QuantileRequests& wanted, Replicates replicates)
    : requests(wanted),
      policy(replicates) {
    for (const double period : requests.periods) {
        atPeriods.push_back({QuantileOfPeriod(fitted, period, frame, requests.meaning), {}, {}});
    }
    for (const double probability : requests.probabilities) {
        atProbabilities.push_back({Quantile(fitted, probability), {}, {}});
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
                const double quantile = QuantileOfExceedance(d, e);
                entry.differences.Add(quantile - entry.estimate, w);
                if (policy == Replicates::Kept && std::isfinite(quantile)) {
                    entry.replicates.push_back(quantile);
                }
            }
            for (std::size_t i = 0; i < atProbabilities.size(); ++i) {
                Entry& entry = atProbabilities[i];
                entry.differences.Add(Quantile(d, requests.probabilities[i]) - entry.estimate, w);
            }
        },
        resample);
}

std::vector<ResampledQuantile> QuantileTally::Summarised(std::vector<Entry>& entries,
                                                         std::size_t needed, Summary summary) {
    std::vector<ResampledQuantile> results;
    for (Entry& entry : entries) {
        ResampledQuantile& result =
            results.emplace_back(ResampledQuantile{entry.estimate, kNaN, kNaN, kNaN});
        result.used = static_cast<std::size_t>(entry.differences.count);
        if (entry.differences.count >= static_cast<double>(needed)) {
            summary(result, entry.differences);
            SetPercentileInterval(entry.replicates, result);
        }
    }
    return results;
}

ResampledQuantiles QuantileTally::Results(std::size_t asked, std::size_t needed, Summary summary) {
    // None needed of none asked for must not pass for enough.
    needed = std::max<std::size_t>(needed, 1);
    return {Summarised(atPeriods, needed, summary), Summarised(atProbabilities, needed, summary),
            asked, kept, needed};
}

} // namespace ryn::stats
