#pragma once

#include <string>

#include "stats/distribution.h"

namespace ryn {

/// What the sign and size of a distribution's shape mean, as one sentence without indent and line
/// end: which convention it follows, and what the upper tail is like. Empty for a family without a
/// shape.
std::string ShapeNote(const stats::Distribution& distribution);

} // namespace ryn
