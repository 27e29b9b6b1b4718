// Monte Carlo uncertainty of 1000 samples: each combination alone, and all of annual maxima.

#include "stats_samples.h"

#include "stats/fit.h"
#include "stats/monte_carlo.h"
#include "stats/quantile_curve.h"

#include <array>
#include <stdexcept>
#include <utility>

#include <benchmark/benchmark.h>

namespace ryn::stats::bench {

namespace {

constexpr std::size_t kYears = 60;
constexpr std::array kPeriods = {10.0, 20.0, 50.0, 100.0, 200.0, 500.0, 1000.0};

/// Everything that one pass needs, made outside the measured time: a fitted combination, and the
/// quantiles that a run of the program asks for.
class Pass {
  public:
    explicit Pass(const NamedCombination& named)
        : Pass(named.combination, RealSample(named.kind, kYears), named.name) {}

    ResampledQuantiles Run() const {
        return MonteCarlo(subject, {kPeriods, PeriodMeaning::OfEvent, probabilities});
    }

  private:
    Pass(const Combination& combination, const Sample& sample, const std::string& name)
        : subject{combination, Fitted(combination, sample, name), kYears, sample.frame},
          probabilities(QuantileCurveProbabilities({kYears, kPeriods.back(), sample.frame})) {}

    static Distribution Fitted(const Combination& combination, const Sample& sample,
                               const std::string& name) {
        const FitResult fit = Fit(combination, {sample.values, sample.frame});
        if (!fit) {
            throw std::runtime_error(name + ": " + FailureText(fit.Failure()));
        }
        return fit->distribution;
    }

    MonteCarloSubject subject;
    std::vector<double> probabilities;
};

void MonteCarloOf(benchmark::State& state, const NamedCombination& named) {
    const Pass pass(named);
    for ([[maybe_unused]] auto _ : state) {
        benchmark::DoNotOptimize(pass.Run());
    }
}

void MonteCarloOfAnnualMaxima(benchmark::State& state) {
    std::vector<Pass> passes;
    for (const NamedCombination& named : AnnualMaximumCombinations()) {
        passes.emplace_back(named);
    }
    for ([[maybe_unused]] auto _ : state) {
        for (const Pass& pass : passes) {
            benchmark::DoNotOptimize(pass.Run());
        }
    }
    state.counters["combinations"] = static_cast<double>(passes.size());
}

BENCHMARK(MonteCarloOfAnnualMaxima)->Unit(benchmark::kMillisecond);

const bool registered = [] {
    for (const NamedCombination& named : AllCombinations()) {
        const std::string name = "MonteCarlo/" + KindName(named.kind) + "/" + named.name;
        benchmark::RegisterBenchmark(name.c_str(), MonteCarloOf, named)
            ->Unit(benchmark::kMillisecond);
    }
    return true;
}();

} // namespace

} // namespace ryn::stats::bench
