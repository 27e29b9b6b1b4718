#pragma once

#include <span>

#include "engine/analysis.h"
#include "kvf/kvf.h"

namespace ryn {

/// Adds target "RYNoutput" to a tree: sections Settings, IndependenceHomogeneityTest,
/// SampleStatistics, Histogram, ProbabilityPlotObs (all five plotting position formulas) and
/// DistributionAnalysis with one Item for each combination, in their order. Numbers that were not
/// asked for are 0, numbers that do not exist NaN.
void WriteResultTree(const EngineInput& input, const SeriesResults& series,
                     std::span<const CombinationResults> combinations, KvfTree* tree);

} // namespace ryn
