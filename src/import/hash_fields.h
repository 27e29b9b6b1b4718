#pragma once

#include <string_view>

namespace ryn {

/// "########": what a spreadsheet shows, and exports, where a column is too narrow for its value.
bool IsHashField(std::string_view field);

/// A line that begins with such a field and is a row: other fields hold values. "### 2001" and
/// lines of nothing but these signs are comments.
bool IsRowWithHashes(std::string_view line, char delimiter);

/// How refusals end that meet one.
inline constexpr std::string_view kHashAdvice =
    " is what a spreadsheet writes where a column is too narrow; widen it and export again";

} // namespace ryn
