#pragma once

#include "base/status.h"
#include "import/import_options.h"
#include "import/table_layout.h"
#include "import/table_shape.h"

namespace ryn {

/// Refuses a table above which rows stand whose time is written otherwise ("1961-62" above 1969,
/// "Q1 1950" above dates): they would pass for lines of the header. `run` are the rows by their
/// kinds.
Status CheckRowsAbove(const TableShape& shape, const RowRun& run);

/// Where no column reads as time though most of one does: a fault that names the rows which do not.
/// Else the fault given.
Status NameRowsWithoutTime(const TableShape& shape, const RowRun& run,
                           const ImportSettings& settings, const TableLayout& layout,
                           const Status& fault);

} // namespace ryn
