#pragma once

#include <string>

#include "base/atomic_file.h"
#include "base/status.h"
#include "results/output_settings.h"

namespace ryn {

/// The result file of an analysis (.res): targets RYNoutput and OutputSettings and, once the
/// document was saved, Graphs and Histogram with the looks of the two plots where they are kept.
/// docs/formats/res.md describes it.

/// Takes the results in target RYNoutput of the engine's tree into `results`, which is to be empty,
/// and closes the tree.
void TakeEngineOutput(KvfHandle* tree, COutputSettings& results);

/// After a run: writes the results, then appends the display settings. The kept plots wait for the
/// next save of the document. A failure between the two steps leaves a file of results alone, which
/// opens.
Status WriteResultsOfRun(COutputSettings& results, const std::string& path, Durability durability);

/// On saving the document: results, display settings and the kept plots, in one write.
Status WriteResultsOfDocument(COutputSettings& results, const std::string& path,
                              const std::string& baseDirectory, Durability durability);

/// On opening a document: display settings, results, and the kept plots, as far as the file has
/// them. A failure (the file is missing or broken) leaves `results` without results.
Status ReadResultFile(COutputSettings& results, const std::string& path,
                      const std::string& baseDirectory);

} // namespace ryn
