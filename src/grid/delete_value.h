#pragma once

#include <vector>

#include "grid/layout.h"

namespace ryn {

/// The finite number that stands for every missing value of a grid file: the first `_FillValue` or
/// `missing_value` that marks missing values in every item and lies in the file as the values are
/// handed on, not packed; else netCDF's own fill of floats, 9.96921e36. So no item's data can be
/// taken for missing because another item's are.
float ChooseDeleteValue(const NcFile& file, const std::vector<GridVariable>& items);

} // namespace ryn
