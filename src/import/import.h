#pragma once

#include <functional>
#include <string>
#include <vector>

#include "base/status.h"
#include "import/import_options.h"
#include "import/import_report.h"
#include "import/table_samples.h"
#include "import/text_source.h"

namespace ryn {

/// Hears, after each block of a table, how many of its bytes were read. A table's head is read
/// twice, so the number can go back once.
using ImportProgress = std::function<void(long long done, long long total)>;
/// Sees the items when everything is read, and may name them anew and change their units before
/// they are written; a fault ends the import.
using ItemsEditor = std::function<Status(std::vector<ImportedItem>& items)>;

/// What a caller takes part in; either may be empty.
struct ImportCallbacks {
    ImportProgress progress;
    ItemsEditor editItems;
};

/// Brings a table of text, a DONAR DIF file or a netCDF file of another program into a data file.
/// docs/import.md tells what is understood and how. Nothing is written when something is refused;
/// an existing output is replaced when the new file is complete. The report is filled as far as the
/// import came.
Status ImportFile(const std::string& input, const std::string& output, const ImportOptions& options,
                  ImportReport* report, const ImportCallbacks& callbacks = {});

/// The same up to the samples, which stay in memory. `fallbackName` names an item that the table
/// does not name.
Status ImportTable(TextSource& source, const ImportOptions& options,
                   const std::string& fallbackName, TableSamples* samples, ImportReport* report);

} // namespace ryn
