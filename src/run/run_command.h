#pragma once

#include <cstdint>
#include <string>

#include "base/status.h"
#include "document/ryn_edit_doc.h"
#include "engine/rynengine.h"

namespace ryn {

/// An analysis engine: takes the tree of a saved parameter file and an empty tree, to which it adds
/// the target RYNoutput, and sets the status.
using AnalysisEngine = void (*)(const KvfHandle* input, KvfHandle* output, std::int32_t* status);

/// How the Run command ended.
enum class RunEnd {
    Findings,         ///< the sections hold faults; nothing happened
    OutputUnwritable, ///< the result file cannot be written, or is an input; nothing happened
    SaveFailed,       ///< the analysis could not be saved; the results in memory are as they were
    EngineFailed,     ///< the engine gave status 1 or 3, or the saved file could not be read back
    Succeeded,        ///< results are in memory and in the result file
    ResultsUnwritten, ///< results are in memory; the result file could not be written
};

struct RunOutcome {
    RunEnd end = RunEnd::Succeeded;
    /// What failed: of OutputUnwritable, SaveFailed, ResultsUnwritten, and of EngineFailed when the
    /// engine was not reached or the series file could not be read.
    Status reason;
    std::int32_t engineStatus = 0;
    std::string logFile; ///< the engine's log; it can be missing when the engine was not reached
};

/// The Run command: checks, saves the analysis, has the engine work from the saved file, and takes
/// its results or offers its log. All messages go through the document's ports. While the engine
/// works the process's current directory is the parameter file's.
///
/// The results in memory are gone from before the engine starts, so that a failed run leaves none.
/// The modified flag is not touched after the save.
RunOutcome RunAnalysis(CRynEditDoc& document, AnalysisEngine engine = RYNENGINE);

/// The engine's log beside a result file.
std::string LogFileOf(const std::string& resultFile);

} // namespace ryn
