#pragma once

#include <string>

#include "engine/analysis.h"

namespace ryn {

/// "Rynout2.txt": the T-year events of each combination with their uncertainty.
constexpr const char* kQuantileReportName = "Rynout2.txt";
constexpr const char* kQuantileReportSubject = "T-year events";

std::string QuantileReportHead(const EngineInput& input);

std::string QuantileReportOf(const EngineInput& input, std::size_t index,
                             const SeriesResults& series, const CombinationResults& results);

} // namespace ryn
