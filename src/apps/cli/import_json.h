#pragma once

#include "apps/cli/json_output.h"
#include "import/import_report.h"

namespace ryn::cli {

/// An import's report: form, rows, count, relative, first, last, items, missing, dropped, notes.
/// Times of a relative axis are seconds, others "YYYY-MM-DDTHH:MM:SS".
Json JsonOfImport(const ImportReport& report);

} // namespace ryn::cli
