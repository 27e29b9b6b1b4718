#include "framework/setup_doc.h"

#include "strings/catalogue.h"

namespace ryn {

const CRuntimeClass& CK44SetupDoc::GetRuntimeClass() const {
    return RuntimeClass();
}

CRuntimeClass& CK44SetupDoc::RuntimeClass() {
    static CRuntimeClass record{"CK44SetupDoc", &CQxDoc::RuntimeClass()};
    return record;
}

bool CK44SetupDoc::Disabled(std::uint32_t /*page*/) const {
    return false;
}

void CK44SetupDoc::SetEngine(const std::string& /*name*/) {}

FileChoicePort::SaveRequest CK44SetupDoc::MakeSaveRequest() const {
    return {fileExtension, std::string(Text(kTextParameterFileFilter)), ""};
}

} // namespace ryn
