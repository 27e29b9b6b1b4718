#include "apps/cli/grid_command.h"

#include <array>
#include <malloc.h>
#include <memory>
#include <optional>
#include <ostream>

#include "apps/cli/case_file.h"
#include "apps/cli/command_options.h"
#include "apps/cli/engine_log.h"
#include "apps/cli/grid_progress.h"
#include "apps/cli/size_text.h"
#include "base/stop_signals.h"
#include "strings/catalogue.h"

namespace ryn::cli {

namespace {

/// What would go wrong at the first point, and at every other.
Status TestSettings(CaseFile& file) {
    const CBasicInputKvf& basic = file.Root().BasicInput();
    if (basic.SelectionMethod != file.Root().DefineEVS().SelectionMethod)
        return Status::InputFault(FormatText(kTextCliGridMethodsDiffer, file.ShownName(),
                                             basic.SelectionMethod,
                                             file.Root().DefineEVS().SelectionMethod));
    // Written so that NaN, which a hand-edited file can hold, is refused too.
    if (basic.SelectionMethod == kSelectPartialDurations && !(basic.AvgAnNum > 0.0))
        return Status::InputFault(FormatText(kTextCliGridNoRate, file.ShownName()));
    return Status::Ok();
}

void ShowCounts(const BatchCounts& counts, Console& console) {
    if (counts.withMissing > 0)
        ShowWarning(console, FormatText(kTextCliGridMissingLater, counts.withMissing));
    if (counts.withMissingYears > 0)
        ShowNote(console, FormatText(kTextCliGridMissingYears, counts.withMissingYears));
    if (counts.withFewerPeaks > 0)
        ShowNote(console, FormatText(kTextCliGridFewerPeaks, counts.withFewerPeaks));
    if (counts.failed > 0)
        ShowWarning(console, FormatText(kTextCliGridFailed, counts.failed, counts.computed));
}

int ShowEnd(const GridBatchOutcome& outcome, bool hasLog, const CaseFile& file, Console& console) {
    ShowCounts(outcome.counts, console);
    switch (outcome.end) {
    case BatchEnd::Written:
        ShowNote(console, FormatText(kTextCliGridWritten, outcome.outputFile,
                                     outcome.counts.computed - outcome.counts.failed,
                                     outcome.counts.points));
        return kExitDone;
    case BatchEnd::NotWanted:
        return Report(console,
                      Status::InputFault(FormatText(kTextCliGridNotWanted, file.ShownName())));
    case BatchEnd::NothingGood:
        return kExitAnalysis;
    case BatchEnd::SetUpFailed:
        ShowEngineLog(outcome.logFile, hasLog, console);
        return kExitAnalysis;
    case BatchEnd::Stopped:
        return kExitSystem;
    case BatchEnd::Refused:
    case BatchEnd::Failed:
        break;
    }
    return Report(console, outcome.reason);
}

/// Each point takes and frees some megabytes; handing them back to the system, which has to clear
/// them for the next point, would cost a sixth of the whole run.
void KeepFreedMemory() {
    constexpr int kKept = 256 << 20;
    ::mallopt(M_MMAP_THRESHOLD, kKept / 4);
    ::mallopt(M_TRIM_THRESHOLD, kKept);
}

int RunBatch(const GridOptions& options, CaseFile& file, Console& console) {
    KeepFreedMemory();
    GridProgress progress(console);
    GridBatchOptions batch;
    batch.scratch = options.scratch;
    batch.memory = options.memory;
    batch.progress = &progress;
    batch.print = [&](const std::string& line) {
        progress.Clear();
        console.out << line << std::flush;
    };
    batch.isStopped = [] { return StopSignals::Caught() != 0; };
    const EngineLogWatch watch;
    const GridBatchOutcome outcome = RunGridAnalysis(file.Document(), batch);
    progress.Clear();
    return ShowEnd(outcome, watch.HasSeen(outcome.logFile), file, console);
}

} // namespace

int RunGrid(const GridOptions& options, Console& console) {
    int exitCode = kExitDone;
    {
        // In memory a batch leaves nothing behind that a signal would have to wait for.
        std::optional<StopSignals> signals;
        if (options.scratch == Scratch::Disk)
            signals.emplace();
        CaseFile file(console, Consent::Given);
        if (const int refused = file.Open(options.file))
            return refused;
        if (const int refused = Report(console, TestSettings(file)))
            return refused;
        exitCode = RunBatch(options, file, console);
    }
    if (const int signal = StopSignals::Caught(); signal != 0 && options.scratch == Scratch::Disk)
        EndBySignal(signal);
    return exitCode;
}

void AddGridCommand(CommandLine& line) {
    auto options = std::make_shared<GridOptions>();
    CLI::App& command = line.Add({"grid", kTextCliHelpGrid, [options](Console& console) {
                                      return RunGrid(*options, console);
                                  }});
    AddCaseFileArgument(command, &options->file);
    static constexpr std::array<std::string_view, 2> kScratch = {"disk", "memory"};
    AddChoiceOption(command, {"--scratch", "memory|disk", kTextCliHelpScratch},
                    {kScratch, ChoiceNumbers::NotTaken}, [options](int choice) {
                        options->scratch = choice == 0 ? Scratch::Disk : Scratch::Memory;
                    });
    AddSizeOption(command, {"--memory", "SIZE", kTextCliHelpMemory}, &options->memory);
}

} // namespace ryn::cli
