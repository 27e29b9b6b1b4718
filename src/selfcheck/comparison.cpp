#include "selfcheck/comparison.h"

#include <cmath>
#include <optional>
#include <utility>

#include "base/number_text.h"

namespace ryn::selfcheck {

namespace {

constexpr std::string_view kNone = "none";

/// The notation of a number: "9.552665e-6" has 6 decimals and the power -6.
struct Notation {
    int decimals = 0;
    std::optional<int> power;
};

Notation NotationOf(std::string_view number) {
    Notation notation;
    const std::size_t e = number.find('e');
    const std::string_view digits = number.substr(0, e);
    if (const std::size_t point = digits.find('.'); point != std::string_view::npos)
        notation.decimals = static_cast<int>(digits.size() - point - 1);
    if (e != std::string_view::npos)
        notation.power = ParseInt(number.substr(e + 1));
    return notation;
}

bool Agrees(std::string_view expected, double found) {
    if (expected == kNone)
        return std::isnan(found);
    const std::optional<double> number = ParseDouble(expected);
    return number && std::abs(found - *number) <= Tolerance(expected);
}

} // namespace

double Tolerance(std::string_view expected) {
    const Notation notation = NotationOf(expected);
    return 0.5000001 * std::pow(10.0, notation.power.value_or(0) - notation.decimals);
}

std::string FoundText(const Comparison& comparison) {
    if (std::isnan(comparison.found))
        return std::string(kNone);
    const Notation notation = NotationOf(comparison.expected);
    if (!notation.power)
        return FixedText(comparison.found, notation.decimals);
    return FixedText(comparison.found / std::pow(10.0, *notation.power), notation.decimals) + 'e' +
           std::to_string(*notation.power);
}

void Compare(Comparisons& list, const CaseLabel& label, std::string quantity,
             std::string_view expected, double found) {
    list.push_back({label, std::move(quantity), expected, found, Agrees(expected, found)});
}

} // namespace ryn::selfcheck
