#pragma once

#include "import/import_report.h"
#include "import/table_layout.h"
#include "import/table_samples.h"

namespace ryn {

/// Finds the numbers that stand for missing values in the items, sets them to kNoValue, and tells
/// them in the report. Taken are
/// - codes that the table's header announces;
/// - negative codes (-99, -99.9, -999, -9999, -777, -8888, -32768, ...) in a series that has no
/// other
///   negative value, or far below all others; -1 only where the values are finer than whole numbers
///   and it occurs three times or more;
/// - nines (99, 99.9, 999, ...) that occur three times or more, far above all others;
/// - values from 1e19 on, as netCDF's fill values.
/// Far is further than the other values spread. What looks like a code and is not as clear stays a
/// value, and a note tells how to exclude it.
void TakeOutCodes(const TableLayout& layout, TableSamples* samples, ImportReport* report);

/// Leaves out the samples in which an item has kNoValue.
void DropMissing(TableSamples* samples, ImportReport* report);

} // namespace ryn
