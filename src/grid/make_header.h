#pragma once

#include "grid/grid_header.h"
#include "grid/layout.h"

namespace ryn {

/// The header of a file in which a grid was found.
GridHeader MakeGridHeader(const NcFile& file, const GridLayout& layout);

/// The name of an item for people: `long_name`, else `standard_name`, else the variable's.
std::string ItemName(const NcFile& file, const NcVariable& variable);

} // namespace ryn
