#pragma once

#include "base/status.h"
#include "import/import_options.h"
#include "import/import_report.h"
#include "import/table_samples.h"
#include "import/text_source.h"

namespace ryn {

/// The Dutch water authorities' DONAR DIF text: blocks of "KEY;VALUE;..." lines, then, behind
/// "[WRD]", many "value/quality:" on a line at equal steps; first time, last time and step stand in
/// the TYD line. Values of quality 99 are missing, as is 999999999.

/// Whether a text begins as such a file does.
bool IsDif(std::string_view start);

/// Reads the file's one series; several blocks of values follow each other. Refused: more than one
/// station or quantity, values that carry their own times, and a count of values other than what
/// the TYD line announces. Sets name, unit, missing values and rows of the report.
Status ReadDif(TextSource& source, const ImportSettings& settings, TableSamples* samples,
               ImportReport* report);

} // namespace ryn
