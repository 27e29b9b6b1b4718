#pragma once

#include <cstddef>
#include <functional>
#include <string>

#include "base/status.h"
#include "document/ryn_edit_doc.h"
#include "ports/progress_port.h"
#include "run/batch_lines.h"
#include "run/point_analysis.h"

namespace ryn {

/// Where the series of the points are while the batch runs.
enum class Scratch { Disk, Memory };

struct GridBatchOptions {
    Scratch scratch = Scratch::Disk;
    /// Bytes that result grids, one tile and one point take together in memory; 0 for a quarter of
    /// what the process may use.
    std::size_t memory = 0;
    /// Gets each line of the standard output, with its end.
    PrintLine print;
    /// Asked between time steps and between points; may be empty.
    std::function<bool()> isStopped;
    ProgressPort* progress = nullptr; ///< points done; may be null
    PointAnalysis::Engines engines;
};

/// How a batch ended. Temporary files are gone in every case.
enum class BatchEnd {
    NotWanted,   ///< UseTsq2Input is false
    Refused,     ///< the input cannot be run; nothing was touched
    Written,     ///< the output grid file stands
    NothingGood, ///< no point could be analysed, so there is no output
    SetUpFailed, ///< the engine gave status 3, so there is no output
    Failed,      ///< a file could not be read or written; no output
    Stopped,     ///< as isStopped asked; no output
};

struct BatchCounts {
    int points = 0;
    int active = 0;           ///< not missing at the first step
    int computed = 0;         ///< of these, those that the engine saw
    int failed = 0;           ///< of these, those with status 1
    int withMissing = 0;      ///< missing values after the first step entered as data
    int withFewerPeaks = 0;   ///< threshold and rate were changed to fit
    int withMissingYears = 0; ///< some years have no value
};

struct GridBatchOutcome {
    BatchEnd end = BatchEnd::NotWanted;
    Status reason; ///< of Refused and Failed
    BatchCounts counts;
    std::string outputFile;
    std::string logFile; ///< the engine's
};

/// The grid batch: runs the analysis of the document at each chosen point of a grid file and writes
/// a grid file of the results. Each point is treated as if a user had set the series file,
/// extracted, and pressed Run. With Scratch::Memory all numbers, what stands on disk afterwards and
/// what is printed are the same as with Scratch::Disk.
///
/// The document's sections and its path name are those of the last point afterwards.
GridBatchOutcome RunGridAnalysis(CRynEditDoc& document, const GridBatchOptions& options = {});

/// The batch over a parameter file from its name on, on disk, printing on the process's standard
/// output: for callers that have no document. What it did shows in the files and in those lines.
void RynTsq2Analysis(const std::string& path);

} // namespace ryn
