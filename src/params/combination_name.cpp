#include "params/combination_name.h"

#include <algorithm>
#include <array>
#include <cctype>

#include "series/selection_rules.h"

namespace ryn {

namespace {

/// What a dialog offers for one distribution.
struct Offer {
    int distribution;
    std::array<bool, 3> methods; // moments, likelihood, L-moments
    std::string_view fixedCode;
    std::string_view estimatedCode;
};

constexpr std::array kAnnual = std::to_array<Offer>({
    {kGeneralizedExtremeValue, {true, true, true}, "GEV", "GEV"},
    {kGumbel, {true, true, true}, "GUM", "GUM"},
    {kWeibull, {true, false, true}, "WEI", "WEI"},
    {kFrechet, {true, false, false}, "FRE", "FRE"},
    {kGeneralisedPareto, {true, false, true}, "GP", "GP"},
    {kGammaPearson3, {true, false, true}, "P3", "P3"},
    {kLogPearson3, {true, false, true}, "LP3", "LP3"},
    {kLogNormal, {true, true, true}, "LN2", "LN3"},
    {kSquareRootExponential, {false, true, false}, "SQE", "SQE"},
});

constexpr std::array kPartial = std::to_array<Offer>({
    {kWeibull, {true, true, true}, "WEI2", "WEI3"},
    {kGeneralisedPareto, {true, true, true}, "GP2", "GP3"},
    {kGammaPearson3, {true, true, true}, "GAM", "P3"},
    {kLogPearson3, {true, false, true}, "LP3", "LP3"},
    {kLogNormal, {true, true, true}, "LN2", "LN3"},
    {kExponential, {true, true, true}, "EXP1", "EXP2"},
    {kTruncatedGumbel, {false, true, false}, "TGUM", "TGUM"},
});

constexpr std::array<std::string_view, 3> kMethodCodes = {"MOM", "ML", "LMOM"};
constexpr std::array<std::string_view, 2> kLogPearsonCodes = {"/LOG", "/REAL"};
constexpr std::array<std::string_view, 4> kLogNormalCodes = {"/BI", "/BII", "/LBQI", "/LBQII"};

template <typename Use>
void ForEachOffer(int selectionMethod, Use use) {
    if (selectionMethod == kSelectAnnualMaxima)
        std::for_each(kAnnual.begin(), kAnnual.end(), use);
    else
        std::for_each(kPartial.begin(), kPartial.end(), use);
}

template <std::size_t N>
std::string_view CodeAt(const std::array<std::string_view, N>& codes, int index) {
    return index >= 0 && static_cast<std::size_t>(index) < N
               ? codes[static_cast<std::size_t>(index)]
               : std::string_view();
}

/// The location counts as estimated in the name. Annual log-normal by L-moments has two parameters
/// whatever the option says.
bool NamesEstimatedLocation(const DieCombination& combination, int selectionMethod) {
    const bool annualByLMoments =
        selectionMethod == kSelectAnnualMaxima && combination.EstimationMethod == kLMoments;
    return combination.EstimateLocationType != 0 && !annualByLMoments;
}

/// Whether the dialogs let the location be estimated for a distribution and method.
bool LocationIsOpen(const DieCombination& combination, int selectionMethod) {
    const bool logNormal = combination.DistributionType == kLogNormal;
    if (combination.EstimationMethod == kMoments)
        return selectionMethod != kSelectAnnualMaxima || logNormal;
    if (combination.EstimationMethod == kMaximumLikelihood)
        return logNormal;
    return selectionMethod != kSelectAnnualMaxima && !logNormal;
}

/// All combinations with a name of their own for one distribution and method.
std::vector<DieCombination> Variants(const DieCombination& base, int selectionMethod) {
    std::vector<DieCombination> variants;
    const auto add = [&variants](DieCombination variant) {
        variants.push_back(std::move(variant));
    };
    add(base);
    DieCombination estimated = base;
    estimated.EstimateLocationType = 1;
    const bool byMoments = base.EstimationMethod == kMoments;
    if (base.DistributionType == kLogPearson3 && byMoments) {
        DieCombination realSpace = base;
        realSpace.LogPearsonType = 1;
        add(realSpace);
    } else if (base.DistributionType == kLogNormal && byMoments) {
        for (int type = 0; type < 4; ++type) {
            estimated.LogNormalType = type;
            add(estimated);
        }
    } else if (LocationIsOpen(base, selectionMethod) &&
               GeneratedName(base, selectionMethod) != GeneratedName(estimated, selectionMethod)) {
        add(estimated);
    }
    return variants;
}

std::vector<DieCombination> AllCombinations(int selectionMethod) {
    std::vector<DieCombination> all;
    ForEachOffer(selectionMethod, [&](const Offer& offer) {
        for (int method = 0; method < 3; ++method) {
            if (!offer.methods[static_cast<std::size_t>(method)])
                continue;
            DieCombination base;
            base.DistributionType = offer.distribution;
            base.EstimationMethod = method;
            for (DieCombination& variant : Variants(base, selectionMethod)) {
                variant.ItemName = GeneratedName(variant, selectionMethod);
                all.push_back(std::move(variant));
            }
        }
    });
    return all;
}

std::string UpperCase(std::string_view text) {
    std::string upper(text);
    std::transform(upper.begin(), upper.end(), upper.begin(),
                   [](unsigned char c) { return static_cast<char>(std::toupper(c)); });
    return upper;
}

} // namespace

std::string GeneratedName(const DieCombination& combination, int selectionMethod) {
    const bool estimated = NamesEstimatedLocation(combination, selectionMethod);
    std::string name;
    ForEachOffer(selectionMethod, [&](const Offer& offer) {
        if (offer.distribution == combination.DistributionType)
            name = estimated ? offer.estimatedCode : offer.fixedCode;
    });
    if (name.empty())
        return name;
    name.append("/").append(CodeAt(kMethodCodes, combination.EstimationMethod));
    if (combination.EstimationMethod != kMoments)
        return name;
    if (combination.DistributionType == kLogPearson3)
        name.append(CodeAt(kLogPearsonCodes, combination.LogPearsonType));
    if (combination.DistributionType == kLogNormal && combination.EstimateLocationType != 0)
        name.append(CodeAt(kLogNormalCodes, combination.LogNormalType));
    return name;
}

std::optional<DieCombination> CombinationOfName(std::string_view name, int selectionMethod) {
    const std::string wanted = UpperCase(name);
    for (DieCombination& combination : AllCombinations(selectionMethod))
        if (combination.ItemName == wanted)
            return combination;
    return std::nullopt;
}

std::vector<std::string> GeneratedNames(int selectionMethod) {
    std::vector<std::string> names;
    for (const DieCombination& combination : AllCombinations(selectionMethod))
        names.push_back(combination.ItemName);
    return names;
}

} // namespace ryn
