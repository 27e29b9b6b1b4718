#pragma once

#include <string>
#include <vector>

#include "base/status.h"
#include "import/import_report.h"
#include "import/table_samples.h"

namespace ryn {

/// Writes samples as a data file: an equidistant axis where all steps are equal, else a
/// non-equidistant one, both in seconds from the first sample; a calendar axis, or a relative one.
/// Times must rise. The file takes its name when it is complete. Sets the report's samples, span,
/// step and the items' types.
Status WriteSeries(const std::string& path, const std::string& title, const TableSamples& samples,
                   ImportReport* report);

} // namespace ryn
