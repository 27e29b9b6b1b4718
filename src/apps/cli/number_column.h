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

/// Reads one number a line. Empty lines, and all behind "#", do not count. A first line that is no
/// number is the heading; any other, and a number that is not finite, is a fault with its line. So
/// is a line of several columns between blanks, tabs, semicolons or commas: the first one of a
/// table is often the year. Lines that are all "digits,digits" may be that or have a decimal comma.
/// `name` stands for the text in faults.
Status ReadNumberColumn(std::string_view text, const std::string& name, NumberColumn* column);

} // namespace ryn::cli
