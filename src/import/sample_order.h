#pragma once

#include <string>

#include "base/status.h"
#include "import/import_options.h"
#include "import/import_report.h"
#include "import/table_samples.h"

namespace ryn {

/// Brings samples into rising order as far as the user allows: sorts where rows may stand in any
/// order (rows of the same time keep theirs), and merges rows of the same time by the rule. What is
/// then still a backward step or a repeated time is a fault that names the lines. With Maximum each
/// item takes its own largest value.
Status OrderSamples(const std::string& source, RowOrder order, DuplicateRule rule,
                    TableSamples* samples, ImportReport* report);

} // namespace ryn
