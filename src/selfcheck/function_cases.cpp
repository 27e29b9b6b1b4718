#include <array>
#include <cmath>
#include <cstdint>
#include <limits>
#include <optional>
#include <string>

#include "base/number_text.h"
#include "selfcheck/case_groups.h"
#include "selfcheck/sources.h"
#include "stats/distribution.h"
#include "stats/resampling_draws.h"
#include "stats/shape_functions.h"

namespace ryn::selfcheck {

namespace {

constexpr std::string_view kScipy = "scipy 1.10.1; an independent program";
constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();

/// Ten significant digits.
struct FunctionCase {
    CaseLabel label;
    double at;                 ///< a value of the variable
    std::string_view quantile; ///< of 0.99
    std::string_view cdf;
    std::string_view logDensity; ///< empty: not published
};

// The parameters stand in the label too, in the same order.
template <stats::Family Family>
void CompareFamily(Comparisons& list, const FunctionCase& row, const std::optional<Family>& d) {
    const std::string at = '(' + ShortestText(row.at) + ')';
    Compare(list, row.label, "x(0.99)", row.quantile, d ? stats::Quantile(*d, 0.99) : kNaN);
    Compare(list, row.label, "F" + at, row.cdf, d ? stats::Cdf(*d, row.at) : kNaN);
    if (!row.logDensity.empty())
        Compare(list, row.label, "ln f" + at, row.logDensity,
                d ? stats::LogDensity(*d, row.at) : kNaN);
}

void CompareFamilies(Comparisons& list) {
    CompareFamily(
        list,
        {{"F1", "", "GEV(3.87, 0.2, 0.05)", "scipy 1.10.1, FAdist 2.4; an independent program"},
         4.5,
         "4.691889303",
         "0.9680575771",
         "-1.679276519"},
        stats::Gev::Make({3.87, 0.2, 0.05}));
    CompareFamily(
        list,
        {{"F2", "", "P3(1, 2, 3)", kScipy}, 10, "17.81189383", "0.8264219291", "-2.878139568"},
        stats::PearsonThree::Make({1, 2, 3}));
    CompareFamily(list,
                  {{"F3", "", "P3(1, -2, 3)", kProgram}, -5, "0.1279096698", "0.4231900811", ""},
                  stats::PearsonThree::Make({1, -2, 3}));
    CompareFamily(list,
                  {{"F4", "", "GP(40, 11.25, -0.0577)", kScipy},
                   60,
                   "99.34376800",
                   "0.8159208541",
                   "-4.210408474"},
                  stats::GeneralisedPareto::Make({40, 11.25, -0.0577}));
    CompareFamily(list,
                  {{"F5", "", "WEI(40, 11.7, 0.958)", kScipy},
                   60,
                   "97.61149207",
                   "0.8120049247",
                   "-4.196353878"},
                  stats::Weibull::Make({40, 11.7, 0.958}));
    CompareFamily(
        list,
        {{"F6", "", "FRE(2000, 2.9)", kScipy}, 3000, "9770.870239", "0.7345061127", "-8.426062605"},
        stats::Frechet::Make({2000, 2.9}));
    CompareFamily(list,
                  {{"F7", "", "LP3(6.2, 0.2, 7.5)", kScipy},
                   3000,
                   "10485.94866",
                   "0.7406672594",
                   "-8.658218559"},
                  stats::LogPearsonThree::Make({6.2, 0.2, 7.5}));
    CompareFamily(list,
                  {{"F8", "", "LN3(30, 2.5, 0.7)", kScipy},
                   50,
                   "92.08121901",
                   "0.7605860402",
                   "-3.808761666"},
                  stats::LogNormal::Make({30, 2.5, 0.7}));
    const auto squareRoot = stats::SquareRootExponential::Make({72, 13.27});
    CompareFamily(
        list,
        {{"F9", "", "SQE(72, 13.27)", kScipy}, 5, "9.783264948", "0.8261539580", "-2.167500279"},
        squareRoot);
    Compare(list, {"F9", "", "SQE(72, 13.27)", kScipy}, "F(0)", "5.380186e-32",
            squareRoot ? stats::Cdf(*squareRoot, 0.0) : kNaN);
    CompareFamily(list,
                  {{"F10", "", "TGUM(3.935, 0.1712; 3.8)", kScipy},
                   4.2,
                   "4.742741869",
                   "0.7845334184",
                   "0.1217417296"},
                  stats::TruncatedGumbel::Make({3.935, 0.1712}, 3.8));
}

/// The n-th uniform number of a seed.
double UniformNumber(std::uint64_t seed, int n) {
    stats::UniformDraws draws(seed);
    double last = kNaN;
    for (int i = 0; i < n; ++i)
        last = draws.Next();
    return last;
}

// The language's standard gives the generator's 10000th output, 9981545732273789042; its upper 52
// bits k make the uniform number (k + 1/2) 2^-52.
void CompareRandomNumbers(Comparisons& list) {
    constexpr std::uint64_t kDefaultSeed = 5489;
    constexpr std::uint64_t kSeed = 12345;
    Compare(list, {"F11", "", "mt19937_64, default seed", "ISO/IEC 14882, [rand.predef]"}, "u10000",
            "0.54110067838473286", UniformNumber(kDefaultSeed, 10000));
    const CaseLabel uniform{"F12", "", "mt19937_64, seed 12345", kProgram};
    Compare(list, uniform, "u1", "0.35762972288842587", UniformNumber(kSeed, 1));
    Compare(list, uniform, "u2", "0.40044261704406126", UniformNumber(kSeed, 2));
    Compare(list, uniform, "u3", "0.68938331700276845", UniformNumber(kSeed, 3));
    const CaseLabel counts{"F13", "", "Poisson(44), seed 12345", kProgram};
    constexpr std::array<std::string_view, 3> kCounts = {"41", "42", "47"};
    for (int i = 0; i < 3; ++i)
        Compare(list, counts, "count " + std::to_string(i + 1),
                kCounts[static_cast<std::size_t>(i)],
                static_cast<double>(stats::PoissonCount(44, UniformNumber(kSeed, i + 1))));
}

void CompareGevSkewness(Comparisons& list) {
    const CaseLabel label{"F14", "", "skewness of GEV", "mpmath 1.2.1"};
    Compare(list, label, "kappa 0.01", "1.0810737598", stats::GevSkewness(0.01));
    Compare(list, label, "kappa -0.01", "1.2004785198", stats::GevSkewness(-0.01));
}

} // namespace

void CompareFunctions(Comparisons& list) {
    CompareFamilies(list);
    CompareRandomNumbers(list);
    CompareGevSkewness(list);
}

} // namespace ryn::selfcheck
