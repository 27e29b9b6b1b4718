#include "document/page_classes.h"

#include <array>

namespace ryn {

CRuntimeClass* FindPageClass(std::string_view className) {
    static std::array records = std::to_array<CRuntimeClass>({
        {"CBasicForm"},
        {"CDefineEVSForm"},
        {"CMiscForm"},
        {"CProbabilityForm"},
        {"CTableView"},
        {"CTextView"},
        {"CTableView2"},
        {"CTextView2"},
        {"CTableView3"},
        {"CTableView4"},
        {"CGraphicalView"},
        {"CGraphicalView2"},
    });
    for (CRuntimeClass& record : records)
        if (record.className == className)
            return &record;
    return nullptr;
}

} // namespace ryn
