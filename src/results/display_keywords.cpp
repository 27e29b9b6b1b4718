#include "results/display_keywords.h"

#include <cstdint>

namespace ryn {

void SaveSelectedItems(KvfTree* file, const SelectedItemList& items) {
    kvfAddKeyword(file, "SelectedItems");
    for (const bool shown : items)
        kvfAddBool(file, shown);
}

void LoadSelectedItems(const KvfSection* section, SelectedItemList* items) {
    const KvfKeyword* const keyword = kvfKeywordByNameNum(section, "SelectedItems", 1);
    const int count = kvfGetNoParams(keyword);
    for (int i = 1; i <= count; ++i) {
        const KvfParam* const parameter = kvfParamByNum(keyword, i);
        items->push_back(kvfIsBool(parameter) != 0 && kvfGetBool(parameter));
    }
}

void GrowSelectedItems(std::size_t count, SelectedItemList* items) {
    if (count > items->size())
        items->push_back(true);
}

void SaveFont(KvfTree* file, const FontRecord& font) {
    kvfPutParam(file, "FontHeight", font.height);
    kvfPutParam(file, "FontName", font.faceName);
    kvfPutParam(file, "FontFamily", static_cast<int>(font.pitchAndFamily));
    kvfPutParam(file, "FontCharSet", static_cast<int>(font.charSet));
}

void LoadFont(const KvfSection* section, FontRecord* font) {
    int family = font->pitchAndFamily;
    int charSet = font->charSet;
    std::string name = font->faceName;
    kvfGetParam(section, "FontHeight", &font->height, 1, 1);
    kvfGetParam(section, "FontName", &name, 1, 1);
    kvfGetParam(section, "FontFamily", &family, 1, 1);
    kvfGetParam(section, "FontCharSet", &charSet, 1, 1);
    font->faceName = FaceName(name);
    font->pitchAndFamily = static_cast<std::uint8_t>(family);
    font->charSet = static_cast<std::uint8_t>(charSet);
}

FontRecord PlainPageFont() {
    FontRecord font;
    font.height = 10;
    font.faceName = "Arial";
    return font;
}

} // namespace ryn
