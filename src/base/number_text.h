#pragma once

#include <optional>
#include <string>
#include <string_view>

namespace ryn {

/// Numbers as text and back, with a decimal point whatever the process's locale.

/// The shortest text that reads back as the same number; "nan", "inf", "-inf" where it is not
/// finite.
std::string ShortestText(double value);
std::string ShortestText(float value);

/// Fixed notation with so many decimals, as printf's "%.*f"; "nan", "inf", "-inf".
std::string FixedText(double value, int decimals);

/// A whole text as a number; nothing else may stand before or behind it. A leading "+" is taken.
/// "nan", "inf" and "infinity" in any case are numbers. Nothing when the text is no number or its
/// magnitude is beyond the type's range (1e999); an underflow gives 0.
std::optional<double> ParseDouble(std::string_view text);
std::optional<float> ParseFloat(std::string_view text);
/// A whole text as a 32-bit number in decimal digits with an optional sign.
std::optional<int> ParseInt(std::string_view text);

} // namespace ryn
