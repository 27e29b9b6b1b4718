#pragma once

#include "grid/grid_file.h"

namespace ryn {

/// From what was read on opening: no values are read for it.
GridDescription DescribeGrid(const GridFile& grid);

} // namespace ryn
