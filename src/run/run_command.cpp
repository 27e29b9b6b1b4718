#include "run/run_command.h"

#include <optional>
#include <utility>

#include "base/atomic_file.h"
#include "base/file_access.h"
#include "base/path_parts.h"
#include "base/qx_path.h"
#include "document/parameter_file_name.h"
#include "results/result_file.h"
#include "strings/catalogue.h"

namespace ryn {

namespace {

constexpr auto kSeriesFailed = static_cast<std::int32_t>(EngineStatus::SeriesFailed);

/// Every other value is a success, those that no engine gives included.
bool IsFailure(std::int32_t status) {
    return status == kSeriesFailed ||
           status == static_cast<std::int32_t>(EngineStatus::SetUpFailed);
}

/// One run, from the check to the written results.
class Run {
  public:
    Run(CRynEditDoc& analysed, AnalysisEngine used)
        : document(analysed),
          engine(used),
          ports(analysed.GetPorts()),
          resultFile(analysed.GetGlobalKvf().DefineEVS().OutputFileName),
          busy(*ports.busy) {}

    RunOutcome Execute();

  private:
    bool Prepare();
    bool TestSave();
    void RefuseOutput(Status reason);
    bool Save();
    void CallEngine();
    void OfferLog();
    void TakeResults(KvfHandle* output);
    void End(RunEnd end, Status reason);

    CRynEditDoc& document;
    AnalysisEngine engine;
    const Ports& ports;
    std::string resultFile;
    BusyScope busy;
    RunOutcome outcome;
};

RunOutcome Run::Execute() {
    if (Prepare() && Save()) {
        document.Results().Clear();
        CallEngine();
    }
    return std::move(outcome);
}

void Run::End(RunEnd end, Status reason) {
    outcome.end = end;
    outcome.reason = std::move(reason);
}

/// Nothing has changed where this says no.
bool Run::Prepare() {
    if (document.GetGlobalKvf().CheckForRun() != 0) {
        ports.messages->Show(MessageKind::Error, std::string(Text(kTextRunInputFaults)));
        End(RunEnd::Findings, Status::Ok());
        return false;
    }
    outcome.logFile = LogFileOf(resultFile);
    Status writable = document.TestResultFileName();
    // Whether both files can be written is found out before the results are emptied.
    if (writable)
        writable = TestAtomicWrite(resultFile);
    if (writable && !TestSave())
        return false;
    if (writable)
        writable = EmptyFile(resultFile);
    if (!writable)
        RefuseOutput(std::move(writable));
    return outcome.end == RunEnd::Succeeded;
}

void Run::RefuseOutput(Status reason) {
    ports.messages->Show(MessageKind::Error, std::string(Text(kTextRunOutputUnwritable)));
    End(RunEnd::OutputUnwritable, std::move(reason));
}

/// A document without a name has no place yet that could be tested.
bool Run::TestSave() {
    if (document.GetPathName().empty())
        return true;
    Status writable = TestAtomicWrite(SavedParameterFileName(document.GetPathName(), "RYN"));
    if (writable)
        return true;
    ports.messages->Show(MessageKind::Error, writable.Text());
    End(RunEnd::SaveFailed, std::move(writable));
    return false;
}

/// A document that was never saved gets a name; where the user gives none the command goes on, and
/// finds no file to work from.
bool Run::Save() {
    std::string path = document.GetPathName();
    if (path.empty() || document.GetTitle() == kUntitled) {
        const std::optional<std::string> chosen = ports.fileChoice->ChooseFileToSave(
            {"RYN", std::string(Text(kTextParameterFileFilter)), ""});
        path = chosen.value_or("");
    }
    if (!path.empty()) {
        (void)document.TakeSaveError();
        document.OnSaveDocument(path);
        if (Status saved = document.TakeSaveError(); !saved) {
            document.SetModifiedFlag(1);
            ports.messages->Show(MessageKind::Error, saved.Text());
            End(RunEnd::SaveFailed, std::move(saved));
        }
    }
    // The name that was chosen just now may be the result file's.
    if (Status free = document.TestResultFileName(); outcome.end == RunEnd::Succeeded && !free)
        RefuseOutput(std::move(free));
    busy.Restore();
    return outcome.end == RunEnd::Succeeded;
}

void Run::CallEngine() {
    KvfHandle input = kvfLoadFile(document.GetPathName(), 1);
    std::int32_t status = 0;
    KvfHandle output;
    if (kvfPeekErrorGlb() != 0) {
        kvfGetErrorGlb();
        std::string reason;
        kvfGetSyntaxErr(input.get(), nullptr, nullptr, &reason);
        ports.messages->Show(MessageKind::Error, reason);
        outcome.reason = Status::InputFault(std::move(reason));
        busy.Restore();
        status = kSeriesFailed; // nothing valid to hand to the engine
    } else {
        output = kvfCreate();
        busy.Restore();
        const CurrentDirectoryScope directory(SplitPath(document.GetPathName()).directory);
        engine(&input, &output, &status);
    }
    kvfClose(&input);
    outcome.engineStatus = status;
    if (IsFailure(status)) {
        kvfClose(&output);
        outcome.end = RunEnd::EngineFailed;
        if (outcome.reason)
            outcome.reason = document.GetGlobalKvf().SeriesError();
        OfferLog();
    } else {
        TakeResults(&output);
    }
}

void Run::OfferLog() {
    const Answer answer = ports.messages->AskYesNo(std::string(Text(kTextRunFailed)));
    busy.Restore();
    if (answer == Answer::Yes)
        ports.textViewer->ViewTextFile(outcome.logFile);
}

void Run::TakeResults(KvfHandle* output) {
    ports.messages->Show(MessageKind::Information, std::string(Text(kTextRunCompleted)));
    busy.Restore();
    TakeEngineOutput(output, document.Results());
    if (Status written = WriteResultsOfRun(document.Results(), resultFile, Durability::Flushed);
        !written) {
        ports.messages->Show(MessageKind::Error, written.Text());
        End(RunEnd::ResultsUnwritten, std::move(written));
    }
}

} // namespace

RunOutcome RunAnalysis(CRynEditDoc& document, AnalysisEngine engine) {
    return Run(document, engine).Execute();
}

std::string LogFileOf(const std::string& resultFile) {
    CQxPath path;
    path.SetFileName(resultFile);
    return path.GetDirectoryName() + "Ryn.log";
}

} // namespace ryn
