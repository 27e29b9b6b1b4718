#pragma once

#include <string>
#include <string_view>

#include <fmt/printf.h>

#include "strings/text_id.h"

namespace ryn {

/// A text in the current language (UTF-8). An id that the catalogue does not hold gives an empty
/// text.
std::string_view Text(int id);

/// A text with its printf places filled in; numbers have a decimal point whatever the locale.
template <typename... Arguments>
std::string FormatText(int id, const Arguments&... arguments) {
    return fmt::sprintf(Text(id), arguments...);
}

/// The n-th line of a text that holds several, from 0; empty when there is none.
std::string_view TextLine(int id, int line);

} // namespace ryn
