#pragma once

#include <string>

#include "base/status.h"
#include "import/import_options.h"
#include "import/import_report.h"
#include "import/table_samples.h"

namespace ryn {

/// Whether a file's first bytes are those of netCDF (classic, or HDF5).
bool IsNetcdf(std::string_view start);

/// Reads series from a netCDF file: the items that the settings name, or the first without spatial
/// extent. Missing values are left out. Refused in one line: a grid, and no such item.
Status ReadNetcdfSeries(const std::string& path, const ImportSettings& settings,
                        TableSamples* samples, ImportReport* report);

} // namespace ryn
