#pragma once

#include <string>
#include <string_view>

namespace ryn {

/// A text from a file as part of one harmless line of UTF-8: each character that breaks a line or
/// commands a terminal becomes a blank, each byte that is no UTF-8 a question mark.
std::string PlainText(std::string_view text);

/// The same for a name, which is cut after some hundred bytes with "..." at its end.
std::string PlainName(std::string_view name);

} // namespace ryn
