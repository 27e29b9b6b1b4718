// Reading and extracting a series of 10^7 hourly samples, beside the time in which the netCDF
// library alone reads the same two variables.

#include <cmath>
#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <memory>
#include <string>
#include <vector>

#include <benchmark/benchmark.h>
#include <netcdf.h>

#include "series/annual_maxima.h"
#include "series/partial_durations.h"
#include "series/tsq_values.h"
#include "support/sample_series.h"

namespace ryn {
namespace {

constexpr int kStepsPerDay = 24;

/// Hourly values of a noisy year with a storm now and then; the same on every machine.
float ValueAt(int step) {
    const auto hash = static_cast<unsigned>(step) * 2654435761U;
    const double noise = (hash >> 8U) / 16777216.0;
    const double season = std::sin(step * (2.0 * 3.14159265358979 / (365.25 * kStepsPerDay)));
    return static_cast<float>(10.0 + 4.0 * season + 3.0 * noise + (hash % 977U == 0U ? 20.0 : 0.0));
}

/// A data file of so many hourly steps, written once for the process and removed at its end.
const std::string& DataFile(int steps) {
    struct File {
        int steps = 0;
        std::string path;
        ~File() {
            if (!path.empty())
                std::filesystem::remove(path);
        }
    };
    static std::vector<std::unique_ptr<File>> files;
    for (const auto& file : files)
        if (file->steps == steps)
            return file->path;
    auto file = std::make_unique<File>();
    file->steps = steps;
    file->path =
        (std::filesystem::temp_directory_path() / ("ryn-bench-" + std::to_string(steps) + ".tsq0"))
            .string();
    TsqHeaderHandle header;
    tsqHeaderCreate(4, "bench", "bench", 1, 1, 1, &header);
    tsqSetNeqCalendarAxis(header.get(), "1000-01-01", "01:00:00", kUnitSecond, 0.0, 0);
    tsqSetItemInfo(header.get(), tsqItemD(header.get(), 1), kItemTypeUndefined, "value",
                   UnitOfText("m3/s"), kTsqDataTypeFloat);
    TsqFileHandle out;
    tsqFileCreate(file->path, header.get(), &out);
    for (int step = 0; step < steps; ++step) {
        const float value = ValueAt(step);
        tsqWriteItemTimeStep(header.get(), out.get(), step * 3600.0, &value);
    }
    if (tsqFileClose(header.get(), &out) != 0) {
        std::fprintf(stderr, "%s\n", tsqTakeError().Text().c_str());
        std::exit(3);
    }
    files.push_back(std::move(file));
    return files.back()->path;
}

/// The two variables of the file into freshly allocated arrays, by the library alone.
void NetcdfAlone(benchmark::State& state) {
    const auto steps = static_cast<std::size_t>(state.range(0));
    const std::string& path = DataFile(static_cast<int>(state.range(0)));
    for (auto _ : state) {
        int file = 0;
        int variables = 0;
        nc_open(path.c_str(), NC_NOWRITE, &file);
        nc_inq_nvars(file, &variables);
        const std::unique_ptr<double[]> times(new double[steps]);
        const std::unique_ptr<float[]> values(new float[steps]);
        for (int id = 0; id < variables; ++id) {
            nc_type type = NC_NAT;
            int dimensions = 0;
            nc_inq_vartype(file, id, &type);
            nc_inq_varndims(file, id, &dimensions);
            if (dimensions != 1)
                continue;
            if (type == NC_DOUBLE)
                nc_get_var_double(file, id, times.get());
            else
                nc_get_var_float(file, id, values.get());
        }
        nc_close(file);
        benchmark::DoNotOptimize(times[steps - 1]);
        benchmark::DoNotOptimize(values[steps - 1]);
    }
}

void ReadSeries(benchmark::State& state) {
    const std::string& path = DataFile(static_cast<int>(state.range(0)));
    for (auto _ : state) {
        CTsqValues values;
        if (!values.ReadSeries(path, 0))
            state.SkipWithError(values.ReadError().Text().c_str());
        benchmark::DoNotOptimize(values.samples.data());
    }
    state.counters["bytesPerSample"] = sizeof(STSItem);
}

/// Runs a selection over samples whose marks are cleared outside the measured time.
template <typename Select>
void Selection(benchmark::State& state, Select select) {
    CTsqValues values;
    if (!values.ReadSeries(DataFile(static_cast<int>(state.range(0))), 0))
        state.SkipWithError(values.ReadError().Text().c_str());
    for (auto _ : state) {
        state.PauseTiming();
        for (STSItem& sample : values.samples)
            sample.selected = 0;
        state.ResumeTiming();
        benchmark::DoNotOptimize(select(values.samples));
    }
}

SelectionRules SummerHalf(SelectionRules rules) {
    rules.IncludeSeasonalAnalysis = true;
    rules.SeasonalStartDate = test::At("2000-04-01");
    rules.SeasonalEndDate = test::At("2000-09-30");
    return rules;
}

SelectionRules Partial() {
    SelectionRules rules;
    rules.SelectionMethod = kSelectPartialDurations;
    rules.InterTime = 3.0;
    rules.Threshold = 25.0;
    return rules;
}

void AnnualMaximaOfYears(benchmark::State& state) {
    Selection(state, [](auto& samples) {
        return SelectAnnualMaxima(samples, SelectionRules()).selection.size();
    });
}

void AnnualMaximaOfSeasons(benchmark::State& state) {
    Selection(state, [](auto& samples) {
        return SelectAnnualMaxima(samples, SummerHalf(SelectionRules())).selection.size();
    });
}

void PartialDurationsOfAllYear(benchmark::State& state) {
    Selection(state, [](auto& samples) {
        return SelectPartialDurations(samples, Partial()).selection.size();
    });
}

void PartialDurationsOfSeasons(benchmark::State& state) {
    Selection(state, [](auto& samples) {
        return SelectPartialDurations(samples, SummerHalf(Partial())).selection.size();
    });
}

constexpr int kMillion = 1'000'000;

BENCHMARK(NetcdfAlone)->Arg(10 * kMillion)->Unit(benchmark::kMillisecond);
BENCHMARK(ReadSeries)->Arg(3 * kMillion)->Arg(10 * kMillion)->Unit(benchmark::kMillisecond);
BENCHMARK(AnnualMaximaOfYears)
    ->Arg(3 * kMillion)
    ->Arg(10 * kMillion)
    ->Unit(benchmark::kMillisecond);
BENCHMARK(AnnualMaximaOfSeasons)->Arg(10 * kMillion)->Unit(benchmark::kMillisecond);
BENCHMARK(PartialDurationsOfAllYear)
    ->Arg(3 * kMillion)
    ->Arg(10 * kMillion)
    ->Unit(benchmark::kMillisecond);
BENCHMARK(PartialDurationsOfSeasons)->Arg(10 * kMillion)->Unit(benchmark::kMillisecond);

} // namespace
} // namespace ryn
