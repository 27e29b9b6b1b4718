#pragma once

#include <string>
#include <string_view>
#include <vector>

#include "base/status.h"

namespace ryn::cli {

/// A column of numbers from a text.
struct NumberColumn {
    std::vector<double> values;
    /// The first line where it is a heading and no number; else empty.
    std::string heading;
};

/// Reads one number a line, or the first column of several between blanks, tabs, semicolons or
/// commas. Empty lines, and all behind "#", do not count. A first line that is no number is the
/// heading; any other, and a number that is not finite, is a fault with its line. Lines that are
/// all "digits,digits" are refused, since a decimal comma cannot be told from two columns there.
/// `name` stands for the text in faults.
Status ReadNumberColumn(std::string_view text, const std::string& name, NumberColumn* column);

} // namespace ryn::cli
