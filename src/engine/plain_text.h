#pragma once

#include <string>
#include <string_view>

namespace ryn {

/// A text from a file as part of one harmless line of UTF-8: each character that breaks a line or
/// commands a terminal becomes a blank, each byte that is no UTF-8 a question mark.
std::string PlainText(std::string_view text);

/// The same for a name, which is cut after some hundred bytes with "..." at its end.
std::string PlainName(std::string_view name);

/// A value of the series within a sentence: with the digits that a 32-bit float has, in which
/// series are stored, so that 0.1 is not told as 0.10000000149. "nan", "inf" and "-inf" too.
std::string NumberText(double value);

/// A return period: as it was given, without an exponent as long as people write it without one.
std::string PeriodText(double years);

} // namespace ryn
