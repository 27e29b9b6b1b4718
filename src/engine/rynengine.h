#pragma once

#include <cstdint>

#include "kvf/kvf.h"

namespace ryn {

/// What a run of the engine ended in. Callers count all but 1 and 3 as success.
enum class EngineStatus : std::int32_t {
    Done = 0,
    SeriesFailed = 1,     ///< this series cannot be analysed, or no combination could be fitted
    DoneWithWarnings = 2, ///< the log says which
    SetUpFailed = 3,      ///< the tree itself is wrong, so that every other series would fail too
};

/// The analysis engine: one run over one series.
///
/// `input` is the tree of a parameter file, target "RynEditor"; it is not trusted in anything.
/// `output` is an empty tree from kvfCreate; where the run succeeds, a tree with the target
/// "RYNoutput" takes its place, otherwise it is left as it is. `status` receives an EngineStatus. A
/// null pointer or handle ends in SetUpFailed. Nothing is thrown.
///
/// Three files in the directory of the result file (DefineEVS/OutputFileName, taken against the
/// current directory) are replaced: "Ryn.log", "Rynout1.txt" (goodness of fit) and "Rynout2.txt"
/// (T-year events with their uncertainty). One that cannot be written is passed over.
///
/// Time and memory grow in proportion to the numbers of values (at most 1 000 000), return periods
/// (10 000) and combinations (1 000), but for the jackknife of a maximum likelihood fit, whose time
/// grows with the square of the number of values.
void RYNENGINE(const KvfHandle* input, KvfHandle* output, std::int32_t* status) noexcept;

/// The same, to the last digit, without log and reports: for one of many series, whose files the
/// next one's would replace.
void RynEngineWithoutFiles(const KvfHandle* input, KvfHandle* output,
                           std::int32_t* status) noexcept;

} // namespace ryn
