#pragma once

#include "base/status.h"
#include "import/import_options.h"
#include "import/sample_rows.h"
#include "import/table_layout.h"

namespace ryn {

/// Finds the columns that say when a row was measured, and how to read them; notes what the user
/// should know. A fault says what to give. The layout's columns are set already.
Status FindTime(const SampleRows& rows, const ImportSettings& settings, TableLayout* layout);

} // namespace ryn
