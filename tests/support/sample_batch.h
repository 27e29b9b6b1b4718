#pragma once

#include <cmath>
#include <functional>
#include <string>
#include <vector>

#include "document/ryn_edit_doc.h"
#include "grid/grid_edit.h"
#include "run/grid_batch.h"
#include "support/netcdf_sample.h"
#include "support/recording_ports.h"
#include "support/temporary_directory.h"

namespace ryn::test {

inline constexpr float kMissingCell = -999.0F;

/// A grid of `sizeX` by `sizeY` points and 150 steps of 30 days from 1 January 1990, by a function
/// of place and step.
struct SampleHistory {
    int sizeX = 3;
    int sizeY = 2;
    int steps = 150;
    /// Different at each point, with no two equal values in a history.
    std::function<double(int x, int y, int step)> value = [](int x, int y, int step) {
        const double phase = 0.9 * step + 1.7 * x + 2.3 * y;
        return 20.0 + x + 0.5 * y + 8.0 * std::sin(phase) + 3.0 * std::sin(0.37 * phase * phase);
    };

    void Write(const std::string& path) const {
        NetcdfSample file(path);
        const auto size = [](int count) { return static_cast<std::size_t>(count); };
        file.Dimension("time", size(steps)).Dimension("lat", size(sizeY));
        file.Dimension("lon", size(sizeX));
        file.Variable("time", NC_DOUBLE, {"time"})
            .Text("time", "units", "days since 1990-01-01 06:00:00");
        file.Variable("lat", NC_DOUBLE, {"lat"}).Text("lat", "units", "degrees_north");
        file.Variable("lon", NC_DOUBLE, {"lon"}).Text("lon", "units", "degrees_east");
        file.Variable("level", NC_FLOAT, {"time", "lat", "lon"}).Text("level", "units", "m");
        file.Text("level", "long_name", "water level").Mark("level", "_FillValue", kMissingCell);
        std::vector<double> times;
        std::vector<double> cells;
        for (int t = 0; t < steps; ++t) {
            times.push_back(30.0 * t);
            for (int y = 0; y < sizeY; ++y)
                for (int x = 0; x < sizeX; ++x)
                    cells.push_back(value(x, y, t));
        }
        file.Values("time", times).Values("lat", Axis(40.0, sizeY)).Values("lon", Axis(5.0, sizeX));
        file.Values("level", cells).Finish();
    }

  private:
    static std::vector<double> Axis(double first, int count) {
        std::vector<double> values;
        for (int i = 0; i < count; ++i)
            values.push_back(first + 0.25 * i);
        return values;
    }
};

/// A batch over such a grid: GEV and Gumbel by L-moments, three return periods, two goodness-of-fit
/// statistics.
class SampleBatch {
  public:
    TemporaryDirectory directory;
    RecordingPorts ports;
    std::string printed;

    explicit SampleBatch(const SampleHistory& history = {}) {
        history.Write(directory.Path("grid.nc"));
        Edit([&](CGlobalKvf& root) {
            CTsq2InputKvf& grid = root.GridInput();
            grid.UseTsq2Input = true;
            grid.Tsq2InputFile = "grid.nc";
            grid.Tsq2ItemNo = 1;
            grid.X_Range_And_Interval = {0, history.sizeX - 1, 1};
            grid.Y_Range_And_Interval = {0, history.sizeY - 1, 1};
            grid.Time_Range_And_Interval = {0, history.steps - 1, 1};
            grid.Tsq2OutputFile = "out.nc";
            grid.UncertaintyCal = false;
            root.DefineEVS().OutputFileName = directory.Path("case.res");
            root.Analysis().EvaluatedReturnPeriods = {2.0, 10.0, 100.0};
            root.Analysis().KolmogorovSmirnovTest = true;
            root.Analysis().LogLikelihood = true;
            AddCombination(root, "GEV", kGeneralizedExtremeValue, kLMoments);
            AddCombination(root, "Gumbel", kGumbel, kLMoments);
        });
    }

    static void AddCombination(CGlobalKvf& root, const std::string& name, int distribution,
                               int method) {
        DieCombination settings;
        settings.ItemName = name;
        settings.IsDefaultName = true;
        settings.DistributionType = distribution;
        settings.EstimationMethod = method;
        root.Distributions().Combinations.push_back(std::make_unique<CDieCombinationKvf>(settings));
    }

    /// Changes the parameter file.
    void Edit(const std::function<void(CGlobalKvf&)>& change) {
        CRynEditDoc document;
        const std::string path = directory.Path("case.RYN");
        if (directory.Has("case.RYN"))
            document.OnOpenDocument(path);
        change(document.GetGlobalKvf());
        document.OnSaveDocument(path);
    }

    GridBatchOptions Options(Scratch scratch) {
        GridBatchOptions options;
        options.scratch = scratch;
        options.print = [this](const std::string& line) { printed += line; };
        return options;
    }
    GridBatchOutcome Run(Scratch scratch) { return Run(Options(scratch)); }
    GridBatchOutcome Run(const GridBatchOptions& options) {
        printed.clear();
        CRynEditDoc document;
        document.UsePorts(ports);
        document.OnOpenDocument(directory.Path("case.RYN"));
        return RunGridAnalysis(document, options);
    }
};

/// A netCDF grid of results as its reader sees it: items by name, x fast.
struct ResultFile {
    CGridEditEngine engine;
    CGridEditHeaderInfo header;

    explicit ResultFile(const std::string& path) {
        EXPECT_EQ(engine.OpenFile(path, true), kGridOk) << engine.LastError().Text();
        header = engine.QueryHeaderInfo();
    }
    std::vector<std::string> Names() const {
        std::vector<std::string> names;
        for (int i = 1; i <= header.Items(); ++i)
            names.push_back(header.DynamicItem(i).GetName());
        return names;
    }
    CQxArray2D<float> Item(int number) {
        CGridEditSlice slice;
        slice.Initilize(header, 0);
        slice.SetItem(number);
        EXPECT_EQ(engine.GetSlice(slice), kGridOk) << engine.LastError().Text();
        return slice.GetArray();
    }
};

} // namespace ryn::test
