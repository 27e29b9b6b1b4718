#include "stats/monte_carlo.h"

#include "stats/estimate.h"
#include "stats/quantile_tally.h"
#include "stats/resampling_draws.h"

#include <algorithm>
#include <cmath>
#include <vector>

namespace ryn::stats {

namespace {

// A year has one maximum, whatever the year; the number of peaks in a record is chance.
bool CountVaries(const MonteCarloSubject& subject, const MonteCarloSettings& settings) {
    return subject.frame.kind == SeriesKind::PartialDuration &&
           settings.events == EventCount::Poisson;
}

// A count below the minimum would be dropped as a failed fit, and with it the samples of long
// quiet spells.
std::size_t DrawnCount(const MonteCarloSubject& subject, double u) {
    return std::max(PoissonCount(static_cast<double>(subject.count), u),
                    MinimumCount(subject.combination, subject.frame.kind));
}

void DrawValues(const Distribution& fitted, UniformDraws& draws, std::vector<double>& values) {
    std::visit(
        [&](const auto& d) {
            for (double& x : values) {
                x = Quantile(d, draws.Next());
            }
        },
        fitted);
}

// Average and bias both come from the mean difference to the estimate.
void Summarise(ResampledQuantile& quantile, const Spread& differences) {
    quantile.average = quantile.estimate + differences.mean;
    quantile.standardDeviation = std::sqrt(differences.squares / (differences.count - 1));
    quantile.bias = differences.mean;
}

} // namespace

ResampledQuantiles MonteCarlo(const MonteCarloSubject& subject, const QuantileRequests& requests,
                              const MonteCarloSettings& settings) {
    QuantileTally tally(subject.fitted, subject.frame, requests, Replicates::Kept);
    UniformDraws draws(settings.seed);
    FitScratch scratch;
    SeriesFrame frame = subject.frame;
    std::vector<double> values(subject.count);
    const bool countVaries = CountVaries(subject, settings);
    for (std::size_t b = 0; b < settings.samples; ++b) {
        // The order of the draws, first the count and then the values, is part of the results.
        if (countVaries) {
            values.resize(DrawnCount(subject, draws.Next()));
            frame.rate = subject.frame.rate * static_cast<double>(values.size()) /
                         static_cast<double>(subject.count);
        }
        DrawValues(subject.fitted, draws, values);
        // The estimate alone: its support against values that it was fitted to is no reason to
        // drop it, which would leave the milder samples.
        const auto estimate = EstimateParameters(subject.combination, {values, frame}, scratch);
        if (estimate) {
            tally.Add(estimate->distribution, frame, 1);
        }
    }
    // ceil(0.8 B) in whole numbers.
    return tally.Results(settings.samples, (8 * settings.samples + 9) / 10, Summarise);
}

} // namespace ryn::stats
