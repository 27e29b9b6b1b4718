#pragma once

#include <initializer_list>
#include <string>
#include <string_view>

namespace ryn {

/// A number with six significant digits, in fixed notation where it has a sensible length; "-" for
/// one that does not exist, "inf" and "-inf". A decimal point in any locale.
std::string SixDigits(double value);

/// Cells as a line of right-aligned columns, wide enough for any SixDigits; the line ends at the
/// last cell. A longer cell moves the rest of its line.
void AppendRow(std::string& text, std::initializer_list<std::string_view> cells);

/// "NAME  VALUE" with the values below each other, as a line.
void AppendValue(std::string& text, std::string_view name, std::string_view value);

/// A heading with a line of `underline` below it and a blank line above.
void AppendHeading(std::string& text, std::string_view heading, char underline);

} // namespace ryn
