#pragma once

#include "base/status.h"
#include "params/global_kvf.h"

namespace ryn {

struct ExtractionResult {
    Status status;     ///< Ok when the series file was written; else names file and reason
    int messageId = 0; ///< the system's own text for what refused it, where it has one
    ExtractionReport report;
};

/// The Extract command from the sections on: tests the paths, reads the samples of the basic
/// input's item, empties the output file, extracts into it and frees the samples. Threshold and
/// AvgAnNum of the basic input can change. Until the output file is emptied nothing has changed.
///
/// Missing years and changed parameters are shown through the ports of the root's series. Showing
/// what refused the command, taking the series over into DefineEVS, and saving, are the caller's.
ExtractionResult ExtractSeriesOf(CGlobalKvf& root);

} // namespace ryn
