#pragma once

#include "grid/grid_file.h"

namespace ryn {

GridDescription DescribeGrid(const GridFile& grid);

} // namespace ryn
