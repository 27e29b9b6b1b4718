#pragma once

#include "apps/cli/json_output.h"
#include "kvf/kvf.h"

namespace ryn::cli {

/// A parameter or result file as JSON, in file order. Targets and sections are objects. A keyword
/// is a scalar where it has one parameter, else an array (empty for none). A name that occurs
/// several times in a section is one member, at the place of the first, whose value is the array of
/// its occurrences: repeated keywords with several parameters are an array of arrays. Numbers that
/// are not finite are null.
Json JsonOfTree(const KvfTree* tree);

} // namespace ryn::cli
