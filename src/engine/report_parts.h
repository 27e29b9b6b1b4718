#pragma once

#include <string>

#include "engine/analysis.h"

namespace ryn {

/// What both reports have: the head, and the start of each combination.

/// `subject`, title and subtitle, what was asked for, and how to read the numbers.
std::string ReportHead(std::string_view subject, const EngineInput& input);

/// What a report says where the series could not be analysed.
std::string ReportOfFailure(std::string_view subject, const EngineInput& input,
                            const Sentences& faults);

/// Name and description of a combination, then its parameters with the warnings that came with
/// them, or why it could not be fitted.
std::string CombinationHead(const EngineInput& input, std::size_t index,
                            const CombinationResults& results);

} // namespace ryn
