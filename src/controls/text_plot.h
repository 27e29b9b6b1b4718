#pragma once

#include <string>

#include "base/font_record.h"
#include "kvf/kvf.h"

namespace ryn {

/// What a text page says, without the window that shows it: its text, with a line feed as the only
/// line end, and its font.
class CQxTextOcxPlot {
  public:
    /// Replaces the whole text.
    void SetText(std::string newText) { text = std::move(newText); }
    const std::string& GetText() const { return text; }

    void SetFont(const FontRecord& newFont) { font = newFont; }
    const FontRecord& GetFont() const { return font; }

    /// Writes the text into the open target: one keyword Line for each line, in order.
    void ExportData(KvfTree* file) const;

  private:
    std::string text;
    FontRecord font;
};

} // namespace ryn
