#pragma once

#include <cstdint>
#include <span>
#include <string>
#include <string_view>

#include "framework/dlg_enumerator.h"

namespace ryn {

/// One page of the tree.
struct PageEntry {
    std::uint32_t page;
    std::uint32_t root;         ///< the root that it stands under; 0 for a root
    int titleId;                ///< in the catalogue; 0 for a root
    std::string_view rootTitle; ///< the same in every language; empty for a page
    std::string_view className; ///< empty for a root
    int helpContext;            ///< 0 for a root
    std::string_view helpTopic; ///< of a root
    std::string_view address;   ///< of a root: its built-in HTML page
};

/// All pages in the order of the tree. Under Setup page 5 stands above page 4.
std::span<const PageEntry> PageTable();
/// The entry of a page number, or null.
const PageEntry* FindPage(std::uint32_t page);

/// The analysis's pages.
class CDlgEnumerator : public CK44SetupDlgEnumerator {
  public:
    std::string GetPageTitle(std::uint32_t page) const override;
    const CRuntimeClass* GetPageClass(std::uint32_t page, std::string& helpTopic,
                                      std::string& pageAddress) const override;
};

} // namespace ryn
