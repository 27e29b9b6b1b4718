#pragma once

#include <string>
#include <string_view>
#include <vector>

namespace ryn::selfcheck {

/// What a value belongs to. The views are of constants.
struct CaseLabel {
    std::string_view number;  ///< of the case: "A2"
    std::string_view series;  ///< of the reference series; empty for a function's value
    std::string_view subject; ///< what was computed: "GEV/ML", "run test"
    std::string_view source;  ///< who published the value, or what computed it
};

/// One published value and what was found.
struct Comparison {
    CaseLabel label;
    std::string quantity; ///< "xi", "x100", "ln L": symbols of the formulas
    /// With the digits that were published: "4.296212", "9.552665e-6". "none" where there is no
    /// such number, as the likelihood of a fit that leaves a value outside its support.
    std::string_view expected;
    double found = 0; ///< NaN for none
    bool agrees = false;
};

/// How far a value may lie from `expected`: half a unit of its last digit, and a ten-millionth of
/// that for the rounding of the binary numbers.
double Tolerance(std::string_view expected);

/// What was found in the notation, and with as many digits, as what was expected.
std::string FoundText(const Comparison& comparison);

using Comparisons = std::vector<Comparison>;

/// Adds a value, compared.
void Compare(Comparisons& list, const CaseLabel& label, std::string quantity,
             std::string_view expected, double found);

} // namespace ryn::selfcheck
