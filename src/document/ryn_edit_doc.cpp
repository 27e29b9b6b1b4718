#include "document/ryn_edit_doc.h"

#include <memory>
#include <utility>

#include "base/path_parts.h"
#include "base/qx_path.h"
#include "document/dlg_enumerator.h"
#include "document/parameter_file_name.h"
#include "strings/catalogue.h"

namespace ryn {

CRynEditDoc::CRynEditDoc() {
    enumerator = std::make_unique<CDlgEnumerator>();
    fileExtension = "RYN";
    auto root = std::make_unique<CGlobalKvf>();
    globalKvf = root.get();
    rootSection = std::move(root);
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
    LoadParameters(name, SplitPath(name).directory);
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
    if (ready)
        WriteFiles(name);
    else
        NoteSaveError(ready);
    SetModifiedFlag(0);
    return 1;
}

void CRynEditDoc::WriteFiles(const std::string& path) {
    const std::string baseDirectory = CQxPath(path).GetDirectoryName();
    KvfHandle tree = kvfCreate();
    globalKvf->Write(tree.get(), baseDirectory);
    NoteSaveError(kvfWrite(tree.get(), path, durability));
    kvfClose(&tree);
}

void CRynEditDoc::NoteSaveError(Status status) {
    if (saveError)
        saveError = std::move(status);
}

Status CRynEditDoc::TakeSaveError() {
    return std::exchange(saveError, Status::Ok());
}

} // namespace ryn
