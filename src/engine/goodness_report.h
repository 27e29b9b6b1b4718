#pragma once

#include <string>

#include "engine/analysis.h"

namespace ryn {

/// "Rynout1.txt": sample statistics, tests of the series, and how well each combination fits it.
constexpr const char* kGoodnessReportName = "Rynout1.txt";
constexpr const char* kGoodnessReportSubject = "Goodness of fit";

std::string GoodnessReportHead(const EngineInput& input, const SeriesResults& series);

/// The measures that were asked for with what they were made of, and the observations by ascending
/// rank beside the fitted quantiles, each with its place in the series.
std::string GoodnessReportOf(const EngineInput& input, std::size_t index,
                             const SeriesResults& series, const CombinationAnalysis& analysis);

} // namespace ryn
