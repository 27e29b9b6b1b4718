#pragma once

#include "engine/engine_input.h"

namespace ryn {

/// What an analysis is asked to do, in lines for log and reports: series and unit, kind of series
/// with threshold and rate, return periods, method of uncertainty, plotting positions, number of
/// combinations.
Sentences SummaryLines(const EngineInput& input);

/// The name of a combination in log and reports, harmless and never empty; `index` counts from 0.
std::string LabelOf(const NamedCombination& combination, std::size_t index);

/// Distribution, method and options in words: "generalised Pareto distribution, location fixed at
/// the threshold, by L-moments".
std::string DescriptionOf(const stats::Combination& combination, stats::SeriesKind kind);

/// "Cunnane" and so on.
std::string_view NameOf(stats::PlottingMethod method);

/// " UNIT", for behind a number; empty where there is no unit.
std::string UnitSuffix(const EngineInput& input);

} // namespace ryn
