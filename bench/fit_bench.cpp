// Fits of one sample, and the jackknife, each at two sizes.

#include "stats_samples.h"

#include "stats/fit.h"
#include "stats/jackknife.h"

#include <array>

#include <benchmark/benchmark.h>

namespace ryn::stats::bench {

namespace {

void FitOf(benchmark::State& state, const NamedCombination& named) {
    const Sample sample = DrawnSample(named.kind, static_cast<std::size_t>(state.range(0)));
    FitScratch scratch;
    for ([[maybe_unused]] auto _ : state) {
        const FitResult fit = Fit(named.combination, {sample.values, sample.frame}, scratch);
        if (!fit) {
            state.SkipWithError(FailureText(fit.Failure()).c_str());
            break;
        }
        benchmark::DoNotOptimize(*fit);
    }
}

/// The 100-year event alone, so that the fits count and not the quantiles. Sorted beforehand: of
/// 1000 values that are sorted again and again a processor learns the branches, of 10000 it does
/// not, and the ratio of the two would tell that.
void JackknifeOf(benchmark::State& state, const NamedCombination& named) {
    constexpr std::array periods = {100.0};
    Sample sample = DrawnSample(named.kind, static_cast<std::size_t>(state.range(0)));
    SortAscending(sample.values);
    const FitInput input{sample.values, sample.frame, ValueOrder::Ascending};
    const FitResult fit = Fit(named.combination, input);
    for ([[maybe_unused]] auto _ : state) {
        benchmark::DoNotOptimize(
            Jackknife(named.combination, fit->distribution, input, {.periods = periods}));
    }
}

// Estimators that go through the sample anew for each deletion take the square of the time, and are
// left out.
bool HasClosedFormDeletion(const NamedCombination& named) {
    return BasisOf(named.combination) != EstimationBasis::Values;
}

const bool registered = [] {
    for (const NamedCombination& named : AllCombinations()) {
        const std::string name = KindName(named.kind) + "/" + named.name;
        benchmark::RegisterBenchmark(("Fit/" + name).c_str(), FitOf, named)
            ->Arg(50)
            ->Arg(500)
            ->Unit(benchmark::kMicrosecond);
        if (HasClosedFormDeletion(named)) {
            benchmark::RegisterBenchmark(("Jackknife/" + name).c_str(), JackknifeOf, named)
                ->Arg(1'000)
                ->Arg(10'000)
                ->Unit(benchmark::kMillisecond);
        }
    }
    return true;
}();

} // namespace

} // namespace ryn::stats::bench
