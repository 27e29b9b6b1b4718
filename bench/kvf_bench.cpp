// A parameter tree of many keywords: written, read, and looked up by occurrence.

#include <filesystem>
#include <string>

#include <benchmark/benchmark.h>

#include "kvf/kvf.h"

namespace ryn {
namespace {

KvfHandle TreeOf(int keywords) {
    KvfHandle tree = kvfCreate();
    kvfAddTarget(tree.get(), "RynEditor");
    kvfAddSection(tree.get(), "EvaluatedReturnPeriods");
    for (int i = 0; i < keywords; ++i)
        kvfPutParam(tree.get(), "Item", i * 0.5);
    kvfEndSection(tree.get());
    return tree;
}

std::string TreeFile(int keywords) {
    const std::string path = (std::filesystem::temp_directory_path() /
                              ("ryn-bench-" + std::to_string(keywords) + ".RYN"))
                                 .string();
    const KvfHandle tree = TreeOf(keywords);
    (void)kvfWrite(tree.get(), path, Durability::Unflushed);
    return path;
}

void KvfWrite(benchmark::State& state) {
    const KvfHandle tree = TreeOf(static_cast<int>(state.range(0)));
    const std::string path = TreeFile(static_cast<int>(state.range(0)));
    for (auto _ : state)
        (void)kvfWrite(tree.get(), path, Durability::Unflushed);
    std::filesystem::remove(path);
}

void KvfRead(benchmark::State& state) {
    const std::string path = TreeFile(static_cast<int>(state.range(0)));
    for (auto _ : state)
        benchmark::DoNotOptimize(kvfLoadFile(path, 1));
    std::filesystem::remove(path);
}

/// Every occurrence in turn, in a tree that was not looked up before.
void KvfLookUpAll(benchmark::State& state) {
    const std::string path = TreeFile(static_cast<int>(state.range(0)));
    for (auto _ : state) {
        state.PauseTiming();
        KvfHandle tree = kvfLoadFile(path, 1);
        state.ResumeTiming();
        const KvfSection* const section = kvfSectionByNameNum(
            kvfTargetByNameNum(tree.get(), "RynEditor", 1), "EvaluatedReturnPeriods", 1);
        double value = 0.0;
        double sum = 0.0;
        for (int n = 1; kvfGetParam(section, "Item", &value, n, 1) != 0; ++n)
            sum += value;
        benchmark::DoNotOptimize(sum);
        state.PauseTiming();
        kvfClose(&tree);
        state.ResumeTiming();
    }
    std::filesystem::remove(path);
}

constexpr int kHundredThousand = 100'000;

BENCHMARK(KvfWrite)
    ->Arg(kHundredThousand)
    ->Arg(10 * kHundredThousand)
    ->Unit(benchmark::kMillisecond);
BENCHMARK(KvfRead)
    ->Arg(kHundredThousand)
    ->Arg(10 * kHundredThousand)
    ->Unit(benchmark::kMillisecond);
BENCHMARK(KvfLookUpAll)
    ->Arg(kHundredThousand)
    ->Arg(10 * kHundredThousand)
    ->Unit(benchmark::kMillisecond);

} // namespace
} // namespace ryn
