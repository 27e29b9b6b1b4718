#pragma once

#include <cstddef>
#include <string>
#include <string_view>

namespace ryn::cli {

/// A text from a file or an argument as one harmless line: line breaks at the end go,
/// line breaks within become blanks, other control characters "\xHH", so that no file can send
/// commands to a terminal or forge a line of output. Bytes beyond ASCII stay.
std::string PlainLine(std::string_view text);

/// Columns that a UTF-8 text takes on a terminal: two for wide East Asian characters, one for
/// others and for each byte that is no valid UTF-8.
std::size_t DisplayWidth(std::string_view text);

} // namespace ryn::cli
