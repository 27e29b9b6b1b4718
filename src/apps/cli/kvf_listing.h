#pragma once

#include <iosfwd>

#include "kvf/kvf.h"

namespace ryn::cli {

/// Prints a parameter or result file for people: targets and sections indented, a keyword with its
/// parameters on one line, of long lists the start and the length.
void PrintTree(std::ostream& out, const KvfTree* tree);

} // namespace ryn::cli
