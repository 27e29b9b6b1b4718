#pragma once

#include <string>
#include <string_view>
#include <vector>

namespace ryn {

enum class NumberKind {
    Value,     ///< a finite number within the range of a 32-bit float
    Missing,   ///< empty, or a usual word or mark for a missing value
    Marked,    ///< a number with a quality mark behind it: "12.3 e", "31.1*"
    Censored,  ///< "<0.5", ">12": a bound, not a value
    Grouped,   ///< with a sign between thousands: "1,234.5"
    NotFinite, ///< "inf"
    TooLarge,  ///< beyond the range of a 32-bit float
    NoNumber,
};

struct NumberField {
    NumberKind kind = NumberKind::NoNumber;
    float value = 0.0F;    ///< for Value and Marked
    std::string_view mark; ///< for Marked and Censored
};

/// Reads a trimmed field. `decimal` is '.' or ','; the other one, and any thousands separator,
/// makes it no number. Marks are up to three letters or signs; digits are none, so that "1 234" and
/// "1,234" stay no numbers.
NumberField ReadNumber(std::string_view field, char decimal);

/// "", "NA", "NaN", "null", "-", "--", "***", "ND", "M", "Lücke", ... in any case; and the words
/// that gauge networks put in the place of a value ("Ice", "Eqp").
bool IsMissingWord(std::string_view field);

} // namespace ryn
