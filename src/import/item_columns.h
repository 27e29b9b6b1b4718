#pragma once

#include "base/status.h"
#include "import/import_options.h"
#include "import/sample_rows.h"
#include "import/table_layout.h"

namespace ryn {

/// Chooses the columns to import: those the user names, else the first column of measurements. Left
/// aside for that choice: the time's own columns, columns named or built like a time, a station's
/// number or place, a quality code, and row counters. Taking all columns of numbers instead would
/// lose every row in which only one of them is missing.
Status ChooseItems(const SampleRows& rows, const ImportSettings& settings, TableLayout* layout);

/// The columns of numbers that ChooseItems would offer besides the chosen ones.
std::vector<std::size_t> OtherItems(const TableLayout& layout);

} // namespace ryn
