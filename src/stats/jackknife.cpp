#include "stats/jackknife.h"

#include "stats/deletion.h"
#include "stats/equal_runs.h"
#include "stats/quantile_tally.h"

#include <cmath>
#include <vector>

namespace ryn::stats {

namespace {

// Every basis wants the order: ranks, or equal values side by side.
std::vector<double> Sorted(const FitInput& input) {
    std::vector<double> sorted(input.values.begin(), input.values.end());
    if (input.order == ValueOrder::AsObserved) {
        SortAscending(sorted);
    }
    return sorted;
}

// Ascending like the values. Those that have none have no fit either.
std::vector<double> Logarithms(std::span<const double> sorted) {
    std::vector<double> logs;
    logs.reserve(sorted.size());
    for (const double x : sorted) {
        logs.push_back(std::log(x));
    }
    return logs;
}

// Equal values leave equal samples behind: one fit stands for all of them.
template <class EstimateWithout>
void AddDeletions(std::span<const double> sorted, const SeriesFrame& frame, QuantileTally& tally,
                  EstimateWithout&& estimateWithout) {
    ForEachEqualRun(sorted, [&](std::size_t first, std::size_t count) {
        if (const Outcome<Estimate> estimate = estimateWithout(first)) {
            tally.Add(estimate->distribution, frame, count);
        }
    });
}

// What the estimator needs of the sample decides how a deletion is made; which family it is does
// not matter here.
void AddDeletions(const Combination& combination, std::span<const double> sorted,
                  const SeriesFrame& frame, QuantileTally& tally) {
    FitScratch scratch;
    const auto fromMoments = [&](std::span<const double> ascending) {
        const MomentDeletions deletions(ascending);
        AddDeletions(sorted, frame, tally, [&](std::size_t i) {
            return EstimateFromMoments(combination, frame, deletions.Without(i), scratch);
        });
    };
    const auto fromLMoments = [&](std::span<const double> ascending) {
        const LMomentDeletions deletions(ascending);
        AddDeletions(sorted, frame, tally, [&](std::size_t i) {
            return EstimateFromLMoments(combination, frame, deletions.Without(i));
        });
    };
    switch (BasisOf(combination)) {
    case EstimationBasis::Moments:
        return fromMoments(sorted);
    case EstimationBasis::LMoments:
        return fromLMoments(sorted);
    case EstimationBasis::LogMoments:
        return fromMoments(Logarithms(sorted));
    case EstimationBasis::LogLMoments:
        return fromLMoments(Logarithms(sorted));
    case EstimationBasis::Values:
        break;
    }
    ShortenedSample shortened(sorted);
    AddDeletions(sorted, frame, tally, [&](std::size_t i) {
        const FitInput rest{shortened.Without(i), frame, ValueOrder::Ascending};
        return EstimateParameters(combination, rest, scratch);
    });
}

// With est_i = est + difference_i, bar - est is the mean difference.
void Summarise(ResampledQuantile& quantile, const Spread& differences) {
    const double n = differences.count;
    quantile.bias = (n - 1) * differences.mean;
    quantile.average = quantile.estimate - quantile.bias;
    quantile.standardDeviation = std::sqrt((n - 1) / n * differences.squares);
}

} // namespace

ResampledQuantiles Jackknife(const Combination& combination, const Distribution& fitted,
                             const FitInput& input, const QuantileRequests& requests) {
    const std::size_t n = input.values.size();
    QuantileTally tally(fitted, input.frame, requests, Replicates::Dropped);
    if (n > 0) {
        AddDeletions(combination, Sorted(input), input.frame, tally);
    }
    // ceil(0.9 n) in whole numbers.
    return tally.Results(n, (9 * n + 9) / 10, Summarise);
}

} // namespace ryn::stats
