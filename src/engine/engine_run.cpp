#include "engine/engine_run.h"

#include <algorithm>

#include "engine/findings.h"
#include "engine/goodness_report.h"
#include "engine/input_summary.h"
#include "engine/quantile_report.h"
#include "engine/report_parts.h"
#include "engine/result_tree.h"

namespace ryn {

namespace {

/// The first sentences of a list, then how many there are more: a tree from elsewhere may have as
/// many faults as keywords.
template <typename Write>
void ForTheFirst(const Sentences& sentences, Write write) {
    constexpr std::size_t kMost = 20;
    const std::size_t told = std::min(sentences.size(), kMost);
    for (std::size_t i = 0; i < told; ++i)
        write(sentences[i]);
    if (told < sentences.size())
        write("and " + std::to_string(sentences.size() - told) + " more like these");
}

bool IsFitted(const CombinationResults& results) {
    return static_cast<bool>(results.fit);
}

/// An empty list has not failed: a user may want the statistics of the series alone.
bool HaveAllFailed(const std::vector<CombinationResults>& combinations) {
    return !combinations.empty() &&
           std::none_of(combinations.begin(), combinations.end(), IsFitted);
}

} // namespace

EngineRun::EngineRun(const std::string& directory, RunLog& runLog)
    : log(runLog),
      goodness(directory, kGoodnessReportName),
      quantiles(directory, kQuantileReportName) {}

// All faults of a tree at once, not the first alone: they are mended in one go.
EngineStatus EngineRun::Execute(const KvfTree* tree, KvfHandle* output) {
    InputReading reading = ReadEngineInput(tree);
    const EngineInput& input = reading.input;
    if (output == nullptr || *output == nullptr)
        reading.faults.emplace_back("there is no tree that could take the results");
    if (!reading.faults.empty())
        return Fail(EngineStatus::SetUpFailed, input, reading.faults);
    for (const std::string& line : SummaryLines(input))
        log.Line(line);
    TellWarnings(reading.warnings);
    return Analyse(input, output);
}

// A series without faults can still have no histogram: doubles that differ in their last bit.
EngineStatus EngineRun::Analyse(const EngineInput& input, KvfHandle* output) {
    const Sentences seriesFaults = SeriesFaults(input);
    if (!seriesFaults.empty())
        return Fail(EngineStatus::SeriesFailed, input, seriesFaults);
    const std::optional<SeriesResults> series = AnalyseSeries(input);
    if (!series)
        return Fail(EngineStatus::SeriesFailed, input,
                    {"the values of the series are too close together to be told apart"});
    TellWarnings(SeriesWarnings(input, *series));
    const auto combinations = AnalyseAll(input, *series);
    // The reports, which say why, are in place; a page of nothing but missing numbers helps nobody.
    if (HaveAllFailed(combinations)) {
        log.Error("none of the combinations could be fitted");
        return EngineStatus::SeriesFailed;
    }
    // Built aside: when memory ends half way, the caller's tree is still empty.
    KvfHandle results = kvfCreate();
    WriteResultTree(input, *series, combinations, results.get());
    *output = std::move(results);
    return log.HasWarnings() ? EngineStatus::DoneWithWarnings : EngineStatus::Done;
}

// Log and reports say the same.
EngineStatus EngineRun::Fail(EngineStatus status, const EngineInput& input,
                             const Sentences& faults) {
    Sentences told;
    ForTheFirst(faults, [&told](const std::string& fault) { told.push_back(fault); });
    for (const std::string& fault : told)
        log.Error(fault);
    // The reports of an earlier run would pass for those of this one.
    goodness.Write(ReportOfFailure(kGoodnessReportSubject, input, told));
    quantiles.Write(ReportOfFailure(kQuantileReportSubject, input, told));
    FinishReport(goodness, kGoodnessReportName);
    FinishReport(quantiles, kQuantileReportName);
    return status;
}

std::vector<CombinationResults> EngineRun::AnalyseAll(const EngineInput& input,
                                                      const SeriesResults& series) {
    if (goodness.IsWanted())
        goodness.Write(GoodnessReportHead(input, series));
    if (quantiles.IsWanted())
        quantiles.Write(QuantileReportHead(input));
    std::vector<CombinationResults> combinations;
    for (std::size_t i = 0; i < input.combinations.size(); ++i) {
        CombinationAnalysis analysis = AnalyseCombination(input, series, input.combinations[i]);
        Tell(LabelOf(input.combinations[i], i), series, analysis.results);
        // Written one by one, and the plot with its n ranks dropped then: a report of thirty
        // combinations is larger than all else in memory.
        if (goodness.IsWanted())
            goodness.Write(GoodnessReportOf(input, i, series, analysis));
        if (quantiles.IsWanted())
            quantiles.Write(QuantileReportOf(input, i, series, analysis.results));
        combinations.push_back(std::move(analysis.results));
    }
    FinishReport(goodness, kGoodnessReportName);
    FinishReport(quantiles, kQuantileReportName);
    return combinations;
}

void EngineRun::Tell(const std::string& label, const SeriesResults& series,
                     const CombinationResults& results) {
    if (!results.fit) {
        log.Line(label + ": " + FailureSentence(results.fit.Failure()));
        log.NoteWarning(); // the run as a whole goes on
        return;
    }
    log.Line(label + ": ok");
    TellWarnings(CombinationWarnings(label, series, results));
}

void EngineRun::TellWarnings(const Sentences& warnings) {
    ForTheFirst(warnings, [this](const std::string& warning) { log.Warning(warning); });
}

// Not a warning: the results are complete without the file.
void EngineRun::FinishReport(ReportFile& report, const char* name) {
    const Status finished = report.Finish();
    if (!finished)
        log.Line(std::string(name) + " was not written: " + finished.Text());
}

} // namespace ryn
