#pragma once

#include "base/status.h"
#include "import/table_layout.h"
#include "import/table_shape.h"

namespace ryn {

/// Refuses a table that spreads one series over columns: a row for each month with a column for
/// each day ("d1" to "d31", "1" to "31"), a row for each year with one for each month or day, a row
/// for each day with one for each hour. The first of them alone would pass for a series. Not to be
/// asked where the user named the item.
Status CheckSpreadColumns(const TableShape& shape, const TableLayout& layout);

} // namespace ryn
