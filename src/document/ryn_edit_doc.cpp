#include "document/ryn_edit_doc.h"

#include <memory>
#include <utility>

#include "base/file_access.h"
#include "base/path_parts.h"
#include "base/qx_path.h"
#include "document/dlg_enumerator.h"
#include "document/parameter_file_name.h"
#include "results/result_file.h"
#include "strings/catalogue.h"

namespace ryn {

CRynEditDoc::CRynEditDoc() {
    enumerator = std::make_unique<CDlgEnumerator>();
    fileExtension = "RYN";
    auto root = std::make_unique<CGlobalKvf>();
    globalKvf = root.get();
    rootSection = std::move(root);
}

CRynEditDoc::~CRynEditDoc() {
    rootSection.reset();
    enumerator.reset();
}

const CRuntimeClass& CRynEditDoc::GetRuntimeClass() const {
    return RuntimeClass();
}

CRuntimeClass& CRynEditDoc::RuntimeClass() {
    static CRuntimeClass record{"CRynEditDoc", &CK44SetupDoc::RuntimeClass(),
                                []() { return std::make_unique<CRynEditDoc>(); }};
    return record;
}

void CRynEditDoc::UsePorts(const Ports& outside) {
    CK44SetupDoc::UsePorts(outside);
    globalKvf->Values().UsePorts(outside);
    if (GetPathName().empty()) // the fonts of an opened document are its file's
        results.UseMessageFont(outside.platformFont->MessageFont());
}

int CRynEditDoc::OnNewDocument() {
    return CK44SetupDoc::OnNewDocument() != 0 ? 1 : 0;
}

int CRynEditDoc::OnOpenDocument(const std::string& path) {
    if (!IsParameterFileName(path)) {
        GetPorts().messages->Show(MessageKind::Error,
                                  std::string(Text(kTextUnsupportedFileFormat)));
        return 0;
    }
    // Absolute before anything is read, since reading moves the current directory.
    const std::string name = FindParameterFile(FullPath(path));
    const std::string baseDirectory = SplitPath(name).directory;
    LoadParameters(name, baseDirectory);
    LoadResults(baseDirectory);
    CDocument::SetPathName(name, 0);
    return 1;
}

void CRynEditDoc::LoadParameters(const std::string& path, const std::string& baseDirectory) {
    KvfHandle tree = kvfLoadFile(path, 1);
    if (kvfPeekErrorGlb() != 0) {
        kvfGetErrorGlb();
        std::string text;
        kvfGetSyntaxErr(tree.get(), nullptr, nullptr, &text);
        GetPorts().messages->Show(MessageKind::Error, text);
        readWhole = false;
    } else {
        const KvfSection* const target = kvfTargetByNameNum(tree.get(), "RynEditor", 1);
        globalKvf->Read(target, baseDirectory);
        SetModifiedFlag(0);
        readWhole = target != nullptr;
    }
    brokenFile = readWhole ? std::string() : path;
    kvfClose(&tree);
}

void CRynEditDoc::LoadResults(const std::string& baseDirectory) {
    results.Clear();
    kvfClose(&results.HistogramKvf);
    kvfClose(&results.GraphsKvf);
    resultError = Status::Ok();
    const std::string& file = globalKvf->DefineEVS().OutputFileName;
    if (file.empty())
        return;
    resultError = ReadResultFile(results, file, baseDirectory);
    if (resultError)
        SetModifiedFlag(0);
}

int CRynEditDoc::OnSaveDocument(const std::string& path) {
    GetPorts().keyboardFocus->ReleaseFocus();
    const std::string asked = FullPath(path);
    const std::string opened = GetPathName();
    const std::string name = SavedParameterFileName(asked, fileExtension);
    Status ready = SettleSpelling(opened, asked, name);
    if (ready && !brokenFile.empty() && SavedParameterFileName(brokenFile, fileExtension) == name) {
        ready = KeepBrokenFile(name);
        if (ready)
            brokenFile.clear();
    }
    SetPathName(name, 1);
    const std::string baseDirectory = CQxPath(name).GetDirectoryName();
    if (ready)
        ready = WriteParameters(name, baseDirectory);
    NoteSaveError(std::move(ready));
    // Whether or not the parameters could be written: a run has emptied the file by now.
    // Without a name for them the results live in memory alone.
    if (results.IsValid() && !globalKvf->DefineEVS().OutputFileName.empty())
        NoteSaveError(WriteResults(baseDirectory));
    SetModifiedFlag(0);
    return 1;
}

Status CRynEditDoc::WriteParameters(const std::string& path, const std::string& baseDirectory) {
    KvfHandle tree = kvfCreate();
    globalKvf->Write(tree.get(), baseDirectory);
    Status written = kvfWrite(tree.get(), path, durability);
    kvfClose(&tree);
    return written;
}

Status CRynEditDoc::WriteResults(const std::string& baseDirectory) {
    if (Status refused = TestResultFileName(); !refused)
        return refused;
    return WriteResultsOfDocument(results, globalKvf->DefineEVS().OutputFileName, baseDirectory,
                                  durability);
}

namespace {

/// Whether the file is one of those that the engine writes beside the results.
bool IsEngineFile(const std::string& path) {
    const PathParts parts = SplitPath(path);
    const std::string name = parts.name + parts.extension;
    return name == "Ryn.log" || name == "Rynout1.txt" || name == "Rynout2.txt";
}

} // namespace

Status CRynEditDoc::TestResultFileName() const {
    const std::string& result = globalKvf->DefineEVS().OutputFileName;
    bool isTaken = IsEngineFile(result);
    // The parameter file's name also where the file is not there yet.
    if (!GetPathName().empty())
        isTaken = isTaken || result == SavedParameterFileName(GetPathName(), fileExtension);
    for (const std::string& other :
         {GetPathName(), globalKvf->DefineEVS().InputFileName,
          globalKvf->BasicInput().InputFileName, globalKvf->BasicInput().OutputFileName,
          globalKvf->GridInput().Tsq2InputFile, globalKvf->GridInput().Tsq2OutputFile})
        isTaken = isTaken || IsSameFile(result, other);
    return isTaken ? Status::InputFault(FormatText(kTextRunOverInput, result)) : Status::Ok();
}

void CRynEditDoc::NoteSaveError(Status status) {
    if (saveError)
        saveError = std::move(status);
}

Status CRynEditDoc::TakeSaveError() {
    return std::exchange(saveError, Status::Ok());
}

} // namespace ryn
