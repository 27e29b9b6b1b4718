#pragma once

#include "base/status.h"
#include "import/table_layout.h"
#include "import/text_source.h"

namespace ryn {

/// Where the first rows fit several forms of a date ("5/6/2001"), reads on until one row decides.
/// Refused when none in the whole table does. Leaves the source at its start.
Status DecideDateOrder(TextSource& source, TableLayout* layout);

} // namespace ryn
