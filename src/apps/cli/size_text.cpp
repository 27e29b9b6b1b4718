#include "apps/cli/size_text.h"

#include <cctype>
#include <cmath>
#include <string>

#include "base/number_text.h"

namespace ryn::cli {

namespace {

/// 1 without a suffix, 1024 for "k", ...; 0 for no suffix of a size.
double FactorOf(std::string suffix) {
    for (char& letter : suffix)
        letter = static_cast<char>(std::tolower(static_cast<unsigned char>(letter)));
    if (suffix.empty() || suffix == "b")
        return 1.0;
    const std::string rest = suffix.substr(1);
    const std::size_t power = std::string("kmgt").find(suffix.front());
    if (power == std::string::npos || (!rest.empty() && rest != "b" && rest != "ib"))
        return 0.0;
    return std::pow(1024.0, static_cast<double>(power + 1));
}

} // namespace

std::optional<std::size_t> ParseSize(std::string_view text) {
    const std::size_t end = text.find_last_of("0123456789.") + 1; // 0 where there is none
    const std::optional<double> number = ParseDouble(text.substr(0, end));
    if (!number)
        return std::nullopt;
    const double bytes = *number * FactorOf(std::string(text.substr(end)));
    constexpr double kMost = 0x1p60;
    if (!(bytes >= 1.0 && bytes <= kMost))
        return std::nullopt;
    return static_cast<std::size_t>(bytes);
}

} // namespace ryn::cli
