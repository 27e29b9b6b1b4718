#include "apps/cli/grid_command.h"

#include <algorithm>
#include <array>
#include <malloc.h>
#include <memory>
#include <optional>
#include <ostream>
#include <string>
#include <vector>

#include "apps/cli/case_file.h"
#include "apps/cli/command_options.h"
#include "apps/cli/engine_log.h"
#include "apps/cli/grid_case.h"
#include "apps/cli/grid_progress.h"
#include "apps/cli/input_file.h"
#include "apps/cli/launcher.h"
#include "apps/cli/nearest_names.h"
#include "apps/cli/part_jobs.h"
#include "apps/cli/size_text.h"
#include "base/path_parts.h"
#include "base/process_limits.h"
#include "base/stop_signals.h"
#include "run/grid_parts.h"
#include "strings/catalogue.h"
#include "strings/language.h"

namespace ryn::cli {

namespace {

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
    if (outcome.end != BatchEnd::Stopped)
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
        ShowError(console, outcome.counts.active == 0
                               ? std::string(Text(kTextCliGridAllMissing))
                               : FormatText(kTextCliGridLastPoint,
                                            hasLog ? LastErrorIn(outcome.logFile) : ""));
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

GridBatchOptions BatchOptionsOf(const GridOptions& options, GridProgress& progress,
                                Console& console) {
    GridBatchOptions batch;
    batch.scratch = options.scratch;
    batch.memory = options.memory;
    batch.progress = &progress;
    batch.print = [&progress, &console](const std::string& line) {
        progress.Clear();
        console.out << line << std::flush;
    };
    batch.isStopped = [] { return StopSignals::Caught() != 0; };
    return batch;
}

int RunWhole(const GridOptions& options, CaseFile& file, Console& console) {
    GridProgress progress(console);
    const EngineLogWatch watch;
    const GridBatchOutcome outcome =
        RunGridAnalysis(file.Document(), BatchOptionsOf(options, progress, console));
    progress.Clear();
    return ShowEnd(outcome, watch.HasSeen(outcome.logFile), file, console);
}

int RunShare(const GridOptions& options, const GridPart& part, CaseFile& file, Console& console) {
    GridProgress progress(console);
    const EngineLogWatch watch;
    const GridBatchOutcome outcome =
        RunGridPart(file.Document(), BatchOptionsOf(options, progress, console), part);
    progress.Clear();
    if (outcome.end == BatchEnd::Written)
        return kExitDone; // the merge tells what was found
    return ShowEnd(outcome, watch.HasSeen(outcome.logFile), file, console);
}

/// A few names of many.
std::string SomeOf(const std::vector<std::string>& names) {
    constexpr std::size_t kMost = 20;
    const std::size_t shown = std::min(names.size(), kMost);
    std::string text =
        JoinNames({names.begin(), names.begin() + static_cast<std::ptrdiff_t>(shown)});
    return shown < names.size() ? text + ", ..." : text;
}

int FinishMerge(GridMerge& merge, CaseFile& file, Console& console) {
    using State = GridMerge::TileState;
    const EngineLogWatch watch;
    if (const auto unfit = merge.TilesIn(State::Unfit); !unfit.empty())
        return Report(console,
                      Status::InputFault(FormatText(kTextCliGridTilesUnfit, SomeOf(unfit))));
    if (const auto missing = merge.TilesIn(State::Missing); !missing.empty())
        return Report(console, Status::SystemFault(FormatText(kTextCliGridTilesMissing,
                                                              missing.size(), SomeOf(missing))));
    const GridBatchOutcome outcome = merge.Finish();
    return ShowEnd(outcome, watch.HasSeen(outcome.logFile), file, console);
}

int RunMerge(const GridOptions& options, int parts, CaseFile& file, Console& console) {
    GridProgress progress(console);
    GridBatchOptions batch = BatchOptionsOf(options, progress, console);
    batch.print = {}; // the lines tell how far a computation has come
    GridMerge merge(file.Document(), batch, parts);
    if (!merge.Prepare())
        return ShowEnd(merge.Outcome(), false, file, console);
    merge.TakeTiles();
    progress.Clear();
    return FinishMerge(merge, file, console);
}

/// The arguments with which a part is started; the case is named absolute, since opening it has
/// moved the current directory.
std::vector<std::string> ArgumentsOfPart(const GridOptions& options, const CaseFile& file,
                                         int part) {
    const int parts = *options.jobs;
    const std::size_t memory = options.memory != 0 ? options.memory : UsableMemory() / 4;
    return {"grid",      file.Path(),
            "--parts",   std::to_string(parts),
            "--part",    std::to_string(part),
            "--scratch", options.scratch == Scratch::Disk ? "disk" : "memory",
            "--memory",  std::to_string(memory / static_cast<std::size_t>(parts)),
            "--lang",    CurrentLanguage() == Language::Japanese ? "ja" : "en"};
}

int RunJobs(const GridOptions& options, CaseFile& file, Console& console) {
    GridProgress progress(console);
    GridMerge merge(file.Document(), BatchOptionsOf(options, progress, console), *options.jobs);
    if (!merge.Prepare())
        return ShowEnd(merge.Outcome(), false, file, console);
    PartJobs jobs;
    jobs.program = "/proc/self/exe";
    jobs.parts = *options.jobs;
    jobs.argumentsOf = [&](int part) { return ArgumentsOfPart(options, file, part); };
    jobs.noteProgress = [&merge] { merge.TakeTiles(); };
    jobs.isStopped = [] { return StopSignals::Caught() != 0; };
    const PartJobsEnd end = RunPartJobs(jobs);
    progress.Clear();
    if (end.wasStopped)
        return kExitSystem;
    if (end.part != 0) {
        ShowError(console, FormatText(kTextCliGridPartFailed, end.part, *options.jobs));
        console.err << end.errors;
        return end.exitCode;
    }
    merge.TakeTiles();
    progress.Clear();
    return FinishMerge(merge, file, console);
}

int RunAsAsked(const GridOptions& options, CaseFile& file, Console& console) {
    KeepFreedMemory();
    if (options.jobs)
        return RunJobs(options, file, console);
    if (!options.parts)
        return RunWhole(options, file, console);
    if (options.merge)
        return RunMerge(options, *options.parts, file, console);
    GridPart part{options.part.value_or(0), *options.parts};
    if (!options.part)
        if (const int refused =
                Report(console, PartOfLauncher(ProcessEnvironment(), part.count, &part.number)))
            return refused;
    return RunShare(options, part, file, console);
}

/// Where a signal has to wait until what the batch leaves elsewhere is gone: files on disk, or
/// processes of its own. In memory there is nothing of that kind.
bool NeedsOrderlyEnd(const GridOptions& options) {
    return options.scratch == Scratch::Disk || options.jobs.has_value();
}

/// Options that need each other, or exclude each other.
Status TestOptions(const GridOptions& options) {
    const int parts = options.parts.value_or(0);
    if (options.jobs && (options.parts || options.part || options.merge))
        return Status::InputFault(std::string(Text(kTextCliGridJobsAlone)));
    if (!options.parts && (options.part || options.merge))
        return Status::InputFault(std::string(Text(kTextCliGridPartsMissing)));
    if (options.part && options.merge)
        return Status::InputFault(std::string(Text(kTextCliGridPartOrMerge)));
    if (options.part && *options.part > parts)
        return Status::InputFault(FormatText(kTextCliGridPartOutside, *options.part, parts));
    return Status::Ok();
}

} // namespace

int RunGrid(const GridOptions& options, Console& console) {
    if (const int refused = Report(console, TestOptions(options)))
        return refused;
    int exitCode = kExitDone;
    {
        std::optional<StopSignals> signals;
        if (NeedsOrderlyEnd(options))
            signals.emplace();
        CaseFile file(console, Consent::Given);
        if (const int refused = file.Open(options.file))
            return refused;
        if (const int refused = Report(console, TestGridSettings(file)))
            return refused;
        exitCode = RunAsAsked(options, file, console);
    }
    if (const int signal = StopSignals::Caught(); signal != 0 && NeedsOrderlyEnd(options))
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
    AddIntOption(command, {"--parts", "N", kTextCliHelpParts}, 1, &options->parts);
    AddIntOption(command, {"--part", "I", kTextCliHelpPart}, 1, &options->part);
    AddIntOption(command, {"--jobs", "N", kTextCliHelpJobs}, 1, &options->jobs);
    command.add_flag("--merge", options->merge, std::string(Text(kTextCliHelpMerge)));
    AddSizeOption(command, {"--memory", "SIZE", kTextCliHelpMemory}, &options->memory);
}

} // namespace ryn::cli
