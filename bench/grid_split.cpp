// What a point of the grid batch costs, by step: the batch is run as far as each of its steps, and
// a step's share is what it adds. Milliseconds of processor time a point; the median of several
// rounds.
//
// usage: ryn_grid_split CASE.ryn

#include <algorithm>
#include <array>
#include <cstdio>
#include <ctime>
#include <string>
#include <vector>

#include "base/path_parts.h"
#include "document/parameter_file_name.h"
#include "run/batch_ports.h"
#include "run/grid_batch.h"
#include "run/grid_plan.h"
#include "run/point_series.h"

namespace ryn {
namespace {

constexpr std::size_t kTileBytes = std::size_t{256} << 20U;
constexpr int kRounds = 3;

double ProcessorSeconds() {
    return static_cast<double>(std::clock()) / CLOCKS_PER_SEC;
}

template <typename Work>
double SecondsOf(Work work) {
    const double before = ProcessorSeconds();
    work();
    return ProcessorSeconds() - before;
}

void Demand(const Status& good) {
    if (good)
        return;
    std::fprintf(stderr, "%s\n", good.Text().c_str());
    std::exit(3);
}

/// Reads every tile and does nothing with it.
void ReadTiles(const GridPlan& plan) {
    CGridEditEngine engine;
    std::vector<GridTile> tiles;
    std::vector<float> values;
    if (engine.OpenFile(plan.gridFile, true) != kGridOk ||
        engine.PlanTiles(plan.Whole(), kTileBytes, &tiles) != kGridOk)
        Demand(engine.LastError());
    for (const GridTile& tile : tiles) {
        values.resize(tile.Values());
        if (engine.ReadTile(tile, kTileBytes, values) != kGridOk)
            Demand(engine.LastError());
    }
}

/// Makes the series of every point that takes part, and gives it to `use`.
template <typename Use>
void ForEverySeries(const GridPlan& plan, Use use) {
    PointSeries series;
    std::vector<bool> active;
    ScratchFiles scratch = ScratchFiles::InMemory(SplitPath(plan.gridFile).directory);
    Demand(series.Open(plan));
    Demand(series.ReadActivity(kTileBytes, &active));
    PointSeries::Visit visit;
    visit.use = [&use](int /*point*/, CTsq0FileInfo& files) {
        use(files);
        return Next::GoOn;
    };
    Demand(series.ForEachPoint(plan.Whole(), {plan.Whole()}, kTileBytes, active, scratch, visit));
}

/// The engine's place where only what is made for it is of interest.
void RefuseSeries(const KvfHandle* /*input*/, KvfHandle* /*output*/, std::int32_t* status) {
    *status = static_cast<std::int32_t>(EngineStatus::SeriesFailed);
}

double engineSeconds = 0.0;

void TimedEngine(const KvfHandle* input, KvfHandle* output, std::int32_t* status) {
    engineSeconds += SecondsOf([&] { RynEngineWithoutFiles(input, output, status); });
}

/// Seconds of one round, by step.
struct Split {
    double reading = 0.0;
    double series = 0.0;
    double extraction = 0.0;
    double trees = 0.0;
    double engine = 0.0;
    double writing = 0.0;
};

class SplitRun {
  public:
    explicit SplitRun(const std::string& name) : path(FullPath(name)) {
        CRynEditDoc document;
        document.OnOpenDocument(path);
        Demand(MakeGridPlan(document.GetGlobalKvf().GridInput(), SplitPath(path).directory, &plan));
    }

    Split Round() {
        Split split;
        double until = 0.0;
        const auto added = [&until](double seconds) {
            const double step = seconds - until;
            until = seconds;
            return step;
        };
        split.reading = added(SecondsOf([&] { ReadTiles(plan); }));
        split.series = added(SecondsOf([&] { ForEverySeries(plan, [](CTsq0FileInfo&) {}); }));
        split.extraction = added(SecondsOf([&] { Extract(); }));
        split.trees = added(SecondsOf([&] { MakeTrees(); }));
        engineSeconds = 0.0;
        const double all = added(SecondsOf([&] { RunAll(); }));
        split.engine = engineSeconds;
        split.writing = all - engineSeconds;
        return split;
    }

    int Points() const { return plan.Points(); }

  private:
    void Extract() {
        CRynEditDoc document;
        document.OnOpenDocument(path);
        const BatchPorts ports(document);
        CGlobalKvf& root = document.GetGlobalKvf();
        root.Values().SetDurability(Durability::Unflushed);
        ForEverySeries(plan, [&root](CTsq0FileInfo& files) {
            CBasicInputKvf& basic = root.BasicInput();
            basic.InputItem = 1;
            root.Values().ClearSeries();
            const bool read = basic.summary.ReadSummary(files.Path(), 0) &&
                              root.Values().ReadSeries(files.Path(), 0);
            Demand(read ? root.Values().ExtractSeries(files.NameSeries(), basic, true).written
                        : root.Values().ReadError());
        });
    }

    void MakeTrees() {
        CRynEditDoc document;
        document.OnOpenDocument(path);
        const BatchPorts ports(document);
        document.GetGlobalKvf().Values().SetDurability(Durability::Unflushed);
        PointAnalysis analysis(document, {RefuseSeries, RefuseSeries});
        ForEverySeries(plan, [&analysis](CTsq0FileInfo& files) {
            const PointOutcome outcome =
                analysis.Run({files.Path(), files.NameSeries(), ""}, PointTrace::None);
            Demand(outcome.reason);
        });
    }

    void RunAll() {
        CRynEditDoc document;
        document.OnOpenDocument(path);
        GridBatchOptions options;
        options.scratch = Scratch::Memory;
        options.engines.withoutFiles = TimedEngine;
        const GridBatchOutcome outcome = RunGridAnalysis(document, options);
        Demand(outcome.end == BatchEnd::Written ? Status::Ok() : outcome.reason);
    }

    std::string path;
    GridPlan plan;
};

double Median(std::array<double, kRounds> values) {
    std::sort(values.begin(), values.end());
    return values[kRounds / 2];
}

void Print(SplitRun& run) {
    struct Step {
        const char* name;
        double Split::*seconds;
    };
    constexpr std::array kSteps = {
        Step{"reading", &Split::reading},       Step{"series", &Split::series},
        Step{"extraction", &Split::extraction}, Step{"trees", &Split::trees},
        Step{"engine", &Split::engine},         Step{"writing", &Split::writing}};
    std::array<Split, kRounds> rounds;
    for (Split& round : rounds)
        round = run.Round();
    for (const Step& step : kSteps) {
        std::array<double, kRounds> seconds{};
        std::transform(rounds.begin(), rounds.end(), seconds.begin(),
                       [&step](const Split& round) { return round.*step.seconds; });
        std::printf("%s %.4f\n", step.name, 1e3 * Median(seconds) / run.Points());
    }
}

} // namespace
} // namespace ryn

int main(int count, char** arguments) {
    if (count != 2) {
        std::fputs("usage: ryn_grid_split CASE.ryn\n", stderr);
        return 2;
    }
    ryn::SplitRun run(arguments[1]);
    ryn::Print(run);
    return 0;
}
