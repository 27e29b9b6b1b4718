#include "framework/kvf_base.h"

#include <utility>

namespace ryn {

int CKvfBase::Check(CMessageList& /*messages*/, int /*flag*/) {
    return 0;
}

void CKvfBase::Reset(int /*argument*/) {}

CKvfBase* CKvfBase::GetRoot() {
    return parent == nullptr ? this : parent->GetRoot();
}

const CKvfBase* CKvfBase::GetRoot() const {
    return parent == nullptr ? this : std::as_const(*parent).GetRoot();
}

CKvfBase* CKvfBase::GetParent() {
    return parent;
}

CKvfBase* CKvfBase::FindChildKvf(unsigned long /*id*/) {
    return nullptr;
}

} // namespace ryn
