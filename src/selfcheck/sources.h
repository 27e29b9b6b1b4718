#pragma once

#include <string_view>

/// Where the published values come from. "An independent program" was written for these values
/// alone, from the formulas of the literature; it shares nothing with this one.
namespace ryn::selfcheck {

inline constexpr std::string_view kProgram = "an independent program";
inline constexpr std::string_view kScipyMoments =
    "an independent program; moments of the fit by scipy 1.10.1";
inline constexpr std::string_view kMpmathMoments =
    "an independent program; moments of the fit by mpmath 1.2.1";
inline constexpr std::string_view kFormulaInR = "an independent program; the formula in R 4.2.2";
inline constexpr std::string_view kTwoOptimisers = "an independent program, two optimisers";
inline constexpr std::string_view kOf40Digits =
    "an independent program; x100 by arithmetic of 40 digits";
inline constexpr std::string_view kOf30Digits =
    "an independent program; x100 by arithmetic of 30 digits";
inline constexpr std::string_view kExactFormula = "an independent program; the exact formula";
inline constexpr std::string_view kLmom = "R lmom 3.2; an independent program";
inline constexpr std::string_view kLmomOfMoments =
    "R lmom 3.2 with moments by R; an independent program";
inline constexpr std::string_view kEvd = "R evd 2.3-6.1; an independent program";
inline constexpr std::string_view kEnvStats = "R EnvStats 3.1.0; an independent program";
inline constexpr std::string_view kFitdistrplus = "R fitdistrplus 1.1-8; an independent program";
inline constexpr std::string_view kFitdistrplusEnvStats =
    "R fitdistrplus 1.1-8 and EnvStats 3.1.0; an independent program";
inline constexpr std::string_view kOptim =
    "R optim with the density of evd 2.3-6.1; an independent program";
inline constexpr std::string_view kColes = "Coles (2001)";
inline constexpr std::string_view kBulletin = "Bulletin 17B (1982)";

} // namespace ryn::selfcheck
