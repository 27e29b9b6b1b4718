#include "framework/document.h"

#include "base/path_parts.h"

namespace ryn {

CDocument::CDocument() : ports(&SilentPorts()), title(kUntitled) {}

const CRuntimeClass& CDocument::GetRuntimeClass() const {
    return RuntimeClass();
}

CRuntimeClass& CDocument::RuntimeClass() {
    static CRuntimeClass record{"CDocument", &CObject::RuntimeClass()};
    return record;
}

void CDocument::SetPathName(const std::string& path, int addToRecentList) {
    pathName = FullPath(path);
    const PathParts parts = SplitPath(pathName);
    title = parts.name + parts.extension;
    if (addToRecentList != 0)
        ports->recentFiles->AddRecentFile(pathName);
}

int CDocument::OnNewDocument() {
    pathName.clear();
    title = kUntitled;
    SetModifiedFlag(0);
    return 1;
}

void CDocument::OnCloseDocument() {
    if (!closeRequested)
        return;
    // Moved out first: the owner destroys this object, and the function with it.
    const std::function<void(CDocument&)> close = std::move(closeRequested);
    close(*this);
}

} // namespace ryn
