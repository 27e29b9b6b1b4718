#pragma once

#include <string>
#include <vector>

#include "engine/analysis.h"
#include "engine/report_file.h"
#include "engine/run_log.h"
#include "engine/rynengine.h"

namespace ryn {

/// One run, from the input tree to results and reports. What it finds goes to the log at once.
/// May throw; nothing has reached the output then.
class EngineRun {
  public:
    /// `directory` is where the reports go, empty for none. `runLog` must outlive the run.
    EngineRun(const std::string& directory, RunLog& runLog);

    EngineStatus Execute(const KvfTree* tree, KvfHandle* output);

  private:
    EngineStatus Analyse(const EngineInput& input, KvfHandle* output);
    EngineStatus Fail(EngineStatus status, const EngineInput& input, const Sentences& faults);
    /// Both reports are complete afterwards.
    std::vector<CombinationResults> AnalyseAll(const EngineInput& input,
                                               const SeriesResults& series);
    void Tell(const std::string& label, const SeriesResults& series,
              const CombinationResults& results);
    void TellWarnings(const Sentences& warnings);
    /// Puts a report in its place; the log tells where that fails.
    void FinishReport(ReportFile& report, const char* name);

    RunLog& log;
    ReportFile goodness;
    ReportFile quantiles;
};

} // namespace ryn
