#include "run/point_analysis.h"

#include <filesystem>
#include <system_error>

#include "base/path_parts.h"
#include "results/result_file.h"
#include "strings/catalogue.h"
#include "tsq/tsq.h"

namespace ryn {

namespace {

std::string ParameterFileBeside(const std::string& path) {
    const PathParts parts = SplitPath(path);
    return parts.directory + parts.name + "Extract.RYN";
}

/// Whether a tree was saved for these files. Their names are drawn at random, so that no other
/// batch has them.
bool IsOf(const PointFiles& files, const KvfTree* tree) {
    std::string series;
    kvfGetParam(kvfSectionByNameNum(kvfTargetByNameNum(tree, "RynEditor", 1), "BasicInput", 1),
                "InputFileName", &series, 1, 1);
    return SplitPath(series).name == SplitPath(files.series).name;
}

} // namespace

PointAnalysis::PointAnalysis(CRynEditDoc& analysed, const Engines& used)
    : document(analysed),
      root(analysed.GetGlobalKvf()),
      engines(used),
      parameterFile(ParameterFileBeside(analysed.GetPathName())),
      threshold(root.BasicInput().Threshold),
      annualNumber(root.BasicInput().AvgAnNum) {}

void PointAnalysis::PointSections(const PointFiles& files) {
    CBasicInputKvf& basic = root.BasicInput();
    basic.InputFileName = files.series;
    basic.InputItem = 1;
    basic.OutputFileName = files.extremes;
    basic.Threshold = threshold;
    basic.AvgAnNum = annualNumber;
    root.DefineEVS().InputFileName = files.extremes;
    root.DefineEVS().InputItem = 1;
}

Status PointAnalysis::Extract(const PointFiles& files, bool* hasFewerPeaks) {
    CBasicInputKvf& basic = root.BasicInput();
    CDefineEVSKvf& define = root.DefineEVS();
    CTsqValues& values = root.Values();
    if (!basic.summary.ReadSummary(files.series, 0))
        return basic.summary.ReadError();
    values.ClearSeries();
    if (!values.ReadSeries(files.series, 0))
        return values.ReadError();
    const ExtractionReport report = values.ExtractSeries(files.extremes, basic, /*silent=*/true);
    *hasFewerPeaks = report.parametersChanged;
    if (!report.written)
        return report.written;
    if (!define.summary.ReadSummary(files.extremes, 0))
        return define.summary.ReadError();
    define.Threshold = basic.PdsDataType != kPartialDurationsByThreshold
                           ? define.summary.minimum.value
                           : basic.Threshold;
    define.AvgAnNum = basic.AvgAnNum;
    return Status::Ok();
}

Status PointAnalysis::Keep(const PointFiles& files) const {
    if (files.kept.empty())
        return Status::Ok();
    const std::string directory = SplitPath(files.kept).directory;
    std::error_code error;
    std::filesystem::create_directories(directory, error);
    return error ? Status::FromErrno(directory, error.value())
                 : tsqCopyFile(files.extremes, files.kept);
}

// A file that cannot be read back is shown and the batch goes on: this point alone has failed. One
// that another batch over the same parameter file has put in its place would give this point that
// one's numbers.
Status PointAnalysis::SaveAndLoad(const PointFiles& files, KvfHandle* input, bool* isRead) {
    (void)document.TakeSaveError();
    document.OnSaveDocument(parameterFile);
    if (Status saved = document.TakeSaveError(); !saved)
        return saved;
    *input = kvfLoadFile(document.GetPathName(), 1);
    *isRead = kvfPeekErrorGlb() == 0;
    if (!*isRead) {
        kvfGetErrorGlb();
        std::string reason;
        kvfGetSyntaxErr(input->get(), nullptr, nullptr, &reason);
        document.GetPorts().messages->Show(MessageKind::Error, reason);
    }
    return !*isRead || IsOf(files, input->get())
               ? Status::Ok()
               : Status::SystemFault(FormatText(kTextGridPointFileReplaced, parameterFile));
}

/// The tree that a save would write and a load would give back, but for names of files, which stay
/// absolute here: every type survives the text.
KvfHandle PointAnalysis::MakeTree() {
    KvfHandle tree = kvfCreate();
    root.Write(tree.get(), "");
    return tree;
}

PointOutcome PointAnalysis::Run(const PointFiles& files, PointTrace trace) {
    PointOutcome outcome;
    PointSections(files);
    outcome.reason = Extract(files, &outcome.hasFewerPeaks);
    if (outcome.reason)
        outcome.reason = Keep(files);
    root.Values().ClearSeries();
    const bool leavesFiles = trace == PointTrace::Files;
    KvfHandle input;
    bool isRead = true;
    if (outcome.reason && leavesFiles)
        outcome.reason = SaveAndLoad(files, &input, &isRead);
    else if (outcome.reason)
        input = MakeTree();
    if (!outcome.reason) {
        outcome.end = PointEnd::Broken;
        return outcome;
    }
    auto status = static_cast<std::int32_t>(EngineStatus::SeriesFailed);
    KvfHandle output = kvfCreate();
    if (isRead)
        (leavesFiles ? engines.withFiles : engines.withoutFiles)(&input, &output, &status);
    kvfClose(&input);
    if (status == static_cast<std::int32_t>(EngineStatus::SeriesFailed)) {
        outcome.end = PointEnd::Failed;
    } else if (status == static_cast<std::int32_t>(EngineStatus::SetUpFailed)) {
        outcome.end = PointEnd::SetUpFailed;
    } else {
        document.Results().Clear();
        TakeEngineOutput(&output, document.Results());
    }
    kvfClose(&output);
    return outcome;
}

} // namespace ryn
