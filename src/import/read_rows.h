#pragma once

#include "base/status.h"
#include "import/import_options.h"
#include "import/import_report.h"
#include "import/table_layout.h"
#include "import/table_samples.h"
#include "import/text_source.h"

namespace ryn {

/// Reads the rows of a table by its layout. Rows with a missing value are left out and counted in
/// the report, as are rows with a date that lacks its day, dividing lines, repeated headers and
/// text behind the last row. What cannot be read is a fault that names its lines: a time or value
/// that is none, an infinite or too large value, a bound ("<0.5"), text between rows, a row that
/// ends before the item's column.
Status ReadRows(TextSource& source, const TableLayout& layout, const MissingRules& missing,
                TableSamples* samples, ImportReport* report);

} // namespace ryn
