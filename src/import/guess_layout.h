#pragma once

#include "base/status.h"
#include "import/import_options.h"
#include "import/table_layout.h"
#include "import/text_source.h"

namespace ryn {

/// Finds out how a table is built: encoding, delimiter, header, time, items. What the settings say
/// overrides the guess. Looks at the first lines, and further only where they leave it open whether
/// the day or the month stands first. The source must be at its start, and is left there. A fault
/// names the table and says what is missing or undecidable.
Status GuessLayout(TextSource& source, const ImportSettings& settings, TableLayout* layout);

} // namespace ryn
