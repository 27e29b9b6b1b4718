#pragma once

#include <string_view>
#include <vector>

#include "base/font_record.h"
#include "kvf/kvf.h"

namespace ryn {

/// The keywords of display settings that several pages share.

/// One flag for each D/E combination in the engine's order: whether the page shows it.
using SelectedItemList = std::vector<bool>;

/// A flag of a page's settings under its keyword.
template <class Page>
struct DisplayFlag {
    const char* keyword;
    bool Page::*member;
};

template <class Page, std::size_t N>
void SaveFlags(KvfTree* file, const Page& page, const DisplayFlag<Page> (&flags)[N]) {
    for (const DisplayFlag<Page>& flag : flags)
        kvfPutParam(file, flag.keyword, page.*flag.member);
}

template <class Page, std::size_t N>
void LoadFlags(const KvfSection* section, Page& page, const DisplayFlag<Page> (&flags)[N]) {
    for (const DisplayFlag<Page>& flag : flags)
        kvfGetParam(section, flag.keyword, &(page.*flag.member), 1, 1);
}

void SaveSelectedItems(KvfTree* file, const SelectedItemList& items);
/// Appends the stored flags; a parameter that is no bool counts as false. They are read before any
/// result is, so that their number need not match anything yet.
void LoadSelectedItems(const KvfSection* section, SelectedItemList* items);
/// After the `count`-th combination was appended: shows it when no flag is stored for it.
void GrowSelectedItems(std::size_t count, SelectedItemList* items);

void SaveFont(KvfTree* file, const FontRecord& font);
void LoadFont(const KvfSection* section, FontRecord* font);
/// Height 10, face "Arial", all else 0: the font with which most pages start.
FontRecord PlainPageFont();

} // namespace ryn
