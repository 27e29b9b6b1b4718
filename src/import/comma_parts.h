#pragma once

#include "base/status.h"
#include "import/sample_rows.h"
#include "import/table_layout.h"
#include "import/table_shape.h"

namespace ryn {

/// Refuses a table between commas whose commas may part the decimals too: "2001-01-01,10,5" is the
/// value 10.5, or the values 10 and 5. Below names that are one fewer than the fields this holds
/// for all whole numbers. Without names it is told from two columns of whole numbers by how the
/// second is written; where that leaves it open, the table is refused as well. Not to be asked
/// where the user gave the decimal sign.
Status CheckCommaPartsColumns(const TableShape& shape, const RowRun& run,
                              const ImportSettings& settings, const TableLayout& layout);

/// "-12": digits with or without a sign.
bool IsWholeNumber(std::string_view field);

} // namespace ryn
