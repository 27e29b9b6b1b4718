#pragma once

#include <cstdint>
#include <stdexcept>
#include <string>
#include <vector>

#include "engine/rynengine.h"
#include "kvf/kvf.h"
#include "support/temporary_directory.h"
#include "unit/stats/named_combinations.h"
#include "unit/stats/reference_files.h"

namespace ryn::test {

/// An analysis as the editor saves it: a reference series with all measures and tests asked for.
struct EngineCase {
    std::string series = "portpirie";
    std::vector<std::string> combinations = {"GEV/LMOM"};
    int uncertainty = 0;
    int plotting = 4; // Cunnane
    std::vector<double> periods = {10, 50, 100};
    int firstSample = 32; // values of subsample 1
};

inline void PutCombination(KvfTree* tree, const std::string& name) {
    const stats::Combination combination = stats::testing::Named(name);
    kvfPutParam(tree, "ItemName", name);
    kvfPutParam(tree, "IsDefaultName", true);
    kvfPutParam(tree, "DistributionType", static_cast<int>(combination.distribution));
    kvfPutParam(tree, "EstimationMethod", static_cast<int>(combination.method));
    kvfPutParam(tree, "LogNormalType", static_cast<int>(combination.logNormal));
    kvfPutParam(tree, "LogPearsonType", static_cast<int>(combination.logPearson));
    kvfPutParam(tree, "EstimateLocationType", static_cast<int>(combination.location));
    kvfPutParam(tree, "SampleCorrection", combination.sampleCorrection);
}

inline void PutDefinition(KvfTree* tree, const std::string& series, const std::string& directory) {
    const stats::SeriesFrame frame = stats::testing::FrameOf(series);
    kvfAddSection(tree, "DefineEVS");
    kvfPutParam(tree, "SelectionMethod", static_cast<int>(frame.kind));
    kvfPutParam(tree, "OutputFileName", directory + "/case.res");
    kvfPutParam(tree, "Title", "A title");
    kvfPutParam(tree, "Subtitle", "A subtitle");
    kvfPutParam(tree, "ItemName", "Water level");
    kvfPutParam(tree, "Unit", "m");
    kvfPutParam(tree, "Threshold", frame.threshold);
    kvfPutParam(tree, "AvgAnNum", frame.rate);
    kvfEndSection(tree);
}

inline void PutAnalysis(KvfTree* tree, const EngineCase& engineCase) {
    kvfAddSection(tree, "Analysis");
    for (const char* flag :
         {"RunTest", "TestForTrend", "TestForShiftInMean", "ChiSquaredTest",
          "KolmogorovSmirnovTest", "SLSCTest", "PPCCTest", "PPCCTest2", "LogLikelihood"})
        kvfPutParam(tree, flag, true);
    kvfPutParam(tree, "UncertaintyCalcType", engineCase.uncertainty);
    kvfPutParam(tree, "PlottingMethod", engineCase.plotting);
    kvfAddSection(tree, "EvaluatedReturnPeriods");
    kvfPutParam(tree, "AnnualReturnPeriod", false);
    kvfPutParam(tree, "NoOfItems", static_cast<int>(engineCase.periods.size()));
    for (const double period : engineCase.periods)
        kvfPutParam(tree, "Item", period);
    kvfEndSection(tree);
    kvfEndSection(tree);
}

inline void PutSeries(KvfTree* tree, const std::vector<double>& values, int firstSample) {
    const int count = static_cast<int>(values.size());
    kvfAddSection(tree, "ExtremeValueSection");
    kvfPutParam(tree, "NoOfItems", count);
    kvfAddKeyword(tree, "ExtremeValues");
    for (const double value : values)
        kvfAddFloat(tree, static_cast<float>(value));
    kvfAddKeyword(tree, "SampleNo");
    for (int i = 0; i < count; ++i)
        kvfAddInt(tree, i < firstSample ? 1 : 2);
    kvfEndSection(tree);
}

inline KvfHandle TreeOf(const EngineCase& engineCase, const std::string& directory) {
    KvfHandle tree = kvfCreate();
    kvfAddTarget(tree.get(), "RynEditor");
    kvfAddSection(tree.get(), "Tsq2Input");
    kvfPutParam(tree.get(), "UseTsq2Input", false);
    kvfPutParam(tree.get(), "UncertaintyCal", true);
    kvfEndSection(tree.get());
    PutDefinition(tree.get(), engineCase.series, directory);
    PutAnalysis(tree.get(), engineCase);
    kvfAddSection(tree.get(), "ProbabilityDistribution");
    kvfPutParam(tree.get(), "NoOfItems", static_cast<int>(engineCase.combinations.size()));
    for (std::size_t i = 0; i < engineCase.combinations.size(); ++i) {
        kvfAddSection(tree.get(), "Item" + std::to_string(i + 1));
        PutCombination(tree.get(), engineCase.combinations[i]);
        kvfEndSection(tree.get());
    }
    kvfEndSection(tree.get());
    PutSeries(tree.get(), stats::testing::ReferenceSeries(engineCase.series),
              engineCase.firstSample);
    kvfEndSection(tree.get());
    return tree;
}

/// A run in a directory of its own.
struct EngineRunOf {
    explicit EngineRunOf(const EngineCase& engineCase) { Run(TreeOf(engineCase, Directory())); }
    /// With the tree's text edited beforehand: the first `from` becomes `to`.
    EngineRunOf(const EngineCase& engineCase, const std::string& from, const std::string& to) {
        std::string text = kvfText(TreeOf(engineCase, Directory()).get());
        const std::size_t place = text.find(from);
        if (place == std::string::npos)
            throw std::runtime_error("no such text in the tree: " + from);
        Run(kvfLoadText(text.replace(place, from.size(), to), "edited"));
    }

    std::string Directory() const { return directory.Root().string(); }
    std::string Log() const { return directory.Read("Ryn.log"); }
    std::string File(const std::string& name) const { return directory.Read(name); }
    const KvfSection* Target() const { return kvfTargetByNameNum(output.get(), "RYNoutput", 1); }

    TemporaryDirectory directory;
    KvfHandle output = kvfCreate();
    std::int32_t status = -1;

  private:
    void Run(const KvfHandle& input) {
        if (input == nullptr)
            throw std::runtime_error("the tree cannot be read");
        RYNENGINE(&input, &output, &status);
    }
};

/// The section or keyword behind a path of names parted by "/".
inline const KvfSection* SectionAt(const KvfSection* section, const std::string& path) {
    for (std::size_t start = 0; start < path.size();) {
        const std::size_t end = std::min(path.find('/', start), path.size());
        section = kvfSectionByNameNum(section, path.substr(start, end - start), 1);
        start = end + 1;
    }
    return section;
}

/// The number of a keyword given by its path; throws where there is none.
inline double NumberAt(const KvfSection* target, const std::string& path, int index = 1) {
    const std::size_t slash = path.rfind('/');
    double value = 0;
    if (kvfGetParam(SectionAt(target, path.substr(0, slash)), path.substr(slash + 1), &value, 1,
                    index) == 0)
        throw std::runtime_error("no number at " + path);
    return value;
}

} // namespace ryn::test
