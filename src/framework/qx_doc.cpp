#include "framework/qx_doc.h"

#include "strings/catalogue.h"

namespace ryn {

const CRuntimeClass& CQxDoc::GetRuntimeClass() const {
    return RuntimeClass();
}

CRuntimeClass& CQxDoc::RuntimeClass() {
    static CRuntimeClass record{"CQxDoc", &CDocument::RuntimeClass()};
    return record;
}

int CQxDoc::SaveModified() {
    if (!IsModified())
        return 1;
    switch (GetPorts().messages->AskYesNoCancel(FormatText(kTextSaveChangesTo, GetTitle()))) {
    case Answer::Yes:
        return DoSave(GetPathName());
    case Answer::No:
        return 1;
    case Answer::Cancel:
        break;
    }
    return 0;
}

int CQxDoc::DoSave(const std::string& path, int replace) {
    std::string name = path;
    if (name.empty()) {
        const std::optional<std::string> chosen =
            GetPorts().fileChoice->ChooseFileToSave(MakeSaveRequest());
        if (!chosen)
            return 0;
        name = *chosen;
    }
    const std::string previousName = GetPathName();
    const std::string previousTitle = GetTitle();
    const bool wasModified = IsModified();
    (void)TakeSaveError();
    const int saved = OnSaveDocument(name);
    const Status error = TakeSaveError();
    const bool done = saved != 0 && error;
    if (!done || replace == 0) { // the document keeps its own name, and its own file is as it was
        SetPathName(previousName, 0);
        SetTitle(previousTitle);
        SetModifiedFlag(wasModified ? 1 : 0);
    }
    if (done)
        return 1;
    SetModifiedFlag(1);
    if (!error)
        GetPorts().messages->Show(MessageKind::Error, error.Text());
    return 0;
}

Status CQxDoc::TakeSaveError() {
    return Status::Ok();
}

FileChoicePort::SaveRequest CQxDoc::MakeSaveRequest() const {
    return {"", "", GetTitle()};
}

} // namespace ryn
