#pragma once

#include <string>
#include <string_view>
#include <vector>

/// Small questions about a table's text.
namespace ryn {

/// Without blanks, tabs and no-break spaces at both ends.
std::string_view Trimmed(std::string_view text);
/// ASCII letters in lower case; other bytes as they are.
std::string Lowercase(std::string_view text);
bool IsDigit(char c);
bool IsLetter(char c);
/// All digits and not empty.
bool IsDigits(std::string_view text);
/// The runs of letters of a text in lower case: "Water_Year (WY)" gives water, year, wy. A
/// non-ASCII byte counts as a letter.
std::vector<std::string> Words(std::string_view text);
/// True for one of the words of a list such as "na|n/a|no data"; the list is in lower case, and the
/// text's ASCII letters may be in any.
bool IsOneOf(std::string_view text, std::string_view list);
/// True where a text in lower case begins with one of the words of such a list.
bool StartsWithOneOf(std::string_view lower, std::string_view list);
/// Where the first of the words of such a list stands in a text in lower case; npos for none.
std::size_t FindOneOf(std::string_view lower, std::string_view list);
/// A line that only divides: no letter and no digit ("=======", "-----"), or a merge tool's mark.
/// Decimal points, quotes and missing marks in fields do not make one: a delimiter does not occur.
bool IsSeparatorLine(std::string_view line, char delimiter);
/// A text for messages: in UTF-8, control characters as blanks, cut when it is long.
std::string ShownText(std::string_view text);
/// The same in double quotes.
std::string Quoted(std::string_view text);

} // namespace ryn
