#include "framework/object.h"

namespace ryn {

bool CRuntimeClass::IsDerivedFrom(const CRuntimeClass& other) const {
    for (const CRuntimeClass* step = this; step != nullptr; step = step->base)
        if (step == &other)
            return true;
    return false;
}

const CRuntimeClass& CObject::GetRuntimeClass() const {
    return RuntimeClass();
}

CRuntimeClass& CObject::RuntimeClass() {
    static CRuntimeClass record{"CObject"};
    return record;
}

} // namespace ryn
