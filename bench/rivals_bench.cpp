// The same work on the same 50 values as the scripts *_speed.R and *_speed.py beside this file give
// to R and SciPy. Each tells the shape that it found, so that the answers can be compared too.

#include "stats_samples.h"

#include "stats/fit.h"
#include "stats/monte_carlo.h"

#include <array>

#include <benchmark/benchmark.h>

namespace ryn::stats::bench {

namespace {

constexpr std::size_t kCount = 50;
constexpr std::array kPeriod = {100.0};

Combination GevBy(EstimationMethod method) {
    Combination combination;
    combination.distribution = DistributionType::Gev;
    combination.method = method;
    return combination;
}

void TellShape(benchmark::State& state, const FitResult& fit) {
    state.counters["kappa"] = fit->parameters[2].value;
}

void GevLikelihoodFit(benchmark::State& state) {
    const Combination combination = GevBy(EstimationMethod::MaximumLikelihood);
    const Sample sample = RealSample(SeriesKind::AnnualMaximum, kCount);
    FitScratch scratch;
    for ([[maybe_unused]] auto _ : state) {
        benchmark::DoNotOptimize(Fit(combination, {sample.values, sample.frame}, scratch));
    }
    TellShape(state, Fit(combination, {sample.values, sample.frame}));
}

/// 1000 replicates: a sample drawn, its fit, its 100-year event.
void GevReplicates(benchmark::State& state, EstimationMethod method) {
    const Combination combination = GevBy(method);
    const Sample sample = RealSample(SeriesKind::AnnualMaximum, kCount);
    const FitResult fit = Fit(combination, {sample.values, sample.frame});
    const MonteCarloSubject subject{combination, fit->distribution, kCount, sample.frame};
    for ([[maybe_unused]] auto _ : state) {
        benchmark::DoNotOptimize(MonteCarlo(subject, {.periods = kPeriod}));
    }
    TellShape(state, fit);
}

BENCHMARK(GevLikelihoodFit)->Unit(benchmark::kMicrosecond);
BENCHMARK_CAPTURE(GevReplicates, likelihood, EstimationMethod::MaximumLikelihood)
    ->Unit(benchmark::kMillisecond);
BENCHMARK_CAPTURE(GevReplicates, lMoments, EstimationMethod::LMoments)
    ->Unit(benchmark::kMillisecond);

} // namespace

} // namespace ryn::stats::bench
